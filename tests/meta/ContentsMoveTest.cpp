// How models hand their contents to others.
#include "tarnkiln/kernel/ExtensionListener.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelUpdater.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/meta/DataModelUsageProvider.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tests/meta/ExtensionFixture.h"
#include "tests/support/NodePicture.h"
#include "tests/support/ScriptedListener.h"

#include <type_traits>

namespace testkit {
namespace {

using Picture = std::vector<std::string>;
using ::testing::UnorderedElementsAre;

/// A model with a tree of nodes, and an empty one in another constellation.
class MovedContents : public ::testing::Test
{
protected:
    MovedContents()
    {
        m_root->setTag("root");
        m_child->setTag("child");
        m_other->setTag("other");
        m_root->getChildren().push_back(m_child);
        m_child->setLeft(m_other);
        m_other->getLinks().push_back(m_root);
        m_other->setCount(7);
    }
    ~MovedContents() override
    {
        for (Model const& model : {m_source, m_target})
        {
            if (model)
            {
                EXPECT_THAT(model->checkInvariants(), IsEmpty());
            }
        }
    }

    static Class const& nodes() { return Node::metaClass(); }
    static void extend(Model const& model, ustring const& name, int byDefault)
    {
        model->extendMetaclass(nodes(), prototype(name), number(byDefault));
    }
    void move() { m_source->moveAllContentsTo(m_target); }
    /// That a move fails with `Id` and leaves both models as they were.
    template <class Id> void expectRefused()
    {
        Picture const source = pictureOf(m_source);
        Picture const target = pictureOf(m_target);
        EXPECT_RAISES(Id, move());
        EXPECT_EQ(pictureOf(m_source), source);
        EXPECT_EQ(pictureOf(m_target), target);
        EXPECT_EQ(m_root->getModel(), m_source);
        EXPECT_EQ(m_source->findElement(m_root->getUuid()), m_root);
        EXPECT_THAT(m_source->checkInvariants(), IsEmpty());
        EXPECT_THAT(m_target->checkInvariants(), IsEmpty());
    }

    Model m_source = Model::create(ModelConstellation());
    Model m_target = Model::create(ModelConstellation());
    Node m_root = Node::create(m_source);
    Node m_child = Node::create(m_source);
    Node m_other = Node::create(m_source);
};

// ---------------------------------------------------------------------------- elements

TEST_F(MovedContents, AreInTheOtherModelAsTheyWere)
{
    Picture const before = pictureOf(m_source);
    UUID const id = m_child->getUuid();

    move();

    EXPECT_EQ(pictureOf(m_target), before);
    EXPECT_EQ(m_target->findElement(id), m_child);
    EXPECT_EQ(m_child->getUuid(), id);
    EXPECT_EQ(m_child->getModel(), m_target);
    EXPECT_EQ(m_child->container(), m_root);
    EXPECT_THAT(m_target->getTopLevelElements(), UnorderedElementsAre(m_root, m_other));
}

TEST_F(MovedContents, LeaveAnEmptyModelThatCanBeUsed)
{
    move();

    EXPECT_TRUE(m_source);
    EXPECT_EQ(m_source->getElementCount(), 0u);
    EXPECT_THAT(m_source->getTopLevelElements(), IsEmpty());
    EXPECT_THAT(m_source->getUsedPackages(), IsEmpty());
    Node const fresh = Node::create(m_source);
    Transaction const transaction = m_source->beginTransaction(/*revertible=*/true);
    fresh->setCount(1);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);
    EXPECT_EQ(fresh->getCount(), 0);
    EXPECT_EQ(m_source->getElementCount(), 1u);
    EXPECT_EQ(m_target->getUsedPackages().size(), 1u);
}

TEST_F(MovedContents, JoinWhatIsThereAlready)
{
    Node const present = Node::create(m_target);

    move();

    EXPECT_EQ(m_target->getElementCount(), 4u);
    m_root->getParts().push_back(present);
    m_other->setBuddy(present);
    EXPECT_EQ(present->container(), m_root);
}

TEST_F(MovedContents, OutliveTheModelThatTheyCameFrom)
{
    move();
    m_source->destroy();
    m_source = Model();

    EXPECT_TRUE(m_child);
    EXPECT_EQ(m_child->getModel(), m_target);
    m_root->destroy();
    EXPECT_FALSE(m_child);
}

TEST_F(MovedContents, AppearAsCreatedToTheListeners)
{
    ScriptedListener listener;
    listen(m_target, listener);

    move();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_THAT(listener.committed.back()->getCreated(),
                UnorderedElementsAre(m_root, m_child, m_other));
    EXPECT_THAT(listener.committed.back()->getChanged(), IsEmpty());
}

TEST_F(MovedContents, CanBeChangedAndTakenBackThere)
{
    move();

    Transaction const transaction = m_target->beginTransaction(/*revertible=*/true);
    m_child->setParent(m_other);
    m_root->destroy();
    transaction.rollBack();

    EXPECT_TRUE(m_root);
    EXPECT_EQ(m_child->container(), m_root);
}

TEST_F(MovedContents, TakeTheirProxiesAlong)
{
    Node const proxy =
        Node::createProxy(m_source, ProxyId(ElementId::UUID_TYPE,
                                            u"00000000-0000-4000-8000-000000000001", boost::none));
    m_root->setBuddy(proxy);

    move();
    EXPECT_EQ(proxy->getModel(), m_target);
    m_source->destroy();
    m_source = Model();

    EXPECT_EQ(m_root->getBuddyImpl(), proxy.getImpl());
    EXPECT_EQ(proxy->getModel(), m_target);
}

TEST_F(MovedContents, LeaveTheDeadBehind)
{
    Node const dead = Node::create(m_source);
    dead->destroy();

    move();

    EXPECT_EQ(dead->getModel(), m_source);
}

TEST_F(MovedContents, AreGoneWithTheTransactionThatTheyJoined)
{
    Transaction const transaction = m_target->beginTransaction(/*revertible=*/true);
    move();
    EXPECT_EQ(m_target->getElementCount(), 3u);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_FALSE(m_root);
    EXPECT_EQ(m_target->getElementCount(), 0u);
    EXPECT_EQ(m_source->getElementCount(), 0u);
}

TEST_F(MovedContents, AreLostWhenAListenerRefusesThem)
{
    ScriptedListener listener;
    listen(m_target, listener);
    listener.onValidate = [](Report const&) { return false; };

    move();

    EXPECT_FALSE(m_root);
    EXPECT_EQ(m_source->getElementCount(), 0u);
    EXPECT_EQ(m_target->getElementCount(), 0u);
}

TEST_F(MovedContents, MoveWithinAConstellation)
{
    Model const sibling = Model::create(m_source->getModelConstellation());
    Picture const before = pictureOf(m_source);

    m_source->moveAllContentsTo(sibling);

    EXPECT_EQ(pictureOf(sibling), before);
    EXPECT_EQ(m_source->getElementCount(), 0u);
    EXPECT_EQ(sibling->getCurrentTransaction(), nullptr);
    EXPECT_EQ(m_source->getCurrentTransaction(), nullptr);
    EXPECT_THAT(sibling->checkInvariants(), IsEmpty());
}

TEST_F(MovedContents, CanMoveBackAndForth)
{
    Picture const before = pictureOf(m_source);
    for (int i = 0; i < 3; ++i)
    {
        move();
        m_target->moveAllContentsTo(m_source);
    }

    EXPECT_EQ(pictureOf(m_source), before);
}

TEST_F(MovedContents, MayBeNone)
{
    Model const empty = Model::create(ModelConstellation());

    empty->moveAllContentsTo(m_target);

    EXPECT_EQ(m_target->getElementCount(), 0u);
}

// ---------------------------------------------------------------------------- refusals

TEST_F(MovedContents, StayIfTheTargetIsNone)
{
    Model const dead = Model::create(ModelConstellation());
    dead->destroy();
    for (Model const& target : {Model(), dead, m_source})
        EXPECT_RAISES(messages::CannotChangeModel, m_source->moveAllContentsTo(target));

    EXPECT_EQ(m_source->getElementCount(), 3u);
}

TEST_F(MovedContents, StayIfTheModelHasAListener)
{
    ScriptedListener listener;
    listen(m_source, listener, {.shallow = true});

    expectRefused<messages::CannotChangeModel>();
}

TEST_F(MovedContents, StayIfATransactionIsOpen)
{
    Transaction const transaction = m_source->beginTransaction(/*revertible=*/false);
    expectRefused<messages::CannotChangeModel>();
    transaction.commit();
}

TEST_F(MovedContents, StayIfTheTargetIsFrozen)
{
    extend(m_source, u"shelf", 0);
    Model::Freezer const frozen = m_target->freeze();

    expectRefused<messages::ModelFrozen>();

    EXPECT_TRUE(m_source->getExtension(nodes(), u"shelf"));
}

TEST_F(MovedContents, StayIfTheTargetHasAnElementOfTheSameUuid)
{
    extend(m_source, u"shelf", 0);
    Node const present = Node::create(m_target, m_child->getUuid());
    present->setTag("present");

    expectRefused<messages::UUIDConflict>();

    EXPECT_EQ(m_child->getUuid(), present->getUuid());
    EXPECT_TRUE(m_source->getExtension(nodes(), u"shelf"));
    EXPECT_FALSE(m_target->getExtension(nodes(), u"shelf"));
}

TEST_F(MovedContents, ReturnWhenTheTargetTakesNoMore)
{
    extend(m_source, u"shelf", 0);
    m_child->setExtension(u"shelf", number(4));
    Transaction const transaction = m_target->beginTransaction(/*revertible=*/true);
    m_target->destroyAllContents();

    expectRefused<messages::CreateWithDestroyAll>();

    EXPECT_EQ(m_child->getExtension(u"shelf"), number(4));
    EXPECT_FALSE(m_target->getExtension(nodes(), u"shelf"));
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);
}

/// Fails at the creation of a given element.
class StrictProvider : public meta::DataModelUsageProvider
{
public:
    explicit StrictProvider(int number) : m_remaining(number) {}

    std::vector<meta::Package> getUsedPackages() const override { return {}; }
    void elementCreated(ModelElement::Impl*) override
    {
        if (--m_remaining == 0)
            throw std::runtime_error("no more");
    }

private:
    int m_remaining;
};

TEST_F(MovedContents, ReturnWhenTheMoveBreaksOffHalfWay)
{
    extend(m_source, u"mapped", 0);
    extend(m_target, u"mapped", 0);
    m_source->extendMetaclass(nodes(), manyNumbers(u"pages"), boost::none);
    m_child->setExtension(u"mapped", number(1));
    m_root->getExtension(u"pages").getValue<AbstractPrimitiveCollection&>().genericAdd(number(2));
    Picture const before = pictureOf(m_source);
    for (int broken = 1; broken <= 3; ++broken)
    {
        m_target->setUsageProvider(std::make_unique<StrictProvider>(broken));
        EXPECT_THROW(move(), std::runtime_error);

        EXPECT_EQ(pictureOf(m_source), before);
        EXPECT_EQ(m_target->getElementCount(), 0u);
        EXPECT_THAT(m_source->checkInvariants(), IsEmpty());
        EXPECT_THAT(m_target->checkInvariants(), IsEmpty());
        EXPECT_EQ(m_child->getExtension(u"mapped"), number(1));
        EXPECT_THAT(numbersIn(m_root->getExtension(u"pages")), ElementsAre(2));
        EXPECT_FALSE(m_target->getExtension(nodes(), u"pages"));
    }
    m_root->destroy();
    EXPECT_EQ(m_source->getTopLevelElements(), std::vector<ModelElement>{m_other});
}

// ---------------------------------------------------------------------------- extensions

class ExtensionTrace : public ExtensionListener
{
public:
    explicit ExtensionTrace(Model const& model) : m_model(model)
    {
        model->addExtensionListener(this);
    }
    ~ExtensionTrace() override { m_model->removeExtensionListener(this); }

    void extensionAdded(Model const& model, Extension const& extension) override
    {
        EXPECT_EQ(model, m_model);
        added.push_back(extension->getName());
        elementsThen = model->getElementCount();
        if (refuses)
            throw std::runtime_error("no extension");
    }
    void extensionRemoved(Model const&, Extension const& extension) override
    {
        removed.push_back(extension->getName());
    }

    std::vector<ustring> added, removed;
    std::size_t elementsThen = 99;
    bool refuses = false;

private:
    Model const m_model;
};

TEST_F(MovedContents, TakeTheirExtensionsAlong)
{
    extend(m_source, u"shelf", 5);
    m_child->setExtension(u"shelf", number(6));
    Extension const shelf = m_source->getExtension(nodes(), u"shelf");
    ExtensionTrace const trace(m_target);

    move();

    EXPECT_THAT(trace.added, ElementsAre(u"shelf"));
    EXPECT_EQ(trace.elementsThen, 0u) << "before the elements";
    EXPECT_EQ(m_target->getExtension(nodes(), u"shelf"), shelf);
    EXPECT_FALSE(m_source->getExtension(nodes(), u"shelf"));
    EXPECT_FALSE(nodes()->getExtensions().find(m_source->getModelCounter()));
    EXPECT_EQ(m_target->getExtensionDefault(nodes(), u"shelf"), number(5));
    EXPECT_EQ(m_child->getExtension(u"shelf"), number(6));
    EXPECT_EQ(m_root->getExtension(u"shelf"), number(5));
    m_source->destroy();
    EXPECT_EQ(m_child->getExtension(u"shelf"), number(6)) << "it belongs to the target now";
}

TEST_F(MovedContents, JoinTheExtensionsThatTheTargetHasOnTheSameClass)
{
    extend(m_target, u"row", 1);
    auto const group = nodes()->getExtensions().find(m_target->getModelCounter());
    extend(m_source, u"shelf", 5);

    move();

    EXPECT_EQ(nodes()->getExtensions().find(m_target->getModelCounter()), group);
    EXPECT_EQ(group->getExtensions().size(), 2u);
}

TEST_F(MovedContents, TakeTheExtensionOfTheTargetThatHasTheSameShape)
{
    extend(m_source, u"shelf", 5);
    extend(m_target, u"shelf", 5);
    m_child->setExtension(u"shelf", number(6));
    Extension const ended = m_source->getExtension(nodes(), u"shelf");
    Extension const kept = m_target->getExtension(nodes(), u"shelf");
    ExtensionTrace const trace(m_target);

    move();

    EXPECT_THAT(trace.added, IsEmpty());
    EXPECT_FALSE(ended);
    EXPECT_FALSE(nodes()->getExtensions().find(m_source->getModelCounter()));
    EXPECT_EQ(m_target->getExtension(nodes(), u"shelf"), kept);
    EXPECT_EQ(m_child->getExtension(u"shelf"), number(6));
    EXPECT_TRUE(m_child->hasNonDefaultExtension(u"shelf"));
    EXPECT_EQ(m_root->getExtension(u"shelf"), number(5));
}

TEST_F(MovedContents, RecordChangesOfCollectionsUnderTheExtensionOfTheTarget)
{
    m_source->extendMetaclass(nodes(), manyNumbers(u"pages"), boost::none);
    m_target->extendMetaclass(nodes(), manyNumbers(u"pages"), boost::none);
    Value const pages = m_child->getExtension(u"pages");
    auto& collection = pages.getValue<AbstractPrimitiveCollection&>();
    collection.genericAdd(number(1));

    move();
    EXPECT_EQ(&m_child->getExtension(u"pages").getValue<AbstractPrimitiveCollection&>(),
              &collection);
    EXPECT_EQ(collection.getCollectionProperty(), m_target->getExtension(nodes(), u"pages"));
    Transaction const transaction = m_target->beginTransaction(/*revertible=*/true);
    collection.genericAdd(number(2));
    transaction.rollBack();

    EXPECT_THAT(numbersIn(m_child->getExtension(u"pages")), ElementsAre(1));
}

TEST_F(MovedContents, MayTakeOneExtensionForThoseOfSeveralClasses)
{
    RegistryElement<Class> const text(u"MovedText");
    RegistryElement<Class> const novel(u"MovedNovel");
    RegistryElement<Class> const magazine(u"MovedMagazine");
    {
        RegistrySession session;
        novel->setSuperclass(text);
        magazine->setSuperclass(text);
        session.commit();
    }
    for (Class const& cls : {novel.get(), magazine.get()})
        m_source->extendMetaclass(cls, prototype(u"row"), number(0));
    m_target->extendMetaclass(text, prototype(u"row"), number(0));
    ModelElement const one = ModelElement::createReflective(m_source, novel);
    ModelElement const two = ModelElement::createReflective(m_source, magazine);
    one->setExtension(u"row", number(1));
    two->setExtension(u"row", number(2));

    m_target->setUsageProvider(std::make_unique<StrictProvider>(5));
    EXPECT_THROW(move(), std::runtime_error);
    EXPECT_EQ(one->getExtension(u"row"), number(1)) << "it has that of its own class again";
    EXPECT_EQ(two->getExtension(u"row"), number(2));
    move();
    EXPECT_EQ(one->getExtension(u"row"), number(1));
    EXPECT_EQ(two->getExtension(u"row"), number(2));

    EXPECT_TRUE(novel->getExtensions().empty());
    EXPECT_TRUE(magazine->getExtensions().empty());
    m_target->destroy();
    m_target = Model();
}

TEST_F(MovedContents, StayIfAnExtensionOfTheTargetIsInTheWay)
{
    extend(m_source, u"other", 1);
    extend(m_source, u"shelf", 5);
    extend(m_target, u"shelf", 6);
    m_child->setExtension(u"shelf", number(7));
    ExtensionTrace const trace(m_target);

    expectRefused<messages::ExtensionNameMustBeUnique>();

    EXPECT_THAT(trace.added, IsEmpty());
    EXPECT_EQ(m_child->getExtension(u"shelf"), number(7));
    EXPECT_TRUE(m_source->getExtension(nodes(), u"other"));
    EXPECT_FALSE(m_target->getExtension(nodes(), u"other"));
}

TEST_F(MovedContents, AreUsableTogetherWithTheExtensionsThatTheyTook)
{
    extend(m_source, u"shelf", 5);
    move();

    EXPECT_RAISES(messages::ExtensionNameMustBeUnique, extend(m_target, u"shelf", 5));
    extend(m_source, u"shelf", 9);
    EXPECT_EQ(Node::create(m_source)->getExtension(u"shelf"), number(9));
    m_target->unextendMetaclass(nodes(), u"shelf");
    EXPECT_RAISES(messages::NoSuchExtension, m_root->getExtension(u"shelf"));
}

TEST_F(MovedContents, ReturnWhenAListenerDoesNotWantTheExtension)
{
    extend(m_source, u"shelf", 5);
    m_child->setExtension(u"shelf", number(6));
    ExtensionTrace trace(m_target);
    trace.refuses = true;

    EXPECT_THROW(move(), std::runtime_error);

    EXPECT_THAT(trace.removed, ElementsAre(u"shelf"));
    EXPECT_EQ(m_child->getModel(), m_source);
    EXPECT_EQ(m_child->getExtension(u"shelf"), number(6));
    EXPECT_FALSE(m_target->getExtension(nodes(), u"shelf"));
    EXPECT_FALSE(nodes()->getExtensions().find(m_target->getModelCounter()));
}

TEST_F(MovedContents, StayIfTheRegistryKeepsItsExtensions)
{
    extend(m_source, u"shelf", 5);
    ScriptedListener listener;
    {
        meta::MetaRegistry::LockedModel const locked(meta::MetaRegistry::getInstance());
        listen(locked.getModel(), listener);
    }
    listener.onValidate = [](Report const&) { return false; };

    expectRefused<messages::CannotChangeModel>();

    EXPECT_TRUE(m_source->getExtension(nodes(), u"shelf"));
    EXPECT_FALSE(m_target->getExtension(nodes(), u"shelf"));
}

TEST_F(MovedContents, LeaveExtensionsBehindThatAreNoMore)
{
    {
        RegistryElement<Class> const book(u"MovedBook");
        m_source->extendMetaclass(book, prototype(u"shelf"), number(0));
    }

    move();

    EXPECT_EQ(m_target->getElementCount(), 3u);
}

// ---------------------------------------------------------------------------- updaters

static_assert(std::is_abstract_v<ModelUpdater>);
static_assert(!std::is_copy_constructible_v<ModelUpdater>);

/// Moves what the source has.
class MovingUpdater : public ModelUpdater
{
public:
    void updateModel(Model const& target, Model const& source) override
    {
        source->moveAllContentsTo(target);
    }
};

TEST_F(MovedContents, CanBeMovedByAnUpdaterOfAClient)
{
    MovingUpdater updater;
    ModelUpdater& update = updater;

    update.updateModel(m_target, m_source);

    EXPECT_EQ(m_target->getElementCount(), 3u);
}
}  // namespace
}  // namespace testkit
