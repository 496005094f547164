#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/meta/Class.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/FakeDataSource.h"
#include "tests/support/Node.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/PlainChange.h"
#include "tests/support/Uuids.h"

#include <boost/uuid/uuid_io.hpp>
#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

ustring textOf(UUID const& id)
{
    std::string const text = boost::uuids::to_string(id);
    return ustring(text.begin(), text.end());
}

ProxyId idOf(UUID const& id, boost::optional<ustring> model = boost::none)
{
    return ProxyId(ElementId::UUID_TYPE, textOf(id), std::move(model));
}

/// Two models of one constellation, with an open transaction, and one of another constellation.
class Proxies : public ::testing::Test
{
protected:
    Proxies()
    {
        model->setModelURI(u"file://here");
        neighbour->setModelURI(u"file://there");
    }

    ModelConstellation const home = ModelConstellation::create();
    Model const model = Model::create(home);
    Model const neighbour = Model::create(home);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    Plain const local = Plain::create(model, uuidOf(1));
    Plain const remote = Plain::create(neighbour, uuidOf(2));
};

using ThePersistentId = Proxies;
using AProxy = Proxies;
using AProxyIsResolved = Proxies;
using AProxyIsPeeked = Proxies;
using AReferenceToADyingModel = Proxies;

// ---------------------------------------------------------------------------- ids

TEST_F(ThePersistentId, IsTheUuidAndTheUriOfTheModel)
{
    ProxyId const id = local->getPersistentProxyId(/*omitModel=*/false);

    EXPECT_EQ(id.getType(), u"uuid");
    EXPECT_EQ(id.getId(), u"00000001-0000-0000-0000-000000000001");
    ASSERT_TRUE(id.getModelId());
    EXPECT_EQ(*id.getModelId(), u"file://here");
    EXPECT_EQ(local->_getPersistentProxyId(), id);
    EXPECT_EQ(model->getPersistentProxyId(local.getImpl(), false), id);
}

TEST_F(ThePersistentId, IsWrittenInLowerCaseWithHyphens)
{
    UUID const id{{0xAB, 0xCD, 0xEF, 0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF, 0x01, 0x23,
                   0x45, 0x67, 0x89}};

    EXPECT_EQ(Plain::create(model, id)->getPersistentProxyId(true).getId(),
              u"abcdef01-2345-6789-abcd-ef0123456789");
}

TEST_F(ThePersistentId, HasNoModelPartWhenThatIsToBeLeftOut)
{
    EXPECT_FALSE(local->getPersistentProxyId(/*omitModel=*/true).getModelId());
}

TEST_F(ThePersistentId, OfAProxyIsItsOwnWhole)
{
    ProxyId const id(u"some type", u"some id", ustring(u"some model"));
    Plain const proxy = Plain::createProxy(model, id);

    EXPECT_EQ(proxy->getPersistentProxyId(/*omitModel=*/true), id);
    EXPECT_EQ(*proxy->getPersistentProxyId(true).getModelId(), u"some model");
    EXPECT_EQ(proxy->_getPersistentProxyId(), id);
}

TEST_F(AProxy, IsWhatHasAProxyId)
{
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(7)));

    EXPECT_TRUE(proxy->isProxy());
    ASSERT_TRUE(proxy->getProxyId());
    EXPECT_EQ(proxy->getProxyId()->getId(), textOf(uuidOf(7)));
    EXPECT_NE(proxy->getUuid(), uuidOf(7));
    EXPECT_FALSE(local->isProxy());
    EXPECT_FALSE(local->getProxyId());
}

TEST_F(AProxy, IsHeldByItsReferenceOnly)
{
    ExpectNoLeakedElements const noLeaks;
    local->setLook(Plain::createProxy(model, idOf(uuidOf(7))));
    EXPECT_EQ(local->fields.look->getRefCount(), 1u);

    local->fields.look = ModelElement();
}

TEST_F(AProxy, IsNotModified)
{
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(7)));

    EXPECT_RAISES_WITH(messages::CannotModifyProxy, proxy->setValue(1));
}

TEST_F(AProxy, IsNotRecordedWhenItIsAnnounced)
{
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(7)));

    proxy->notifyModifying(Plain::Impl::VALUE);
    proxy->basicSetContainer(local.getImpl(), Plain::Impl::PARTS_SLOT, Plain::Impl::NO_INDEX);
    proxy->basicSetContainer(nullptr, Feature(), Plain::Impl::NO_INDEX);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);
    EXPECT_TRUE(proxy);
    EXPECT_THAT(model->getTopLevelElements(), IsEmpty());
}

// ---------------------------------------------------------------------------- resolving

TEST_F(AProxyIsResolved, InItsOwnModelIfItNamesNone)
{
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(1)));

    EXPECT_EQ(model->resolveProxy(local.getImpl(), proxy), local);
    EXPECT_EQ(model->peekResolveProxy(local.getImpl(), proxy), local);
}

TEST_F(AProxyIsResolved, InItsOwnModelIfItNamesThat)
{
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(1), ustring(u"file://here")));

    EXPECT_EQ(model->resolveProxy(local.getImpl(), proxy), local);
    EXPECT_EQ(model->peekResolveProxy(local.getImpl(), proxy), local);
}

TEST_F(AProxyIsResolved, WithoutAConstellationIfItNamesItsOwnModel)
{
    Model const registry = Model::createRegistryModel(u"registry://own");
    Plain const element = Plain::create(registry, uuidOf(5));
    Plain const proxy = Plain::createProxy(registry, idOf(uuidOf(5), ustring(u"registry://own")));

    EXPECT_EQ(registry->resolveProxy(element.getImpl(), proxy), element);
}

TEST_F(AProxyIsResolved, InTheModelOfTheConstellationThatItNames)
{
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(2), ustring(u"file://there")));

    EXPECT_EQ(model->resolveProxy(local.getImpl(), proxy), remote);
    EXPECT_EQ(model->peekResolveProxy(local.getImpl(), proxy), remote);
}

TEST_F(AProxyIsResolved, ToItselfIfThereIsNoSuchElement)
{
    for (ProxyId const& id :
         {idOf(uuidOf(9)), idOf(uuidOf(2), ustring(u"file://here")),
          idOf(uuidOf(1), ustring(u"file://there")), idOf(uuidOf(1), ustring(u"file://nowhere")),
          ProxyId(u"unknown type", u"1"), ProxyId(ElementId::UUID_TYPE, u"no uuid")})
    {
        Plain const proxy = Plain::createProxy(model, id);
        EXPECT_EQ(model->resolveProxy(local.getImpl(), proxy), proxy);
        EXPECT_EQ(model->peekResolveProxy(local.getImpl(), proxy), proxy);
    }
}

TEST_F(AProxyIsResolved, ToItselfInAModelWithoutAConstellationThatIsNotTheNamedOne)
{
    Model const transient = Model::createTransientModel();
    Plain const element = Plain::create(transient, uuidOf(1));
    Plain const proxy = Plain::createProxy(transient, idOf(uuidOf(1), ustring(u"file://here")));

    EXPECT_EQ(transient->resolveProxy(element.getImpl(), proxy), proxy);
    EXPECT_EQ(transient->peekResolveProxy(element.getImpl(), proxy), proxy);
}

TEST_F(AProxyIsResolved, ToItselfIfItsTargetWasDestroyed)
{
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(2), ustring(u"file://there")));
    remote->destroy();

    EXPECT_EQ(model->resolveProxy(local.getImpl(), proxy), proxy);
}

TEST_F(AProxyIsResolved, FromTheDataSourceOfTheModel)
{
    FakeDataSource& source = FakeDataSource::installIn(neighbour);
    Plain const loaded = Plain::create(neighbour);
    source.onLookup = [&](ElementId const& id) {
        EXPECT_EQ(id.getId(), textOf(uuidOf(9)));
        return loaded;
    };
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(9), ustring(u"file://there")));

    EXPECT_EQ(model->resolveProxy(local.getImpl(), proxy), loaded);
    EXPECT_THAT(source.calls, ElementsAre("lookupElement"));
}

TEST_F(AProxyIsResolved, WhenItsReferenceIsRead)
{
    local->fields.peer = Plain::createProxy(model, idOf(uuidOf(2), ustring(u"file://there")));

    EXPECT_EQ(local->getPeer(), remote);
    EXPECT_EQ(local->fields.peer, remote);
}

// ---------------------------------------------------------------------------- compatibility

/// The kinds of places that a reference may lead from and to.
class CompatibleModel : public Proxies
{
protected:
    Model const stranger = Model::create(ModelConstellation());
    Model const registry = Model::createRegistryModel(u"registry://compatible");
    Model const transient = Model::createTransientModel();
    Plain const strange = Plain::create(stranger);
    Plain const registered = Plain::create(registry);
    Plain const transitory = Plain::create(transient);
    Feature const single = Plain::Impl::LOOK_SLOT;
    Feature const paired = Plain::Impl::PEER_SLOT;
    Feature const composite = Plain::Impl::PARTS_SLOT;
    Feature const compositePaired = Plain::Impl::CHILDREN_SLOT;
    std::vector<Feature> const all{single, paired, composite, compositePaired};

    static void allow(Plain const& source, ModelElement const& target,
                      std::vector<Feature> const& features)
    {
        for (Feature const& feature : features)
            EXPECT_NO_THROW(source->checkCompatibleModel(target.getImpl(), feature))
                << feature.index();
    }
    static void refuse(Plain const& source, ModelElement const& target,
                       std::vector<Feature> const& features)
    {
        for (Feature const& feature : features)
            EXPECT_RAISES_WITH(messages::CannotCreateCrossModelAssociation,
                               source->checkCompatibleModel(target.getImpl(), feature));
    }
};

TEST_F(CompatibleModel, IsThatOfNothing)
{
    Plain const dead = Plain::create(neighbour);
    dead->destroy();

    allow(local, ModelElement(), all);
    allow(local, dead, all);
    allow(registered, dead, all);
}

TEST_F(CompatibleModel, IsTheSameOne)
{
    allow(local, Plain::create(model), all);
    allow(registered, Plain::create(registry), all);
    allow(transitory, Plain::create(transient), all);
}

TEST_F(CompatibleModel, IsTheSameOneUnlessAContainerWouldContainItself)
{
    Plain const below = Plain::create(model);
    local->addPart(below);

    EXPECT_RAISES_WITH(messages::CircularContainment,
                       local->checkCompatibleModel(local.getImpl(), composite));
    EXPECT_RAISES_WITH(messages::CircularContainment,
                       below->checkCompatibleModel(local.getImpl(), compositePaired));
    allow(below, local, {single, paired});
    allow(local, below, {composite});
}

TEST_F(CompatibleModel, IsAnyOrdinaryOneForPlainReferences)
{
    allow(local, remote, {single, paired});
    allow(local, strange, {single, paired});
    refuse(local, remote, {composite, compositePaired});
    refuse(local, strange, {composite, compositePaired});
}

TEST_F(CompatibleModel, IsNoneForARegistryModel)
{
    refuse(registered, local, all);
    refuse(registered, transitory, all);
    Model const other = Model::createRegistryModel(u"registry://other");
    refuse(registered, Plain::create(other), all);
}

TEST_F(CompatibleModel, IsARegistryModelUnlessItWouldReferBack)
{
    allow(local, registered, {single});
    allow(transitory, registered, {single});
    refuse(local, registered, {paired, composite, compositePaired});
    refuse(transitory, registered, {paired, composite, compositePaired});
}

TEST_F(CompatibleModel, IsATransientModelUnlessItWouldReferBackFromEitherSide)
{
    allow(transitory, local, {single});
    allow(local, transitory, {single});
    refuse(transitory, local, {paired, composite, compositePaired});
    refuse(local, transitory, {paired, composite, compositePaired});
}

TEST_F(CompatibleModel, IsThatOfAProxyWithoutAModelPart)
{
    allow(local, Plain::createProxy(model, idOf(uuidOf(9))), all);
}

TEST_F(CompatibleModel, IsThatOfAProxyWithAModelPartUnlessItWouldBeContained)
{
    Plain const proxy = Plain::createProxy(model, idOf(uuidOf(9), ustring(u"file://here")));

    allow(local, proxy, {single, paired});
    refuse(local, proxy, {composite, compositePaired});
}

TEST_F(CompatibleModel, IsNotThatOfAProxyForARegistryModel)
{
    refuse(registered, Plain::createProxy(registry, idOf(uuidOf(9))), all);
}

TEST_F(CompatibleModel, IsThatOfAProxyForATransientModelUnlessItWouldReferBack)
{
    Plain const proxy = Plain::createProxy(transient, idOf(uuidOf(9)));

    allow(transitory, proxy, {single, composite});
    refuse(transitory, proxy, {paired, compositePaired});
}

TEST_F(CompatibleModel, IsTestedForCirclesBeforeRegistriesAndTransients)
{
    EXPECT_RAISES(messages::CircularContainment,
                  registered->checkCompatibleModel(registered.getImpl(), composite));
}

TEST_F(CompatibleModel, IsTestedBeforeAnythingChanges)
{
    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation, local->addChild(remote));
    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation, local->setPeer(registered));

    EXPECT_THAT(local->fields.children, IsEmpty());
    EXPECT_FALSE(local->fields.peer);
    EXPECT_TRUE(remote->isTopLevel());
}

// ---------------------------------------------------------------------------- conversion

TEST_F(AReferenceToADyingModel, BecomesAProxyThatNamesTheLostElement)
{
    local->addLink(remote);
    local->setPeer(remote);

    neighbour->destroy();

    ASSERT_EQ(local->fields.links.size(), 1u);
    ModelElement const proxy = local->fields.links[0];
    EXPECT_TRUE(proxy);
    EXPECT_TRUE(proxy->isProxy());
    EXPECT_EQ(*proxy->getProxyId(), idOf(uuidOf(2), ustring(u"file://there")));
    EXPECT_EQ(proxy->getModel(), model);
    ASSERT_TRUE(local->fields.peer);
    EXPECT_EQ(*local->fields.peer->getProxyId(), *proxy->getProxyId());
}

TEST_F(AReferenceToADyingModel, BecomesAProxyFromEitherEnd)
{
    remote->addLink(local);

    neighbour->destroy();

    ASSERT_EQ(local->fields.backlinks.size(), 1u);
    EXPECT_TRUE(local->fields.backlinks[0]->isProxy());
}

TEST_F(AReferenceToADyingModel, ResolvesAgainWhenTheModelIsBack)
{
    local->setPeer(remote);
    neighbour->destroy();
    EXPECT_TRUE(local->getPeer()->isProxy());

    Model const again = Model::create(home);
    again->setModelURI(u"file://there");
    Plain const back = Plain::create(again, uuidOf(2));

    EXPECT_EQ(local->getPeer(), back);
}

TEST_F(AReferenceToADyingModel, StaysDeadWithoutAnOpposite)
{
    local->setLook(remote);

    neighbour->destroy();

    EXPECT_FALSE(local->fields.look);
    EXPECT_EQ(local->fields.look, remote);
}

TEST_F(AReferenceToADyingModel, IsEmptiedAtTheDyingEnd)
{
    remote->addLink(local);
    remote->setPeer(local);
    remote->setLook(local);

    neighbour->destroy();

    EXPECT_THAT(remote->fields.links, IsEmpty());
    EXPECT_EQ(remote->fields.peer.getImpl(), nullptr);
    EXPECT_EQ(remote->fields.look.getImpl(), nullptr);
}

TEST(AReferenceWithinADyingModel, IsEmptiedWithoutProxies)
{
    ExpectNoLeakedElements const noLeaks;
    Model const model = Model::create(ModelConstellation());
    Plain const first = Plain::create(model);
    Plain const second = Plain::create(model);
    first->addLink(second);
    first->setPeer(second);

    model->destroy();

    EXPECT_THAT(first->fields.links, IsEmpty());
    EXPECT_THAT(second->fields.backlinks, IsEmpty());
    EXPECT_EQ(second->fields.peer.getImpl(), nullptr);
}

// ---------------------------------------------------------------------------- creation

TEST(CreatingAProxy, IsLeftToTheBuilderOfTheClass)
{
    Model const model = Model::create(ModelConstellation());
    ProxyId const id(ElementId::UUID_TYPE, u"x", ustring(u"file://a"));

    ModelElement const proxy = ModelElement::createProxy(model, NodeMetamodel::get().node, id);

    EXPECT_TRUE(Node::cast(proxy));
    EXPECT_EQ(proxy->getValidity(), ElementImpl::ElementValidity::BuilderProxy);
    EXPECT_EQ(*proxy->getProxyId(), id);
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST(CreatingAProxy, FailsForAClassThatCannotBeInstantiated)
{
    Model const model = Model::create(ModelConstellation());

    EXPECT_RAISES_WITH(messages::NoSuchType,
                       ModelElement::createProxy(model, ModelElement::metaClass(), ProxyId()),
                       u"ModelElement");
}
}  // namespace
