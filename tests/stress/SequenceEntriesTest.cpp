// The storage of sequences against a plain vector: random changes of long lists, with snapshots in
// between, and memory that runs out at each allocation.
#include "tarnkiln/collections/SequenceEntries.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/FailingAllocation.h"
#include "tests/support/NodeImpl.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <algorithm>
#include <random>
#include <vector>

namespace {

using namespace testkit;
using support::SequenceEntries;

/// What both have to hold.
using Plain = std::vector<ModelElement>;

Plain contentsOf(SequenceEntries const& entries)
{
    Plain result;
    entries.appendTo(result);
    return result;
}

bool holds(SequenceEntries const& entries, Plain const& wanted)
{
    return entries.isSound() && entries.size() == wanted.size() && contentsOf(entries) == wanted;
}

std::size_t positionIn(Plain const& list, ModelElement const& element)
{
    return static_cast<std::size_t>(std::find(list.begin(), list.end(), element) - list.begin());
}

/// Some thousand elements, of which the reference counts are known.
class Elements
{
public:
    explicit Elements(std::size_t count)
    {
        for (std::size_t i = 0; i < count; ++i)
            m_all.push_back(Node::create(m_model));
        m_refCount = m_all.front().getImpl()->getRefCount();
    }

    ModelElement const& operator[](std::size_t index) const { return m_all[index % m_all.size()]; }
    std::size_t size() const { return m_all.size(); }
    /// Whether nobody else holds any of them.
    bool areReleased() const
    {
        return std::all_of(m_all.begin(), m_all.end(), [&](ModelElement const& element) {
            return element.getImpl()->getRefCount() == m_refCount;
        });
    }

private:
    Model const m_model = Model::create(ModelConstellation());
    Plain m_all;
    std::uint32_t m_refCount;
};

/// Entries, a plain list that does the same, and snapshots of both.
class Play
{
public:
    Play(Elements const& elements, std::uint32_t seed, bool unique)
        : m_elements(elements),
          m_random(seed),
          m_unique(unique)
    {}

    void step()
    {
        switch (draw(12))
        {
        case 0:
            insertSome(m_list.size(), /*goesOn=*/true);
            break;
        case 1:
            insertSome(0, /*goesOn=*/false);
            break;
        case 2:
            insertSome(draw(m_list.size() + 1), /*goesOn=*/true);
            break;
        case 3:
            insertSome(draw(m_list.size() + 1), /*goesOn=*/false);
            break;
        case 4:
            takeSome([&] { return std::size_t{0}; });
            break;
        case 5:
            takeSome([&] { return m_list.size() - 1; });
            break;
        case 6:
            takeSome([&] { return draw(m_list.size()); });
            break;
        case 7:
            removeSome();
            break;
        case 8:
            exchangeSome();
            break;
        case 9:
            m_snapshots.emplace_back(m_entries, m_list);
            break;
        case 10:
            restore();
            break;
        default:
            dropSnapshot();
        }
    }
    void check() const
    {
        RC_ASSERT(holds(m_entries, m_list));
        for (std::size_t i = 0; i < m_list.size(); i += 7)
            RC_ASSERT(m_entries[i] == m_list[i]);
        RC_ASSERT(!m_entries[m_list.size()].getImpl());
    }
    void checkSnapshots() const
    {
        for (auto const& [entries, list] : m_snapshots)
            RC_ASSERT(holds(entries, list));
    }

private:
    std::size_t draw(std::size_t limit) { return limit == 0 ? 0 : m_random() % limit; }
    /// An element; one that is not in here if it must not be twice, or none.
    ModelElement newcomer()
    {
        ModelElement const& element = m_elements[draw(m_elements.size())];
        bool const isKnown = m_unique && positionIn(m_list, element) != m_list.size();
        return isKnown ? ModelElement() : element;
    }
    void insertSome(std::size_t place, bool goesOn)
    {
        for (std::size_t count = draw(300); count != 0; --count)
        {
            ModelElement const element = newcomer();
            if (!element)
                continue;
            m_entries.insert(place, element);
            m_list.insert(m_list.begin() + static_cast<std::ptrdiff_t>(place), element);
            place += goesOn ? 1 : 0;
        }
    }
    template <class Pick> void takeSome(Pick const& pick)
    {
        for (std::size_t count = std::min(draw(300), m_list.size()); count != 0; --count)
            takeAt(pick());
    }
    void takeAt(std::size_t place)
    {
        RC_ASSERT(m_entries.take(place) == m_list[place]);
        m_list.erase(m_list.begin() + static_cast<std::ptrdiff_t>(place));
    }
    /// By the element, in random order or one after the other.
    void removeSome()
    {
        bool const atRandom = draw(2) == 0;
        std::size_t next = draw(m_list.size());
        for (std::size_t count = std::min(draw(100), m_list.size()); count != 0; --count)
        {
            next = atRandom ? draw(m_list.size()) : std::min(next, m_list.size() - 1);
            ModelElement const element = m_list[next];
            std::size_t const first = positionIn(m_list, element);
            RC_ASSERT(m_entries.findFirst(element) == first);
            RC_ASSERT(m_entries.findForChange(element, /*mustBeFirst=*/true) == first);
            std::size_t const found = m_entries.findForChange(element, /*mustBeFirst=*/!m_unique);
            RC_ASSERT(found == first);
            takeAt(found);
        }
        ModelElement const absent = newcomer();
        if (absent && m_unique)
            RC_ASSERT(m_entries.findForChange(absent, /*mustBeFirst=*/false) == m_list.size());
    }
    void exchangeSome()
    {
        for (std::size_t count = m_list.empty() ? 0 : draw(30); count != 0; --count)
        {
            std::size_t const place = draw(m_list.size());
            std::size_t const other = draw(m_list.size());
            m_entries.swapEntries(place, other);
            std::swap(m_list[place], m_list[other]);
            if (ModelElement const element = newcomer())
                RC_ASSERT(m_entries.exchange(place, element) ==
                          std::exchange(m_list[place], element));
        }
    }
    void restore()
    {
        if (m_snapshots.empty())
            return;
        auto& [entries, list] = m_snapshots[draw(m_snapshots.size())];
        m_entries.swap(entries);
        m_list.swap(list);
    }
    void dropSnapshot()
    {
        if (m_snapshots.empty())
            return;
        std::swap(m_snapshots[draw(m_snapshots.size())], m_snapshots.back());
        m_snapshots.pop_back();
    }

    Elements const& m_elements;
    std::mt19937 m_random;
    bool m_unique;
    SequenceEntries m_entries;
    Plain m_list;
    std::vector<std::pair<SequenceEntries, Plain>> m_snapshots;
};

TEST(SequenceEntries, DoWhatAPlainListDoes)
{
    Elements const elements(4000);

    EXPECT_TRUE(rc::check("entries and snapshots are those of plain lists", [&] {
        {
            Play play(elements, *rc::gen::arbitrary<std::uint32_t>(), *rc::gen::arbitrary<bool>());
            int const steps = *rc::gen::inRange(1, 80);
            for (int i = 0; i < steps; ++i)
            {
                play.step();
                play.check();
                if (i % 8 == 0)
                    play.checkSnapshots();
            }
            play.checkSnapshots();
        }
        RC_ASSERT(elements.areReleased());
    }));
}

/// Does `change` with each allocation failing once, until it needs no more of them.
template <class Change> void expectAllOrNothing(SequenceEntries& entries, Change const& change)
{
    Plain const before = contentsOf(entries);
    for (unsigned long number = 1;; ++number)
    {
        bool hasFailed = false;
        {
            FailingAllocation const failing(number, Failing::Once);
            try
            {
                change();
            }
            catch (std::bad_alloc const&)
            {
                hasFailed = true;
            }
        }
        if (!hasFailed)
            break;
        ASSERT_TRUE(holds(entries, before)) << "after allocation " << number << " failed";
    }
    ASSERT_TRUE(entries.isSound());
}

/// Entries of 0 to some thousand elements, with a snapshot that shares them all.
class ExhaustedMemory : public ::testing::TestWithParam<std::size_t>
{
protected:
    ExhaustedMemory()
    {
        for (std::size_t i = 0; i < GetParam(); ++i)
            entries.append(elements[i]);
        snapshot = entries;
        list = contentsOf(entries);
    }
    ~ExhaustedMemory() override { EXPECT_TRUE(holds(snapshot, list)); }

    Elements const elements{5000};
    ModelElement const added = elements[4999];
    SequenceEntries entries;
    SequenceEntries snapshot;
    Plain list;
};

TEST_P(ExhaustedMemory, LeavesEntriesAsTheyWereWhenOneIsInserted)
{
    for (std::size_t const place : {std::size_t{0}, list.size() / 3, list.size()})
    {
        entries = snapshot;
        expectAllOrNothing(entries, [&] { entries.insert(place, added); });

        Plain expected = list;
        expected.insert(expected.begin() + static_cast<std::ptrdiff_t>(place), added);
        EXPECT_TRUE(holds(entries, expected)) << "at " << place;
    }
}

TEST_P(ExhaustedMemory, LeavesEntriesAsTheyWereWhenOneIsTaken)
{
    for (std::size_t place = 0; place < list.size(); place = place * 2 + 1)
    {
        entries = snapshot;
        ModelElement taken;
        expectAllOrNothing(entries, [&] { taken = entries.take(place); });

        EXPECT_EQ(taken, list[place]);
        Plain expected = list;
        expected.erase(expected.begin() + static_cast<std::ptrdiff_t>(place));
        EXPECT_TRUE(holds(entries, expected)) << "at " << place;
    }
}

TEST_P(ExhaustedMemory, LeavesEntriesAsTheyWereWhenTheyAreExchanged)
{
    if (list.size() < 2)
        return;
    std::size_t const last = list.size() - 1;
    expectAllOrNothing(entries, [&] { entries.exchange(last, added); });
    entries.exchange(last, list[last]);
    entries = snapshot;
    expectAllOrNothing(entries, [&] { entries.swapEntries(0, last); });

    Plain expected = list;
    std::swap(expected.front(), expected.back());
    EXPECT_TRUE(holds(entries, expected));
}

TEST_P(ExhaustedMemory, LetsFindersDoWithoutAnIndex)
{
    SequenceEntries own = entries.duplicate();
    for (unsigned long number = 1; number < 4; ++number)
    {
        for (std::size_t i = 0; i < list.size(); i += 97)
        {
            std::size_t const place = (i * 61) % list.size();
            FailingAllocation const failing(number, Failing::FromThereOn);
            ASSERT_EQ(own.findForChange(list[place], /*mustBeFirst=*/true), place);
        }
    }
    for (std::size_t i = 0; i < 20 && !list.empty(); ++i)
        own.findForChange(list[list.size() / 2], /*mustBeFirst=*/true);
    expectAllOrNothing(own, [&] { own.append(added); });
    EXPECT_EQ(own.findForChange(added, /*mustBeFirst=*/true), list.size());
}

INSTANTIATE_TEST_SUITE_P(Sizes, ExhaustedMemory, testing::Values(0, 1, 2, 31, 32, 300, 992, 4000));
TEST(SharedEntries, HaveRoomForMoreAfterSomeWereTaken)
{
    Elements const elements(40);
    for (std::size_t size = 1; size < elements.size(); ++size)
    {
        SequenceEntries entries;
        Plain list;
        for (std::size_t i = 0; i < size; ++i)
        {
            entries.append(elements[i]);
            list.push_back(elements[i]);
        }
        for (; list.size() > size / 2; list.pop_back())
            static_cast<void>(entries.take(list.size() - 1));
        SequenceEntries const snapshot = entries;
        Plain const before = list;

        entries.append(elements[size]);
        list.push_back(elements[size]);

        EXPECT_TRUE(holds(entries, list)) << size;
        EXPECT_TRUE(holds(snapshot, before)) << size;
    }
}
}  // namespace
