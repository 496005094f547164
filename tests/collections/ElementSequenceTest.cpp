#include "tests/collections/CollectionFixture.h"

namespace testkit {
namespace {

/// `parts` is a sequence that may hold an element twice; here it has no upkeep at all.
class PlainSequence : public CollectionFixture
{
protected:
    Node const owner = node(u"owner");
    Node const a = node(u"a");
    Node const b = node(u"b");
    Node const c = node(u"c");
    Opened<ElementSequence<Node>> sequence{owner.getImpl(), /*unique=*/false, Feature(), Feature()};
    Opened<ElementSequence<Node>> unique{owner.getImpl(), /*unique=*/true, Feature(), Feature()};
};

TEST_F(PlainSequence, KeepsTheOrderAndDuplicates)
{
    sequence.push_back(b);
    sequence.push_back(a);
    sequence.push_back(b);

    EXPECT_EQ(namesIn(sequence), (Names{u"b", u"a", u"b"}));
    EXPECT_EQ(sequence.size(), 3u);
    EXPECT_FALSE(sequence.isUnique());
}

TEST_F(PlainSequence, IgnoresADuplicateIfUnique)
{
    unique.push_back(a);
    unique.push_back(b);

    unique.push_back(a);

    EXPECT_EQ(namesIn(unique), (Names{u"a", u"b"}));
}

TEST_F(PlainSequence, IsUniqueIfItHasAnOppositeWhateverItWasTold)
{
    ElementSequence<Node> const links(owner.getImpl(), /*unique=*/false, Node::Impl::LINKS);

    EXPECT_TRUE(links.isUnique());
}

TEST_F(PlainSequence, InsertsBeforeAPosition)
{
    sequence.push_back(a);
    sequence.push_back(c);

    EXPECT_EQ(sequence.insert(1, b), 1u);
    EXPECT_EQ(sequence.insert(3, a), 3u);

    EXPECT_EQ(namesIn(sequence), (Names{u"a", u"b", u"c", u"a"}));
}

TEST_F(PlainSequence, ReturnsThePositionOfAnElementThatAUniqueOneHolds)
{
    unique.push_back(a);
    unique.push_back(b);

    EXPECT_EQ(unique.insert(0, b), 1u);

    EXPECT_EQ(namesIn(unique), (Names{u"a", u"b"}));
}

TEST_F(PlainSequence, InsertsAtAnIteratorAndErasesThere)
{
    sequence.push_back(a);
    sequence.push_back(c);

    auto const place = sequence.insert(sequence.begin() + 1, b);
    EXPECT_EQ(*place, b);

    auto const next = sequence.erase(place);
    EXPECT_EQ(*next, c);
    EXPECT_EQ(namesIn(sequence), (Names{u"a", u"c"}));
}

TEST_F(PlainSequence, CanBeWalked)
{
    sequence.push_back(a);
    sequence.push_back(b);

    Names names;
    for (Node const& entry : sequence)
        names.push_back(entry->getName());

    EXPECT_EQ(names, (Names{u"a", u"b"}));
    EXPECT_EQ(sequence.end() - sequence.begin(), 2);
    EXPECT_EQ((*(sequence.end() - 1))->getName(), u"b");
    EXPECT_EQ(sequence.begin()[1], b);
    EXPECT_TRUE(sequence.begin() < sequence.end());
}

TEST_F(PlainSequence, ErasesAtAPosition)
{
    for (Node const& element : {a, b, c})
        sequence.push_back(element);

    sequence.erase(1);

    EXPECT_EQ(namesIn(sequence), (Names{u"a", u"c"}));
}

TEST_F(PlainSequence, RemovesTheFirstOfEqualEntries)
{
    for (Node const& element : {a, b, a})
        sequence.push_back(element);

    sequence.remove(a);
    EXPECT_EQ(namesIn(sequence), (Names{u"b", u"a"}));

    sequence.remove(c);
    EXPECT_EQ(sequence.size(), 2u);
}

TEST_F(PlainSequence, ReplacesAnEntry)
{
    sequence.push_back(a);
    sequence.push_back(b);

    sequence.replace(0, c);

    EXPECT_EQ(namesIn(sequence), (Names{u"c", u"b"}));
}

TEST_F(PlainSequence, ReplacesAnEntryByItselfWithoutAChange)
{
    unique.push_back(a);

    unique.replace(0, a);

    EXPECT_EQ(namesIn(unique), (Names{u"a"}));
}

TEST_F(PlainSequence, RefusesToReplaceByNothing)
{
    sequence.push_back(a);
    b->destroy();

    EXPECT_RAISES(messages::CannotAddNonExistentObject, sequence.replace(0, Node()));
    EXPECT_RAISES(messages::CannotAddNonExistentObject, sequence.replace(0, b));
    EXPECT_RAISES(messages::CannotAddNonExistentObject, genericOf(sequence).genericReplace({}, 0));

    EXPECT_EQ(namesIn(sequence), (Names{u"a"}));
}

TEST_F(PlainSequence, RefusesToReplaceByAnElementThatItHoldsElsewhereIfUnique)
{
    unique.push_back(a);
    unique.push_back(b);

    EXPECT_RAISES(messages::CannotAddSecondObject, unique.replace(0, b));
    EXPECT_EQ(namesIn(unique), (Names{u"a", u"b"}));

    sequence.push_back(a);
    sequence.push_back(b);
    sequence.replace(0, b);
    EXPECT_EQ(namesIn(sequence), (Names{u"b", u"b"}));
}

TEST_F(PlainSequence, IgnoresNullAndDestroyedElements)
{
    b->destroy();
    for (Node const& nothing : {Node(), b})
    {
        sequence.push_back(nothing);
        EXPECT_EQ(sequence.insert(0, nothing), 0u);
        sequence.ensureAt(0, nothing);
        sequence.remove(nothing);
        genericOf(sequence).genericAdd(nothing);
        genericOf(sequence).genericInsert(nothing, 0);
        genericOf(sequence).genericEnsureAt(nothing, 0);
        genericOf(sequence).genericRemove(nothing);
        EXPECT_EQ(genericOf(sequence).genericIndexOf(nothing), -1);
        EXPECT_FALSE(sequence.contains(nothing));
    }

    EXPECT_TRUE(sequence.empty());
}

TEST_F(PlainSequence, KeepsAHandleOfAnElementThatDies)
{
    sequence.push_back(a);
    sequence.push_back(b);

    a->destroy();

    EXPECT_EQ(namesIn(sequence), (Names{u"-", u"b"}));
    EXPECT_EQ(genericOf(sequence).genericSize(), 2u);
    EXPECT_EQ(genericOf(sequence).genericIndexOf(a), -1);
}

TEST_F(PlainSequence, MovesAnElementThatItHoldsToWhereItIsWanted)
{
    for (Node const& element : {a, b, c})
        unique.push_back(element);

    unique.ensureAt(0, c);

    EXPECT_EQ(namesIn(unique), (Names{u"c", u"b", u"a"})) << "the two change places";
}

TEST_F(PlainSequence, PutsANewElementWhereItIsWanted)
{
    unique.push_back(a);
    unique.push_back(b);

    unique.ensureAt(1, c);
    unique.ensureAt(9, node(u"d"));

    EXPECT_EQ(namesIn(unique), (Names{u"a", u"c", u"b", u"d"}));
}

TEST_F(PlainSequence, FindsByPointer)
{
    sequence.push_back(a);
    sequence.push_back(b);
    sequence.push_back(b);

    EXPECT_EQ(sequence.indexOf(b), 1u);
    EXPECT_EQ(sequence.indexOf(c), 3u);
    EXPECT_TRUE(sequence.contains(a));
    EXPECT_FALSE(sequence.contains(c));
    EXPECT_EQ(genericOf(sequence).genericIndexOf(b), 1);
    EXPECT_EQ(genericOf(sequence).genericIndexOf(c), -1);
}

TEST_F(PlainSequence, CanBeUsedWithoutItsElementClass)
{
    GenericSequenceInterface& generic = genericOf(sequence);
    EXPECT_TRUE(generic.isSequenceInterface());
    EXPECT_FALSE(generic.isMapInterface());
    EXPECT_FALSE(generic.isMultimapInterface());

    generic.genericAdd(a);
    generic.genericInsert(b, 0);
    generic.genericEnsureAt(c, 1);
    EXPECT_EQ(namesIn(sequence), (Names{u"b", u"c", u"a"}));
    EXPECT_EQ(generic.genericAt(2), a);
    EXPECT_EQ(generic.genericSize(), 3u);

    generic.genericReplace(node(u"d"), 1);
    generic.genericRemoveAt(0);
    generic.genericRemove(a);
    EXPECT_EQ(namesIn(sequence), (Names{u"d"}));

    generic.genericClear();
    EXPECT_EQ(generic.genericSize(), 0u);
}

TEST_F(PlainSequence, BasicOperationsTestNothing)
{
    unique.basicAdd(a);
    unique.basicAdd(a);
    EXPECT_EQ(namesIn(unique), (Names{u"a", u"a"}));

    unique.basicRemove(a);
    unique.basicRemove(b);
    EXPECT_EQ(namesIn(unique), (Names{u"a"}));

    unique.basicClear();
    EXPECT_TRUE(unique.empty());
}

TEST_F(PlainSequence, WithoutUpkeepLosesAnEntryWhereverItLies)
{
    for (std::size_t size = 1; size <= 5; ++size)
    {
        for (std::size_t place = 0; place < size; ++place)
        {
            unique.basicClear();
            std::vector<Node> members;
            for (std::size_t i = 0; i < size; ++i)
            {
                members.push_back(node(u"x"));
                unique.basicAdd(members.back());
            }

            unique.basicRemove(members[place]);
            unique.basicRemove(members[place]);

            std::vector<ModelElement> expected(members.begin(), members.end());
            expected.erase(expected.begin() + static_cast<std::ptrdiff_t>(place));
            EXPECT_EQ(expected, unique.getAllValues());
        }
    }
}

TEST_F(PlainSequence, WithoutUpkeepLosesTheFirstOfSeveralEqualEntries)
{
    for (Node const& each : {a, b, a, c})
        sequence.basicAdd(each);

    sequence.basicRemove(a);

    EXPECT_EQ(namesIn(sequence), (Names{u"b", u"a", u"c"}));
}

// ---------------------------------------------------------------------------- element class

TEST_F(PlainSequence, RefusesElementsOfAWrongClass)
{
    ElementSequence<SpecialNode> special(owner.getImpl(), /*unique=*/false, Feature(), Feature());
    SpecialNode const good = SpecialNode::create(model);
    special.push_back(good);
    GenericSequenceInterface& generic = genericOf(special);

    EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, generic.genericAdd(a),
                       u"testkit.SpecialNode", u"testkit.Node");
    EXPECT_RAISES(messages::CannotAddIncompatibleTypes, generic.genericInsert(a, 0));
    EXPECT_RAISES(messages::CannotAddIncompatibleTypes, generic.genericEnsureAt(a, 0));
    EXPECT_RAISES(messages::CannotAddIncompatibleTypes, generic.genericReplace(a, 0));
    EXPECT_RAISES(messages::CannotAddIncompatibleTypes, generic.genericRemove(a));
    EXPECT_EQ(generic.genericIndexOf(a), -1);

    EXPECT_EQ(special.size(), 1u);
    EXPECT_EQ(special.at(0), good);
}

TEST_F(PlainSequence, AcceptsElementsOfAMoreSpecialClass)
{
    genericOf(sequence).genericAdd(SpecialNode::create(model));

    EXPECT_EQ(sequence.size(), 1u);
}

TEST_F(PlainSequence, RefusesAWrongClassInBasicOperationsToo)
{
    Opened<ElementSequence<SpecialNode>> special(owner.getImpl(), /*unique=*/false, Feature(),
                                                 Feature());

    EXPECT_RAISES(messages::CannotAddIncompatibleTypes, special.basicAdd(a));

    EXPECT_TRUE(special.empty());
}

// ---------------------------------------------------------------------------- filter

TEST_F(PlainSequence, AsksAFilterBeforeItScans)
{
    auto filter = std::make_unique<SaturatedBloomFilter>();
    SaturatedBloomFilter& seen = *filter;
    unique.push_back(a);
    unique.setFilter(std::move(filter));

    EXPECT_TRUE(seen.contains(a->getUuid())) << "what was there before";
    unique.push_back(b);
    EXPECT_TRUE(seen.contains(b->getUuid()));
    seen.remove(b->getUuid());
    EXPECT_FALSE(unique.contains(b)) << "the filter rules it out";
    seen.add(b->getUuid());
    EXPECT_TRUE(unique.contains(b));
}

TEST_F(PlainSequence, KeepsAFilterCurrent)
{
    auto filter = std::make_unique<SaturatedBloomFilter>();
    SaturatedBloomFilter& seen = *filter;
    unique.setFilter(std::move(filter));

    unique.insert(0, a);
    EXPECT_TRUE(seen.contains(a->getUuid()));
    unique.replace(0, b);
    EXPECT_FALSE(seen.contains(a->getUuid()));
    EXPECT_TRUE(seen.contains(b->getUuid()));
    unique.erase(0);
    EXPECT_FALSE(seen.contains(b->getUuid()));
    unique.basicAdd(a);
    EXPECT_TRUE(seen.contains(a->getUuid()));
    unique.basicRemove(a);
    EXPECT_FALSE(seen.contains(a->getUuid()));
    unique.push_back(c);
    unique.clear();
    EXPECT_FALSE(seen.contains(c->getUuid()));
}

TEST_F(PlainSequence, LeavesAFilterAsItIsWhenContentsAreCopied)
{
    auto filter = std::make_unique<SaturatedBloomFilter>();
    SaturatedBloomFilter& seen = *filter;
    unique.setFilter(std::move(filter));
    unique.push_back(a);
    Opened<ElementSequence<Node>> snapshot(nullptr, /*unique=*/true, Feature(), Feature());
    snapshot.push_back(b);

    unique.copyContents(snapshot);

    EXPECT_EQ(namesIn(unique), (Names{u"b"}));
    EXPECT_TRUE(seen.contains(a->getUuid()));
    EXPECT_FALSE(seen.contains(b->getUuid()));
}

// ---------------------------------------------------------------------------- announcing

/// Sequences of a node, whose changes are announced.
class AnnouncedSequence : public CollectionFixture
{
protected:
    AnnouncedSequence() { model->addListener(&counter); }
    ~AnnouncedSequence() override { model->removeListener(&counter); }

    Node const owner = node(u"owner");
    Node const a = node(u"a");
    Node const b = node(u"b");
    DeepCounter counter;
};

TEST_F(AnnouncedSequence, OpensNothingForADuplicate)
{
    owner->getLinks().push_back(a);
    ASSERT_EQ(counter.commits, 1);

    owner->getLinks().push_back(a);
    owner->getLinks().insert(0, a);
    owner->getLinks().replace(0, a);
    owner->getLinks().remove(b);

    EXPECT_EQ(counter.commits, 1);
}

TEST_F(AnnouncedSequence, EnsuresAPositionInTwoChanges)
{
    owner->getParts().ensureAt(0, a);

    EXPECT_EQ(counter.commits, 2);
}

TEST_F(AnnouncedSequence, CommitsTheDestructionOfItsContentsEvenIfEmpty)
{
    owner->getParts().destroyAllContents();

    EXPECT_EQ(counter.commits, 1);
}

TEST_F(AnnouncedSequence, DestroysItsContents)
{
    owner->getLinks().push_back(a);
    owner->getLinks().push_back(b);
    int const before = counter.commits;

    owner->getLinks().destroyAllContents();

    EXPECT_EQ(counter.commits, before + 1);
    EXPECT_FALSE(a);
    EXPECT_FALSE(b);
    EXPECT_TRUE(owner->getLinks().empty());
}

TEST_F(AnnouncedSequence, TellsWhatBothEndsOfAnAssociationWere)
{
    owner->getLinks().push_back(a);

    EXPECT_TRUE(counter.sawChanged({owner, a}));
}
}  // namespace
}  // namespace testkit
