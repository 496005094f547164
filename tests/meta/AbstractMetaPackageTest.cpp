// How meta packages make the elements of a metamodel, and how displays are told about them.
#include "tarnkiln/meta/AbstractMetaPackage.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/PrimitiveSet.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/AbstractMethodInvoker.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/SchemaBase.h"
#include "tarnkiln/support/PrimitiveInstantiator.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/ScriptedListener.h"

#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

namespace tarn::kiln::meta {
namespace {

using tarnkiln::tests::RegistrySession;
using ::testing::ElementsAre;

constexpr char const* SOME_UUID = "3d1c8a52-7f0e-3b57-9c5e-0a6f5a1d2e01";

/// Tells when it goes.
class Invoker final : public AbstractMethodInvoker
{
public:
    explicit Invoker(bool& isGone) : m_isGone(isGone) {}
    ~Invoker() override { m_isGone = true; }

    boost::optional<Value> invoke(ModelElement const&, std::vector<Value> const&) const override
    {
        return boost::none;
    }

private:
    bool& m_isGone;
};

/// A package without a metamodel; what it makes ends with the test.
class MetaPackage : public ::testing::Test, protected AbstractMetaPackage
{
protected:
    ~MetaPackage() override
    {
        RegistrySession session;
        for (ModelElement const& element : m_made)
        {
            if (element)
                element->destroy();
        }
        session.commit();
    }
    template <class Handle> Handle made(Handle const& element)
    {
        m_made.push_back(element);
        return element;
    }
    Property propertyOf(ValueFlags flags)
    {
        return made(createProperty(u"title", flags, /*isComposite=*/false, SOME_UUID));
    }
    static UUID uuid() { return boost::lexical_cast<UUID>(SOME_UUID); }

private:
    std::vector<ModelElement> m_made;
};

TEST_F(MetaPackage, MakesAPackageWithAFreshUuid)
{
    Package const first = made(createPackage(u"library", SchemaBase + u"library/20260101"));
    Package const second = made(createPackage(u"library", SchemaBase + u"library/20260101"));

    EXPECT_EQ(first->getName(), u"library");
    EXPECT_EQ(first->getUri(), SchemaBase + u"library/20260101");
    EXPECT_NE(first->getUuid(), second->getUuid());
    EXPECT_EQ(first->getModel(), MetaRegistry::getInstance().getModel());
}

TEST_F(MetaPackage, MakesClassesAndDataTypes)
{
    Class const book = made(createClass(u"Book", "library.Book", /*isAbstract=*/true, SOME_UUID));
    DataType const date =
        made(createDataType(u"Date", "library.Date", "3d1c8a52-7f0e-3b57-9c5e-0a6f5a1d2e02"));

    EXPECT_EQ(book->getUuid(), uuid());
    EXPECT_EQ(book->getName(), u"Book");
    EXPECT_EQ(book->getVobjName(), "library.Book");
    EXPECT_TRUE(book->isAbstract());
    EXPECT_FALSE(book->getSuperclass());
    EXPECT_EQ(date->getName(), u"Date");
    EXPECT_EQ(date->getVobjName(), "library.Date");
}

TEST_F(MetaPackage, MakesEnumerationsAndLiterals)
{
    Enum const colour = made(createEnum(u"Colour", SOME_UUID));
    EnumLiteral const red =
        made(createEnumLiteral(u"red", -3, "3d1c8a52-7f0e-3b57-9c5e-0a6f5a1d2e02"));

    EXPECT_EQ(colour->getName(), u"Colour");
    EXPECT_EQ(colour->getUuid(), uuid());
    EXPECT_EQ(red->getName(), u"red");
    EXPECT_EQ(red->getValue(), -3);
    EXPECT_FALSE(red->getParentEnum());
}

TEST_F(MetaPackage, MakesARequiredPropertyForASingleValue)
{
    Property const title = propertyOf(ValueFlags::Single);

    EXPECT_EQ(title->getLower(), 1u);
    EXPECT_EQ(title->getUpper(), 1u);
    EXPECT_FALSE(title->isOrdered());
    EXPECT_FALSE(title->isComposite());
    EXPECT_EQ(title->getUuid(), uuid());
}

TEST_F(MetaPackage, MakesAnOptionalPropertyForAnOptionalValue)
{
    Property const title = propertyOf(ValueFlags::OptionalSingle);

    EXPECT_EQ(title->getLower(), 0u);
    EXPECT_EQ(title->getUpper(), 1u);
}

TEST_F(MetaPackage, MakesAnOrderedPropertyForASequence)
{
    Property const title = propertyOf(ValueFlags::Sequence);

    EXPECT_EQ(title->getLower(), 0u);
    EXPECT_EQ(title->getUpper(), 0xFFFFFFFFu);
    EXPECT_TRUE(title->isOrdered());
}

TEST_F(MetaPackage, MakesAnUnorderedPropertyForAllOtherShapes)
{
    for (int const flags : {3, 5, 6, 7})
    {
        Property const title = createProperty(u"parts", static_cast<ValueFlags>(flags),
                                              /*isComposite=*/true, SOME_UUID);
        EXPECT_EQ(title->getLower(), 0u);
        EXPECT_EQ(title->getUpper(), 0xFFFFFFFFu);
        EXPECT_FALSE(title->isOrdered());
        EXPECT_TRUE(title->isComposite());

        RegistrySession session;
        title->destroy();
        session.commit();
    }
}

TEST_F(MetaPackage, RefusesATextThatIsNoUuid)
{
    std::size_t const before = MetaRegistry::getInstance().getModel()->getElementCount();

    EXPECT_THROW(createClass(u"Book", "", false, "no-uuid"), boost::bad_lexical_cast);
    EXPECT_THROW(createDataType(u"Date", "", "no-uuid"), boost::bad_lexical_cast);
    EXPECT_THROW(createEnum(u"Colour", "no-uuid"), boost::bad_lexical_cast);
    EXPECT_THROW(createEnumLiteral(u"red", 1, "no-uuid"), boost::bad_lexical_cast);
    EXPECT_THROW(createProperty(u"title", ValueFlags::Single, false, "no-uuid"),
                 boost::bad_lexical_cast);
    EXPECT_EQ(MetaRegistry::getInstance().getModel()->getElementCount(), before);
}

TEST_F(MetaPackage, JoinsTheTransactionThatIsOpen)
{
    RegistrySession session;
    Class const book = createClass(u"Book", "library.Book", /*isAbstract=*/false, SOME_UUID);
    EXPECT_TRUE(book);

    session.rollBack();

    EXPECT_FALSE(book);
}

TEST_F(MetaPackage, SetsWhatDisplaysNeed)
{
    Class const book = made(createClass(u"Book", "library.Book", /*isAbstract=*/false, SOME_UUID));
    Property const title = made(createProperty(u"title", ValueFlags::Single, /*isComposite=*/false,
                                               "3d1c8a52-7f0e-3b57-9c5e-0a6f5a1d2e02"));
    Package const library = made(createPackage(u"library", u"library"));
    RegistrySession session;

    setPropertyIndex(title, 7);
    setVobjClassName(book, "Book");
    setVobjCompactDisplay(book, true);
    setVobjDispCategory(title, "General");
    setVobjDispSkipEmpty(title);
    setDefaultVobjCategory(library, "Other");
    session.commit();

    EXPECT_EQ(title->getPropertyIndex(), 7);
    EXPECT_EQ(book->getVobjName(), "Book");
    EXPECT_TRUE(book->getVobjCompactDisplay());
    EXPECT_EQ(title->getVobjDispCategory().value(), "General");
    EXPECT_TRUE(title->getVobjDispSkipEmpty());
    EXPECT_EQ(library->getDefaultVobjCategory().value(), "Other");
}

TEST_F(MetaPackage, ReplacesTheOrderedCategoriesOfAType)
{
    Class const book = made(createClass(u"Book", "library.Book", /*isAbstract=*/false, SOME_UUID));
    RegistrySession session;
    setOrderedVobjDispCategories(book, {"Old"});

    setOrderedVobjDispCategories(book, {"General", "Details", "General"});

    EXPECT_THAT(book->getVobjDispCategories().getEntries(),
                ElementsAre("General", "Details", "General"));
    session.commit();
}

TEST_F(MetaPackage, ReplacesTheOrderedCategoriesInOneChange)
{
    Class const book = made(createClass(u"Book", "library.Book", /*isAbstract=*/false, SOME_UUID));
    MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
    testkit::ScriptedListener listener;
    testkit::listen(locked.getModel(), listener);

    setOrderedVobjDispCategories(book, {"General", "Details", "Other"});

    EXPECT_EQ(listener.committed.size(), 1u);
    EXPECT_EQ(book->getVobjDispCategories().size(), 3u);
}

TEST_F(MetaPackage, DestroysTheInvokerThatItReplaces)
{
    RegistrySession session;
    Operation const lend = made(Operation::create(MetaRegistry::getInstance().getModel()));
    bool isFirstGone = false;
    bool isSecondGone = false;

    setInvoker(lend, std::make_unique<Invoker>(isFirstGone));
    EXPECT_FALSE(isFirstGone);
    setInvoker(lend, std::make_unique<Invoker>(isSecondGone));

    EXPECT_TRUE(isFirstGone);
    EXPECT_FALSE(isSecondGone);
    setInvoker(lend, nullptr);
    EXPECT_TRUE(isSecondGone);
    session.commit();
}

TEST_F(MetaPackage, RegistersRootPackages)
{
    ustring const uri = SchemaBase + u"library/20260101";
    Package const library = made(createPackage(u"library", uri));
    MetaRegistry& registry = MetaRegistry::getInstance();
    RegistrySession session;

    registerRootPackage(library);
    EXPECT_EQ(registry.getRootPackage(uri), library);

    unregisterRootPackage(uri);
    EXPECT_FALSE(registry.getRootPackage(uri));
    session.commit();
}

TEST_F(MetaPackage, ReplacesWhatMakesTheCollectionsOfAType)
{
    Enum const colour = made(createEnum(u"Colour", SOME_UUID));
    Property const colours = made(createProperty(u"colours", ValueFlags::Set, /*isComposite=*/false,
                                                 "3d1c8a52-7f0e-3b57-9c5e-0a6f5a1d2e02"));
    RegistrySession session;
    colours->setType(colour);
    MetaRegistry& registry = MetaRegistry::getInstance();
    registry.registerType(colour, nullptr, nullptr);
    EXPECT_EQ(registry.instantiateDynamicCollection(ModelElement(), colours), nullptr);

    updateCollectionInstantiator(colour, support::makePrimitiveCollection<int>);

    std::unique_ptr<AbstractOwnedCollection> const collection(
        registry.instantiateDynamicCollection(ModelElement(), colours));
    EXPECT_TRUE(dynamic_cast<PrimitiveSet<int>*>(collection.get()));
    registry.unregisterType(colour, u"Colour");
    session.commit();
}
}  // namespace
}  // namespace tarn::kiln::meta
