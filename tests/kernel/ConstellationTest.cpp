#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/FakeNormalizer.h"
#include "tests/support/InvalidationLog.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/TracingConstellationListener.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

ProxyId remoteId(ModelElement const& element, ustring const& uri)
{
    return ProxyId(ElementId(element->getPersistentProxyId(true)), uri);
}

class Constellation : public ::testing::Test
{
protected:
    /// A new member.
    Model modelAt(ustring const& uri) const
    {
        Model const model = Model::create(home);
        model->setModelURI(uri);
        return model;
    }

    ModelConstellation const home = ModelConstellation::create();
};

/// With two members.
class AReferenceAcrossModels : public Constellation
{
protected:
    Plain proxyOf(ProxyId const& id) const { return Plain::createProxy(here, id); }

    Model const here = Model::create(home);
    Model const there = modelAt(u"file://a");
    InstalledNormalizer const normalizer;
};

/// With a service that loads and saves models.
class AFetchedModel : public Constellation
{
protected:
    InstalledNormalizer const normalizer;
};

using AConstellation = Constellation;
using AJoiningModel = Constellation;
using AGroup = Constellation;
using TheHistoryOfUris = Constellation;
using SavingAllModels = AFetchedModel;
using ADestroyedConstellation = Constellation;

// ---------------------------------------------------------------------------- members

TEST_F(AConstellation, IsValidAndEmptyAtFirst)
{
    EXPECT_TRUE(home);
    EXPECT_EQ(home->getValidity(), ElementImpl::ElementValidity::Valid);
    EXPECT_EQ(home->getRefCount(), 1u);
    EXPECT_FALSE(home->getUuid().is_nil());
    EXPECT_THAT(home->getModels(), IsEmpty());
    EXPECT_FALSE(home->isMultiModelConstellation());
    EXPECT_FALSE(home->hasAliveModels());
    EXPECT_FALSE(home->getModel());
    EXPECT_EQ(home->getTransactionGroup(), nullptr);
}

TEST_F(AConstellation, IsForSeveralModelsFromTheSecondOn)
{
    Model const first = Model::create(home);
    EXPECT_FALSE(home->isMultiModelConstellation());

    Model const second = Model::create(home);
    EXPECT_TRUE(home->isMultiModelConstellation());

    second->destroy();
    EXPECT_FALSE(home->isMultiModelConstellation());
}

TEST_F(AConstellation, KnowsItsModelsInTheOrderOfTheirLocations)
{
    Model const b = Model::create(home);
    Model const c = Model::create(home);
    Model const a = Model::create(home);
    b->setModelURI(u"file://b");
    c->setModelURI(u"file://c");
    a->setModelURI(u"file://a");

    EXPECT_THAT(home->getModels(), ElementsAre(a, b, c));
}

TEST_F(AConstellation, KnowsWhetherSomebodyHoldsOneOfItsModels)
{
    Model model = Model::create(home);
    EXPECT_TRUE(home->hasAliveModels());

    model = Model();
    EXPECT_FALSE(home->hasAliveModels());
    EXPECT_EQ(home->getRefCount(), 1u) << "the question itself holds nothing";
}

TEST_F(AConstellation, FindsAModelByItsLocationAndLoadsNothing)
{
    InstalledNormalizer const normalizer;
    Model const model = Model::create(home);

    EXPECT_EQ(home->peekModel(model->getModelURI()), model);
    EXPECT_FALSE(home->peekModel(u"file://unknown"));
    EXPECT_THAT(normalizer->loads, IsEmpty());
}

TEST_F(AConstellation, FindsAModelByAnIdThatANormalizerTurnsIntoItsLocation)
{
    InstalledNormalizer const normalizer;
    normalizer->toLocation = [](ustring const& id) {
        return id == u"alias" ? boost::optional<ustring>(u"file://a") : boost::none;
    };
    Model const model = modelAt(u"alias");

    EXPECT_EQ(model->getLocationModelId(), u"file://a");
    EXPECT_EQ(home->peekModel(u"alias"), model);
    EXPECT_EQ(home->peekModel(u"file://a"), model);
}

TEST_F(AConstellation, FindsAModelThatNobodyHolds)
{
    ustring const uri = Model::create(home)->getModelURI();

    Model const found = home->peekModel(uri);

    ASSERT_TRUE(found);
    EXPECT_EQ(found->getModelURI(), uri);
}

TEST(TheUriOfAModel, IsStoredAsTheExternalFormOfItsLocation)
{
    InstalledNormalizer const normalizer;
    normalizer->toLocation = [](ustring const& id) { return u"location of " + id; };
    normalizer->toExternal = [](ustring const& id) { return u"form of " + id; };
    Model const model = Model::create(ModelConstellation());

    model->setModelURI(u"x");

    EXPECT_EQ(model->getLocationModelId(), u"location of x");
    EXPECT_EQ(model->getModelURI(), u"form of location of x");
}

TEST(TheUriOfAModel, IsFoundAtItsNewLocationEvenIfItsExternalFormFails)
{
    ModelConstellation const home = ModelConstellation::create();
    InstalledNormalizer const normalizer;
    Model model = Model::create(home);
    normalizer->toExternal = [](ustring const&) -> boost::optional<ustring> {
        throw std::runtime_error("no");
    };

    EXPECT_THROW(model->setModelURI(u"file://a"), std::runtime_error);

    EXPECT_EQ(home->peekModel(model->getLocationModelId()), model);
    model->destroy();
    model = Model();
    EXPECT_THAT(home->getModels(), IsEmpty());
}

// ---------------------------------------------------------------------------- joining

TEST_F(AJoiningModel, MayNotTakeATakenLocation)
{
    Model const first = modelAt(u"file://a");
    Model const second = Model::create(ModelConstellation());
    second->setModelURI(u"file://a");
    ModelConstellation const elsewhere = second->getModelConstellation();

    EXPECT_RAISES_WITH(messages::UniquenessConstraint,
                       home->addModelToConstellation(second.getImpl()));

    EXPECT_THAT(home->getModels(), ElementsAre(first));
    EXPECT_EQ(second->getModelConstellation(), elsewhere);
    EXPECT_THAT(elsewhere->getModels(), ElementsAre(second));
}

TEST_F(AJoiningModel, IsReleasedIfItsLocationIsTaken)
{
    InvalidationLog const log;
    Model const occupant = Model::create(home);
    std::string const next = std::to_string(occupant->getModelCounter() + 1);
    occupant->setModelURI(u"memory://" + ustring(next.begin(), next.end()));

    EXPECT_RAISES_WITH(messages::UniquenessConstraint, Model::create(home));

    EXPECT_THAT(home->getModels(), ElementsAre(occupant));
    EXPECT_EQ(log.calls().size(), 1u) << "the newcomer died";
    EXPECT_EQ(home->getRefCount(), 1u);
}

TEST_F(AJoiningModel, MayNotJoinAnOpenShallowGroup)
{
    InvalidationLog const log;
    Model const first = Model::create(home);
    Transaction const transaction = first->beginTransaction(/*revertible=*/false);

    EXPECT_RAISES_WITH(messages::CannotJoinShallowTransaction, Model::create(home));

    EXPECT_THAT(home->getModels(), ElementsAre(first));
    EXPECT_EQ(log.calls().size(), 1u) << "the newcomer died";
    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
    EXPECT_TRUE(Model::create(home));
}

TEST_F(AJoiningModel, IsRefusedAsJoiningAShallowGroupFirst)
{
    Model const first = Model::create(home);
    std::string const next = std::to_string(first->getModelCounter() + 1);
    first->setModelURI(u"memory://" + ustring(next.begin(), next.end()));
    Transaction const transaction = first->beginTransaction(/*revertible=*/false);

    EXPECT_RAISES(messages::CannotJoinShallowTransaction, Model::create(home));
}

TEST_F(AJoiningModel, TakesPartInAnOpenDeepGroup)
{
    Model const first = Model::create(home);
    Transaction const transaction = first->beginTransaction(/*revertible=*/true);

    Model const second = Model::create(home);
    ASSERT_NE(second->getCurrentTransaction(), nullptr);
    Plain const element = Plain::create(second);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_FALSE(element);
    EXPECT_EQ(second->getCurrentTransaction(), nullptr);
    EXPECT_TRUE(second);
}

TEST_F(AJoiningModel, IsAnnouncedBeforeItTakesPartInTheGroup)
{
    Model const first = Model::create(home);
    Transaction const transaction = first->beginTransaction(/*revertible=*/true);
    Trace trace;
    TracingListener listener(trace);
    bool hadTransaction = true;
    bool wasKnown = false;
    listener.onAdded = [&](ModelConstellation const& constellation, Model const& model) {
        EXPECT_EQ(constellation, home);
        hadTransaction = model->getCurrentTransaction() != nullptr;
        wasKnown = home->peekModel(model->getLocationModelId()) == model &&
                   model->getModelConstellation() == home;
    };
    home->addConstellationListener(&listener);

    Model const second = Model::create(home);

    EXPECT_FALSE(hadTransaction);
    EXPECT_TRUE(wasKnown);
    EXPECT_NE(second->getCurrentTransaction(), nullptr);
    home->removeConstellationListener(&listener);
}

TEST_F(AJoiningModel, StaysWhenAListenerFails)
{
    Trace trace;
    TracingListener listener(trace);
    listener.onAdded = [](ModelConstellation const&, Model const&) {
        throw std::runtime_error("no");
    };
    home->addConstellationListener(&listener);

    EXPECT_THROW(Model::create(home), std::runtime_error);

    EXPECT_EQ(home->getModels().size(), 1u);
    EXPECT_FALSE(home->hasAliveModels());
    home->removeConstellationListener(&listener);
}

TEST_F(AJoiningModel, LeavesItsOldConstellation)
{
    Trace trace;
    TracingListener listener(trace);
    Model const model = Model::create(ModelConstellation());
    ModelConstellation const old = model->getModelConstellation();
    old->addConstellationListener(&listener);

    home->addModelToConstellation(model.getImpl());

    EXPECT_EQ(model->getModelConstellation(), home);
    EXPECT_THAT(old->getModels(), IsEmpty());
    EXPECT_THAT(home->getModels(), ElementsAre(model));
    EXPECT_THAT(trace, ElementsAre("listener destroyed"));
    EXPECT_TRUE(model);
    old->removeConstellationListener(&listener);
}

TEST_F(AJoiningModel, MayBeTheLastThatHeldItsOldConstellation)
{
    InvalidationLog const log;
    Model const model = Model::create(ModelConstellation());
    ElementImpl const* const old = model->getModelConstellationImpl();

    home->addModelToConstellation(model.getImpl());

    EXPECT_EQ(log.deathsOf(old), 1);
    EXPECT_TRUE(model);
    EXPECT_EQ(model->getModelConstellation(), home);
}

// ---------------------------------------------------------------------------- groups

TEST_F(AGroup, IsShallowForOneModelUnlessAskedOtherwise)
{
    Model const model = Model::create(home);
    Plain const element = Plain::create(model);
    {
        Transaction const shallow = model->beginTransaction(/*revertible=*/false);
        change(element, 1);
    }
    EXPECT_EQ(element->getValue(), 1);
    {
        Transaction const deep = model->beginTransaction(/*revertible=*/true);
        change(element, 2);
    }
    EXPECT_EQ(element->getValue(), 1);
}

TEST_F(AGroup, IsDeepForSeveralModelsWhateverWasAsked)
{
    Model const first = Model::create(home);
    Plain const element = Plain::create(first);
    Model const second = Model::create(home);

    Transaction const transaction = second->beginTransaction(/*revertible=*/false);
    change(element, 1);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(element->getValue(), 0);
}

TEST_F(AGroup, SpansAllModelsUntilItEnds)
{
    Model const first = Model::create(home);
    Model const second = Model::create(home);

    Transaction const transaction = first->beginTransaction(/*revertible=*/false);
    EXPECT_NE(home->getTransactionGroup(), nullptr);
    EXPECT_NE(first->getCurrentTransaction(), nullptr);
    EXPECT_NE(second->getCurrentTransaction(), nullptr);
    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_EQ(home->getTransactionGroup(), nullptr);
    EXPECT_EQ(first->getCurrentTransaction(), nullptr);
    EXPECT_EQ(second->getCurrentTransaction(), nullptr);
}

TEST_F(AGroup, TellsModelsInTheOrderOfTheirLocations)
{
    Trace trace;
    ScriptedListener listenerOfB("b", &trace);
    ScriptedListener listenerOfA("a", &trace);
    Model const b = modelAt(u"file://b");
    Model const a = modelAt(u"file://a");
    listen(b, listenerOfB, {.prepare = false, .validate = false});
    listen(a, listenerOfA, {.prepare = false, .validate = false});
    Transaction const transaction = b->beginTransaction(/*revertible=*/true);
    Plain::create(b);
    Plain::create(a);

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_THAT(trace, ElementsAre("a committed", "b committed"));
}

// ---------------------------------------------------------------------------- history

TEST_F(TheHistoryOfUris, AnswersAnUnknownUriWithItself)
{
    EXPECT_EQ(home->getLatestModelURI(u"file://unknown"), u"file://unknown");
}

TEST_F(TheHistoryOfUris, FollowsRenames)
{
    Model const model = Model::create(home);
    ustring const born = model->getModelURI();
    model->setModelURI(u"file://a");
    model->setModelURI(u"file://b");

    EXPECT_EQ(home->getLatestModelURI(born), u"file://b");
    EXPECT_EQ(home->getLatestModelURI(u"file://a"), u"file://b");
    EXPECT_EQ(home->getLatestModelURI(u"file://b"), u"file://b");
}

TEST_F(TheHistoryOfUris, KeepsTheLastNameOfADestroyedModel)
{
    Model const model = Model::create(home);
    ustring const born = model->getModelURI();
    model->setModelURI(u"file://a");
    model->setModelURI(u"file://b");

    model->destroy();

    EXPECT_EQ(home->getLatestModelURI(u"file://a"), u"file://b");
    EXPECT_EQ(home->getLatestModelURI(born), u"file://b");
}

TEST_F(TheHistoryOfUris, ForgetsAModelThatLastLayInMemoryOnly)
{
    Model const model = Model::create(home);
    ustring const born = model->getModelURI();
    model->setModelURI(u"file://a");
    model->setModelURI(u"memory://z");

    model->destroy();

    EXPECT_EQ(home->getLatestModelURI(u"file://a"), u"file://a");
    EXPECT_EQ(home->getLatestModelURI(born), born);
}

TEST_F(TheHistoryOfUris, TakesMemoryForThatAtTheBeginningOnly)
{
    Model const model = modelAt(u"file://a");
    model->setModelURI(u"x@memory://z");

    model->destroy();

    EXPECT_EQ(home->getLatestModelURI(u"file://a"), u"x@memory://z");
}

TEST_F(TheHistoryOfUris, PointsToTheModelThatHasTheUriNow)
{
    Model const old = modelAt(u"file://a");
    old->setModelURI(u"file://b");
    EXPECT_EQ(home->getLatestModelURI(u"file://a"), u"file://b");
    Model const joining = Model::create(ModelConstellation());
    joining->setModelURI(u"file://a");

    home->addModelToConstellation(joining.getImpl());
    joining->setModelURI(u"file://c");

    EXPECT_EQ(home->getLatestModelURI(u"file://a"), u"file://c");
}

// ---------------------------------------------------------------------------- references

TEST_F(AReferenceAcrossModels, SurvivesARename)
{
    Transaction const transaction = here->beginTransaction(/*revertible=*/false);
    Plain const target = Plain::create(there, uuidOf(1));
    Plain const proxy = proxyOf(remoteId(target, u"file://a"));

    there->setModelURI(u"file://b");

    EXPECT_EQ(home->resolveProxy(proxy), target);
    EXPECT_EQ(here->resolveProxy(nullptr, proxy), target);
}

TEST_F(AReferenceAcrossModels, SurvivesTheDestructionAndReloadOfItsTarget)
{
    Plain const proxy = proxyOf(ProxyId(
        ElementId::UUID_TYPE, u"00000001-0000-0000-0000-000000000001", ustring(u"file://a")));
    there->destroy();
    Plain reloaded;
    normalizer->load = [&](ustring const&) {
        Model const model = Model::create(ModelConstellation());
        reloaded = Plain::create(model, uuidOf(1));
        return model;
    };

    EXPECT_EQ(home->resolveProxy(proxy), reloaded);

    EXPECT_THAT(normalizer->loads, ElementsAre(u"file://a"));
    EXPECT_EQ(reloaded->getModel()->getModelConstellation(), home);
    EXPECT_EQ(home->peekModel(u"file://a"), reloaded->getModel());
    EXPECT_EQ(home->resolveProxy(proxy), reloaded);
    EXPECT_EQ(normalizer->loads.size(), 1u);
}

TEST_F(AReferenceAcrossModels, IsLoadedByTheUriItNamesAndNotByTheLatest)
{
    there->setModelURI(u"file://b");
    there->destroy();
    Plain const proxy = proxyOf(ProxyId(ElementId::UUID_TYPE, u"x", ustring(u"file://a")));

    EXPECT_EQ(home->resolveProxy(proxy), proxy);

    EXPECT_THAT(normalizer->loads, ElementsAre(u"file://a"));
}

TEST_F(AReferenceAcrossModels, IsSoughtAtTheLocationOfItsUriToo)
{
    normalizer->toLocation = [](ustring const& id) {
        return id == u"alias" ? boost::optional<ustring>(u"file://a") : boost::none;
    };
    Transaction const transaction = here->beginTransaction(/*revertible=*/false);
    Plain const target = Plain::create(there, uuidOf(1));

    EXPECT_EQ(home->resolveProxy(proxyOf(remoteId(target, u"alias"))), target);
    EXPECT_THAT(normalizer->loads, IsEmpty());
}

TEST_F(AReferenceAcrossModels, StaysUnresolvedIntoALostModelOfMemory)
{
    Model const lost = Model::create(home);
    ProxyId const id(ElementId::UUID_TYPE, u"00000001-0000-0000-0000-000000000001",
                     lost->getModelURI());
    Plain const proxy = proxyOf(id);
    lost->destroy();

    EXPECT_EQ(here->resolveProxy(nullptr, proxy), proxy);
    EXPECT_EQ(here->peekResolveProxy(nullptr, proxy), proxy);
}

TEST_F(AReferenceAcrossModels, LoadsNothingWhenItIsOnlyPeekedAt)
{
    Plain const proxy = proxyOf(ProxyId(ElementId::UUID_TYPE, u"x", ustring(u"file://a")));

    EXPECT_EQ(here->peekResolveProxy(nullptr, proxy), proxy);

    EXPECT_THAT(normalizer->loads, IsEmpty());
}

// ---------------------------------------------------------------------------- loading

TEST_F(AFetchedModel, IsAdoptedUnderTheUriThatWasAskedFor)
{
    Model const loaded = Model::create(ModelConstellation());
    normalizer->load = [&](ustring const&) { return loaded; };

    EXPECT_EQ(home->fetchModel(u"file://a"), loaded);

    EXPECT_EQ(loaded->getModelURI(), u"file://a");
    EXPECT_EQ(loaded->getModelConstellation(), home);
}

TEST_F(AFetchedModel, IsNoneIfThereIsNone)
{
    EXPECT_FALSE(home->fetchModel(u"file://a"));
    EXPECT_THAT(normalizer->loads, ElementsAre(u"file://a"));
    EXPECT_THAT(home->getModels(), IsEmpty());
}

TEST_F(AFetchedModel, IsNotATransientOne)
{
    normalizer->load = [](ustring const&) { return Model::createTransientModel(); };

    EXPECT_EQ(home->fetchModel(u"file://a").getImpl(), nullptr);
    EXPECT_THAT(home->getModels(), IsEmpty());
}

TEST_F(AFetchedModel, MayBeARegistryModelThatIsNotAdopted)
{
    Model const registry = Model::createRegistryModel(u"registry://r");
    normalizer->load = [&](ustring const&) { return registry; };

    EXPECT_EQ(home->fetchModel(u"file://a"), registry);

    EXPECT_EQ(registry->getModelURI(), u"registry://r");
    EXPECT_FALSE(registry->getModelConstellation());
}

TEST_F(AFetchedModel, FailsAsItsNormalizerFails)
{
    normalizer->load = [](ustring const&) -> Model { throw std::runtime_error("no"); };
    normalizer->save = [](Model const&, ustring const&) -> bool { throw std::range_error("no"); };
    Model const model = Model::create(home);

    EXPECT_THROW(home->fetchModel(u"file://a"), std::runtime_error);
    EXPECT_THROW(home->saveModels(), std::range_error);
}

TEST_F(SavingAllModels, NamesEachByItsLocationInOrder)
{
    Model const b = modelAt(u"file://b");
    Model const a = modelAt(u"file://a");

    home->saveModels();

    EXPECT_THAT(normalizer->saves, ElementsAre(u"file://a", u"file://b"));
}

TEST_F(SavingAllModels, AllowsAModelToBeRenamedByItsSaving)
{
    Model const a = modelAt(u"file://a");
    Model const b = modelAt(u"file://b");
    normalizer->save = [](Model const& model, ustring const& location) {
        model->setModelURI(u"file://saved/" + location);
        return true;
    };

    home->saveModels();

    EXPECT_THAT(normalizer->saves, ElementsAre(u"file://a", u"file://b"));
    EXPECT_EQ(b->getModelURI(), u"file://saved/file://b");
}

// ---------------------------------------------------------------------------- end

TEST_F(ADestroyedConstellation, DestroysItsModelsInOrderAndThenItself)
{
    Trace trace;
    TracingListener listener(trace);
    Model const b = modelAt(u"file://b");
    Model const a = modelAt(u"file://a");
    std::vector<ElementImpl*> told;
    listener.onDestroyed = [&](ModelConstellation const& constellation, Model const& model) {
        told.push_back(model.getImpl());
        EXPECT_TRUE(constellation);
    };
    home->addConstellationListener(&listener);

    home->destroy();

    EXPECT_FALSE(home);
    EXPECT_FALSE(a);
    EXPECT_FALSE(b);
    EXPECT_THAT(told, ElementsAre(a.getImpl(), b.getImpl()));
    EXPECT_THAT(trace, ElementsAre("listener destroyed", "listener destroyed", "listener removed"));
    EXPECT_THAT(home->getModels(), IsEmpty());
    home->destroy();
    EXPECT_EQ(trace.size(), 3u);
}

TEST_F(ADestroyedConstellation, RollsItsOpenGroupBackFirst)
{
    Model const model = Model::create(home);
    Plain const element = Plain::create(model);
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    change(element, 1);

    home->destroy();

    EXPECT_EQ(listener.rolledBack.size(), 1u);
    EXPECT_EQ(element->getValue(), 0);
    EXPECT_FALSE(element);
    EXPECT_EQ(transaction.commit(), TransactionResult::NotCompleted);
}

TEST_F(ADestroyedConstellation, IsToldToTheInvalidateCallbackAfterItsModels)
{
    InvalidationLog const log;
    Model const model = Model::create(home);

    home->destroy();

    EXPECT_THAT(log.calls(), ElementsAre(InvalidationLog::Call(model.getImpl(), nullptr),
                                         InvalidationLog::Call(home.getImpl(), nullptr)));
}
}  // namespace
