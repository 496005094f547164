// Collections whose property is an element of a metamodel, as those of run-time classes are.
#include "tests/collections/CollectionFixture.h"

#include "tarnkiln/collections/QualifierKeys.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/NodeMetamodel.h"

namespace testkit {
namespace {

/// A node that answers every question for a value with the one that a test gives it.
class AnsweringImpl : public Node::Impl
{
public:
    using Node::Impl::Impl;

    Value getPropertyValue(meta::Property const&, ReflectionPrivateTag const& tag) const override
    {
        wasPublic = tag == PUBLIC_ACCESS;
        return *answer;
    }
    void setUuid(UUID const& uuid) { m_uuid = uuid; }

    boost::optional<Value> answer;
    mutable bool wasPublic = false;
};

class PropertyGiven : public CollectionFixture
{
protected:
    PropertyGiven()
    {
        meta::StandardTypes::ensureInitialized();
        answeringHandle->notifyCreated();
    }

    static meta::Property const& propertyOf(Slot const& slot)
    {
        return NodeMetamodel::get().properties[slot.index];
    }

    Node const owner = node(u"owner");
    Node const a = node(u"a");
    Node const b = node(u"b");
    AnsweringImpl* const answering = new AnsweringImpl(model, UUID{});
    Node const answeringHandle{answering};
};

TEST_F(PropertyGiven, KnowsItsProperty)
{
    ElementSequence<Node> const sequence(owner.getImpl(), /*unique=*/false,
                                         propertyOf(Node::Impl::CHILDREN));

    EXPECT_EQ(sequence.getCollectionProperty(), propertyOf(Node::Impl::CHILDREN));
    EXPECT_EQ(sequence.getOpposite(), Feature(Node::Impl::PARENT));
    EXPECT_TRUE(sequence.isComposite());
    EXPECT_TRUE(sequence.isUnique());
    EXPECT_EQ(sequence.getCollectionType(), NodeMetamodel::get().node);
    EXPECT_EQ(owner->getChildren().getCollectionProperty(), propertyOf(Node::Impl::CHILDREN))
        << "given by a slot, it is the same one";
}

TEST_F(PropertyGiven, KeepsTheOtherEndInStep)
{
    UndoneAtEnd const undone(model);  // the node has another collection of its own
    ElementSequence<Node> owned(owner.getImpl(), /*unique=*/true, propertyOf(Node::Impl::OWNED));

    owned.push_back(a);
    EXPECT_EQ(a->getOwner(), owner);
    EXPECT_TRUE(owned.contains(a)) << "asked by reflection";
    EXPECT_FALSE(owned.contains(b));

    owned.replace(0, b);
    EXPECT_FALSE(a->getOwner());
    EXPECT_EQ(b->getOwner(), owner);
    owned.clear();
    EXPECT_FALSE(b->getOwner());
}

TEST_F(PropertyGiven, ContainsAndReleases)
{
    UndoneAtEnd const undone(model);
    ElementSequence<Node> children(owner.getImpl(), /*unique=*/true,
                                   propertyOf(Node::Impl::CHILDREN));
    ElementSequence<Node> parts(owner.getImpl(), /*unique=*/false, propertyOf(Node::Impl::PARTS));

    children.push_back(a);
    EXPECT_EQ(a->container(), owner);
    EXPECT_TRUE(children.contains(a));
    EXPECT_FALSE(children.contains(b));
    children.erase(0);
    EXPECT_TRUE(a->isTopLevel());

    parts.push_back(b);
    EXPECT_EQ(b->container(), owner);
    EXPECT_EQ(b->containmentFeature(), propertyOf(Node::Impl::PARTS));
    parts.erase(0);
    EXPECT_TRUE(b->isTopLevel());
}

TEST_F(PropertyGiven, CannotTellWhatItContainsIfTheOtherEndIsHidden)
{
    auto const hide = [](Slot const& slot, bool hidden) {
        meta::MetaRegistry::LockedModel const locked(meta::MetaRegistry::getInstance());
        propertyOf(slot)->setIsPublicAccessor(!hidden);
    };
    ElementSequence<Node> owned(owner.getImpl(), /*unique=*/true, propertyOf(Node::Impl::OWNED));
    ElementSequence<Node> children(owner.getImpl(), /*unique=*/true,
                                   propertyOf(Node::Impl::CHILDREN));
    hide(Node::Impl::OWNER, true);
    hide(Node::Impl::PARENT, true);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, owned.push_back(a), u"owner", u"testkit.Node");
    EXPECT_RAISES(messages::NoSuchProperty, children.push_back(a));

    hide(Node::Impl::OWNER, false);
    hide(Node::Impl::PARENT, false);
    EXPECT_TRUE(owned.empty());
}

TEST_F(PropertyGiven, AnnouncesNothingWithoutALiveProperty)
{
    meta::Property const property = meta::Property::create(model);
    property->setPropertyIndex(1);
    PrimitiveSequence<int> sequence(owner.getImpl(), /*unique=*/false, property);
    DeepCounter counter;
    model->addListener(&counter);

    sequence.push_back(1);
    EXPECT_EQ(counter.commits, 1);
    property->destroy();
    EXPECT_EQ(counter.commits, 2);
    sequence.push_back(2);

    EXPECT_EQ(counter.commits, 2);
    EXPECT_EQ(sequence.size(), 2u);
    model->removeListener(&counter);
}

TEST_F(PropertyGiven, LeavesNoTraceOfAPropertyWithoutASlot)
{
    meta::Property const property = meta::Property::create(model);
    PrimitiveSequence<int> sequence(owner.getImpl(), /*unique=*/false, property);
    DeepCounter counter;
    model->addListener(&counter);

    sequence.push_back(1);

    EXPECT_EQ(counter.commits, 0);
    EXPECT_EQ(sequence.size(), 1u);
    {
        Model::Freezer const frozen = model->freeze();
        EXPECT_RAISES(messages::ModelFrozen, sequence.push_back(2));
    }
    model->removeListener(&counter);
}

// ---------------------------------------------------------------------------- keys

TEST_F(PropertyGiven, ReadsKeysWithPublicAccess)
{
    a->setCount(7);
    a->setRank(9);

    EXPECT_EQ(keyOf<int>(a.getImpl(), propertyOf(Node::Impl::COUNT)), 7);
    EXPECT_EQ(keyOf<int>(a.getImpl(), propertyOf(Node::Impl::RANK)), 9) << "an optional one";
    EXPECT_EQ(keyOf<ustring>(a.getImpl(), propertyOf(Node::Impl::NAME)), u"a");

    answering->answer = Value(meta::StandardTypes::integerMeta, 1);
    EXPECT_EQ(keyOf<int>(answering, propertyOf(Node::Impl::COUNT)), 1);
    EXPECT_TRUE(answering->wasPublic);
}

TEST_F(PropertyGiven, RefusesAnElementWithoutAKey)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       keyOf<int>(a.getImpl(), propertyOf(Node::Impl::RANK)), u"Integer");

    ElementMap<int, Node> map(owner.getImpl(), makeKeyExtractor<int>(propertyOf(Node::Impl::RANK)),
                              propertyOf(Node::Impl::BY_NAME), Feature());
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, map.insert(a));
    EXPECT_TRUE(map.empty());
    EXPECT_TRUE(a->isTopLevel());
}

TEST_F(PropertyGiven, RefusesAKeyOfAnotherType)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       keyOf<int>(a.getImpl(), propertyOf(Node::Impl::NAME)), u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       keyOf<int>(a.getImpl(), propertyOf(Node::Impl::NOTE)), u"String");
}

TEST_F(PropertyGiven, KeysByTheElementThatAReferenceHolds)
{
    meta::Property const& buddy = propertyOf(Node::Impl::BUDDY);
    EXPECT_TRUE(referenceKeyOf(a.getImpl(), buddy).is_nil());

    a->setBuddy(b);
    EXPECT_EQ(referenceKeyOf(a.getImpl(), buddy), b->getUuid());

    b->destroy();
    EXPECT_TRUE(referenceKeyOf(a.getImpl(), buddy).is_nil());
}

TEST_F(PropertyGiven, KeysByTheNumberOfALiteral)
{
    meta::Enum const colour = meta::Enum::create(model);
    meta::Property const& any = propertyOf(Node::Impl::COUNT);

    answering->answer = Value(colour, 3L);
    EXPECT_EQ(enumerationKeyOf(answering, any), 3u);

    answering->answer = Value(meta::StandardTypes::integerMeta, boost::optional<int>());
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, enumerationKeyOf(answering, any),
                       u"Integer");
}

TEST_F(PropertyGiven, CarriesTheKeysOfEnumerationsAsLiterals)
{
    using Keys = support::KeyTraits<unsigned long>;
    meta::Enum const colour = meta::Enum::create(model);

    Value const value = Keys::toValue(3, colour);

    EXPECT_EQ(value.getType(), colour);
    EXPECT_EQ(Keys::fromValue(value), 3u);
    EXPECT_EQ(Keys::fromValue(Keys::toValue(4, meta::StandardTypes::uinteger64Meta)), 4u);
}

TEST_F(PropertyGiven, CarriesTheKeysOfReferencesAsUuids)
{
    using Keys = support::KeyTraits<UUID>;

    Value const value = Keys::toValue(a->getUuid(), NodeMetamodel::get().node);

    EXPECT_EQ(value.getType(), meta::StandardTypes::uuidMeta);
    EXPECT_EQ(Keys::fromValue(value), a->getUuid());
}

TEST_F(PropertyGiven, TellsTheTypeOfItsKeys)
{
    ElementMap<ustring, ModelElement> const map(
        owner.getImpl(), makeKeyExtractor<ustring>(propertyOf(Node::Impl::NAME)),
        propertyOf(Node::Impl::BY_NAME));
    ElementMultimap<int, ModelElement> const unqualified(
        owner.getImpl(), makeKeyExtractor<int>(propertyOf(Node::Impl::COUNT)),
        propertyOf(Node::Impl::MARKS));

    EXPECT_EQ(dynamic_cast<GenericMapInterface&>(genericOf(map)).getKeyType(),
              meta::StandardTypes::stringMeta);
    EXPECT_FALSE(dynamic_cast<GenericMultimapInterface&>(genericOf(unqualified)).getKeyType());
}

// ---------------------------------------------------------------------------- nil UUIDs

TEST_F(PropertyGiven, FindsAnElementWhoseUuidBecameNilWhileItWasInASet)
{
    UUID const uuid = answering->getUuid();
    std::vector<Node> others;
    for (int count = 0; count < 200; ++count)
        others.push_back(Node::create(model));
    UnorderedElementSet<Node> set(nullptr, Feature(), Feature());
    set.insert(a);
    set.insert(answeringHandle);
    set.insert(b);

    answering->setUuid(UUID{});
    EXPECT_TRUE(set.contains(answeringHandle));
    set.insert(answeringHandle);
    EXPECT_EQ(set.size(), 3u);
    for (Node const& other : others)
        set.insert(other);
    EXPECT_TRUE(set.contains(answeringHandle)) << "the set has grown in between";
    set.erase(answeringHandle);
    answering->setUuid(uuid);

    EXPECT_FALSE(set.contains(answeringHandle));
    EXPECT_EQ(set.size(), 202u);
    EXPECT_TRUE(set.contains(a));
}
}  // namespace
}  // namespace testkit
