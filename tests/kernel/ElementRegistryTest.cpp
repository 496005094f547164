#include "tarnkiln/support/ElementRegistry.h"
#include "tests/support/PlainElement.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <random>
#include <unordered_set>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using support::ElementRegistry;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;
using ::testing::UnorderedElementsAreArray;

/// Elements that no model knows, and a registry of their own.
class Registry : public ::testing::Test
{
protected:
    ModelElement::Impl* make(UUID const& id)
    {
        m_made.push_back(Plain(new Plain::Impl(m_model, id)));
        return m_made.back().getImpl();
    }
    std::vector<ModelElement::Impl*> all() const
    {
        std::vector<ModelElement::Impl*> result;
        registry.forEach([&](ModelElement::Impl* element) { result.push_back(element); });
        return result;
    }

    ElementRegistry registry;

private:
    Model const m_model = Model::createTransientModel();
    std::vector<Plain> m_made;
};

using AnElementRegistry = Registry;

TEST_F(AnElementRegistry, IsEmptyAtFirst)
{
    ModelElement::Impl* const stranger = make(uuidOf(1));

    EXPECT_EQ(registry.size(), 0u);
    EXPECT_EQ(registry.find(uuidOf(1)), nullptr);
    EXPECT_FALSE(registry.contains(stranger));
    EXPECT_THAT(all(), IsEmpty());
    registry.erase(stranger);
    registry.clear();
    EXPECT_EQ(registry.size(), 0u);
}

TEST_F(AnElementRegistry, FindsWhatWasInserted)
{
    ModelElement::Impl* const first = make(uuidOf(1));
    ModelElement::Impl* const second = make(uuidOf(2));

    EXPECT_TRUE(registry.insert(first));
    EXPECT_TRUE(registry.insert(second));

    EXPECT_EQ(registry.find(uuidOf(1)), first);
    EXPECT_EQ(registry.find(uuidOf(2)), second);
    EXPECT_EQ(registry.find(uuidOf(3)), nullptr);
    EXPECT_THAT(all(), UnorderedElementsAre(first, second));
}

TEST_F(AnElementRegistry, HoldsNoReference)
{
    ModelElement::Impl* const element = make(uuidOf(1));

    registry.insert(element);

    EXPECT_EQ(element->getRefCount(), 1u);
}

TEST_F(AnElementRegistry, RefusesATakenUuid)
{
    ModelElement::Impl* const first = make(uuidOf(1));
    ModelElement::Impl* const second = make(uuidOf(1));
    registry.insert(first);

    EXPECT_FALSE(registry.insert(second));
    EXPECT_FALSE(registry.insert(first));

    EXPECT_EQ(registry.size(), 1u);
    EXPECT_EQ(registry.find(uuidOf(1)), first);
    EXPECT_TRUE(registry.contains(first));
    EXPECT_FALSE(registry.contains(second));
}

TEST_F(AnElementRegistry, ErasesTheElementAndNotAnotherOfItsUuid)
{
    ModelElement::Impl* const first = make(uuidOf(1));
    ModelElement::Impl* const twin = make(uuidOf(1));
    registry.insert(first);

    registry.erase(twin);
    EXPECT_EQ(registry.find(uuidOf(1)), first);
    registry.erase(first);

    EXPECT_EQ(registry.find(uuidOf(1)), nullptr);
    EXPECT_EQ(registry.size(), 0u);
}

TEST_F(AnElementRegistry, CanBeClearedAndFilledAgain)
{
    for (std::uint32_t i = 0; i < 100; ++i)
        registry.insert(make(uuidOf(i)));

    registry.clear();
    EXPECT_EQ(registry.size(), 0u);
    EXPECT_EQ(registry.find(uuidOf(7)), nullptr);
    EXPECT_TRUE(registry.insert(make(uuidOf(7))));

    EXPECT_EQ(registry.size(), 1u);
}

TEST_F(AnElementRegistry, TakesElementsBack)
{
    std::vector<ModelElement::Impl*> elements;
    for (std::uint32_t i = 0; i < 50; ++i)
    {
        elements.push_back(make(uuidOf(i)));
        registry.insert(elements.back());
    }
    for (ModelElement::Impl* const element : elements)
    {
        registry.reserveReturn();
        registry.erase(element);
    }
    for (std::uint32_t i = 100; i < 150; ++i)
        registry.insert(make(uuidOf(i)));

    for (ModelElement::Impl* const element : elements)
        registry.insertReturning(element);

    EXPECT_EQ(registry.size(), 100u);
    for (std::uint32_t i = 0; i < 50; ++i)
        EXPECT_EQ(registry.find(uuidOf(i)), elements[i]);
    registry.forgetReturns();
    EXPECT_TRUE(registry.insert(make(uuidOf(200))));
}

TEST_F(AnElementRegistry, TakesElementsBackForWhichNoRoomWasKept)
{
    std::vector<ModelElement::Impl*> elements;
    for (std::uint32_t i = 0; i < 200; ++i)
    {
        elements.push_back(make(uuidOf(i)));
        registry.insertReturning(elements.back());
    }

    EXPECT_EQ(registry.size(), 200u);
    for (std::uint32_t i = 0; i < 200; ++i)
        EXPECT_EQ(registry.find(uuidOf(i)), elements[i]);
}

TEST_F(AnElementRegistry, VisitsEachElementOnceHoweverManyThereAre)
{
    std::vector<ModelElement::Impl*> elements;
    for (std::uint32_t i = 0; i < 300; ++i)
    {
        ASSERT_THAT(all(), UnorderedElementsAreArray(elements));
        elements.push_back(make(uuidOf(i)));
        registry.insert(elements.back());
    }
}

TEST_F(AnElementRegistry, LosesNoneAndTakesNoneTwiceWhileItGrowsAndShrinks)
{
    std::vector<ModelElement::Impl*> elements;
    for (std::uint32_t i = 0; i < 20'000; ++i)
    {
        elements.push_back(make(uuidOf(i)));
        ASSERT_TRUE(registry.insert(elements.back()));
        ASSERT_FALSE(registry.insert(elements.back()));
        ASSERT_EQ(registry.size(), i + 1);
    }
    std::shuffle(elements.begin(), elements.end(), std::mt19937(1));
    auto const half = elements.begin() + 10'000;

    std::for_each(elements.begin(), half, [&](auto* element) { registry.erase(element); });

    EXPECT_EQ(registry.size(), 10'000u);
    EXPECT_TRUE(std::none_of(elements.begin(), half,
                             [&](auto* element) { return registry.find(element->getUuid()); }));
    EXPECT_TRUE(std::all_of(half, elements.end(), [&](auto* element) {
        return registry.find(element->getUuid()) == element;
    }));
    std::for_each(elements.begin(), half,
                  [&](auto* element) { ASSERT_TRUE(registry.insert(element)); });
    std::vector<ModelElement::Impl*> visited = all();
    std::sort(visited.begin(), visited.end());
    std::sort(elements.begin(), elements.end());
    EXPECT_EQ(visited, elements);
}

TEST_F(AnElementRegistry, FindsElementsAmongOthersWhoseUuidsDifferInFewBits)
{
    // in each case all bytes but two are equal
    for (std::size_t byte = 0; byte + 1 < UUID::static_size(); ++byte)
    {
        ElementRegistry mine;
        std::vector<ModelElement::Impl*> elements;
        for (int i = 0; i < 2'000; ++i)
        {
            UUID id = uuidOf(0x12345678);
            id.data[byte] = static_cast<std::uint8_t>(i);
            id.data[byte + 1] = static_cast<std::uint8_t>(i >> 8);
            elements.push_back(make(id));
            ASSERT_TRUE(mine.insert(elements.back()));
        }
        for (ModelElement::Impl* const element : elements)
            ASSERT_EQ(mine.find(element->getUuid()), element);
        EXPECT_LT(mine.longestProbe(), 200u) << "bytes " << byte << " and " << byte + 1;
    }
}

TEST_F(AnElementRegistry, AgreesWithAMapAfterAnyOperations)
{
    for (unsigned seed = 1; seed <= 5; ++seed)
    {
        std::mt19937 random(seed);
        auto const below = [&](std::size_t end) { return random() % end; };
        ElementRegistry tested;
        std::unordered_map<std::uint32_t, ModelElement::Impl*> expected;
        std::unordered_map<std::uint32_t, ModelElement::Impl*> mayReturn;
        for (int step = 0; step < 4'000; ++step)
        {
            auto const number = static_cast<std::uint32_t>(below(300));
            UUID const id = uuidOf(number);
            auto const found = expected.find(number);
            switch (below(8))
            {
            case 0:
            case 1:
            case 2: {
                ModelElement::Impl* const element = make(id);
                ASSERT_EQ(tested.insert(element), found == expected.end());
                expected.emplace(number, element);
                break;
            }
            case 3:
                if (found != expected.end())
                {
                    tested.erase(found->second);
                    expected.erase(found);
                }
                break;
            case 4:
                if (found != expected.end() && !mayReturn.count(number))
                {
                    tested.reserveReturn();
                    tested.erase(found->second);
                    mayReturn.insert(*found);
                    expected.erase(found);
                }
                break;
            case 5:
                if (found == expected.end() && mayReturn.count(number))
                {
                    tested.insertReturning(mayReturn.at(number));
                    expected.emplace(number, mayReturn.at(number));
                    mayReturn.erase(number);
                }
                break;
            case 6:
                tested.erase(make(id));  // another one of that UUID
                break;
            default:
                if (below(50) == 0)
                {
                    tested.forgetReturns();
                    mayReturn.clear();
                }
            }
            ASSERT_EQ(tested.size(), expected.size());
        }
        std::unordered_set<ModelElement::Impl*> visited;
        tested.forEach([&](ModelElement::Impl* element) { visited.insert(element); });
        EXPECT_EQ(visited.size(), expected.size());
        for (std::uint32_t number = 0; number < 300; ++number)
        {
            auto const found = expected.find(number);
            ModelElement::Impl* const wanted = found == expected.end() ? nullptr : found->second;
            ASSERT_EQ(tested.find(uuidOf(number)), wanted);
            EXPECT_TRUE(!wanted || (visited.count(wanted) && tested.contains(wanted)));
        }
    }
}
}  // namespace
