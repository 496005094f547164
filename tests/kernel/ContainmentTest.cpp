#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tarnkiln/meta/Property.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::UnorderedElementsAre;

class Containment : public ::testing::Test
{
protected:
    ~Containment() override { EXPECT_THAT(model->checkInvariants(), IsEmpty()); }

    bool isInTopLevelSet(ModelElement const& element) const
    {
        std::vector<ModelElement> const all = model->getTopLevelElements();
        return std::find(all.begin(), all.end(), element) != all.end();
    }

    Model const model = Model::create(ModelConstellation());
    Plain const parent = Plain::create(model, uuidOf(1));
    Plain const other = Plain::create(model, uuidOf(2));
    Plain const child = Plain::create(model, uuidOf(3));
};

using AContainedElement = Containment;
using AMovedElement = Containment;
using AReleasedElement = Containment;
using TheContainerLink = Containment;
using ACircle = Containment;
using AnInverseCall = Containment;
using TheBaseOfAllElements = Containment;

// ---------------------------------------------------------------------------- contained

TEST_F(AContainedElement, KnowsItsContainerAndLeavesTheTopLevel)
{
    parent->addChild(child);

    EXPECT_FALSE(child->isTopLevel());
    EXPECT_EQ(child->container(), parent);
    EXPECT_EQ(child->containerImpl(), parent.getImpl());
    EXPECT_EQ(child->basicContainer(), parent.getImpl());
    EXPECT_EQ(child->getContainment(), Feature(Plain::Impl::CHILDREN_SLOT));
    EXPECT_FALSE(isInTopLevelSet(child));
    EXPECT_TRUE(isInTopLevelSet(parent));
}

TEST_F(AContainedElement, StaysInTheRegistry)
{
    parent->addChild(child);

    EXPECT_EQ(model->findElement(uuidOf(3)), child);
    EXPECT_EQ(model->getElementCount(), 3u);
}

TEST_F(AContainedElement, IsKeptByItsContainerAlone)
{
    ExpectNoLeakedElements const noLeaks;
    UUID id;
    {
        Plain const grandchild = Plain::create(model);
        id = grandchild->getUuid();
        child->addChild(grandchild);
        EXPECT_EQ(grandchild->getRefCount(), 2u);
    }
    EXPECT_EQ(model->findElementImpl(id)->getRefCount(), 1u);

    ModelElement(model->findElementImpl(id))->destroy();

    EXPECT_EQ(model->findElementImpl(id), nullptr);
}

TEST_F(AContainedElement, MayLieInAPropertyWithoutAnOpposite)
{
    parent->addPart(child);

    EXPECT_EQ(child->container(), parent);
    EXPECT_EQ(child->getContainment(), Feature(Plain::Impl::PARTS_SLOT));
    EXPECT_FALSE(isInTopLevelSet(child));
}

TEST_F(AContainedElement, HasNoMetamodelPropertiesToShowWhileItsMetamodelIsNotBuilt)
{
    parent->addChild(child);

    EXPECT_FALSE(child->containmentFeature());
    EXPECT_EQ(child->containmentFeatureImpl(), nullptr);
    EXPECT_FALSE(child->containerProperty());
    EXPECT_FALSE(child->containerFeature());
}

TEST(AContainedNode, ShowsBothPropertiesOfItsContainment)
{
    Model const model = Model::create(ModelConstellation());
    Node const parent = Node::create(model);
    Node const child = Node::create(model);
    auto const& properties = NodeMetamodel::get().properties;
    meta::Property const& children = properties[Node::Impl::CHILDREN.index];

    child->setParent(parent);

    EXPECT_EQ(child->containmentFeature(), children);
    EXPECT_EQ(child->containmentFeatureImpl(), children.getImpl());
    EXPECT_EQ(child->containerProperty(), properties[Node::Impl::PARENT.index]);
    EXPECT_EQ(child->containerFeature(), child->containerProperty());
    EXPECT_EQ(child->getContainment(), Feature(children));
    EXPECT_EQ(child->container(), parent);
}

TEST(ATopLevelElement, HasNoContainer)
{
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);

    EXPECT_TRUE(element->isTopLevel());
    EXPECT_FALSE(element->container());
    EXPECT_EQ(element->containerImpl(), nullptr);
    EXPECT_TRUE(element->getContainment().isNull());
    EXPECT_FALSE(element->containerProperty());
    EXPECT_FALSE(element->containmentFeature());
    EXPECT_EQ(element->containmentFeatureImpl(), nullptr);
}

// ---------------------------------------------------------------------------- moves

TEST_F(AMovedElement, EndsInTheNewContainerAndNotInTheTopLevel)
{
    parent->addChild(child);

    other->addChild(child);

    EXPECT_EQ(child->container(), other);
    EXPECT_THAT(parent->fields.children, IsEmpty());
    EXPECT_THAT(other->fields.children, ElementsAre(ModelElement(child)));
    EXPECT_FALSE(isInTopLevelSet(child));
}

TEST_F(AMovedElement, PassesThroughTheTopLevel)
{
    parent->addPart(child);

    child->makeUncontained();
    bool const wasTopLevel = isInTopLevelSet(child);
    other->_setContainedByThis(child.getImpl(), Plain::Impl::PARTS_SLOT);
    other->fields.parts.push_back(child);

    EXPECT_TRUE(wasTopLevel);
    EXPECT_FALSE(isInTopLevelSet(child));
    EXPECT_THAT(parent->fields.parts, IsEmpty());
}

TEST_F(AMovedElement, SurvivesAMoveThroughItsContainerReference)
{
    Plain::Impl* const onlyHeldByItsParent = [&] {
        Plain const made = Plain::create(model);
        parent->addChild(made);
        return made.getImpl();
    }();

    onlyHeldByItsParent->setParent(other);

    EXPECT_EQ(onlyHeldByItsParent->container(), other);
    EXPECT_EQ(onlyHeldByItsParent->getRefCount(), 1u);
}

TEST_F(AMovedElement, SurvivesAMoveWhileNobodyHoldsIt)
{
    Plain::Impl* const impl = Plain::create(model, uuidOf(9)).getImpl();
    long const before = Plain::Impl::inMemory;

    parent->_setContainedByThis(impl, Plain::Impl::PARTS_SLOT);

    // it died when the move was over, since no collection holds it, and not on the way
    EXPECT_EQ(Plain::Impl::inMemory, before - 1);
    EXPECT_FALSE(model->findElement(uuidOf(9)));
}

TEST_F(AMovedElement, MayChangeThePropertyOfItsContainer)
{
    parent->addChild(child);

    parent->addPart(child);

    EXPECT_THAT(parent->fields.children, IsEmpty());
    EXPECT_THAT(parent->fields.parts, ElementsAre(ModelElement(child)));
    EXPECT_EQ(child->getContainment(), Feature(Plain::Impl::PARTS_SLOT));
}

// ---------------------------------------------------------------------------- release

TEST_F(AReleasedElement, IsTopLevelAgain)
{
    parent->addChild(child);

    child->makeUncontained();

    EXPECT_TRUE(child->isTopLevel());
    EXPECT_FALSE(child->container());
    EXPECT_THAT(parent->fields.children, IsEmpty());
    EXPECT_TRUE(isInTopLevelSet(child));
}

TEST_F(AReleasedElement, IsLeftAloneIfItWasTopLevel)
{
    child->makeUncontained();

    EXPECT_TRUE(isInTopLevelSet(child));
    EXPECT_EQ(child->getRefCount(), 2u);
}

TEST_F(AReleasedElement, SurvivesThoughNobodyElseHeldIt)
{
    UUID id;
    {
        Plain const made = Plain::create(model);
        id = made->getUuid();
        parent->addPart(made);
    }
    Plain::Impl* const impl = Plain::cast(model->findElement(id)).getImpl();

    impl->makeUncontained();

    EXPECT_EQ(model->findElement(id), ModelElement(impl));
    EXPECT_EQ(impl->getRefCount(), 1u);
}

TEST_F(AReleasedElement, MayBeLinkedOffWithoutItsContainerBeingTold)
{
    parent->addPart(child);

    parent->_basicSetUncontained(child.getImpl());

    EXPECT_TRUE(isInTopLevelSet(child));
    EXPECT_THAT(parent->fields.parts, ElementsAre(ModelElement(child)));
    parent->fields.parts.clear();
}

// ---------------------------------------------------------------------------- recording

class WhatAMoveRecords : public Containment
{
protected:
    WhatAMoveRecords()
    {
        parent->addPart(Plain::create(model, uuidOf(4)));
        listen(model, listener);
    }
    ~WhatAMoveRecords() override { model->removeListener(&listener); }

    ScriptedListener listener;
};

TEST_F(WhatAMoveRecords, NamesTheElementAndBothContainers)
{
    parent->addChild(child);
    listener.committed.clear();

    other->addChild(child);

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_THAT(plains(listener.committed[0]->getChanged()),
                UnorderedElementsAre(child, parent, other));
}

TEST_F(WhatAMoveRecords, ComesInTheOrderInWhichTheEndsChange)
{
    parent->addChild(child);
    parent->name = "parent";
    other->name = "other";
    child->name = "child";
    std::vector<std::string> trace;
    Plain::Impl::trace = &trace;
    Plain::Impl::tracesModifications = true;

    other->addChild(child);
    Plain::Impl::trace = nullptr;
    Plain::Impl::tracesModifications = false;

    EXPECT_THAT(trace, ElementsAre("modify 2 other", "modify 3 child", "modify 2 parent"));
}

TEST_F(WhatAMoveRecords, IsTakenBackByARollback)
{
    parent->addChild(child);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    other->addChild(child);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(child->container(), parent);
    EXPECT_THAT(parent->fields.children, ElementsAre(ModelElement(child)));
    EXPECT_THAT(other->fields.children, IsEmpty());
    EXPECT_FALSE(isInTopLevelSet(child));
}

TEST_F(WhatAMoveRecords, IsTakenBackWhereTheElementHasNoPropertyOfItsOwn)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    parent->addPart(child);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(child->isTopLevel());
    EXPECT_TRUE(isInTopLevelSet(child));
    EXPECT_THAT(parent->fields.parts, Not(Contains(ModelElement(child))));
}

TEST_F(WhatAMoveRecords, IsTakenBackForAReleasedElementThatNobodyHolds)
{
    ModelElement::Impl* const impl = model->findElementImpl(uuidOf(4));
    Transaction transaction = model->beginTransaction(/*revertible=*/true);
    impl->makeUncontained();

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(impl->container(), parent);
    EXPECT_FALSE(isInTopLevelSet(ModelElement(impl)));
    listener.rolledBack.clear();  // reports keep what they name
    transaction = Transaction();
    EXPECT_EQ(impl->getRefCount(), 1u);
}

TEST_F(WhatAMoveRecords, IsTheFirstContainerOfSeveral)
{
    parent->addChild(child);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    Plain const third = Plain::create(model);
    other->addChild(child);
    third->addPart(child);
    child->makeUncontained();

    transaction.rollBack();

    EXPECT_EQ(child->container(), parent);
    EXPECT_EQ(child->getContainment(), Feature(Plain::Impl::CHILDREN_SLOT));
}

TEST_F(WhatAMoveRecords, IsNothingForAnElementMovedUnderConstruction)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    Plain const fresh = Plain::create(model);
    parent->addPart(fresh);
    transaction.commit();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_THAT(plains(listener.committed[0]->getCreated()), ElementsAre(fresh));
    EXPECT_THAT(plains(listener.committed[0]->getChanged()), ElementsAre(parent));
}

// ---------------------------------------------------------------------------- the link itself

TEST_F(TheContainerLink, IsSetWithoutTheContainersKnowledge)
{
    child->basicSetContainer(parent.getImpl(), Plain::Impl::CHILDREN_SLOT, Plain::Impl::NO_INDEX);

    EXPECT_EQ(child->container(), parent);
    EXPECT_FALSE(isInTopLevelSet(child));
    EXPECT_THAT(parent->fields.children, IsEmpty());

    child->basicSetContainer(nullptr, Feature(), Plain::Impl::NO_INDEX);
    EXPECT_TRUE(isInTopLevelSet(child));
}

TEST_F(TheContainerLink, IsClearedByAContainerWithoutAProperty)
{
    parent->addPart(child);

    child->basicSetContainer(parent.getImpl(), Feature(), Plain::Impl::NO_INDEX);

    EXPECT_TRUE(child->isTopLevel());
    EXPECT_TRUE(isInTopLevelSet(child));
    parent->fields.parts.clear();
}

TEST_F(TheContainerLink, IsClearedByAPropertyWithoutAContainer)
{
    parent->addPart(child);

    child->basicSetContainer(nullptr, Plain::Impl::PARTS_SLOT, Plain::Impl::NO_INDEX);

    EXPECT_TRUE(isInTopLevelSet(child));
    parent->fields.parts.clear();
}

TEST_F(TheContainerLink, AnnouncesTheIndexItIsGiven)
{
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    child->basicSetContainer(nullptr, Feature(), Plain::Impl::PARENT);
    other->basicSetContainer(nullptr, Feature(), Plain::Impl::NO_INDEX);
    transaction.commit();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_THAT(plains(listener.committed[0]->getChanged()), ElementsAre(child));
    model->removeListener(&listener);
}

TEST_F(TheContainerLink, DoesNotLeadIntoAnotherModel)
{
    Model const elsewhere = Model::create(ModelConstellation());
    Plain const stranger = Plain::create(elsewhere);
    parent->addPart(child);

    EXPECT_RAISES_WITH(
        messages::CannotChangeModel,
        child->basicSetContainer(stranger.getImpl(), Plain::Impl::PARTS_SLOT, Plain::Impl::PARENT));

    EXPECT_EQ(child->container(), parent);
    EXPECT_FALSE(isInTopLevelSet(child));
}

TEST_F(TheContainerLink, RecordsThePropertyThoughItRefusesTheModel)
{
    ScriptedListener listener;
    listen(model, listener);
    Model const elsewhere = Model::create(ModelConstellation());
    Plain const stranger = Plain::create(elsewhere);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    EXPECT_RAISES(
        messages::CannotChangeModel,
        child->basicSetContainer(stranger.getImpl(), Plain::Impl::PARTS_SLOT, Plain::Impl::PARENT));
    transaction.commit();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_THAT(plains(listener.committed[0]->getChanged()), ElementsAre(child));
    model->removeListener(&listener);
}

// ---------------------------------------------------------------------------- circles

TEST_F(ACircle, IsFoundWhereTheContainerIsTheElementOrLiesBelowIt)
{
    Plain const grandchild = Plain::create(model);
    parent->addChild(child);
    child->addPart(grandchild);

    EXPECT_RAISES_WITH(messages::CircularContainment, parent->checkCircularContainment(parent));
    EXPECT_RAISES_WITH(messages::CircularContainment, parent->checkCircularContainment(child));
    EXPECT_RAISES_WITH(messages::CircularContainment, parent->checkCircularContainment(grandchild));
}

TEST_F(ACircle, IsNotFoundAboveBesideOrInNothing)
{
    parent->addChild(child);

    child->checkCircularContainment(parent);
    parent->checkCircularContainment(other);
    other->checkCircularContainment(child);
    parent->checkCircularContainment(ModelElement());
}

TEST_F(ACircle, IsRefusedBeforeAnythingChanges)
{
    parent->addChild(child);

    EXPECT_RAISES(messages::CircularContainment, child->addChild(parent));
    EXPECT_RAISES(messages::CircularContainment, parent->addPart(parent));
    EXPECT_RAISES(messages::CircularContainment, parent->setParent(child));

    EXPECT_TRUE(parent->isTopLevel());
    EXPECT_THAT(child->fields.children, IsEmpty());
}

TEST_F(ACircle, IsLookedForInAChainOfAnyLength)
{
    Plain const deepest = addChain(parent, 20'000);

    EXPECT_RAISES(messages::CircularContainment, parent->checkCircularContainment(deepest));
    deepest->checkCircularContainment(other);
}

// ---------------------------------------------------------------------------- inverse calls

TEST_F(AnInverseCall, GoesNowhereWithoutAnotherEndOrToAProxy)
{
    Plain const proxy = Plain::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"x"));

    child->_inverseAddThis(nullptr, Plain::Impl::LINKS_SLOT, /*force=*/true);
    child->_inverseRemoveThis(nullptr, Plain::Impl::LINKS_SLOT);
    child->_inverseAddThis(proxy.getImpl(), Plain::Impl::LINKS_SLOT, /*force=*/true);
    child->_inverseRemoveThis(proxy.getImpl(), Plain::Impl::LINKS_SLOT);
    child->_convertToProxy(nullptr, Plain::Impl::LINKS_SLOT, ProxyId());
    child->_convertToProxy(proxy.getImpl(), Plain::Impl::LINKS_SLOT, ProxyId());

    EXPECT_THAT(proxy->fields.links, IsEmpty());
    EXPECT_FALSE(child->_inverseContainsThis(nullptr, Plain::Impl::LINKS_SLOT));
    EXPECT_FALSE(child->_inverseContainsThis(proxy.getImpl(), Plain::Impl::LINKS_SLOT));
}

TEST_F(AnInverseCall, ReachesTheOtherEnd)
{
    child->_inverseAddThis(other.getImpl(), Plain::Impl::LINKS_SLOT, /*force=*/false);
    EXPECT_THAT(other->fields.links, ElementsAre(ModelElement(child)));

    child->_inverseRemoveThis(other.getImpl(), Plain::Impl::LINKS_SLOT);
    EXPECT_THAT(other->fields.links, IsEmpty());
}

TEST_F(AnInverseCall, IsLeftToTheOtherSideOfAPlainListDuringAParse)
{
    Model::ParseInProgressIndicator const parsing = model->startParse();

    child->_inverseAddThis(other.getImpl(), Plain::Impl::LINKS_SLOT, /*force=*/false);

    EXPECT_THAT(other->fields.links, IsEmpty());
}

TEST_F(AnInverseCall, IsMadeDuringAParseWhenForced)
{
    {
        Model::ParseInProgressIndicator const parsing = model->startParse();
        child->_inverseAddThis(other.getImpl(), Plain::Impl::LINKS_SLOT, /*force=*/true);
    }

    EXPECT_THAT(other->fields.links, ElementsAre(ModelElement(child)));
    child->_inverseRemoveThis(other.getImpl(), Plain::Impl::LINKS_SLOT);
}

TEST_F(AnInverseCall, IsMadeDuringAParseForSingleAndContainedOnes)
{
    {
        Model::ParseInProgressIndicator const parsing = model->startParse();
        child->_inverseAddThis(other.getImpl(), Plain::Impl::PEER_SLOT, /*force=*/false);
        other->_inverseAddThis(child.getImpl(), Plain::Impl::PARENT_SLOT, /*force=*/false);
        child->_inverseAddThis(other.getImpl(), Plain::Impl::CHILDREN_SLOT, /*force=*/false);
    }

    EXPECT_EQ(other->fields.peer, child);
    EXPECT_EQ(child->container(), other);
    EXPECT_THAT(other->fields.children, ElementsAre(ModelElement(child)));
    child->fields.peer = other;
}

TEST_F(AnInverseCall, IsSkippedByTheParseOfItsOwnModelOnly)
{
    Model const elsewhere = Model::create(ModelConstellation());
    Model::ParseInProgressIndicator const parsing = elsewhere->startParse();

    child->_inverseAddThis(other.getImpl(), Plain::Impl::LINKS_SLOT, /*force=*/false);

    EXPECT_THAT(other->fields.links, ElementsAre(ModelElement(child)));
    other->fields.links.clear();
}

// ---------------------------------------------------------------------------- base class

TEST_F(TheBaseOfAllElements, KnowsNoProperty)
{
    meta::Property const none;
    ModelElement::Impl& base = *parent.getImpl();

    EXPECT_RAISES_WITH(messages::NoSuchProperty, base.inverseAdd(child, none), u"", u"");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, base.inverseContainsProxyTo(child, none), u"",
                       u"");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, base.ModelElement::Impl::copyValue(nullptr, 7),
                       u"", u"");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       base.hasPropertyValue(none, ModelElement::Impl::PUBLIC_ACCESS), u"", u"");
    EXPECT_EQ(base.identifier(), u"");
    EXPECT_FALSE(base.getPropertyByIndex(1));
}

TEST(TheReflectionTags, AreFourAndToldApartByTheirAddress)
{
    using Impl = ModelElement::Impl;
    std::set<void const*> const tags{&Impl::PUBLIC_ACCESS, &Impl::PRIVILEGED_ACCESS,
                                     &Impl::NO_PROXY_RESOLVE, &Impl::IN_MEMORY_ONLY};

    EXPECT_EQ(tags.size(), 4u);
    EXPECT_EQ(Impl::NO_INDEX, ~0UL);
}
}  // namespace
