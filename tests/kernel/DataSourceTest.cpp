/// \file
/// How a data source is asked for what is not in memory, and how it loads.
#include "tarnkiln/services/datasource/DataSource.h"

#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/RecordingDataSource.h"

namespace testkit {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;

using datasource::DataSource;
using datasource::LoadingTransaction;

/// Counts the transactions that it is told of.
class CountingListener : public Listener
{
public:
    void transactionCommitted(ReportData&) { ++count; }

    int count = 0;
};

class DataSourceOfAModel : public ::testing::Test
{
protected:
    Node makeProxy(ProxyId const& id) const { return Node::createProxy(model, id); }
    Node makeLocalProxy(Node const& target) const
    {
        return makeProxy(ProxyId(ElementId::UUID_TYPE, textOf(target->getUuid())));
    }

    Model model = Model::create(ModelConstellation());
    RecordingDataSource& source = RecordingDataSource::installIn(model);
};

TEST(DataSourceTags, ArePrivilegedWithAndWithoutResolving)
{
    EXPECT_EQ(&DataSource::privilegedTag, &ModelElement::Impl::NO_PROXY_RESOLVE);
    EXPECT_EQ(&DataSource::privilegedTagWithResolve, &ModelElement::Impl::PRIVILEGED_ACCESS);
}

TEST_F(DataSourceOfAModel, LooksAFetchedElementUpByTheTextOfItsUuid)
{
    UUID const id{{0xab, 0xcd, 0xef, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13}};
    source.answer = Node::create(model);

    EXPECT_EQ(model->findElement(id, FindElementBehavior::Fetch), source.answer);

    EXPECT_THAT(source.fetches, ElementsAre(id));
    ASSERT_EQ(source.lookups.size(), 1u);
    EXPECT_EQ(source.lookups[0].metaClass, ModelElement::metaClass());
    EXPECT_EQ(source.lookups[0].id.getType(), u"uuid");
    EXPECT_EQ(source.lookups[0].id.getId(), u"abcdef01-0203-0405-0607-08090a0b0c0d");
}

TEST_F(DataSourceOfAModel, IsNotAskedForAnElementInMemory)
{
    Node const node = Node::create(model);

    EXPECT_EQ(model->findElement(node->getUuid(), FindElementBehavior::Fetch), node);
    EXPECT_EQ(model->findElement(ElementImpl::generateNewUuid(), FindElementBehavior::InMemory),
              ModelElement());
    EXPECT_THAT(source.fetches, IsEmpty());
}

TEST_F(DataSourceOfAModel, FillsACollectionBeforeItsFirstRead)
{
    Node node = Node::create(model);
    Node target = Node::create(model);
    source.fill = [&](ReferenceCollection& collection) {
        if (collection.getOwner() != node.getImpl())
            return;
        LoadingTransaction loading = source.beginLoadingTransaction();
        RecordingDataSource::doBasicAddWithProxy(collection, target);
        RecordingDataSource::doBasicAddWithProxy(target->getBacklinks(), node);
        loading.commit();
    };

    EXPECT_THAT(node->getLinks().getAllValues(), ElementsAre(target));
    EXPECT_THAT(node->getLinks().getAllValues(), ElementsAre(target));

    EXPECT_THAT(source.loadedCollections, ElementsAre(&node->getLinks(), &target->getBacklinks()));
}

TEST_F(DataSourceOfAModel, PutsAnElementIntoACollectionWithoutUpkeepOfTheOtherEnd)
{
    Node node = Node::create(model);
    Node target = Node::create(model);
    LoadingTransaction loading = source.beginLoadingTransaction();

    RecordingDataSource::doBasicAddWithProxy(node->getLinks(), target);

    EXPECT_THAT(node->getLinks().getAllValues(), ElementsAre(target));
    EXPECT_TRUE(target->getBacklinks().empty());
    RecordingDataSource::doBasicAddWithProxy(target->getBacklinks(), node);
    loading.commit();
}

TEST_F(DataSourceOfAModel, MayPutAStandInIntoACollection)
{
    Node const node = Node::create(model);
    Node proxy = makeProxy(ProxyId(u"isbn", u"1", ustring(u"file:elsewhere")));

    RecordingDataSource::doBasicAddWithProxy(node->getLinks(), proxy);

    EXPECT_THAT(node->getLinks().getAllValuesAndProxies(), ElementsAre(proxy));
}

TEST_F(DataSourceOfAModel, MayTellALoadedElementItsContainer)
{
    Node const owner = Node::create(model);
    Node child = Node::create(model);
    meta::Property const& children = Node::Impl::CHILDREN.property();

    LoadingTransaction loading = source.beginLoadingTransaction();
    RecordingDataSource::doBasicAddWithProxy(owner->getChildren(), child);
    RecordingDataSource::doSetContained(child, owner, children);
    loading.commit();

    EXPECT_EQ(child->container(), owner);
    EXPECT_EQ(child->containmentFeature(), children);
    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(owner));
}

TEST(ModelWithoutADataSource, LeavesCollectionsAsTheyAre)
{
    Model const model = Model::createTransientModel();
    Node const node = Node::create(model);

    EXPECT_NO_THROW(node->_loadCollectionContents(&node->getLinks()));
    EXPECT_TRUE(node->getLinks().empty());
}

TEST_F(DataSourceOfAModel, LoadsInAStateOfItsOwn)
{
    {
        LoadingTransaction loading = source.beginLoadingTransaction();
        EXPECT_TRUE(model->isDataSourceLoading());
        EXPECT_NE(model->getCurrentTransaction(), nullptr);
        loading.commit();
    }
    EXPECT_FALSE(model->isDataSourceLoading());
    EXPECT_EQ(model->getCurrentTransaction(), nullptr);
}

TEST_F(DataSourceOfAModel, TellsListenersNothingOfWhatItLoads)
{
    CountingListener listener;
    model->addListener(&listener);
    {
        LoadingTransaction loading = source.beginLoadingTransaction();
        Node::create(model)->setCount(7);
        loading.commit();
    }
    EXPECT_EQ(listener.count, 0);
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        Node::create(model);
        transaction.commit();
    }
    EXPECT_EQ(listener.count, 1);
    model->removeListener(&listener);
}

TEST_F(DataSourceOfAModel, CannotLoadIntoAFrozenModel)
{
    Model::Freezer const freezer = model->freeze();
    LoadingTransaction loading = source.beginLoadingTransaction();

    EXPECT_RAISES(messages::ModelFrozen, Node::create(model));
    loading.commit();
}

TEST_F(DataSourceOfAModel, DoomsAnOuterTransactionByAnUncommittedLoad)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    {
        LoadingTransaction const loading = source.beginLoadingTransaction();
    }
    EXPECT_TRUE(outer.isRollBackOnly());
}

TEST_F(DataSourceOfAModel, LeavesAnOuterTransactionAloneByACommittedLoad)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    {
        LoadingTransaction loading = source.beginLoadingTransaction();
        loading.commit();
    }
    EXPECT_FALSE(outer.isRollBackOnly());
    EXPECT_EQ(outer.commit(), TransactionResult::Committed);
}

TEST_F(DataSourceOfAModel, LoadsAllThatAnElementContains)
{
    Node const root = Node::create(model);
    Node const child = Node::create(model);
    Node const part = Node::create(model);
    Node const core = Node::create(model);
    Node const named = Node::create(model);
    Node const buddy = Node::create(model);
    root->getChildren().push_back(child);
    child->getParts().push_back(part);
    part->setCore(core);
    root->getByName().insert(named);
    root->setBuddy(buddy);

    source.loadElementSubtree(root);

    EXPECT_THAT(source.loadedSubtrees, UnorderedElementsAre(root, child, part, core, named));
}

TEST_F(DataSourceOfAModel, LoadsNothingBelowWhereItsClassCutsTheWalk)
{
    Node const root = Node::create(model);
    Node const child = Node::create(model);
    root->getChildren().push_back(child);
    child->getParts().push_back(Node::create(model));
    source.cutAt = child;

    source.loadElementSubtree(root);

    EXPECT_THAT(source.loadedSubtrees, ElementsAre(root, child));
}

TEST_F(DataSourceOfAModel, ResolvesTheReferencesOfASubtreeThatStayInTheModel)
{
    Node const root = Node::create(model);
    Node child = Node::create(model);
    root->getChildren().push_back(child);
    Node const target = Node::create(model);
    Node local = makeLocalProxy(target);
    Node foreign =
        makeProxy(ProxyId(ElementId::UUID_TYPE, textOf(target->getUuid()), ustring(u"file:x")));
    LoadingTransaction loading = source.beginLoadingTransaction();
    RecordingDataSource::doBasicAddWithProxy(target->getBacklinks(), child);
    RecordingDataSource::doBasicAddWithProxy(child->getLinks(), local);
    RecordingDataSource::doBasicAddWithProxy(child->getLinks(), foreign);

    source.loadElementSubtree(root);
    loading.commit();

    EXPECT_THAT(child->getLinks().getAllValuesAndProxies(), ElementsAre(target, foreign));
}

TEST_F(DataSourceOfAModel, LoadsASubtreeBeforeItIsDestroyed)
{
    Node const root = Node::create(model);
    Node child = Node::create(model);
    source.fill = [&](ReferenceCollection& collection) {
        if (!(collection.getCollectionFeature() == Node::Impl::CHILDREN) || child->container())
            return;
        LoadingTransaction loading = source.beginLoadingTransaction();
        RecordingDataSource::doBasicAddWithProxy(collection, child);
        RecordingDataSource::doSetContained(child, root, Node::Impl::CHILDREN.property());
        loading.commit();
    };

    root->destroy();

    EXPECT_THAT(source.loadedSubtrees, ElementsAre(root, child));
    EXPECT_FALSE(child);
}

/// An element whose class and values are what a test says, and that notes down what is read.
class ScriptedElement : public ModelElement
{
public:
    class Impl;

    static ScriptedElement create(Model const& model, meta::Class const& metaClass);

    Impl* operator->() const;
};

class ScriptedElement::Impl : public ModelElement::Impl
{
public:
    Impl(Model const& model, meta::Class const& metaClass)
        : ModelElement::Impl(model, {}),
          m_class(metaClass)
    {}

    meta::Class const& getMetaClass() const override { return m_class; }
    void doDestroy(bool, bool) override {}
    Changes* createChanges() const override
    {
        return new Changes(getUuid(), getModel(), m_class, 1);
    }
    Storage* createStorage() const override
    {
        return new Storage(getUuid(), getModel(), m_class, 1);
    }
    Value getPropertyValue(meta::Property const& property,
                           ReflectionPrivateTag const& tag) const override
    {
        EXPECT_EQ(&tag, &PRIVILEGED_ACCESS);
        reads.push_back(property->getName());
        return values.at(property->getName());
    }

    std::map<ustring, Value> values;
    mutable std::vector<ustring> reads;

private:
    meta::Class m_class;
};

ScriptedElement ScriptedElement::create(Model const& model, meta::Class const& metaClass)
{
    ScriptedElement element;
    static_cast<ModelElement&>(element) = ModelElement(new Impl(model, metaClass));
    element->notifyCreated();
    return element;
}

ScriptedElement::Impl* ScriptedElement::operator->() const
{
    return static_cast<Impl*>(m_impl);
}

/// A class of a test, with an element of it.
class SubtreeOfAScriptedElement : public ::testing::Test
{
protected:
    meta::Property addProperty(meta::Class const& owner, ustring const& name,
                               meta::Type const& type, bool composite, bool many = false)
    {
        meta::Property const made = meta::Property::create(m_metamodel);
        made->setName(name);
        made->setType(type);
        made->setUpper(many ? 2 : 1);
        made->setIsComposite(composite);
        made->setOwningType(owner);
        return made;
    }
    meta::Class makeClass(ustring const& name, meta::Class const& superclass)
    {
        meta::Class const made = meta::Class::create(m_metamodel);
        made->setName(name);
        made->setSuperclass(superclass);
        return made;
    }
    /// Adds a single reference and its value, which is the empty handle.
    meta::Property addReference(meta::Class const& owner, ustring const& name, bool composite)
    {
        meta::Property const made = addProperty(owner, name, thing, composite);
        element->values.emplace(name, Value::createElementValue(made, ModelElement()));
        return made;
    }
    void load() { RecordingDataSource(model).loadElementSubtree(element); }

private:
    Model m_metamodel = Model::create(ModelConstellation());

protected:
    Model model = Model::createTransientModel();
    meta::Class base = makeClass(u"Base", ModelElement::metaClass());
    meta::Class thing = makeClass(u"Thing", base);
    ScriptedElement element = ScriptedElement::create(model, thing);
};

TEST_F(SubtreeOfAScriptedElement, NeedsNoReadsIfThereAreOnlyPlainValues)
{
    addProperty(thing, u"title", meta::StandardTypes::stringMeta, /*composite=*/false);
    addProperty(thing, u"pages", meta::StandardTypes::integerMeta, /*composite=*/true);
    addProperty(thing, u"untyped", meta::Type(), /*composite=*/true);

    load();

    EXPECT_THAT(element->reads, IsEmpty());
}

TEST_F(SubtreeOfAScriptedElement, HasItsReferencesReadBeforeItsContents)
{
    addReference(thing, u"a contained", /*composite=*/true);
    addReference(thing, u"b referred", /*composite=*/false);
    addReference(base, u"c contained above", /*composite=*/true);
    addReference(base, u"d referred above", /*composite=*/false);

    load();

    EXPECT_THAT(element->reads, ElementsAre(u"b referred", u"d referred above", u"a contained",
                                            u"c contained above"));
}

TEST_F(SubtreeOfAScriptedElement, LeavesDerivedPropertiesAlone)
{
    addReference(thing, u"computed", /*composite=*/false)->setIsDerived(true);
    addReference(thing, u"computed contents", /*composite=*/true)->setIsDerived(true);

    load();

    EXPECT_THAT(element->reads, IsEmpty());
}

TEST_F(SubtreeOfAScriptedElement, FailsIfAManyValuedReferenceIsNoCollection)
{
    meta::Property const many =
        addProperty(thing, u"many", thing, /*composite=*/false, /*many=*/true);
    element->values.emplace(u"many", Value::createElementValue(many, ModelElement()));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, load(), u"Thing");
}

TEST_F(SubtreeOfAScriptedElement, FailsIfManyValuedContentsAreNoCollection)
{
    meta::Property const many =
        addProperty(thing, u"many", thing, /*composite=*/true, /*many=*/true);
    element->values.emplace(u"many", Value::createElementValue(many, ModelElement()));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, load(), u"Thing");
}

TEST_F(SubtreeOfAScriptedElement, FailsIfASingleContentIsPlain)
{
    addReference(thing, u"one", /*composite=*/true);
    element->values.at(u"one") = Value(meta::StandardTypes::integerMeta, 7);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, load(), u"Integer");
}
}  // namespace
}  // namespace testkit
