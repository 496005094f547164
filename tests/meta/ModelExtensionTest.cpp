// How models declare extensions of classes.
#include "tarnkiln/kernel/ExtensionListener.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/Node.h"

#include <gmock/gmock.h>

#include <functional>

namespace tarn::kiln::meta {

using tarnkiln::tests::RegistryElement;
using tarnkiln::tests::RegistrySession;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

namespace {

ExtensionPrototype prototype(ustring const& name, ustring const& type = u"Integer",
                             std::uint32_t upper = 1)
{
    ExtensionPrototype result;
    result.setName(name);
    result.setTypeName(type);
    result.setUpper(upper);
    return result;
}

Value number(int payload)
{
    StandardTypes::ensureInitialized();
    return Value(StandardTypes::integerMeta, payload);
}

class TracingListener : public ExtensionListener
{
public:
    TracingListener(Model const& model, std::string name, std::vector<std::string>& trace)
        : m_model(model),
          m_name(std::move(name)),
          m_trace(trace)
    {
        model->addExtensionListener(this);
    }
    ~TracingListener() override
    {
        if (m_model)
            m_model->removeExtensionListener(this);
    }

    void extensionAdded(Model const& model, Extension const& extension) override
    {
        tell("added", model, extension);
    }
    void extensionRemoved(Model const& model, Extension const& extension) override
    {
        tell("removed", model, extension);
    }

    std::function<void()> react;

private:
    void tell(std::string const& event, Model const& model, Extension const& extension)
    {
        EXPECT_EQ(model, m_model);
        EXPECT_TRUE(extension) << "told when it is not there";
        EXPECT_EQ(m_model->getExtension(extension->getExtendedMetaclass(), extension->getName()),
                  extension);
        ustring const name = extension->getName();
        m_trace.push_back(m_name + ' ' + event + ' ' + std::string(name.begin(), name.end()));
        if (react)
            react();
    }

    Model const m_model;
    std::string const m_name;
    std::vector<std::string>& m_trace;
};
}  // namespace

class ExtendedClasses : public ::testing::Test
{
protected:
    ExtendedClasses()
    {
        RegistrySession session;
        m_novel->setSuperclass(m_book);
        session.commit();
    }

    DynamicExtensions group(Class const& cls, Model const& model) const
    {
        return cls->getExtensions().find(model->getModelCounter());
    }
    DynamicExtensions group(Class const& cls) const { return group(cls, m_model); }

    RegistryElement<Class> m_book{u"ExtendedBook"};
    RegistryElement<Class> m_novel{u"ExtendedNovel"};
    RegistryElement<Class> m_magazine{u"ExtendedMagazine"};
    Model m_model = Model::create(ModelConstellation());
    Model m_other = Model::create(ModelConstellation());
};

// ---------------------------------------------------------------------------- extend

TEST_F(ExtendedClasses, HaveAPropertyLikeThePrototype)
{
    ExtensionPrototype wanted = prototype(u"shelf");
    wanted.setLower(1);
    wanted.setIsOrdered(true);
    wanted.setIsUnique(false);

    m_model->extendMetaclass(m_book, wanted, number(3));

    Extension const shelf = m_model->getDeclaredExtension(m_book, u"shelf");
    ASSERT_TRUE(shelf);
    EXPECT_EQ(shelf->getName(), u"shelf");
    EXPECT_EQ(shelf->getType(), StandardTypes::integerMeta);
    EXPECT_EQ(shelf->getLower(), 1u);
    EXPECT_EQ(shelf->getUpper(), 1u);
    EXPECT_TRUE(shelf->isOrdered());
    EXPECT_FALSE(shelf->isUnique());
    EXPECT_TRUE(shelf->isPublicAccessor());
    EXPECT_TRUE(shelf->isPublicMutator());
    EXPECT_EQ(shelf->getExtendedMetaclass(), m_book.get());
    EXPECT_EQ(shelf->createPrototype(), wanted);
}

TEST_F(ExtendedClasses, KeepExtensionsByTheModelThatMadeThem)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    m_other->extendMetaclass(m_book, prototype(u"shelf"), number(2));

    Extension const mine = m_model->getExtension(m_book, u"shelf");
    Extension const others = m_other->getExtension(m_book, u"shelf");
    EXPECT_NE(mine, others);
    EXPECT_EQ(mine->getOwner(), group(m_book));
    EXPECT_EQ(others->getOwner(), group(m_book, m_other));
    EXPECT_EQ(group(m_book)->getModelID(), m_model->getModelCounter());
    EXPECT_EQ(group(m_book)->getOwningClass(), m_book.get());
    EXPECT_EQ(mine->getModel(), m_book.get()->getModel());
}

TEST_F(ExtendedClasses, KeepAllExtensionsOfAModelTogether)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    DynamicExtensions const first = group(m_book);

    m_model->extendMetaclass(m_book, prototype(u"row"), number(1));

    EXPECT_EQ(group(m_book), first);
    EXPECT_EQ(first->getExtensions().size(), 2u);
    EXPECT_EQ(m_book.get()->getExtensions().size(), 1u);
}

TEST_F(ExtendedClasses, ShareExtensionsWithTheirSubclasses)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    Extension const shelf = m_model->getDeclaredExtension(m_book, u"shelf");

    EXPECT_EQ(m_model->getExtension(m_book, u"shelf"), shelf);
    EXPECT_EQ(m_model->getExtension(m_novel, u"shelf"), shelf);
    EXPECT_FALSE(m_model->getDeclaredExtension(m_novel, u"shelf"));
    EXPECT_FALSE(m_model->getExtension(m_magazine, u"shelf"));
    EXPECT_FALSE(m_model->getExtension(m_book, u"row"));
    EXPECT_FALSE(m_model->getExtension(Class(), u"shelf"));
    EXPECT_FALSE(m_model->getDeclaredExtension(Class(), u"shelf"));
}

TEST_F(ExtendedClasses, KnowTheDefaultsOfTheirExtensions)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(7));

    EXPECT_EQ(m_model->getExtensionDefault(m_book, u"shelf"), number(7));
    EXPECT_EQ(m_model->getExtensionDefault(m_novel, u"shelf"), number(7));
}

TEST_F(ExtendedClasses, HaveEmptyReferencesWhateverTheDefault)
{
    Class const nodes = testkit::Node::metaClass();
    ustring const typeName = nodes->getQualifiedName();
    auto const node = testkit::Node::create(m_model);

    m_model->extendMetaclass(m_book, prototype(u"owner", typeName), boost::none);
    m_model->extendMetaclass(m_magazine, prototype(u"owner", typeName), Value(nodes, node));

    for (Class const& extended : {m_book.get(), m_magazine.get()})
    {
        Value const owner = m_model->getExtensionDefault(extended, u"owner");
        EXPECT_EQ(owner.getType(), nodes);
        EXPECT_EQ(owner.getFlags(), ValueFlags::Single);
        EXPECT_FALSE(owner.getValue<ModelElement>().getElementImpl());
    }
}

TEST_F(ExtendedClasses, MayHaveManyValuesWithoutDefault)
{
    m_model->extendMetaclass(m_book, prototype(u"pages", u"Integer", 0xFFFFFFFF), boost::none);

    Extension const pages = m_model->getExtension(m_book, u"pages");
    ASSERT_TRUE(pages);
    EXPECT_EQ(pages->getUpper(), 0xFFFFFFFFu);
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_model->getExtensionDefault(m_book, u"pages"),
                       u"pages", u"ExtendedBook");
}

TEST_F(ExtendedClasses, AreNoPartOfTheTransactionsOfTheModel)
{
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    transaction.rollBack();

    EXPECT_TRUE(m_model->getExtension(m_book, u"shelf"));
}

// ---------------------------------------------------------------------------- refusals

TEST_F(ExtendedClasses, AreClassesOfTheRegistryOnly)
{
    Model const sketch = Model::createRegistryModel(u"sketch");
    Class const foreign = Class::create(sketch);
    Class const dead = m_magazine.get();
    m_magazine.destroy();

    for (Class const& cls : {Class(), foreign, dead})
    {
        EXPECT_RAISES(messages::CannotCreateWithoutModel,
                      m_model->extendMetaclass(cls, prototype(u"shelf"), number(1)));
        EXPECT_RAISES(messages::CannotCreateWithoutModel,
                      m_model->unextendMetaclass(cls, u"shelf"));
    }
}

TEST_F(ExtendedClasses, NeedATypeANameAndADefault)
{
    EXPECT_RAISES_WITH(messages::NoSuchType,
                       m_model->extendMetaclass(m_book, prototype(u"", u"Nonsense"), boost::none),
                       u"Nonsense");
    EXPECT_RAISES(messages::ExtensionMustHaveName,
                  m_model->extendMetaclass(m_book, prototype(u""), boost::none));
    EXPECT_RAISES(messages::ExtensionMustHaveDefaultValue,
                  m_model->extendMetaclass(m_book, prototype(u"shelf"), boost::none));

    EXPECT_FALSE(group(m_book));
}

TEST_F(ExtendedClasses, HaveEachNameOnceAlongALineOfInheritance)
{
    m_model->extendMetaclass(m_book, prototype(u"a"), number(1));
    m_model->extendMetaclass(m_novel, prototype(u"b"), number(1));

    for (auto const& [cls, name] :
         {std::pair(m_book.get(), u"a"), {m_novel.get(), u"a"}, {m_book.get(), u"b"}})
    {
        EXPECT_RAISES(messages::ExtensionNameMustBeUnique,
                      m_model->extendMetaclass(cls, prototype(name), boost::none));
    }

    EXPECT_EQ(group(m_book)->getExtensions().size(), 1u);
    EXPECT_EQ(group(m_novel)->getExtensions().size(), 1u);
}

TEST_F(ExtendedClasses, ShareNamesWithUnrelatedClassesAndWithOtherModels)
{
    m_model->extendMetaclass(m_novel, prototype(u"shelf"), number(1));
    m_model->extendMetaclass(m_magazine, prototype(u"shelf"), number(2));
    m_other->extendMetaclass(m_book, prototype(u"shelf"), number(3));

    EXPECT_EQ(m_model->getExtensionDefault(m_novel, u"shelf"), number(1));
    EXPECT_EQ(m_model->getExtensionDefault(m_magazine, u"shelf"), number(2));
    EXPECT_EQ(m_other->getExtensionDefault(m_novel, u"shelf"), number(3));
}

TEST_F(ExtendedClasses, RefuseADefaultThatDoesNotSuitAndLeaveNothing)
{
    StandardTypes::ensureInitialized();
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       m_model->extendMetaclass(m_book, prototype(u"shelf"),
                                                Value(StandardTypes::booleanMeta, true)),
                       u"Integer");
    EXPECT_RAISES(messages::InvalidValue,
                  m_model->extendMetaclass(m_book, prototype(u"shelf"),
                                           Value(StandardTypes::integerMeta, std::vector<int>{1})));

    EXPECT_FALSE(group(m_book));
    EXPECT_FALSE(m_model->getExtension(m_book, u"shelf"));
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
}

TEST_F(ExtendedClasses, RefuseManyValuesOfATypeWithoutCollections)
{
    m_model->extendMetaclass(m_book, prototype(u"row"), number(1));

    EXPECT_RAISES_WITH(
        messages::CannotInstantiateCollection,
        m_model->extendMetaclass(m_book, prototype(u"pages", u"JsonValue", 5), boost::none),
        u"JsonValue");

    EXPECT_FALSE(m_model->getExtension(m_book, u"pages"));
    EXPECT_EQ(group(m_book)->getExtensions().size(), 1u);
}

TEST_F(ExtendedClasses, CanNotBeExtendedWhileATransactionOfTheRegistryIsOpen)
{
    std::vector<std::string> trace;
    TracingListener const listener(m_model, "listener", trace);
    {
        RegistrySession session;
        EXPECT_RAISES(messages::NoOpenTransaction,
                      m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1)));
        EXPECT_TRUE(group(m_book)) << "the declaration waits for the outer transaction";
        session.rollBack();
    }

    EXPECT_FALSE(group(m_book));
    EXPECT_THAT(trace, IsEmpty());
}

TEST_F(ExtendedClasses, RefuseDefaultsOfWhatTheyHaveNot)
{
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_model->getExtensionDefault(m_novel, u"shelf"),
                       u"shelf", u"ExtendedNovel");
}

// ---------------------------------------------------------------------------- unextend

TEST_F(ExtendedClasses, LoseTheirLastExtensionWithItsGroup)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    m_model->extendMetaclass(m_book, prototype(u"row"), number(1));
    DynamicExtensions const both = group(m_book);

    m_model->unextendMetaclass(m_book, u"shelf");
    EXPECT_FALSE(m_model->getExtension(m_book, u"shelf"));
    EXPECT_TRUE(m_model->getExtension(m_book, u"row"));
    EXPECT_TRUE(both);

    m_model->unextendMetaclass(m_book, u"row");
    EXPECT_FALSE(both);
    EXPECT_TRUE(m_book.get()->getExtensions().empty());
}

TEST_F(ExtendedClasses, CanHaveANameAgain)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    m_model->unextendMetaclass(m_book, u"shelf");

    m_model->extendMetaclass(m_novel, prototype(u"shelf"), number(2));

    EXPECT_EQ(m_model->getExtensionDefault(m_novel, u"shelf"), number(2));
}

TEST_F(ExtendedClasses, LoseOnlyWhatTheyHave)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));

    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_model->unextendMetaclass(m_book, u"row"),
                       u"row", u"ExtendedBook");
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_model->unextendMetaclass(m_novel, u"shelf"),
                       u"shelf", u"ExtendedNovel");
    EXPECT_RAISES_WITH(messages::NoSuchExtension, m_other->unextendMetaclass(m_book, u"shelf"),
                       u"shelf", u"ExtendedBook");

    EXPECT_TRUE(m_model->getExtension(m_book, u"shelf"));
}

TEST_F(ExtendedClasses, KeepTheirExtensionWhileATransactionOfTheRegistryIsOpen)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    {
        RegistrySession session;
        EXPECT_RAISES(messages::NoOpenTransaction, m_model->unextendMetaclass(m_book, u"shelf"));
        session.rollBack();
    }

    EXPECT_EQ(m_model->getExtensionDefault(m_book, u"shelf"), number(1));
}

TEST_F(ExtendedClasses, LoseTheExtensionsOfAModelThatIsDestroyed)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    m_model->extendMetaclass(m_book, prototype(u"row"), number(1));
    m_model->extendMetaclass(m_magazine, prototype(u"shelf"), number(1));
    m_other->extendMetaclass(m_book, prototype(u"shelf"), number(1));

    m_model->destroy();

    EXPECT_EQ(m_book.get()->getExtensions().size(), 1u);
    EXPECT_TRUE(m_magazine.get()->getExtensions().empty());
    EXPECT_TRUE(m_other->getExtension(m_book, u"shelf"));
}

TEST_F(ExtendedClasses, GoBeforeTheModelThatExtendedThem)
{
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    m_novel.destroy();
    m_book.destroy();

    m_model->destroy();

    EXPECT_EQ(m_model->getValidity(), ElementImpl::ElementValidity::Invalid);
}

// ---------------------------------------------------------------------------- listeners

TEST_F(ExtendedClasses, AreAnnouncedToAllListenersOfTheModel)
{
    std::vector<std::string> trace;
    TracingListener const mine(m_model, "mine", trace);
    TracingListener const others(m_other, "others", trace);
    m_model->addExtensionListener(const_cast<TracingListener*>(&mine));

    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    m_model->unextendMetaclass(m_book, u"shelf");

    EXPECT_THAT(trace, ElementsAre("mine added shelf", "mine removed shelf"));
}

TEST_F(ExtendedClasses, AreNotAnnouncedToListenersThatLeft)
{
    std::vector<std::string> trace;
    TracingListener first(m_model, "a", trace);
    TracingListener second(m_model, "b", trace);
    auto const leaveAlone = [&](TracingListener& other) {
        return [&] { m_model->removeExtensionListener(&other); };
    };
    first.react = leaveAlone(second);
    second.react = leaveAlone(first);

    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));

    EXPECT_EQ(trace.size(), 1u);
}

TEST_F(ExtendedClasses, KeepAnExtensionWhoseRemovalAListenerRefuses)
{
    std::vector<std::string> trace;
    TracingListener listener(m_model, "listener", trace);
    m_model->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    listener.react = [] { throw std::runtime_error("no"); };

    EXPECT_THROW(m_model->unextendMetaclass(m_book, u"shelf"), std::runtime_error);

    EXPECT_EQ(m_model->getExtensionDefault(m_book, u"shelf"), number(1));
}
}  // namespace tarn::kiln::meta
