// What transactions remember of extension values, tell about them, and bring back.
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tests/meta/ExtensionFixture.h"
#include "tests/support/InvalidationLog.h"
#include "tests/support/ScriptedListener.h"

namespace testkit {
namespace {

/// The same elements, with a listener that keeps the reports of commits.
class RecordedExtensions : public ExtendedElements
{
protected:
    void listenWith(Wants const& wants = {}) { listen(m_model, m_listener, wants); }
    ReportData const& report() const { return *m_listener.committed.back(); }
    std::size_t reports() const { return m_listener.committed.size(); }
    /// Makes `change` in a transaction and takes it back.
    template <class Change> void takeBack(Change const& change)
    {
        Transaction const transaction = begin();
        change();
        EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);
        EXPECT_THAT(m_model->checkInvariants(), IsEmpty());
    }

    ScriptedListener m_listener;
};

// ---------------------------------------------------------------------------- records

TEST(ChangeRecordOfAnElement, KnowsWhichExtensionsChanged)
{
    Model const model = Model::create(ModelConstellation());
    model->extendMetaclass(Node::metaClass(), prototype(u"shelf"), number(0));
    Extension const shelf = model->getExtension(Node::metaClass(), u"shelf");
    ModelElement::Impl::Changes changes(UUID{}, model, Node::metaClass(), 3);
    EXPECT_THAT(changes.getChangedExtensions(), IsEmpty());
    EXPECT_FALSE(changes.isExtensionChanged(u"shelf"));

    EXPECT_FALSE(changes.setModified(shelf));
    EXPECT_TRUE(changes.setModified(shelf)) << "it was marked before";

    EXPECT_TRUE(changes.isExtensionChanged(u"shelf"));
    EXPECT_FALSE(changes.isExtensionChanged(u"row"));
    EXPECT_THAT(changes.getChangedExtensions(), ElementsAre(shelf));
    EXPECT_TRUE(changes.revertUnchanged(nullptr));
}

TEST_F(RecordedExtensions, AreToldWithTheElementsThatChanged)
{
    listenWith({.shallow = true});

    m_node->setExtension(u"shelf", number(1));

    ASSERT_EQ(reports(), 1u) << "in a transaction of its own";
    EXPECT_FALSE(report().isDeep());
    EXPECT_THAT(report().getChanged(), ElementsAre(m_node));
    EXPECT_TRUE(report().isExtensionChanged(m_node, u"shelf"));
    EXPECT_FALSE(report().isExtensionChanged(m_node, u"pages"));
    EXPECT_FALSE(report().isExtensionChanged(m_node, u"nonsense"));
    EXPECT_FALSE(report().isExtensionChanged(m_other, u"shelf"));
    EXPECT_FALSE(report().isExtensionChanged(ModelElement(), u"shelf"));
    EXPECT_THAT(report().getChangedExtensions(m_node), ElementsAre(extension(u"shelf")));
    EXPECT_THAT(report().getChangedExtensions(m_other), IsEmpty());
    EXPECT_THAT(report().getChangedExtensions(ModelElement()), IsEmpty());
    EXPECT_THAT(report().getChangedProperties(m_node), IsEmpty());
    EXPECT_RAISES(messages::GetOldValueFromNonDeep,
                  report().getExtensionOldValue(m_node, u"shelf"));
}

TEST_F(RecordedExtensions, AreToldInTheOrderOfTheirFirstChange)
{
    listenWith();
    Transaction const transaction = begin();
    addPage(m_node, 1);
    m_node->setExtension(u"shelf", number(1));
    setFriend(m_node, m_other);
    addPage(m_node, 2);
    transaction.commit();

    EXPECT_THAT(report().getChangedExtensions(m_node),
                ElementsAre(extension(u"pages"), extension(u"shelf"), extension(u"friend")));
}

TEST_F(RecordedExtensions, HaveTheValuesFromBeforeTheTransaction)
{
    m_node->setExtension(u"shelf", number(1));
    addPage(m_node, 1);
    listenWith();
    Transaction const transaction = begin();
    for (int i = 2; i < 5; ++i)
    {
        m_node->setExtension(u"shelf", number(i));
        m_other->setExtension(u"shelf", number(i));
        addPage(m_node, i);
    }
    setFriend(m_node, m_other);
    transaction.commit();

    EXPECT_EQ(report().getExtensionOldValue(m_node, u"shelf"), number(1));
    EXPECT_EQ(report().getExtensionOldValue(m_other, u"shelf"), number(0)) << "the default";
    EXPECT_FALSE(
        report().getExtensionOldValue(m_node, u"friend").getValue<ModelElement>().getElementImpl());
    Value const pages = report().getExtensionOldValue(m_node, u"pages");
    EXPECT_TRUE(pages.isManaged());
    EXPECT_EQ(pages.getFlags(), ValueFlags::Sequence);
    EXPECT_THAT(numbersIn(pages), ElementsAre(1));
    EXPECT_THAT(ExtendedElements::pages(m_node), ElementsAre(1, 2, 3, 4));
}

TEST_F(RecordedExtensions, HaveOldValuesOnlyWhereTheyChanged)
{
    listenWith();
    m_node->setExtension(u"shelf", number(1));

    ustring const className = nodes()->getQualifiedName();
    EXPECT_RAISES_WITH(messages::NoSuchProperty, report().getExtensionOldValue(m_node, u"pages"),
                       u"pages", className);
    EXPECT_RAISES_WITH(messages::NoSuchProperty, report().getExtensionOldValue(m_node, u"none"),
                       u"none", className);
    EXPECT_RAISES_WITH(messages::NoSuchProperty, report().getExtensionOldValue(m_other, u"shelf"),
                       u"shelf", className);
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       report().getExtensionOldValue(ModelElement(), u"shelf"), u"shelf", u"");
}

TEST_F(RecordedExtensions, AreNotToldWhenTheyAreNoMore)
{
    listenWith();
    Transaction const transaction = begin();
    m_node->setExtension(u"shelf", number(1));
    setFriend(m_node, m_other);
    m_model->unextendMetaclass(nodes(), u"shelf");
    transaction.commit();

    EXPECT_THAT(report().getChangedExtensions(m_node), ElementsAre(extension(u"friend")));
    EXPECT_FALSE(report().isExtensionChanged(m_node, u"shelf"));
    EXPECT_RAISES(messages::NoSuchProperty, report().getExtensionOldValue(m_node, u"shelf"));
}

TEST_F(RecordedExtensions, AreNotToldOfElementsThatWereCreated)
{
    listenWith();
    Transaction const transaction = begin();
    Node const created = Node::create(m_model);
    created->setExtension(u"shelf", number(1));
    addPage(created, 1);
    transaction.commit();

    EXPECT_THAT(report().getCreated(), ElementsAre(created));
    EXPECT_THAT(report().getChanged(), IsEmpty());
    EXPECT_THAT(report().getChangedExtensions(created), IsEmpty());
    EXPECT_FALSE(report().isExtensionChanged(created, u"shelf"));
    EXPECT_EQ(shelf(created), 1);
}

TEST_F(RecordedExtensions, AreToldOfNothingThatIsSetToWhatItIs)
{
    m_node->setExtension(u"shelf", number(1));
    listenWith();

    m_node->setExtension(u"shelf", number(1));
    m_other->setExtension(u"shelf", number(0));
    static_cast<void>(m_other->getExtension(u"pages"));

    EXPECT_EQ(reports(), 0u);
}

TEST_F(RecordedExtensions, CountAsAChangeWhereUnchangedElementsAreLeftOut)
{
    m_model->setRevertUnchangedOnReport(true);
    listenWith();

    m_node->setExtension(u"shelf", number(1));

    ASSERT_EQ(reports(), 1u);
    EXPECT_THAT(report().getChanged(), ElementsAre(m_node));
}

TEST_F(RecordedExtensions, AreChangedUnseenWhileADataSourceLoads)
{
    listenWith();
    Transaction const transaction = begin();
    {
        auto const loading = m_model->startDataSourceLoading();
        m_node->setExtension(u"shelf", number(1));
        addPage(m_node, 1);
    }
    transaction.rollBack();

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_THAT(pages(m_node), ElementsAre(1));
}

TEST_F(RecordedExtensions, NeedNoTransactionButMakeOneOfTheirOwn)
{
    listenWith();

    addPage(m_node, 1);
    m_node->setExtension(u"shelf", number(1));

    EXPECT_EQ(reports(), 2u);
    EXPECT_TRUE(report().isDeep());
}

TEST_F(RecordedExtensions, CallBackAtTheirFirstChange)
{
    int calls = 0;
    Transaction const transaction = begin();
    transaction.addFirstChangeCallback([&] {
        ++calls;
        EXPECT_EQ(shelf(m_node), 0) << "before the change";
    });

    m_node->setExtension(u"shelf", number(1));
    m_node->setExtension(u"shelf", number(2));

    EXPECT_EQ(calls, 1);
    EXPECT_EQ(shelf(m_node), 2);
    transaction.commit();
}

TEST_F(RecordedExtensions, CanNotBeChangedByThoseWhoValidate)
{
    listenWith();
    bool refused = false;
    m_listener.onValidate = [&](Report const&) {
        refused = static_cast<bool>(tarnkiln::tests::raises<messages::ChangesProhibited>(
            [&] { m_node->setExtension(u"shelf", number(9)); }));
        return true;
    };

    m_other->setExtension(u"shelf", number(1));

    EXPECT_TRUE(refused);
    EXPECT_EQ(shelf(m_node), 0);
}

// ---------------------------------------------------------------------------- rollback

TEST_F(RecordedExtensions, ComeBackAtARollback)
{
    m_node->setExtension(u"shelf", number(1));
    setFriend(m_node, m_other);
    addPage(m_node, 1);
    meta::Class const type = meta::Class::create(m_model);
    addType(m_node, type);
    Value const collection = m_node->getExtension(u"pages");

    takeBack([&] {
        m_node->setExtension(u"shelf", number(0));
        m_node->setExtension(u"shelf", number(2));
        setFriend(m_node, m_node);
        addPage(m_node, 2);
        addType(m_node, meta::Class::create(m_model));
        m_other->setExtension(u"shelf", number(5));
        addPage(m_other, 5);
    });

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_EQ(friendOf(m_node), m_other);
    EXPECT_THAT(pages(m_node), ElementsAre(1));
    EXPECT_THAT(types(m_node), ElementsAre(ModelElement(type)));
    EXPECT_EQ(m_node->getExtension(u"pages"), collection) << "the same collection";
    EXPECT_EQ(shelf(m_other), 0);
    EXPECT_FALSE(m_other->hasNonDefaultExtension(u"shelf"));
    EXPECT_THAT(pages(m_other), IsEmpty());
}

TEST_F(RecordedExtensions, ComeBackWhenTheyWereReset)
{
    m_node->setExtension(u"shelf", number(1));

    takeBack([&] {
        m_node->setExtension(u"shelf", number(0));
        EXPECT_FALSE(m_node->hasNonDefaultExtension(u"shelf"));
        static_cast<void>(m_node->getExtension(u"pages"));
    });

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_TRUE(m_node->hasNonDefaultExtension(u"shelf"));
}

TEST_F(RecordedExtensions, AreToldOfTheRollback)
{
    m_node->setExtension(u"shelf", number(1));
    listenWith();

    takeBack([&] { m_node->setExtension(u"shelf", number(2)); });

    ASSERT_EQ(m_listener.rolledBack.size(), 1u);
    EXPECT_TRUE(m_listener.rolledBack.back()->isExtensionChanged(m_node, u"shelf"));
    EXPECT_THAT(m_listener.rolledBack.back()->getChanged(), ElementsAre(m_node));
}

TEST_F(RecordedExtensions, ComeBackWhenANestedTransactionFails)
{
    m_node->setExtension(u"shelf", number(1));
    Transaction const outer = begin();
    m_node->setExtension(u"shelf", number(2));
    {
        Transaction const inner = begin();
        m_node->setExtension(u"shelf", number(3));
        addPage(m_node, 1);
    }

    EXPECT_EQ(outer.commit(), TransactionResult::RolledBack);

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_THAT(pages(m_node), IsEmpty());
}

TEST_F(RecordedExtensions, ComeBackWhenAListenerRefuses)
{
    listenWith();
    m_listener.onValidate = [](Report const&) { return false; };

    m_node->setExtension(u"shelf", number(1));
    addPage(m_node, 1);

    EXPECT_EQ(shelf(m_node), 0);
    EXPECT_THAT(pages(m_node), IsEmpty());
    EXPECT_EQ(m_listener.rolledBack.size(), 2u);
}

TEST_F(RecordedExtensions, StayWhenAShallowTransactionIsRolledBack)
{
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
    transaction.addFirstChangeCallback([] {});
    m_node->setExtension(u"shelf", number(1));
    addPage(m_node, 1);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::NotRevertible);

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_THAT(pages(m_node), ElementsAre(1));
}

TEST_F(RecordedExtensions, ComeBackInAllModelsOfAGroup)
{
    Model const second = Model::create(m_model->getModelConstellation());
    extend(second);
    Transaction const setUp = second->beginTransaction(/*revertible=*/true);
    Node const far = Node::create(second);
    far->setExtension(u"shelf", number(1));
    setUp.commit();

    Transaction const mine = begin();
    Transaction const theirs = second->beginTransaction(/*revertible=*/false);
    m_node->setExtension(u"shelf", number(2));
    far->setExtension(u"shelf", number(3));
    addPage(far, 1);
    theirs.commit();
    EXPECT_EQ(mine.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(shelf(m_node), 0);
    EXPECT_EQ(shelf(far), 1);
    EXPECT_THAT(pages(far), IsEmpty());
    second->destroy();
}

TEST_F(RecordedExtensions, ComeBackWhileTheModelIsFrozen)
{
    m_node->setExtension(u"shelf", number(1));
    addPage(m_node, 1);
    Transaction const transaction = begin();
    m_node->setExtension(u"shelf", number(0));
    addPage(m_node, 2);
    Model::Freezer const frozen = m_model->freeze();

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_THAT(pages(m_node), ElementsAre(1));
}

TEST_F(RecordedExtensions, DoNotComeBackWhenTheyAreNoMore)
{
    m_node->setExtension(u"shelf", number(1));
    takeBack([&] {
        m_node->setExtension(u"shelf", number(2));
        m_model->unextendMetaclass(nodes(), u"shelf");
        m_model->extendMetaclass(nodes(), prototype(u"shelf"), number(7));
    });

    EXPECT_EQ(shelf(m_node), 7);
}

TEST_F(RecordedExtensions, AreUsableAfterARollback)
{
    takeBack([&] {
        m_node->setExtension(u"shelf", number(2));
        addPage(m_node, 2);
    });

    m_node->setExtension(u"shelf", number(3));
    addPage(m_node, 3);
    takeBack([&] {
        m_node->setExtension(u"shelf", number(4));
        addPage(m_node, 4);
    });

    EXPECT_EQ(shelf(m_node), 3);
    EXPECT_THAT(pages(m_node), ElementsAre(3));
}

// ---------------------------------------------------------------------------- destruction

TEST_F(RecordedExtensions, ComeBackWithADestroyedElement)
{
    WithoutInvalidationLog::Scope const noHost;
    m_node->setExtension(u"shelf", number(1));
    setFriend(m_node, m_other);
    addPage(m_node, 1);
    meta::Class const type = meta::Class::create(m_model);
    addType(m_node, type);

    takeBack([&] {
        m_node->setExtension(u"shelf", number(2));
        addPage(m_node, 2);
        m_node->destroy();
        type->destroy();
        EXPECT_FALSE(m_node);
    });

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_EQ(friendOf(m_node), m_other);
    EXPECT_THAT(pages(m_node), ElementsAre(1));
    EXPECT_THAT(types(m_node), ElementsAre(ModelElement(type)));
}

TEST_F(RecordedExtensions, ComeBackWithADestroyedElementThatAHostMirrors)
{
    m_node->setExtension(u"shelf", number(1));
    setFriend(m_node, m_node);
    addPage(m_node, 1);
    static_cast<void>(m_node->getExtension(u"types"));
    InvalidationLog const log;

    takeBack([&] {
        addPage(m_node, 2);
        m_node->destroy();
        EXPECT_THAT(m_node->_extensionNames(), IsEmpty());
    });

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_EQ(friendOf(m_node), m_node);
    EXPECT_THAT(pages(m_node), ElementsAre(1));
    EXPECT_THAT(types(m_node), IsEmpty());
    takeBack([&] { addPage(m_node, 3); });
    EXPECT_THAT(pages(m_node), ElementsAre(1)) << "the new collection announces its changes";
}

TEST_F(RecordedExtensions, HaveOldValuesWhenTheirElementIsDestroyed)
{
    m_node->setExtension(u"shelf", number(1));
    listenWith();
    Transaction const transaction = begin();
    m_node->setExtension(u"shelf", number(2));
    m_node->destroy();
    transaction.commit();

    EXPECT_FALSE(report().isExtensionChanged(m_node, u"shelf")) << "it is not live";
    EXPECT_THAT(report().getChangedExtensions(m_node), IsEmpty());
    EXPECT_EQ(report().getExtensionOldValue(m_node, u"shelf"), number(1));
}

TEST_F(RecordedExtensions, OfReferencesLetGoWhenTheDestructionIsCommitted)
{
    long const before = Node::liveCount();
    {
        Node const one = Node::create(m_model);
        Node const two = Node::create(m_model);
        Transaction const transaction = begin();
        setFriend(one, two);
        setFriend(two, one);
        one->destroy();
        two->destroy();
        transaction.commit();
    }
    EXPECT_EQ(Node::liveCount(), before);
}

TEST_F(RecordedExtensions, ReviveWithTheElementsThatTheyAre)
{
    setFriend(m_node, m_other);

    takeBack([&] {
        m_other->destroy();
        EXPECT_FALSE(friendOf(m_node)) << "a dead handle";
    });

    EXPECT_EQ(friendOf(m_node), m_other);
    EXPECT_TRUE(friendOf(m_node));
}
}  // namespace
}  // namespace testkit
