// How elements hold values of the properties that their model has added to their classes.
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tarnkiln/meta/ValueOwnershipConverter.h"
#include "tests/meta/ExtensionFixture.h"
#include "tests/support/InvalidationLog.h"
#include "tests/support/ScriptedListener.h"

namespace testkit {
namespace {

using Names = std::vector<ustring>;

// ---------------------------------------------------------------------------- single values

TEST_F(ExtendedElements, HaveTheDefaultUntilTheyAreGivenAValue)
{
    EXPECT_EQ(m_node->getExtension(u"shelf"), number(0));
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"shelf"));

    m_node->setExtension(u"shelf", number(3));

    EXPECT_EQ(m_node->getExtension(u"shelf"), number(3));
    EXPECT_TRUE(m_node->hasNonDefaultExtension(u"shelf"));
    EXPECT_EQ(shelf(m_other), 0) << "each element has its own";
}

TEST_F(ExtendedElements, AreGivenValuesByTheExtensionItselfToo)
{
    m_node->setExtension(extension(u"shelf"), number(4));
    EXPECT_EQ(shelf(m_node), 4);

    m_node->setExtension(extension(u"shelf"), number(5));
    EXPECT_EQ(shelf(m_node), 5);
}

TEST_F(ExtendedElements, StoreNothingWhenASingleValueIsRead)
{
    static_cast<void>(m_node->getExtension(u"shelf"));
    static_cast<void>(m_node->getExtension(u"friend"));

    EXPECT_THAT(m_node->_extensionNames(), IsEmpty());
}

TEST_F(ExtendedElements, LoseAValueThatBecomesTheDefault)
{
    m_node->setExtension(u"shelf", number(3));
    m_node->setExtension(u"shelf", number(0));

    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"shelf"));
    EXPECT_THAT(m_node->_extensionNames(), IsEmpty());
    EXPECT_EQ(shelf(m_node), 0);
    m_node->setExtension(u"shelf", number(0));
    EXPECT_THAT(m_node->_extensionNames(), IsEmpty());
}

TEST_F(ExtendedElements, GiveCopiesOfTheirSingleValues)
{
    m_node->setExtension(u"shelf", number(3));
    Value const read = m_node->getExtension(u"shelf");

    m_node->setExtension(u"shelf", number(4));

    EXPECT_EQ(read, number(3));
}

TEST_F(ExtendedElements, HoldOtherElements)
{
    EXPECT_FALSE(friendOf(m_node).getElementImpl());

    setFriend(m_node, m_other);

    EXPECT_EQ(friendOf(m_node), m_other);
    EXPECT_TRUE(m_node->hasNonDefaultExtension(u"friend"));

    m_node->setExtension(u"friend", Value::createEmptyValue(nodes(), true));
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"friend"));
}

TEST_F(ExtendedElements, HaveValuesOfSeveralExtensionsSideBySide)
{
    for (int i = 0; i < 20; ++i)
    {
        ustring const name = u"more" + ustring(1, static_cast<char16_t>(u'a' + i));
        m_model->extendMetaclass(nodes(), prototype(name), number(-1));
        m_node->setExtension(name, number(i));
    }

    EXPECT_EQ(m_node->getExtension(u"morea"), number(0));
    EXPECT_EQ(m_node->getExtension(u"moret"), number(19));
    EXPECT_EQ(m_node->_extensionNames().size(), 20u);
    EXPECT_EQ(m_node->_extensionNames().front(), u"morea");
    EXPECT_EQ(m_node->_extensionNames().back(), u"moret");
}

TEST_F(ExtendedElements, InheritExtensionsFromTheClassesAbove)
{
    RegistryElement<Class> const book(u"InheritingBook");
    RegistryElement<Class> const novel(u"InheritingNovel");
    RegistrySession session;
    novel->setSuperclass(book);
    session.commit();
    m_model->extendMetaclass(book, prototype(u"row"), number(1));
    ModelElement const element = ModelElement::createReflective(m_model, novel);

    element->setExtension(u"row", number(2));

    EXPECT_EQ(element->getExtension(u"row"), number(2));
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_node->getExtension(u"row"), u"row",
                       nodes()->getQualifiedName());
    m_model->destroy();
    m_model = Model();
}

TEST_F(ExtendedElements, HaveTheExtensionsOfTheirOwnModelOnly)
{
    Model const other = Model::create(ModelConstellation());
    Node const elsewhere = Node::create(other);
    other->extendMetaclass(nodes(), prototype(u"shelf"), number(7));

    m_node->setExtension(u"shelf", number(1));
    elsewhere->setExtension(u"shelf", number(2));

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_EQ(shelf(elsewhere), 2);
    EXPECT_RAISES_WITH(messages::NoSuchExtension,
                       elsewhere->setExtension(extension(u"shelf"), number(1)), u"shelf",
                       nodes()->getQualifiedName());
    EXPECT_RAISES(messages::NoSuchExtension, elsewhere->getExtension(u"pages"));
}

// ---------------------------------------------------------------------------- many values

TEST_F(ExtendedElements, MakeTheirCollectionsWhenTheseAreReadFirst)
{
    EXPECT_THAT(m_node->_extensionNames(), IsEmpty());

    Value const pages = m_node->getExtension(u"pages");

    EXPECT_EQ(m_node->_extensionNames(), (Names{u"pages"}));
    EXPECT_TRUE(pages.isManaged());
    EXPECT_EQ(pages.getFlags(), ValueFlags::Sequence);
    EXPECT_EQ(pages.getType(), StandardTypes::integerMeta);
    EXPECT_EQ(m_node->getExtension(u"pages"), pages) << "the same collection again";
    auto& collection = pages.getValue<AbstractPrimitiveCollection&>();
    EXPECT_EQ(collection.getOwner(), m_node.getImpl());
    EXPECT_EQ(collection.getCollectionProperty(), extension(u"pages"));
}

TEST_F(ExtendedElements, CountACollectionAsAValueWhenItHoldsAny)
{
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"pages"));
    static_cast<void>(m_node->getExtension(u"pages"));
    static_cast<void>(m_node->getExtension(u"types"));
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"pages"));
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"types"));

    addPage(m_node, 1);
    addType(m_node, meta::Class::create(m_model));

    EXPECT_TRUE(m_node->hasNonDefaultExtension(u"pages"));
    EXPECT_TRUE(m_node->hasNonDefaultExtension(u"types"));
    EXPECT_THAT(pages(m_node), ElementsAre(1));
    EXPECT_EQ(types(m_node).size(), 1u);
}

TEST_F(ExtendedElements, HaveSetsWhereOrderDoesNotMatter)
{
    m_model->extendMetaclass(nodes(), prototype(u"tags", u"Integer", MANY), boost::none);
    Value const tags = m_node->getExtension(u"tags");

    EXPECT_EQ(tags.getFlags(), ValueFlags::Set);
    tags.getValue<AbstractPrimitiveCollection&>().genericAdd(number(2));
    tags.getValue<AbstractPrimitiveCollection&>().genericAdd(number(2));

    EXPECT_THAT(numbersIn(m_node->getExtension(u"tags")), ElementsAre(2));
}

TEST_F(ExtendedElements, ChangeManyValuesThroughTheCollectionOnly)
{
    Value const pages = m_node->getExtension(u"pages");

    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_node->setExtension(u"pages", number(1)),
                       u"pages", nodes()->getQualifiedName());
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_node->setExtension(u"pages", pages), u"pages",
                       nodes()->getQualifiedName());
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_other->setExtension(extension(u"pages"), pages),
                       u"pages", nodes()->getQualifiedName());
    EXPECT_THAT(m_other->_extensionNames(), IsEmpty());
}

// ---------------------------------------------------------------------------- refusals

TEST_F(ExtendedElements, HaveNoOtherExtensions)
{
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_node->getExtension(u"row"), u"row",
                       nodes()->getQualifiedName());
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_node->setExtension(u"row", number(1)), u"row",
                       nodes()->getQualifiedName());
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"row"));
    m_node->setExtension(u"shelf", number(1));
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"row"));
}

TEST_F(ExtendedElements, RefuseValuesThatDoNotSuit)
{
    m_node->setExtension(u"shelf", number(1));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       m_node->setExtension(u"shelf", Value(StandardTypes::booleanMeta, true)),
                       u"Integer");
    EXPECT_RAISES(
        messages::InvalidValue,
        m_node->setExtension(u"shelf", Value(StandardTypes::integerMeta, std::vector<int>{1})));
    EXPECT_RAISES(messages::InvalidValue, m_node->setExtension(Extension(), number(1)));
    EXPECT_EQ(shelf(m_node), 1);
}

TEST_F(ExtendedElements, DoomTheTransactionThatTheyJoinedWhenAValueDoesNotSuit)
{
    Transaction const transaction = begin();
    m_node->setCount(1);

    EXPECT_RAISES(messages::NoSuchExtension, m_node->setExtension(u"row", number(1)));
    EXPECT_FALSE(transaction.isRollBackOnly()) << "the name is looked up before that";
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  m_node->setExtension(u"shelf", Value(StandardTypes::booleanMeta, true)));

    EXPECT_TRUE(transaction.isRollBackOnly());
    EXPECT_EQ(transaction.commit(), TransactionResult::RolledBack);
    EXPECT_EQ(m_node->getCount(), 0);
}

TEST_F(ExtendedElements, AreNotChangedWhileTheirModelIsFrozen)
{
    m_node->setExtension(u"shelf", number(1));
    static_cast<void>(m_node->getExtension(u"pages"));
    Model::Freezer const frozen = m_model->freeze();

    EXPECT_RAISES(messages::ModelFrozen, m_node->setExtension(u"shelf", number(2)));
    EXPECT_RAISES(messages::ModelFrozen, m_node->setExtension(u"shelf", number(0)));
    EXPECT_RAISES(messages::ModelFrozen, m_other->setExtension(u"shelf", number(2)));
    EXPECT_RAISES(messages::ModelFrozen, addPage(m_node, 1));
    m_other->setExtension(u"shelf", number(0));

    EXPECT_EQ(shelf(m_node), 1);
    EXPECT_EQ(shelf(m_other), 0);
    EXPECT_THAT(pages(m_node), IsEmpty());
}

TEST_F(ExtendedElements, AreNoProxies)
{
    Node const proxy = Node::createProxy(m_model, m_node->getPersistentProxyId(/*omitModel=*/true));

    EXPECT_EQ(shelf(proxy), 0);
    EXPECT_RAISES(messages::CannotModifyProxy, proxy->setExtension(u"shelf", number(1)));
    EXPECT_RAISES(messages::CannotModifyProxy, proxy->getExtension(u"pages"));
    EXPECT_FALSE(proxy->hasNonDefaultExtension(u"pages"));
}

TEST_F(ExtendedElements, IgnoreChangesWhenTheyAreDead)
{
    m_node->setExtension(u"shelf", number(1));
    addPage(m_node, 1);
    m_node->destroy();
    m_other->destroy();

    m_node->setExtension(u"shelf", number(2));
    m_node->setExtension(extension(u"shelf"), number(2));
    m_node->setExtension(u"nonsense", number(2));
    m_other->setExtension(u"shelf", number(2));

    EXPECT_EQ(shelf(m_other), 0);
    EXPECT_NE(shelf(m_node), 2);
    addPage(m_other, 2);
    EXPECT_THAT(ExtendedElements::pages(m_other), IsEmpty());
}

TEST_F(ExtendedElements, HaveNoExtensionsAfterTheirModel)
{
    m_node->setExtension(u"shelf", number(1));
    static_cast<void>(m_other->getExtension(u"pages"));
    m_model->destroy();
    m_model = Model();

    m_node->setExtension(u"shelf", number(2));
    EXPECT_RAISES(messages::NoSuchExtension, m_node->getExtension(u"shelf"));
    EXPECT_RAISES(messages::NoSuchExtension, m_other->getExtension(u"pages"));
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"shelf"));
}

// ---------------------------------------------------------------------------- stale values

TEST_F(ExtendedElements, DropTheValueOfAnExtensionThatIsNoMoreWhenItIsAskedFor)
{
    m_node->setExtension(u"shelf", number(1));
    m_model->unextendMetaclass(nodes(), u"shelf");
    EXPECT_EQ(m_node->_extensionNames(), (Names{u"shelf"}));
    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"shelf"));

    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_node->getExtension(u"shelf"), u"shelf",
                       nodes()->getQualifiedName());

    EXPECT_THAT(m_node->_extensionNames(), IsEmpty());
}

TEST_F(ExtendedElements, TakeNoValueOverFromAFormerExtensionOfTheName)
{
    m_node->setExtension(u"shelf", number(1));
    m_other->setExtension(u"shelf", number(1));
    m_model->unextendMetaclass(nodes(), u"shelf");
    m_model->extendMetaclass(nodes(), prototype(u"shelf"), number(5));

    EXPECT_FALSE(m_node->hasNonDefaultExtension(u"shelf"));
    EXPECT_EQ(shelf(m_node), 5);
    EXPECT_THAT(m_node->_extensionNames(), IsEmpty());
    m_other->setExtension(u"shelf", number(6));
    EXPECT_EQ(m_other->_extensionNames(), (Names{u"shelf"}));
    EXPECT_EQ(shelf(m_other), 6);
}

TEST_F(ExtendedElements, RefuseAnExtensionThatIsNoMore)
{
    Extension const gone = extension(u"shelf");
    m_model->unextendMetaclass(nodes(), u"shelf");

    EXPECT_RAISES(messages::InvalidValue, m_node->setExtension(gone, number(1)));
}

TEST_F(ExtendedElements, ChangeTheCollectionOfAnExtensionThatIsNoMoreSilently)
{
    Value const pages = m_node->getExtension(u"pages");
    m_model->unextendMetaclass(nodes(), u"pages");
    Transaction const transaction = begin();

    pages.getValue<AbstractPrimitiveCollection&>().genericAdd(number(1));

    EXPECT_EQ(transaction.rollBack(), TransactionResult::NotCompleted);
    EXPECT_THAT(numbersIn(pages), ElementsAre(1));
}

TEST_F(ExtendedElements, CanNotSetWhatIsDeclaredInAnOpenTransactionOfTheRegistry)
{
    RegistrySession session;
    EXPECT_RAISES(messages::NoOpenTransaction,
                  m_model->extendMetaclass(nodes(), prototype(u"row"), number(1)));

    EXPECT_TRUE(extension(u"row"));
    EXPECT_RAISES(messages::NoSuchExtension, m_node->getExtension(u"row"));
    EXPECT_RAISES(messages::NoSuchExtension, m_node->setExtension(u"row", number(2)));
    m_node->setExtension(u"shelf", number(1));
    EXPECT_EQ(shelf(m_node), 1) << "others are found as before";
    session.rollBack();
}

// ---------------------------------------------------------------------------- reflection

TEST_F(ExtendedElements, ShowExtensionsByReflectionToPrivilegedCallersOnly)
{
    RegistryElement<Class> const book(u"ReflectedBook");
    m_model->extendMetaclass(book, prototype(u"row"), number(1));
    Extension const row = m_model->getExtension(book, u"row");
    Extension const shelfExtension = extension(u"shelf");
    ModelElement const element = ModelElement::createReflective(m_model, book);
    std::pair<ModelElement, Extension> const pairs[] = {{element, row}, {m_node, shelfExtension}};

    for (auto const& [each, property] : pairs)
    {
        ustring const name = property->getName();
        ustring const className = each->getMetaClass()->getQualifiedName();
        for (auto const* tag :
             {&ModelElement::Impl::PRIVILEGED_ACCESS, &ModelElement::Impl::NO_PROXY_RESOLVE,
              &ModelElement::Impl::IN_MEMORY_ONLY})
        {
            each->setPropertyValue(property, number(8), *tag);
            EXPECT_EQ(each->getExtension(name), number(8));
            each->setExtension(name, number(9));
            EXPECT_EQ(each->getPropertyValue(property, *tag), number(9));
        }
        EXPECT_RAISES_WITH(messages::NoSuchProperty,
                           each->getPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS),
                           name, className);
        EXPECT_RAISES_WITH(
            messages::NoSuchProperty,
            each->setPropertyValue(property, number(1), ModelElement::Impl::PUBLIC_ACCESS), name,
            className);
        EXPECT_RAISES_WITH(messages::NoSuchProperty,
                           each->hasPropertyValue(property, ModelElement::Impl::PRIVILEGED_ACCESS),
                           name, className);
        EXPECT_EQ(each->getExtension(name), number(9));
    }
    EXPECT_RAISES(messages::NoSuchProperty,
                  m_node->getPropertyValue(row, ModelElement::Impl::PRIVILEGED_ACCESS));
    EXPECT_NO_THROW(
        m_node->setPropertyValue(row, number(1), ModelElement::Impl::PRIVILEGED_ACCESS));
    EXPECT_RAISES(messages::NoSuchProperty,
                  element->getPropertyValue(shelfExtension, ModelElement::Impl::PRIVILEGED_ACCESS));
    EXPECT_NO_THROW(element->setPropertyValue(shelfExtension, number(1),
                                              ModelElement::Impl::PRIVILEGED_ACCESS));
    m_model->destroy();
    m_model = Model();
}

TEST_F(ExtendedElements, ShowCollectionsOfExtensionsByReflection)
{
    addPage(m_node, 4);

    Value const pages =
        m_node->getPropertyValue(extension(u"pages"), ModelElement::Impl::PRIVILEGED_ACCESS);

    EXPECT_THAT(numbersIn(pages), ElementsAre(4));
    EXPECT_RAISES(messages::NoSuchExtension,
                  m_node->setPropertyValue(extension(u"pages"), pages,
                                           ModelElement::Impl::PRIVILEGED_ACCESS));
}

// ---------------------------------------------------------------------------- host arrays

/// Counts what it makes less what it releases.
class CountingConverter : public meta::ValueOwnershipConverter
{
public:
    explicit CountingConverter(int& living) : m_living(living) {}

    Value convert(Value const& value) override
    {
        ++m_living;
        return value;
    }
    void release(Value const&) override { --m_living; }

private:
    int& m_living;
};

TEST_F(ExtendedElements, KeepHostArraysThroughTheirConverter)
{
    meta::MetaRegistry& registry = meta::MetaRegistry::getInstance();
    int living = 0;
    registry.registerOwnershipConverter(StandardTypes::hostArrayMeta,
                                        std::make_unique<CountingConverter>(living));
    Value const array = [] {
        Value absent = Value::createEmptyValue(StandardTypes::integerMeta, false);
        static_cast<ValueMeta&>(absent) =
            ValueMeta(StandardTypes::hostArrayMeta, ValueFlags::OptionalSingle);
        return absent;
    }();
    Value single = array;
    static_cast<ValueMeta&>(single) = ValueMeta(StandardTypes::hostArrayMeta);
    m_model->extendMetaclass(nodes(), prototype(u"data", u"HostArray"), array);
    EXPECT_EQ(living, 0) << "a default is not an element's";

    m_node->setExtension(u"data", single);
    EXPECT_EQ(living, 1);
    {
        Transaction const transaction = begin();
        m_node->setExtension(u"data", array);
        EXPECT_EQ(living, 1) << "the record has its own";
        transaction.rollBack();
    }
    EXPECT_TRUE(m_node->hasNonDefaultExtension(u"data"));
    EXPECT_EQ(living, 1);
    m_node->setExtension(u"data", array);

    EXPECT_EQ(living, 0);
    registry.unregisterOwnershipConverter(StandardTypes::hostArrayMeta);
}

// ---------------------------------------------------------------------------- moving

TEST_F(ExtendedElements, GiveValuesOfOneExtensionToAnother)
{
    m_node->setExtension(u"shelf", number(3));
    m_node->setExtension(u"friend", Value(nodes(), m_other));
    addPage(m_node, 1);
    m_model->extendMetaclass(nodes(), prototype(u"row"), number(0));
    m_model->extendMetaclass(nodes(), manyNumbers(u"sheets"), boost::none);

    for (Node const& node : {m_node, m_other})
        node->updateDynamicValuesOnMoveToAnotherModel(
            {{extension(u"shelf"), extension(u"row")},
             {extension(u"pages"), extension(u"sheets")}});

    EXPECT_EQ(m_node->_extensionNames(), (Names{u"friend", u"row", u"sheets"}));
    EXPECT_EQ(m_node->getExtension(u"row"), number(3));
    EXPECT_EQ(shelf(m_node), 0);
    EXPECT_THAT(numbersIn(m_node->getExtension(u"sheets")), ElementsAre(1));
    EXPECT_THAT(m_other->_extensionNames(), IsEmpty());
}

// ---------------------------------------------------------------------------- invariants

class BrokenExtensions : public ExtendedElements
{
protected:
    BrokenExtensions()
    {
        m_node->setExtension(u"shelf", number(3));
        addPage(m_node, 1);
    }
    ~BrokenExtensions() override
    {
        m_model->destroy();
        m_model = Model();
    }

    void expectReported(std::string const& sentence) const
    {
        EXPECT_THAT(m_model->checkInvariants(), ElementsAre(::testing::HasSubstr(sentence)));
    }
};

TEST_F(BrokenExtensions, AreReportedIfTheValueHasAnotherShape)
{
    {
        RegistrySession session;
        extension(u"shelf")->setUpper(2);
        session.commit();
    }
    expectReported("has a value of another shape than its extension");
}

TEST_F(BrokenExtensions, AreReportedIfTheyBelongToAnotherModel)
{
    Model const other = Model::create(ModelConstellation());
    other->extendMetaclass(nodes(), prototype(u"row"), number(0));
    {
        RegistrySession session;
        extension(u"shelf")->setOwner(other->getDeclaredExtension(nodes(), u"row")->getOwner());
        session.commit();
    }
    expectReported("has a value of an extension of another model");
}

TEST_F(BrokenExtensions, AreReportedIfTheirCollectionIsOfSomethingElse)
{
    m_node->getExtension(u"pages").getValue<AbstractPrimitiveCollection&>().basicSetProperty(
        extension(u"types"));

    expectReported("has an extension's collection that is of something else");
}

TEST_F(BrokenExtensions, AreReportedIfTheDefaultIsStored)
{
    m_model->extendMetaclass(nodes(), prototype(u"row"), number(3));
    m_node->updateDynamicValuesOnMoveToAnotherModel({{extension(u"shelf"), extension(u"row")}});

    expectReported("stores the default of an extension");
}

// ---------------------------------------------------------------------------- the end

TEST_F(ExtendedElements, TellAHostOfTheirCollectionsBeforeTheyDieThemselves)
{
    Value const pages = m_node->getExtension(u"pages");
    m_node->setExtension(u"shelf", number(3));
    auto* const collection = &pages.getValue<AbstractPrimitiveCollection&>();
    InvalidationLog const log;

    m_node->destroy();

    std::vector<InvalidationLog::Call> const expected = {
        {nullptr, static_cast<AbstractOwnedCollection*>(collection)}, {m_node.getImpl(), nullptr}};
    EXPECT_EQ(log.calls(), expected);
    EXPECT_THAT(m_node->_extensionNames(), IsEmpty());
}

TEST_F(ExtendedElements, DoNotKeepOneAnotherInMemoryWhenTheyAreDestroyed)
{
    WithoutInvalidationLog::Scope const noHost;
    long const before = Node::liveCount();
    {
        Node const one = Node::create(m_model);
        Node const two = Node::create(m_model);
        setFriend(one, two);
        setFriend(two, one);
        setFriend(m_node, m_node);
        one->destroy();
        two->destroy();
    }
    EXPECT_EQ(Node::liveCount(), before);
    {
        Transaction const transaction = begin();
        Node const one = Node::create(m_model);
        setFriend(one, one);
        transaction.rollBack();
    }
    EXPECT_EQ(Node::liveCount(), before);
    m_model->destroy();
    m_model = Model();
    m_node = Node();
    m_other = Node();
    EXPECT_EQ(Node::liveCount(), before - 2);
}
}  // namespace
}  // namespace testkit
