#include "tarnkiln/kernel/ModelImpl.h"

#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/kernel/ModelFixture.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;
using Validity = ElementImpl::ElementValidity;

ustring memoryUriOf(Model const& model)
{
    std::string const digits = std::to_string(model->getModelCounter());
    return u"memory://" + ustring(digits.begin(), digits.end());
}

// ---------------------------------------------------------------------------- creation

TEST(AModel, LivesInAConstellationOfItsOwnIfNoneIsGiven)
{
    Model const model = Model::create(ModelConstellation());

    ModelConstellation const home = model->getModelConstellation();
    ASSERT_TRUE(home);
    EXPECT_THAT(home->getModels(), ElementsAre(model));
    EXPECT_FALSE(home->isMultiModelConstellation());
    EXPECT_FALSE(model->isMultiModel());
}

TEST(AModel, LivesInAConstellationOfItsOwnIfTheGivenOneIsDead)
{
    ModelConstellation const dead = ModelConstellation::create();
    dead->destroy();

    Model const model = Model::create(dead);

    EXPECT_TRUE(model->getModelConstellation());
    EXPECT_NE(model->getModelConstellation(), dead);
}

TEST(AModel, JoinsTheConstellationItIsCreatedIn)
{
    ModelConstellation const home = ModelConstellation::create();
    Model const first = Model::create(home);
    Model const second = Model::create(home);

    EXPECT_EQ(first->getModelConstellation(), home);
    EXPECT_THAT(home->getModels(), UnorderedElementsAre(first, second));
    EXPECT_TRUE(first->isMultiModel());
}

TEST(AModel, IsNamedAfterTheCounterOfTheProcess)
{
    Model const first = Model::create(ModelConstellation());
    Model const second = Model::create(ModelConstellation());

    EXPECT_EQ(second->getModelCounter(), first->getModelCounter() + 1);
    EXPECT_EQ(first->getModelURI(), memoryUriOf(first));
    EXPECT_EQ(first->getLocationModelId(), memoryUriOf(first));
    EXPECT_EQ(second->getModelURI(), memoryUriOf(second));
}

TEST(AModel, CountsModelsOutsideConstellationsToo)
{
    Model const first = Model::createTransientModel();
    Model const second = Model::createRegistryModel(u"registry://counted");

    EXPECT_EQ(second->getModelCounter(), first->getModelCounter() + 1);
}

TEST(AModel, KeepsItsUuidAndTakesAFreshOneForTheNilOne)
{
    EXPECT_EQ(Model::create(uuidOf(4), ModelConstellation())->getUuid(), uuidOf(4));
    EXPECT_EQ(Model::createTransientModel(uuidOf(5))->getUuid(), uuidOf(5));
    EXPECT_EQ(Model::createRegistryModel(u"registry://id", uuidOf(6))->getUuid(), uuidOf(6));
    EXPECT_FALSE(Model::create(UUID{}, ModelConstellation())->getUuid().is_nil());
    EXPECT_FALSE(Model::create(ModelConstellation())->getUuid().is_nil());
}

TEST(AModel, IsValidFromItsConstructionAndItsOwnModel)
{
    Model const model = Model::create(ModelConstellation());

    EXPECT_EQ(model->getValidity(), Validity::Valid);
    EXPECT_EQ(model->getModel(), model);
    EXPECT_EQ(model->getRefCount(), 1u);
}

TEST(AModel, IsOfOneOfThreeKinds)
{
    Model const ordinary = Model::create(ModelConstellation());
    Model const registry = Model::createRegistryModel(u"some@registry://model");
    Model const transient = Model::createTransientModel();

    EXPECT_FALSE(ordinary->isRegistryModel());
    EXPECT_FALSE(ordinary->isTransientModel());
    EXPECT_TRUE(registry->isRegistryModel());
    EXPECT_FALSE(registry->isTransientModel());
    EXPECT_FALSE(transient->isRegistryModel());
    EXPECT_TRUE(transient->isTransientModel());
}

TEST(ARegistryModel, KeepsItsUriAsItIsAndLiesInNoConstellation)
{
    Model const model = Model::createRegistryModel(u"some@registry://model");

    EXPECT_EQ(model->getModelURI(), u"some@registry://model");
    EXPECT_EQ(model->getLocationModelId(), u"some@registry://model");
    EXPECT_FALSE(model->getModelConstellation());
    EXPECT_FALSE(model->isMultiModel());
}

TEST(ARegistryModel, WithoutAUriIsATransientModel)
{
    EXPECT_TRUE(Model::createRegistryModel(u"")->isTransientModel());
}

TEST(ATransientModel, HasNoUri)
{
    Model const model = Model::createTransientModel();

    EXPECT_EQ(model->getModelURI(), u"");
    EXPECT_EQ(model->getLocationModelId(), u"");
}

// ---------------------------------------------------------------------------- registry

using AnElement = ModelFixture;

TEST_F(AnElement, IsConstructingUntilItsModelIsTold)
{
    Plain const element(new Plain::Impl(model, uuidOf(1)));
    EXPECT_EQ(element->getValidity(), Validity::Constructing);
    EXPECT_FALSE(model->findElement(uuidOf(1)));

    element->notifyCreated();

    EXPECT_EQ(element->getValidity(), Validity::Valid);
    EXPECT_EQ(model->findElement(uuidOf(1)), element);
}

TEST_F(AnElement, IsBornTopLevelAndKeptByItsModel)
{
    Plain::Impl* const impl = Plain::create(model, uuidOf(1)).getImpl();

    EXPECT_EQ(impl->getRefCount(), 1u);
    EXPECT_TRUE(impl->isTopLevel());
    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(ModelElement(impl)));
    EXPECT_EQ(model->findElementImpl(uuidOf(1)), impl);
    EXPECT_EQ(model->getElementCount(), 1u);
}

TEST_F(AnElement, IsFoundByItsUuidOnly)
{
    Plain const element = Plain::create(model, uuidOf(1));

    EXPECT_EQ(model->findElement(uuidOf(1)), element);
    EXPECT_FALSE(model->findElement(uuidOf(2)));
    EXPECT_FALSE(model->findElement(UUID{}));
    EXPECT_EQ(model->findElementImpl(uuidOf(2)), nullptr);
}

TEST_F(AnElement, IsFoundInItsOwnModelOnly)
{
    Model const other = Model::create(ModelConstellation());
    Plain const here = Plain::create(model, uuidOf(1));
    Plain const there = Plain::create(other, uuidOf(1));

    EXPECT_EQ(model->findElement(uuidOf(1)), here);
    EXPECT_EQ(other->findElement(uuidOf(1)), there);
}

TEST_F(AnElement, NeedsAModelThatLives)
{
    Model const dead = Model::create(ModelConstellation());
    dead->destroy();

    EXPECT_RAISES_WITH(messages::CannotCreateWithoutModel, Plain::create(Model()));
    EXPECT_RAISES_WITH(messages::CannotCreateWithoutModel, Plain::create(dead));
}

TEST_F(AnElement, ThatCouldNotBeConstructedLeavesNothingBehind)
{
    ExpectNoLeakedElements const noLeaks;

    EXPECT_RAISES(messages::CannotCreateWithoutModel, Plain::create(Model()));
}

TEST_F(AnElement, IsToldLastOfItsCreation)
{
    bool registered = false;
    bool topLevel = false;
    Plain::Impl::whenCreated = [&](Plain::Impl& element) {
        registered = model->findElementImpl(element.getUuid()) == &element;
        topLevel = !model->getTopLevelElements().empty();
    };

    Plain::create(model);
    Plain::Impl::whenCreated = nullptr;

    EXPECT_TRUE(registered);
    EXPECT_TRUE(topLevel);
}

TEST_F(AnElement, IsInTheListOfTopLevelElementsThatWasAskedForBeforeItLeftIt)
{
    Plain const parent = Plain::create(model);
    Plain const child = Plain::create(model);
    std::vector<ModelElement> const before = model->getTopLevelElements();

    parent->addChild(child);

    EXPECT_THAT(before, UnorderedElementsAre(parent, child));
    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(ModelElement(parent)));
}

class ATakenUuid : public ModelFixture
{
protected:
    Plain const occupant = Plain::create(model, uuidOf(1));
};

TEST_F(ATakenUuid, RefusesANewcomerAndTakesItsUuidAway)
{
    Plain newcomer(new Plain::Impl(model, uuidOf(1)));

    EXPECT_RAISES_WITH(messages::UUIDConflict, newcomer->notifyCreated());

    EXPECT_TRUE(newcomer->getUuid().is_nil());
    EXPECT_EQ(model->findElement(uuidOf(1)), occupant);
    EXPECT_FALSE(model->findElement(UUID{}));
    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(ModelElement(occupant)));
    newcomer = Plain();
    EXPECT_EQ(model->findElement(uuidOf(1)), occupant);
}

TEST_F(ATakenUuid, LeavesNoTraceOfTheNewcomerInTheTransaction)
{
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    EXPECT_RAISES(messages::UUIDConflict, Plain::create(model, uuidOf(1)));
    transaction.commit();

    EXPECT_THAT(listener.committed, IsEmpty());
    model->removeListener(&listener);
}

TEST_F(ATakenUuid, IsFreeAgainWhenTheOccupantIsDestroyed)
{
    occupant->destroy();

    Plain const successor = Plain::create(model, uuidOf(1));

    EXPECT_EQ(model->findElement(uuidOf(1)), successor);
}

TEST_F(ATakenUuid, StaysTheOccupantsWhenTheNewcomerFailsBeforeTheConflictIsSeen)
{
    {
        Model::Freezer const freezer = model->freeze();
        EXPECT_RAISES(messages::ModelFrozen, Plain::create(model, uuidOf(1)));
    }
    {
        Plain(new Plain::Impl(model, uuidOf(1)));  // never announced
    }

    EXPECT_EQ(model->findElement(uuidOf(1)), occupant);
    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(ModelElement(occupant)));
}

TEST_F(AnElement, ThatWasNeverAnnouncedDiesWithItsLastHandle)
{
    ExpectNoLeakedElements const noLeaks;
    Plain(new Plain::Impl(model, uuidOf(1)));

    EXPECT_FALSE(model->findElement(uuidOf(1)));
}

TEST_F(AnElement, WhoseTransactionRefusesItIsForgotten)
{
    ExpectNoLeakedElements const noLeaks;
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    model->allElementsDestroying();

    EXPECT_RAISES_WITH(messages::CreateWithDestroyAll, Plain::create(model, uuidOf(1)));

    EXPECT_FALSE(model->findElement(uuidOf(1)));
    EXPECT_THAT(model->getTopLevelElements(), IsEmpty());
}

// ---------------------------------------------------------------------------- URI

TEST(TheUriOfAModel, MayBeSetToItselfEvenWithoutAConstellation)
{
    Model const transient = Model::createTransientModel();
    Model const registry = Model::createRegistryModel(u"registry://fixed");

    transient->setModelURI(u"");
    registry->setModelURI(u"registry://fixed");

    EXPECT_EQ(transient->getModelURI(), u"");
    EXPECT_EQ(registry->getModelURI(), u"registry://fixed");
}

TEST(TheUriOfAModel, IsFixedWithoutAConstellation)
{
    Model const transient = Model::createTransientModel();
    Model const registry = Model::createRegistryModel(u"registry://fixed");

    EXPECT_RAISES_WITH(messages::InvalidValue, transient->setModelURI(u"file://a"));
    EXPECT_RAISES_WITH(messages::InvalidValue, registry->setModelURI(u"file://a"));

    EXPECT_TRUE(transient->isTransientModel());
    EXPECT_EQ(registry->getModelURI(), u"registry://fixed");
}

TEST(TheUriOfAModel, IsWhereItsConstellationFindsIt)
{
    Model const model = Model::create(ModelConstellation());
    ModelConstellation const home = model->getModelConstellation();
    ustring const before = model->getModelURI();

    model->setModelURI(u"file://a");

    EXPECT_EQ(model->getModelURI(), u"file://a");
    EXPECT_EQ(model->getLocationModelId(), u"file://a");
    EXPECT_EQ(home->peekModel(u"file://a"), model);
    EXPECT_FALSE(home->peekModel(before));
}

TEST(TheUriOfAModel, MayNotBeThatOfAnotherModelOfItsConstellation)
{
    ModelConstellation const home = ModelConstellation::create();
    Model const first = Model::create(home);
    Model const second = Model::create(home);
    first->setModelURI(u"file://a");
    second->setModelURI(u"file://b");

    EXPECT_RAISES_WITH(messages::UniquenessConstraint, second->setModelURI(u"file://a"));

    EXPECT_EQ(second->getModelURI(), u"file://b");
    EXPECT_EQ(home->peekModel(u"file://a"), first);
    EXPECT_EQ(home->peekModel(u"file://b"), second);
}

TEST(TheUriOfAModel, MayBeThatOfAModelOfAnotherConstellation)
{
    Model const first = Model::create(ModelConstellation());
    Model const second = Model::create(ModelConstellation());

    first->setModelURI(u"file://a");
    second->setModelURI(u"file://a");

    EXPECT_EQ(first->getModelURI(), second->getModelURI());
}

TEST(TheUriOfAModel, ChangesInNoTransactionAndStaysAfterARollback)
{
    Model const model = Model::create(ModelConstellation());
    Model::Freezer const freezer = model->freeze();
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    model->setModelURI(u"file://a");
    transaction.rollBack();

    EXPECT_EQ(model->getModelURI(), u"file://a");
}
}  // namespace
