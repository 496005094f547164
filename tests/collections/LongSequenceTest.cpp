// Sequences of more entries than one block holds: they do what short ones do.
#include "tests/collections/CollectionFixture.h"

#include <algorithm>
#include <random>

namespace testkit {
namespace {

class LongSequence : public CollectionFixture
{
protected:
    static constexpr std::size_t SIZE = 600;

    LongSequence()
    {
        atOnce([&] {
            for (std::size_t i = 0; i < SIZE; ++i)
                members.push_back(Node::create(model));
        });
    }

    /// In one transaction, since checked builds look at the whole model at the end of each.
    template <class Change> void atOnce(Change const& change) const
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        change();
        transaction.commit();
    }

    /// All members, each in the container `parent`.
    void fill(Node const& parent)
    {
        atOnce([&] {
            for (ModelElement const& member : members)
                parent->getChildren().push_back(Node::cast(member));
        });
    }
    /// The same members in an order that is the same in each run.
    std::vector<ModelElement> shuffledMembers() const
    {
        std::vector<ModelElement> result = members;
        std::shuffle(result.begin(), result.end(), std::mt19937(7));
        return result;
    }

    Node const parent = node(u"parent");
    Node const other = node(u"other");
    std::vector<ModelElement> members;
};

TEST_F(LongSequence, IsWalkedInItsOrder)
{
    fill(parent);

    std::vector<ModelElement> walked(parent->getChildren().begin(), parent->getChildren().end());
    EXPECT_EQ(walked, members);

    std::vector<ModelElement> backward;
    for (auto at = parent->getChildren().end(); at != parent->getChildren().begin();)
        backward.push_back(*--at);
    std::reverse(backward.begin(), backward.end());
    EXPECT_EQ(backward, members);
    EXPECT_EQ(parent->getChildren().getAllValues(), members);
    for (std::size_t i = 0; i < SIZE; i += 41)
        EXPECT_EQ(parent->getChildren().at(i), members[i]);
}

TEST_F(LongSequence, LosesMembersInAnyOrder)
{
    fill(parent);
    std::vector<ModelElement> left = members;

    atOnce([&] {
        for (ModelElement const& member : shuffledMembers())
        {
            Node::cast(member)->setParent(other);
            left.erase(std::find(left.begin(), left.end(), member));
            if (left.size() % 50 == 0)
            {
                ASSERT_EQ(parent->getChildren().getAllValues(), left);
            }
        }
    });

    EXPECT_TRUE(parent->getChildren().empty());
    EXPECT_EQ(other->getChildren().getAllValues(), shuffledMembers());
    EXPECT_TRUE(model->checkInvariants().empty());
}

TEST_F(LongSequence, IsTheSameAfterARollbackAndLosesMembersAgain)
{
    fill(parent);
    for (int round = 0; round < 3; ++round)
    {
        Transaction const deep = model->beginTransaction(/*revertible=*/true);
        for (ModelElement const& member : shuffledMembers())
            Node::cast(member)->setParent(other);
        deep.rollBack();

        ASSERT_EQ(parent->getChildren().getAllValues(), members);
        ASSERT_TRUE(other->getChildren().empty());
    }
    EXPECT_TRUE(model->checkInvariants().empty());
}

TEST_F(LongSequence, LeavesASnapshotAsItWas)
{
    fill(parent);
    Opened<ElementSequence<Node>> snapshot(nullptr, /*unique=*/true, Feature(), Feature());
    snapshot.copyContents(parent->getChildren());

    atOnce([&] {
        for (std::size_t i = 0; i < SIZE; i += 2)
            Node::cast(members[i])->setParent(other);
    });
    snapshot.basicRemove(members[1]);

    EXPECT_EQ(parent->getChildren().size(), SIZE / 2);
    EXPECT_EQ(parent->getChildren().at(0), members[1]);
    std::vector<ModelElement> expected = members;
    expected.erase(expected.begin() + 1);
    EXPECT_EQ(snapshot.getAllValues(), expected);
}

TEST_F(LongSequence, CopiedToAnotherOneGoesItsOwnWay)
{
    Opened<ElementSequence<Node>> from(parent.getImpl(), /*unique=*/true, Feature(), Feature());
    Opened<ElementSequence<Node>> to(other.getImpl(), /*unique=*/true, Feature(), Feature());
    std::vector<ModelElement> const order = shuffledMembers();
    atOnce([&] {
        for (ModelElement const& member : members)
            from.basicAdd(member);
        to.copyContents(from);
        for (std::size_t i = 0; i < order.size(); ++i)
            (i % 2 == 0 ? from : to).basicRemove(order[i]);
    });

    std::vector<ModelElement> inFrom;
    std::vector<ModelElement> inTo;
    for (ModelElement const& member : members)
    {
        auto const place = std::find(order.begin(), order.end(), member) - order.begin();
        (place % 2 == 0 ? inTo : inFrom).push_back(member);
    }
    EXPECT_EQ(from.getAllValues(), inFrom);
    EXPECT_EQ(to.getAllValues(), inTo);
}

TEST_F(LongSequence, LosesTheFirstOfEqualEntries)
{
    Opened<ElementSequence<Node>> sequence(parent.getImpl(), /*unique=*/false, Feature(),
                                           Feature());
    atOnce([&] {
        for (int twice = 0; twice < 2; ++twice)
        {
            for (ModelElement const& member : members)
                sequence.basicAdd(member);
        }
        for (ModelElement const& member : shuffledMembers())
            sequence.basicRemove(member);
    });
    EXPECT_EQ(sequence.getAllValues(), members);

    sequence.push_back(Node::cast(members[0]));
    sequence.remove(members[0]);
    EXPECT_EQ(sequence.at(0), members[1]);
    EXPECT_EQ(sequence.at(sequence.size() - 1), members[0]);
}

TEST_F(LongSequence, RefusesMembersThatItHolds)
{
    Node const last = node(u"last");
    atOnce([&] {
        for (ModelElement const& member : members)
            parent->getLinks().push_back(Node::cast(member));
        for (ModelElement const& member : shuffledMembers())
            parent->getLinks().push_back(Node::cast(member));
    });
    EXPECT_EQ(parent->getLinks().getAllValues(), members);

    EXPECT_EQ(parent->getLinks().insert(3, Node::cast(members[500])), 500u);
    EXPECT_EQ(parent->getLinks().insert(3, last), 3u);
    EXPECT_EQ(parent->getLinks().indexOf(members[500]), 501u);
    EXPECT_RAISES(messages::CannotAddSecondObject, parent->getLinks().replace(9, last));
    EXPECT_TRUE(parent->getLinks().contains(members[590]));
}

TEST_F(LongSequence, PutsMembersWhereTheyAreWanted)
{
    Opened<ElementSequence<Node>> sequence(parent.getImpl(), /*unique=*/true, Feature(), Feature());
    atOnce([&] {
        for (ModelElement const& member : members)
            sequence.basicAdd(member);
    });

    sequence.ensureAt(10, Node::cast(members[590]));

    std::swap(members[10], members[590]);
    EXPECT_EQ(sequence.getAllValues(), members);
    EXPECT_EQ(sequence.indexOf(members[10]), 10u);
}

TEST_F(LongSequence, ResolvesAProxyInItsPlaceAndLeavesTheOneInASnapshot)
{
    Node const target = node(u"target");
    Opened<ElementSequence<Node>> sequence(parent.getImpl(), /*unique=*/false, Node::Impl::BUDDY,
                                           Feature());
    Opened<ElementSequence<Node>> snapshot(nullptr, /*unique=*/false, Feature(), Feature());
    atOnce([&] {
        for (ModelElement const& member : members)
            sequence.basicAdd(member);
    });
    sequence.insert(400, proxyOf(target));
    snapshot.copyContents(sequence);

    EXPECT_EQ(sequence.at(400), target);
    EXPECT_EQ(*(sequence.begin() + 400), target);
    EXPECT_EQ(sequence.indexOf(target), 400u);
    EXPECT_TRUE(snapshot.at(400)->isProxy());
}

TEST_F(LongSequence, IsAskedForMembersWhileAnIteratorLooksAtIt)
{
    fill(parent);
    auto at = parent->getChildren().begin();
    EXPECT_EQ(*at, members[0]);

    Node::cast(members[0])->setParent(other);

    EXPECT_EQ(*parent->getChildren().begin(), members[1]);
    EXPECT_EQ(*at, members[1]) << "a position, whatever lies there";
    at += 300;
    EXPECT_EQ(*at, members[301]);
}
}  // namespace
}  // namespace testkit
