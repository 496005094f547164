#include "tarnkiln/support/TopLevelElements.h"
#include "tests/support/PlainElement.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

#include <random>
#include <unordered_set>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using support::TopLevelElements;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;

class TopLevel : public ::testing::Test
{
protected:
    Plain make() const { return Plain(new Plain::Impl(m_model, UUID{})); }

    Model const m_model = Model::createTransientModel();
    TopLevelElements elements;
};

using TheTopLevelSet = TopLevel;

TEST_F(TheTopLevelSet, IsEmptyAtFirst)
{
    Plain const stranger = make();

    EXPECT_EQ(elements.size(), 0u);
    EXPECT_FALSE(elements.contains(stranger.getImpl()));
    elements.erase(stranger.getImpl());
    elements.clear();
    EXPECT_THAT(elements.all(), IsEmpty());
}

TEST_F(TheTopLevelSet, HoldsEachElementOnce)
{
    Plain const element = make();

    elements.insert(element.getImpl());
    elements.insert(element.getImpl());

    EXPECT_EQ(element->getRefCount(), 2u);
    EXPECT_THAT(elements.all(), ElementsAre(ModelElement(element)));
    elements.erase(element.getImpl());
    EXPECT_EQ(element->getRefCount(), 1u);
    EXPECT_FALSE(elements.contains(element.getImpl()));
}

TEST_F(TheTopLevelSet, ErasesAnyOfSeveral)
{
    for (std::size_t erased = 0; erased < 3; ++erased)
    {
        TopLevelElements mine;
        std::vector<Plain> const made{make(), make(), make()};
        for (Plain const& element : made)
            mine.insert(element.getImpl());

        mine.erase(made[erased].getImpl());

        for (std::size_t i = 0; i < 3; ++i)
            EXPECT_EQ(mine.contains(made[i].getImpl()), i != erased);
        EXPECT_EQ(mine.size(), 2u);
    }
}

TEST_F(TheTopLevelSet, LetsAnElementDieThatNobodyElseHolds)
{
    long const before = Plain::Impl::inMemory;
    ModelElement::Impl* const impl = [&] {
        Plain const element = make();
        elements.insert(element.getImpl());
        return element.getImpl();
    }();
    elements.insert(make().getImpl());
    EXPECT_EQ(Plain::Impl::inMemory, before + 2);

    elements.erase(impl);
    EXPECT_EQ(Plain::Impl::inMemory, before + 1);
    elements.clear();

    EXPECT_EQ(Plain::Impl::inMemory, before);
    EXPECT_EQ(elements.size(), 0u);
}

TEST_F(TheTopLevelSet, TakesElementsInAgainAfterItWasCleared)
{
    Plain const element = make();
    elements.insert(element.getImpl());
    elements.clear();
    EXPECT_FALSE(elements.contains(element.getImpl()));

    elements.insert(element.getImpl());

    EXPECT_TRUE(elements.contains(element.getImpl()));
}

TEST_F(TheTopLevelSet, TakesElementsBackForWhichRoomWasKeptWithoutMoving)
{
    std::vector<Plain> const made{make(), make(), make()};
    for (Plain const& element : made)
    {
        elements.insert(element.getImpl());
        elements.reserveReturn();
        elements.erase(element.getImpl());
    }
    std::vector<Plain> others;
    for (int i = 0; i < 40; ++i)
    {
        others.push_back(make());
        elements.insert(others.back().getImpl());
    }
    ModelElement const* const storage = elements.all().data();

    for (Plain const& element : made)
    {
        elements.insertReturning(element.getImpl());
        elements.insertReturning(element.getImpl());
    }

    EXPECT_EQ(elements.all().data(), storage);
    EXPECT_EQ(elements.size(), 43u);
    EXPECT_EQ(made[0]->getRefCount(), 2u);
    elements.forgetReturns();
}

TEST_F(TheTopLevelSet, IsNotMisledByThePlaceOfAnElementInAnotherSet)
{
    TopLevelElements other;
    Plain const here = make();
    Plain const there = make();
    elements.insert(here.getImpl());
    other.insert(there.getImpl());

    EXPECT_FALSE(elements.contains(there.getImpl()));
    elements.erase(there.getImpl());

    EXPECT_TRUE(elements.contains(here.getImpl()));
    EXPECT_TRUE(other.contains(there.getImpl()));
}

TEST_F(TheTopLevelSet, AgreesWithASetAfterAnyOperations)
{
    std::mt19937 random(7);
    std::vector<Plain> pool;
    for (int i = 0; i < 200; ++i)
        pool.push_back(make());
    std::unordered_set<ModelElement::Impl*> expected;
    for (int step = 0; step < 10'000; ++step)
    {
        ModelElement::Impl* const element = pool[random() % pool.size()].getImpl();
        if (random() % 2)
        {
            elements.insert(element);
            expected.insert(element);
        }
        else
        {
            elements.erase(element);
            expected.erase(element);
        }
        ASSERT_EQ(elements.contains(element), expected.count(element) != 0);
        ASSERT_EQ(elements.size(), expected.size());
    }
    for (Plain const& element : pool)
    {
        EXPECT_EQ(elements.contains(element.getImpl()), expected.count(element.getImpl()) != 0);
        EXPECT_EQ(element->getRefCount(), 1u + expected.count(element.getImpl()));
    }
}
}  // namespace
