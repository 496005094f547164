#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/Uuids.h"

#include <boost/uuid/uuid_io.hpp>
#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::AllOf;
using ::testing::Contains;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

/// A model whose structure each test breaks in one way and mends again.
class Invariants : public ::testing::Test
{
protected:
    ~Invariants() override { EXPECT_THAT(model->checkInvariants(), IsEmpty()) << "not mended"; }

    /// Expects a violation of that sentence which names `element`.
    void expectViolation(ModelElement const& element, std::string const& sentence) const
    {
        std::string const id = boost::uuids::to_string(element->getUuid());
        EXPECT_THAT(model->checkInvariants(), Contains(AllOf(HasSubstr(sentence), HasSubstr(id))));
    }

    Model const model = Model::create(ModelConstellation());
    Plain const parent = Plain::create(model, uuidOf(1));
    Plain const child = Plain::create(model, uuidOf(2));
    Plain const other = Plain::create(model, uuidOf(3));
};

using AConsistentModel = Invariants;
using ABrokenModel = Invariants;

TEST_F(AConsistentModel, HasNoViolations)
{
    parent->addChild(child);
    child->addPart(other);
    parent->setPeer(other);
    other->addLink(child);
    child->setLook(parent);

    EXPECT_THAT(model->checkInvariants(), IsEmpty());
}

TEST_F(AConsistentModel, MayReferToTheDeadToProxiesAndToOtherModels)
{
    Model const elsewhere = Model::create(ModelConstellation());
    Plain const dead = Plain::create(model);
    parent->setLook(dead);
    dead->destroy();
    child->setLook(Plain::create(elsewhere));
    other->fields.peer = Plain::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"x"));

    EXPECT_THAT(model->checkInvariants(), IsEmpty());
}

TEST_F(AConsistentModel, MayHaveOneSidedListsDuringAParse)
{
    parent->fields.links.push_back(other);
    {
        Model::ParseInProgressIndicator const parsing = model->startParse();
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
    }

    expectViolation(other, "is referred to and does not refer back");
    other->fields.backlinks.push_back(parent);
}

TEST_F(ABrokenModel, HasAReferenceThatIsNotAnswered)
{
    parent->fields.peer = other;
    expectViolation(other, "is referred to and does not refer back");

    other->fields.peer = child;  // answers, but another one
    expectViolation(other, "is referred to and does not refer back");
    expectViolation(child, "is referred to and does not refer back");

    other->fields.peer = parent;
}

TEST_F(ABrokenModel, HasAContainerThatHoldsWhatLiesElsewhere)
{
    parent->addChild(child);
    other->fields.children.push_back(child);

    expectViolation(child, "is held by a composite that it does not call its container");

    other->fields.children.clear();
}

TEST_F(ABrokenModel, HasAContainerThatHoldsATopLevelElement)
{
    parent->fields.parts.push_back(child);

    expectViolation(child, "is held by a composite that it does not call its container");

    parent->fields.parts.clear();
}

TEST_F(ABrokenModel, HasAContainerThatHoldsItsContentsInAnotherProperty)
{
    parent->addChild(child);
    parent->fields.parts = std::exchange(parent->fields.children, {});

    expectViolation(child, "is held by a composite that it does not call its container");

    parent->fields.children = std::exchange(parent->fields.parts, {});
}

TEST_F(ABrokenModel, HasAnElementThatItsContainerDoesNotHold)
{
    child->basicSetContainer(parent.getImpl(), Plain::Impl::PARTS_SLOT, Plain::Impl::NO_INDEX);

    expectViolation(child, "calls a container its own that does not hold it");

    parent->fields.parts.push_back(child);
}

TEST_F(ABrokenModel, HasAnElementInAContainerThatIsDead)
{
    Plain const dead = Plain::create(model);
    dead->destroy();
    child->basicSetContainer(dead.getImpl(), Plain::Impl::PARTS_SLOT, Plain::Impl::NO_INDEX);

    expectViolation(child, "lies in a container that the model does not hold");

    child->basicSetContainer(nullptr, Feature(), Plain::Impl::NO_INDEX);
}

TEST_F(ABrokenModel, HasElementsThatContainOneAnother)
{
    parent->addPart(child);
    child->fields.parts.push_back(parent);
    parent->basicSetContainer(child.getImpl(), Plain::Impl::PARTS_SLOT, Plain::Impl::NO_INDEX);

    EXPECT_THAT(model->checkInvariants(), Contains(HasSubstr("contains itself")));

    parent->basicSetContainer(nullptr, Feature(), Plain::Impl::NO_INDEX);
    child->fields.parts.clear();
}

TEST_F(ABrokenModel, HasATopLevelElementThatIsNotInTheSet)
{
    model->elementNoLongerTopLevel(child.getImpl());

    expectViolation(child, "disagrees with the top-level set");

    model->elementMadeTopLevel(child.getImpl());
}

TEST_F(ABrokenModel, HasAContainedElementInTheTopLevelSet)
{
    parent->addPart(child);
    model->elementMadeTopLevel(child.getImpl());

    expectViolation(child, "disagrees with the top-level set");
    expectViolation(child, "stands in the top-level set without being a top-level element");

    model->elementNoLongerTopLevel(child.getImpl());
}

TEST_F(ABrokenModel, HasATopLevelElementThatIsNotRegistered)
{
    Plain const stray(new Plain::Impl(model, uuidOf(9)));
    model->elementMadeTopLevel(stray.getImpl());

    expectViolation(stray, "stands in the top-level set without being a top-level element");

    model->elementNoLongerTopLevel(stray.getImpl());
}

TEST_F(ABrokenModel, HasARegisteredElementThatIsNotValid)
{
    Plain const early(new Plain::Impl(model, uuidOf(9)));
    model->elementCreated(early.getImpl(), /*topLevel=*/true);

    expectViolation(early, "is registered without being valid");

    model->remove(early.getImpl());
}

TEST_F(ABrokenModel, HasARegisteredProxy)
{
    Plain const proxy = Plain::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"x"));
    model->elementCreated(proxy.getImpl(), /*topLevel=*/true);

    EXPECT_THAT(model->checkInvariants(), Contains(HasSubstr("is a registered proxy")));

    model->remove(proxy.getImpl());
}

TEST_F(ABrokenModel, HasAnElementOfAnotherModelInItsRegistry)
{
    Model const elsewhere = Model::createTransientModel();
    Plain const stranger = Plain::create(elsewhere, uuidOf(9));
    model->elementCreated(stranger.getImpl(), /*topLevel=*/false);

    expectViolation(stranger, "is registered in a model that is not its own");

    model->remove(stranger.getImpl());
}

TEST_F(ABrokenModel, ShowsAllViolationsAtOnce)
{
    parent->fields.peer = other;
    model->elementNoLongerTopLevel(child.getImpl());

    EXPECT_EQ(model->checkInvariants().size(), 2u);

    model->elementMadeTopLevel(child.getImpl());
    parent->fields.peer = ModelElement();
}

TEST(TheInvariantCheck, NeedsLittleStackForDeepTrees)
{
    Model const model = Model::create(ModelConstellation());
    addChain(Plain::create(model), 20'000);

    EXPECT_THAT(model->checkInvariants(), IsEmpty());
}

#ifdef TARNKILN_CHECKED
TEST(TheInvariantCheckDeathTest, EndsTheProcessWhenATransactionLeavesABrokenModel)
{
    Model const model = Model::create(ModelConstellation());
    Plain const first = Plain::create(model);
    Plain const second = Plain::create(model);

    EXPECT_DEATH(
        {
            Transaction const transaction = model->beginTransaction(/*revertible=*/false);
            first->fields.peer = second;
            transaction.commit();
        },
        "a model is consistent when a transaction has ended");
}
#endif
}  // namespace
