#include "tests/collections/CollectionFixture.h"

#include "tarnkiln/collections/StringToStringMap.h"

#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace testkit {
namespace {

class PrimitiveCollections : public CollectionFixture
{
protected:
    PrimitiveCollections()
    {
        meta::StandardTypes::ensureInitialized();
        model->addListener(&counter);
    }
    ~PrimitiveCollections() override { model->removeListener(&counter); }

    static Value number(int value) { return Value(meta::StandardTypes::integerMeta, value); }
    static Value text(ustring const& value)
    {
        return Value(meta::StandardTypes::stringMeta, value);
    }
    template <class T>
    static GenericPrimitiveSequenceInterface& sequenceOf(PrimitiveSequence<T> const& sequence)
    {
        return dynamic_cast<GenericPrimitiveSequenceInterface&>(*sequence.getGenericInterface());
    }

    Node const owner = node(u"owner");
    DeepCounter counter;
};

TEST_F(PrimitiveCollections, GiveTheirEntriesAsValuesInOrder)
{
    for (int const value : {3, 1})
        owner->getNumbers().push_back(value);

    std::vector<Value> const values = owner->getNumbers().getAllValues();

    ASSERT_EQ(values.size(), 2u);
    EXPECT_EQ(values[0], number(3));
    EXPECT_EQ(values[1], number(1));
    EXPECT_EQ(owner->getNumbers().getCollectionType(), meta::StandardTypes::integerMeta);
}

TEST_F(PrimitiveCollections, ASequenceCanBeUsedWithoutItsType)
{
    PrimitiveSequence<int>& numbers = owner->getNumbers();
    GenericPrimitiveSequenceInterface& generic = sequenceOf(numbers);

    numbers.genericAdd(number(1));
    generic.genericInsert(number(3), 1);
    generic.genericInsert(number(2), 1);
    EXPECT_EQ(generic.genericAt(1), number(2));
    EXPECT_EQ(generic.genericIndexOf(number(3)), 2);
    EXPECT_EQ(generic.genericIndexOf(number(9)), -1);
    generic.genericReplace(number(3), 0);
    numbers.genericRemove(number(3));
    EXPECT_EQ(numbers.getEntries(), (std::vector<int>{2, 3}));
    generic.genericRemoveAt(0);
    EXPECT_EQ(numbers.getEntries(), (std::vector<int>{3}));
}

TEST_F(PrimitiveCollections, ASetCanBeUsedWithoutItsType)
{
    PrimitiveSet<ustring>& words = owner->getWords();

    words.genericAdd(text(u"b"));
    words.genericAdd(text(u"a"));
    words.genericAdd(text(u"b"));
    words.genericRemove(text(u"c"));

    EXPECT_EQ(words.getAllValues(), (std::vector<Value>{text(u"a"), text(u"b")}));
    words.genericRemove(text(u"a"));
    EXPECT_EQ(words.size(), 1u);
}

TEST_F(PrimitiveCollections, RefuseAValueOfAnotherTypeBeforeTheyOpenAnything)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       owner->getNumbers().genericAdd(text(u"a")), u"String");
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  owner->getNumbers().genericRemove(text(u"a")));
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  sequenceOf(owner->getNumbers()).genericInsert(text(u"a"), 0));
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  sequenceOf(owner->getNumbers()).genericReplace(text(u"a"), 0));
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  sequenceOf(owner->getNumbers()).genericIndexOf(text(u"a")));
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, owner->getWords().genericAdd(number(1)));
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  owner->getWords().genericRemove(number(1)));

    EXPECT_EQ(counter.commits, 0);
}

TEST_F(PrimitiveCollections, AUniqueSequenceOpensNothingForADuplicate)
{
    PrimitiveSequence<ustring>& labels = owner->getLabels();
    labels.push_back(u"a");
    ASSERT_EQ(counter.commits, 1);

    labels.push_back(u"a");
    labels.genericAdd(text(u"a"));
    sequenceOf(labels).genericInsert(text(u"a"), 0);
    sequenceOf(labels).genericReplace(text(u"a"), 0);
    labels.remove(u"b");

    EXPECT_EQ(counter.commits, 1);
    EXPECT_EQ(labels.getEntries(), (std::vector<ustring>{u"a"}));
}

TEST_F(PrimitiveCollections, ASetCommitsADuplicateAndARemovalOfNothing)
{
    owner->getWords().insert(u"a");
    owner->getWords().insert(u"a");
    EXPECT_EQ(counter.commits, 2);

    owner->getWords().erase(u"b");
    EXPECT_EQ(counter.commits, 3);
    EXPECT_TRUE(counter.sawChanged({owner}));
}

TEST_F(PrimitiveCollections, ClearingIsAChangeEvenIfEmpty)
{
    owner->getNumbers().clear();

    EXPECT_EQ(counter.commits, 1);
}

TEST_F(PrimitiveCollections, AnnotationsAnnounceTheirChanges)
{
    StringToStringMap map(owner.getImpl(), Node::Impl::NOTE);

    map.insert(u"key", u"a", StringToStringMap::Fail);
    EXPECT_EQ(counter.commits, 1);
    map.insert(u"key", u"a", StringToStringMap::Fail);
    map.insert(u"key", u"b", StringToStringMap::Keep);
    EXPECT_RAISES(messages::UniquenessConstraint,
                  map.insert(u"key", u"b", StringToStringMap::Fail));
    EXPECT_EQ(map.erase(u"absent"), 0u);
    EXPECT_EQ(counter.commits, 1) << "nothing of that is a change";

    map.merge(StringToStringMap(nullptr, Feature()));
    EXPECT_EQ(counter.commits, 2) << "to merge is a change even if there is nothing to merge";
    map.insert(u"key", u"c", StringToStringMap::Replace);
    EXPECT_EQ(map.erase(u"key"), 1u);
    map.clear();
    map.assign(StringToStringMap(nullptr, Feature()));
    EXPECT_EQ(counter.commits, 6);
    EXPECT_EQ(map.getCollectionType(), meta::StandardTypes::stringMeta);
}

TEST_F(PrimitiveCollections, AnnotationsOfADestroyedElementStayAsTheyAre)
{
    StringToStringMap map(owner.getImpl(), Node::Impl::NOTE);
    StringToStringMap more(nullptr, Feature());
    map.insert(u"key", u"a", StringToStringMap::Fail);
    more.insert(u"other", u"b", StringToStringMap::Fail);
    owner->destroy();
    int const commits = counter.commits;

    map.insert(u"other", u"b", StringToStringMap::Fail);
    map.merge(more);
    EXPECT_EQ(map.erase(map.begin()), map.begin());
    map.erase(map.begin(), map.end());
    EXPECT_EQ(map.erase(u"key"), 0u);
    map.clear();

    ASSERT_EQ(map.size(), 1u);
    EXPECT_EQ(map.begin()->second, u"a");
    EXPECT_EQ(counter.commits, commits);
}
}  // namespace
}  // namespace testkit
