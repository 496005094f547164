// Which model a proxy means, after it meant another one or none before.
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tests/support/FakeDataSource.h"
#include "tests/support/FakeNormalizer.h"
#include "tests/support/PlainChange.h"
#include "tests/support/TracingConstellationListener.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

ustring const NAME = u"00000001-0000-0000-0000-000000000001";

/// A proxy for the first element of the model "file://a", and models that have one.
class NamedModel : public ::testing::Test
{
protected:
    Model modelAt(ustring const& uri, ModelConstellation const& constellation) const
    {
        Model const model = Model::create(constellation);
        model->setModelURI(uri);
        return model;
    }
    Model modelAt(ustring const& uri) const { return modelAt(uri, home); }

    static Plain firstOf(Model const& model)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        Plain const made = Plain::create(model, uuidOf(1));
        transaction.commit();
        return made;
    }
    Plain proxyTo(ustring const& uri) const
    {
        return Plain::createProxy(here, ProxyId(ElementId::UUID_TYPE, NAME, uri));
    }
    ModelElement resolved() const { return resolved(proxy); }
    ModelElement resolved(ModelElement const& which) const
    {
        return here->resolveProxy(nullptr, which);
    }

    InstalledNormalizer const normalizer;
    ModelConstellation const home = ModelConstellation::create();
    Model const here = modelAt(u"file://here");
    Model const there = modelAt(u"file://a");
    Plain const target = firstOf(there);
    Plain const proxy = proxyTo(u"file://a");
};

using TheModelThatAProxyNames = NamedModel;
using TheIdOfAProxy = NamedModel;

TEST_F(TheModelThatAProxyNames, StaysTheSameWhenItIsRenamed)
{
    EXPECT_EQ(resolved(), target);

    there->setModelURI(u"file://b");

    EXPECT_EQ(resolved(), target);
    EXPECT_EQ(here->peekResolveProxy(nullptr, proxy), proxy) << "is asked for its present URI";
}

TEST_F(TheModelThatAProxyNames, IsTheOneThatJoinsUnderTheUriOfARenamedOne)
{
    there->setModelURI(u"file://b");
    EXPECT_EQ(resolved(), target);
    Model const joining = modelAt(u"file://a", ModelConstellation::create());
    Plain const other = firstOf(joining);

    home->addModelToConstellation(joining.getImpl());

    EXPECT_EQ(resolved(), other);
}

TEST_F(TheModelThatAProxyNames, IsTheOneThatAsksOnceThatHasTheUri)
{
    EXPECT_EQ(resolved(), target);
    Plain const own = firstOf(here);

    there->setModelURI(u"file://b");
    EXPECT_EQ(resolved(), target);
    here->setModelURI(u"file://a");
    EXPECT_EQ(resolved(), own);
    here->setModelURI(u"file://c");

    EXPECT_EQ(resolved(), own) << "it was the last to have the URI";
}

TEST_F(TheModelThatAProxyNames, IsNoMoreWhenItIsDestroyed)
{
    EXPECT_EQ(resolved(), target);

    there->destroy();

    EXPECT_EQ(resolved(), proxy);
    EXPECT_THAT(normalizer->loads, ElementsAre(u"file://a"));
}

TEST_F(TheModelThatAProxyNames, IsNoMoreWhenListenersHearOfItsEnd)
{
    EXPECT_EQ(resolved(), target);
    Trace trace;
    TracingListener listener(trace);
    ModelElement found;
    listener.onDestroyed = [&](ModelConstellation const&, Model const&) { found = resolved(); };
    home->addConstellationListener(&listener);

    there->destroy();

    EXPECT_EQ(found, proxy);
    EXPECT_THAT(normalizer->loads, ElementsAre(u"file://a"));
    home->removeConstellationListener(&listener);
}

TEST_F(TheModelThatAProxyNames, IsTheOneThatReplacesADestroyedOne)
{
    EXPECT_EQ(resolved(), target);
    there->destroy();
    EXPECT_EQ(resolved(), proxy);

    Model const replacement = modelAt(u"file://a");
    Plain const other = firstOf(replacement);

    EXPECT_EQ(resolved(), other);
}

TEST_F(TheModelThatAProxyNames, IsNoMoreWhenItLeavesTheConstellation)
{
    EXPECT_EQ(resolved(), target);
    ModelConstellation const elsewhere = ModelConstellation::create();

    elsewhere->addModelToConstellation(there.getImpl());

    EXPECT_EQ(resolved(), proxy);
}

TEST_F(TheModelThatAProxyNames, IsSoughtInTheConstellationThatTheProxyIsIn)
{
    ModelConstellation const elsewhere = ModelConstellation::create();
    Plain const other = firstOf(modelAt(u"file://a", elsewhere));
    EXPECT_EQ(resolved(), target);

    elsewhere->addModelToConstellation(here.getImpl());

    EXPECT_EQ(resolved(), other);
}

TEST_F(TheModelThatAProxyNames, IsSoughtFromTheModelThatTheProxyHasMovedTo)
{
    ModelConstellation const elsewhere = ModelConstellation::create();
    Model const newHome = modelAt(u"file://new", elsewhere);
    Plain const other = firstOf(modelAt(u"file://a", elsewhere));
    EXPECT_EQ(resolved(), target);

    here->moveAllContentsTo(newHome);

    ASSERT_EQ(proxy->getModel(), newHome);
    EXPECT_EQ(newHome->resolveProxy(nullptr, proxy), other);
}

TEST_F(TheModelThatAProxyNames, IsAnotherWhenTheOneThatAsksHasTheUriInAnotherForm)
{
    there->setModelURI(u"file://b");
    here->setModelURI(u"file://a");
    Plain const own = firstOf(here);
    EXPECT_EQ(resolved(), own);

    normalizer->toLocation = [](ustring const&) {
        return boost::make_optional(ustring(u"file://a"));
    };
    normalizer->toExternal = [](ustring const& id) { return u"form of " + id; };
    here->setModelURI(u"alias");

    ASSERT_EQ(here->getLocationModelId(), u"file://a");
    EXPECT_EQ(resolved(), target) << "whose model had the URI before";
}

TEST_F(TheModelThatAProxyNames, IsAskedOfNormalizersEachTimeThatTheyHaveToBeAsked)
{
    ustring location = u"file://a";
    normalizer->toLocation = [&](ustring const& id) {
        return id == u"alias" ? boost::make_optional(location) : boost::none;
    };
    Plain const byAlias = proxyTo(u"alias");
    Plain const other = firstOf(modelAt(u"file://b"));
    EXPECT_EQ(resolved(byAlias), target);

    location = u"file://b";

    EXPECT_EQ(resolved(byAlias), other);
}

TEST_F(TheModelThatAProxyNames, IsKeptApartFromThoseOfManyOthers)
{
    std::vector<Plain> targets;
    std::vector<Plain> proxies;
    for (int i = 0; i < 20; ++i)
    {
        ustring const uri = u"file://many/" + ustring(1, static_cast<char16_t>(u'a' + i));
        targets.push_back(firstOf(modelAt(uri)));
        proxies.push_back(proxyTo(uri));
    }

    for (int round = 0; round < 2; ++round)
        for (std::size_t i = 0; i < proxies.size(); ++i)
            EXPECT_EQ(resolved(proxies[i]), targets[i]) << i;
}

TEST_F(TheModelThatAProxyNames, IsFoundAgainByProxiesThatOutliveAnother)
{
    Plain second = proxyTo(u"file://a");
    Plain const third = proxyTo(u"file://a");
    EXPECT_EQ(resolved(second), target);

    second = Plain();

    EXPECT_EQ(resolved(third), target);
    EXPECT_EQ(resolved(), target);
}

TEST_F(TheModelThatAProxyNames, IsAskedForItsElementAsItIsNow)
{
    FakeDataSource& source = FakeDataSource::installIn(there);
    EXPECT_EQ(resolved(), target);
    EXPECT_THAT(source.calls, IsEmpty());

    target->destroy();
    source.calls.clear();

    EXPECT_EQ(resolved(), proxy);
    EXPECT_THAT(source.calls, ElementsAre("lookupElement"));
}

// ---------------------------------------------------------------------------- ids

TEST_F(TheIdOfAProxy, IsShownAsItWasGiven)
{
    for (ProxyId const& id :
         {ProxyId(ElementId::UUID_TYPE, NAME), ProxyId(ElementId::UUID_TYPE, NAME, ustring()),
          ProxyId(ElementId::UUID_TYPE, u"ABCDEF01-2345-6789-ABCD-EF0123456789", ustring(u"m")),
          ProxyId(ElementId::UUID_TYPE, u"no uuid"), ProxyId(u"another type", NAME, ustring(u"m"))})
    {
        Plain const made = Plain::createProxy(here, id);

        ProxyId const* const shown = made->getProxyIdImpl();

        EXPECT_EQ(shown->getType(), id.getType());
        EXPECT_EQ(shown->getId(), id.getId());
        EXPECT_TRUE(shown->getModelId() == id.getModelId());
        EXPECT_EQ(made->getProxyIdImpl(), shown) << "stays where it is";
        EXPECT_EQ(made->getProxyId()->getId(), id.getId());
    }
}

TEST_F(TheIdOfAProxy, MayBeAUuidInAnUnusualForm)
{
    UUID const uuid{{0xAB, 0xCD, 0xEF, 0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF, 0x01, 0x23,
                     0x45, 0x67, 0x89}};
    Transaction const transaction = here->beginTransaction(/*revertible=*/false);
    Plain const element = Plain::create(here, uuid);
    transaction.commit();

    for (char16_t const* const text :
         {u"abcdef01-2345-6789-abcd-ef0123456789", u"ABCDEF01-2345-6789-ABCD-EF0123456789"})
        EXPECT_EQ(resolved(Plain::createProxy(here, ProxyId(ElementId::UUID_TYPE, text))), element);
}

TEST_F(TheIdOfAProxy, MeansNoUuidUnlessItsTypeSaysSo)
{
    Plain const own = firstOf(here);

    Plain const other = Plain::createProxy(here, ProxyId(u"another type", NAME));

    EXPECT_EQ(resolved(other), other);
    EXPECT_EQ(resolved(Plain::createProxy(here, ProxyId(ElementId::UUID_TYPE, NAME))), own);
}

TEST_F(TheIdOfAProxy, OutlivesTheModel)
{
    Model const other = modelAt(u"file://short");
    Plain const orphan =
        Plain::createProxy(other, ProxyId(ElementId::UUID_TYPE, NAME, ustring(u"file://a")));

    other->destroy();

    EXPECT_FALSE(orphan->getModel());
    EXPECT_EQ(orphan->getProxyId()->getId(), NAME);
    EXPECT_EQ(*orphan->getProxyId()->getModelId(), u"file://a");
}
}  // namespace
