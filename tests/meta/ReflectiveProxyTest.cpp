// Stand-ins in references of reflective elements, and stand-ins that are reflective elements.
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/meta/ReflectiveFixture.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/RecordingDataSource.h"

namespace testkit {
namespace {

using Impl = ModelElement::Impl;

class ReflectiveProxy : public ReflectiveFixture
{
protected:
    /// Takes back what follows: no commit would pass the state in which it leaves associations.
    class UndoneAtEnd
    {
    public:
        explicit UndoneAtEnd(Model const& model)
            : m_transaction(model->beginTransaction(/*revertible=*/true))
        {}
        ~UndoneAtEnd() { m_transaction.rollBack(); }

    private:
        Transaction const m_transaction;
    };

    meta::Class const node = metamodel.makeClass(u"Node");
    meta::Property const name =
        metamodel.property(node, u"name", StandardTypes::stringMeta).required();
    meta::Property const buddy = metamodel.property(node, u"buddy", node);
    meta::Property const left = metamodel.property(node, u"left", node);
    meta::Property const right = metamodel.property(node, u"right", node).opposite(left);
    meta::Property const links = metamodel.property(node, u"links", node).many().ordered();
    meta::Property const marks = metamodel.property(node, u"marks", node).many();
    meta::Property const markedBy =
        metamodel.property(node, u"markedBy", node).many().opposite(marks);
    meta::Property const core = metamodel.property(node, u"core", node).composite();
};

TEST_F(ReflectiveProxy, IsMadeForAClassWithoutABuilder)
{
    ProxyId const id(ElementId::UUID_TYPE, u"some id", ustring(u"memory://elsewhere"));

    ModelElement const proxy = ModelElement::createProxy(model, node, id);

    EXPECT_TRUE(proxy);
    EXPECT_TRUE(proxy->isProxy());
    EXPECT_EQ(proxy->getMetaClass(), node);
    EXPECT_EQ(proxy->getValidity(), ElementImpl::ElementValidity::Constructing);
    EXPECT_EQ(proxy->getProxyIdImpl()->getId(), u"some id");
    EXPECT_FALSE(model->findElement(proxy->getUuid())) << "a stand-in is in no registry";
    EXPECT_EQ(model->getElementCount(), 0u);
    EXPECT_FALSE(proxy->getUuid().is_nil());
}

TEST_F(ReflectiveProxy, IsNotMadeOfAnAbstractClassOrOfOneOfTheRegistry)
{
    ProxyId const id(ElementId::UUID_TYPE, u"some id", boost::none);
    node->setIsAbstract(true);
    tarnkiln::tests::RegistryElement<meta::Class> const registered(u"ClassWithoutABuilder");

    EXPECT_RAISES_WITH(messages::NoSuchType, ModelElement::createProxy(model, node, id),
                       u"rt.Node");
    EXPECT_RAISES_WITH(messages::NoSuchType, ModelElement::createProxy(model, registered.get(), id),
                       u"ClassWithoutABuilder");
}

TEST_F(ReflectiveProxy, IsMadeByTheBuilderOfAClassThatHasOne)
{
    ModelElement const proxy = ModelElement::createProxy(
        model, NodeMetamodel::get().node, ProxyId(ElementId::UUID_TYPE, u"x", boost::none));

    EXPECT_EQ(proxy->getValidity(), ElementImpl::ElementValidity::BuilderProxy);
}

TEST_F(ReflectiveProxy, GivesWayToItsTargetWhenItIsRead)
{
    ModelElement const a = make(node), b = make(node);
    ModelElement const proxy = proxyOf(b, node);
    set(a, buddy, proxy);

    EXPECT_EQ(get<ModelElement>(a, buddy), b);
    EXPECT_EQ(valueOf(a, buddy, Impl::NO_PROXY_RESOLVE).getValue<ModelElement>(), b) << "for good";
}

TEST_F(ReflectiveProxy, StaysWhereItIsNotToBeResolved)
{
    ModelElement const a = make(node), b = make(node);
    ModelElement const proxy = proxyOf(b, node);
    set(a, buddy, proxy);

    EXPECT_EQ(valueOf(a, buddy, Impl::NO_PROXY_RESOLVE).getValue<ModelElement>(), proxy);
    EXPECT_TRUE(has(a, buddy)) << "a stand-in is live";
    EXPECT_EQ(valueOf(a, buddy, Impl::IN_MEMORY_ONLY).getValue<ModelElement>(), b);
}

TEST_F(ReflectiveProxy, IsResolvedWithoutARecord)
{
    ModelElement const a = make(node), b = make(node);
    set(a, buddy, proxyOf(b, node));
    Model::Freezer const frozen = model->freeze();

    EXPECT_EQ(targetOf(a, buddy), b);
}

TEST_F(ReflectiveProxy, ForNothingStaysAStandIn)
{
    ModelElement const a = make(node);
    ModelElement const proxy = danglingProxy(node);

    set(a, buddy, proxy);

    EXPECT_EQ(targetOf(a, buddy), proxy);
}

TEST_F(ReflectiveProxy, StaysIfTheOtherEndDoesNotReferBack)
{
    ModelElement const a = make(node), b = make(node);
    ModelElement const proxy = proxyOf(b, node);
    UndoneAtEnd const undone(model);

    set(a, left, proxy);

    EXPECT_EQ(targetOf(a, left), proxy);
    set(b, right, proxyOf(a, node));
    EXPECT_EQ(targetOf(a, left), b);
    EXPECT_EQ(valueOf(b, right, Impl::NO_PROXY_RESOLVE).getValue<ModelElement>(), a)
        << "asking the other end resolves it too";
}

TEST_F(ReflectiveProxy, InASetGivesWayWhenTheSetIsRead)
{
    ModelElement const a = make(node), b = make(node);
    UndoneAtEnd const undone(model);
    genericOf(a, marks).genericAdd(proxyOf(b, node));
    genericOf(b, markedBy).genericAdd(proxyOf(a, node));

    EXPECT_EQ(genericOf(a, marks).genericSize(), 1u);
    EXPECT_THAT(entriesOf(a, marks), ElementsAre(b));
}

TEST_F(ReflectiveProxy, InASetWaitsForTheEndOfAParse)
{
    ModelElement const a = make(node), b = make(node);
    UndoneAtEnd const undone(model);
    genericOf(a, marks).genericAdd(proxyOf(b, node));
    genericOf(b, markedBy).genericAdd(proxyOf(a, node));
    {
        Model::ParseInProgressIndicator const parsing(model);
        EXPECT_EQ(genericOf(a, marks).genericSize(), 0u);
    }
    EXPECT_EQ(valueOf(a, marks, Impl::NO_PROXY_RESOLVE)
                  .getValue<ReferenceCollection&>()
                  .getGenericInterface()
                  ->genericSize(),
              0u);
    EXPECT_EQ(genericOf(a, marks).genericSize(), 1u);
}

TEST_F(ReflectiveProxy, InASequenceGivesWayWhenTheEntryIsRead)
{
    ModelElement const a = make(node), b = make(node);
    genericOf(a, links).genericAdd(proxyOf(b, node));

    EXPECT_EQ(sequenceOf(a, links).genericAt(0), b);
}

TEST_F(ReflectiveProxy, IntoAnotherModelIsNotContained)
{
    ModelElement const a = make(node), b = make(node);

    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation,
                  set(a, core, proxyOf(b, node, /*namesModel=*/true)));
    EXPECT_FALSE(targetOf(a, core));
}

TEST_F(ReflectiveProxy, TellsTheOtherEndThatAnElementIsMeant)
{
    ModelElement const a = make(node), b = make(node), c = make(node);
    set(a, left, b);

    EXPECT_TRUE(a->inverseContainsProxyTo(b, left));
    EXPECT_FALSE(a->inverseContainsProxyTo(c, left));
    UndoneAtEnd const undone(model);
    genericOf(a, marks).genericAdd(proxyOf(b, node));
    EXPECT_TRUE(a->inverseContainsProxyTo(b, marks));
    EXPECT_TRUE(a->inverseContainsProxyTo(b, marks)) << "the element itself is in there now";
    EXPECT_FALSE(a->inverseContainsProxyTo(c, marks));
}

TEST_F(ReflectiveProxy, DoesNotTakeThePlaceOfAReferenceToADyingModel)
{
    ModelConstellation const constellation = model->getModelConstellation();
    Model const other = Model::create(constellation);
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    ModelElement const a = make(node), b = ModelElement::createReflective(other, node);
    set(b, left, a);
    transaction.commit();
    ASSERT_EQ(targetOf(a, right), b);

    other->destroy();

    EXPECT_EQ(valueOf(a, right, Impl::NO_PROXY_RESOLVE).getValue<ModelElement>().getImpl(),
              b.getImpl());
    EXPECT_FALSE(has(a, right)) << "a dead handle, which is no stand-in";
    clear(a, right);
}

// ---------------------------------------------------------------------------- data sources

TEST_F(ReflectiveProxy, IsFoundBehindADataSource)
{
    ModelElement const a = make(node), b = make(node);
    RecordingDataSource& source = RecordingDataSource::installIn(model);
    ModelElement const proxy = danglingProxy(node);
    set(a, buddy, proxy);
    source.answer = b;

    EXPECT_EQ(targetOf(a, buddy), b);
    EXPECT_THAT(source.lookups, testing::Not(IsEmpty()));
}

TEST_F(ReflectiveProxy, IsPutIntoACollectionByTheDataSourceOnce)
{
    ModelElement const a = make(node), b = make(node);
    RecordingDataSource& source = RecordingDataSource::installIn(model);
    source.fill = [&](ReferenceCollection& collection) {
        ModelElement proxy = proxyOf(b, node);
        RecordingDataSource::doBasicAddWithProxy(collection, proxy);
    };

    EXPECT_THAT(valueOf(a, links, Impl::IN_MEMORY_ONLY)
                    .getValue<ReferenceCollection&>()
                    .getAllValuesAndProxies(),
                IsEmpty());
    EXPECT_THAT(referencesOf(a, links).getAllValues(), ElementsAre(b));
    EXPECT_THAT(referencesOf(a, links).getAllValues(), ElementsAre(b));
    EXPECT_THAT(source.loadedCollections, ElementsAre(&referencesOf(a, links)));
    model->resetDataSource();
}
}  // namespace
}  // namespace testkit
