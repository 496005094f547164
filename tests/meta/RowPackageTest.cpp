// A client's metamodel that is built from rows.
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/meta/ArgumentImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/SchemaBase.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/support/RowPackage.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"

#include <boost/lexical_cast.hpp>

namespace tarn::kiln::support {
namespace {

using meta::Class;
using meta::MetaRegistry;
using meta::Property;
using tarnkiln::tests::RegistrySession;
using enum TypeTable;

constexpr PackageRow packages[] = {
    {.name = u"", .uri = u"shelf/20260101", .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e00"},
    {.name = u"shelf", .parent = 0, .uri = u"http://elsewhere.invalid/shelf"},
};
constexpr PrimitiveTypeRow primitiveTypes[] = {
    {.name = u"Barcode", .package = 1, .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e01"},
};
constexpr StructuredTypeRow classes[] = {
    {.name = u"Novel", .vobjName = "shelf.Novel", .package = 1, .superclass = {Classes, 1},
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e02"},
    {.name = u"Book", .vobjName = "shelf.Book", .package = 1,
     .superclass = {u"tarn.kiln.meta.NamedElement"}, .isAbstract = true, .properties = {0, 4},
     .operations = {0, 1}, .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e03"},
};
constexpr StructuredTypeRow dataTypes[] = {
    {.name = u"Size", .vobjName = "shelf.Size", .package = 1, .properties = {4, 1},
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e04"},
};
constexpr PropertyRow properties[] = {
    {.name = u"code", .index = 2, .type = {PrimitiveTypes, 0}, .lower = 0, .upper = 1,
     .flags = READ_ONLY | SET_ONCE | CUSTOM_QUALIFICATION | QUERY_INDEX | VOBJ_HIDDEN |
              VOBJ_DISP_SKIP_EMPTY,
     .vobjDispCategory = "General", .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e05"},
    {.name = u"sequels", .index = 3, .type = {Classes, 1}, .lower = 0, .upper = UNBOUNDED,
     .flags = UNIQUE, .opposite = {2}, .qualifiedBy = {u"tarn.kiln.meta.NamedElement", u"name"},
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e06"},
    {.name = u"prequel", .index = 4, .type = {Classes, 1}, .lower = 1, .upper = 1, .opposite = {1},
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e07"},
    {.name = u"size", .index = 5, .type = {DataTypes, 0}, .lower = 2, .upper = 5,
     .flags = ORDERED, .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e08"},
    {.name = u"unit", .type = {Enumerations, 0}, .lower = 1, .upper = 1, .defaultText = u"inch",
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e09"},
};
constexpr OperationRow operations[] = {
    {.name = u"lend", .type = {u"Boolean"}, .lower = 1, .upper = 1,
     .flags = ABSTRACT | STATIC | NOT_PUBLIC | EVENT, .arguments = {0, 2},
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e0a"},
};
constexpr ArgumentRow arguments[] = {
    {.name = u"days", .type = {u"Integer"}, .lower = 1, .upper = 1,
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e0b"},
    {.name = u"notes", .type = {u"String"}, .lower = 0, .upper = UNBOUNDED, .isOrdered = true,
     .isInput = false, .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e0c"},
};
constexpr EnumRow enumerations[] = {
    {.name = u"Unit", .package = 1, .underlyingType = {u"Integer"}, .literals = {0, 2},
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e0d"},
};
constexpr LiteralRow literals[] = {
    {.name = u"inch", .value = 4, .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e0e"},
    {.name = u"metre", .value = -4, .publicIdentifier = u"m",
     .uuid = "8c0f2a10-52b1-4d0a-9a3e-6f4b1c2d3e0f"},
};
constexpr PackageRows shelfRows{
    .packages = packages, .primitiveTypes = primitiveTypes, .classes = classes,
    .dataTypes = dataTypes, .properties = properties, .operations = operations,
    .arguments = arguments, .enumerations = enumerations, .literals = literals};

/// Built when a test asks for it. Singletons are for metamodels that stay.
class Shelf final : public RowPackage
{
public:
    explicit Shelf(PackageRows const& rows = shelfRows) : RowPackage(rows) {}
    using RowPackage::ensureBuilt;

    void destroy()
    {
        if (!isBuilt())
            return;
        RegistrySession session;
        unregisterRootPackage(getRootPackage()->getUri());
        getRootPackage()->destroy();
        session.commit();
    }
};

std::size_t elementCount()
{
    return MetaRegistry::getInstance().getModel()->getElementCount();
}

class MetamodelFromRows : public ::testing::Test
{
protected:
    MetamodelFromRows() { meta::MetaPackageMeta::getInstance(); }
    ~MetamodelFromRows() override { shelf.destroy(); }

    MetaRegistry& registry = MetaRegistry::getInstance();
    Shelf shelf;
};

TEST_F(MetamodelFromRows, IsNotThereBeforeItIsAskedFor)
{
    EXPECT_FALSE(shelf.isBuilt());
    EXPECT_FALSE(shelf.getClass(0));
    EXPECT_FALSE(shelf.getRootPackage());
    EXPECT_FALSE(registry.getType(u"shelf.Book"));
}

TEST_F(MetamodelFromRows, RegistersItsTypesAndItsRootPackage)
{
    shelf.ensureBuilt();

    EXPECT_TRUE(shelf.isBuilt());
    EXPECT_EQ(registry.getClass(u"shelf.Novel"), shelf.getClass(0));
    EXPECT_EQ(registry.getType(u"shelf.Size"), shelf.getDataType(0));
    EXPECT_EQ(registry.getType(u"shelf.Unit"), shelf.getEnum(0));
    EXPECT_EQ(registry.getPrimitiveType(u"shelf.Barcode"), shelf.getPrimitiveType(0));
    EXPECT_EQ(registry.getRootPackage(meta::SchemaBase + u"shelf/20260101"),
              shelf.getRootPackage());
    EXPECT_EQ(shelf.getPackage(1)->getUri(), u"http://elsewhere.invalid/shelf");
    EXPECT_EQ(shelf.getPackage(1)->getParentPackage(), shelf.getRootPackage());
}

TEST_F(MetamodelFromRows, RefersToOwnAndForeignClassesInAnyOrder)
{
    shelf.ensureBuilt();

    EXPECT_EQ(shelf.getClass(0)->getSuperclass(), shelf.getClass(1));
    EXPECT_EQ(shelf.getClass(1)->getSuperclass(), meta::NamedElement::metaClass());
    EXPECT_TRUE(shelf.getClass(1)->isAbstract());
    EXPECT_FALSE(shelf.getClass(0)->isAbstract());
    EXPECT_TRUE(shelf.getClass(0)->isA(ModelElement::metaClass()));
}

TEST_F(MetamodelFromRows, GivesPropertiesAllThatTheirRowsSay)
{
    shelf.ensureBuilt();
    Property const code = shelf.getProperty(0);
    Property const sequels = shelf.getProperty(1);
    Property const prequel = shelf.getProperty(2);
    Property const size = shelf.getProperty(3);
    Property const unit = shelf.getProperty(4);

    EXPECT_EQ(code->getType(), shelf.getPrimitiveType(0));
    EXPECT_EQ(code->getLower(), 0u);
    EXPECT_EQ(code->getUpper(), 1u);
    EXPECT_TRUE(code->isReadOnly() && code->isSetOnce() && code->getCustomQualification());
    EXPECT_TRUE(code->isQueryIndex() && code->isVobjHidden() && code->getVobjDispSkipEmpty());
    EXPECT_EQ(code->getVobjDispCategory().value(), "General");
    EXPECT_EQ(code->getPropertyIndex(), 2);
    EXPECT_FALSE(code->isUnique() || code->isOrdered() || code->isComposite());
    EXPECT_EQ(sequels->getOpposite(), prequel);
    EXPECT_EQ(prequel->getOpposite(), sequels);
    EXPECT_EQ(sequels->getQualifiedBy(),
              meta::NamedElement::metaClass()->getPropertyByName(u"name"));
    EXPECT_TRUE(sequels->isUnique() && sequels->isQualificationUnique());
    EXPECT_FALSE(sequels->isOrdered());
    EXPECT_EQ(size->getLower(), 2u);
    EXPECT_EQ(size->getUpper(), 5u);
    EXPECT_TRUE(size->isOrdered());
    EXPECT_EQ(unit->getPropertyIndex(), 0);
    EXPECT_EQ(unit->getOwningType(), shelf.getDataType(0));
    EXPECT_EQ(unit->getDefaultValue().value(), u"inch");
    EXPECT_EQ(unit->getType(), shelf.getEnum(0));
}

TEST_F(MetamodelFromRows, GivesOperationsAllThatTheirRowsSay)
{
    shelf.ensureBuilt();
    meta::Operation const lend = shelf.getOperation(0);

    EXPECT_EQ(lend->getType(), meta::StandardTypes::booleanMeta);
    EXPECT_EQ(lend->getLower(), 1u);
    EXPECT_EQ(lend->getUpper(), 1u);
    EXPECT_TRUE(lend->isAbstract() && lend->isStatic() && lend->isEvent());
    EXPECT_FALSE(lend->isPublic());
    ASSERT_EQ(lend->getArguments().size(), 2u);
    EXPECT_EQ(lend->getArguments()[0], shelf.getArgument(0));
    EXPECT_TRUE(shelf.getArgument(0)->isInput());
    EXPECT_FALSE(shelf.getArgument(1)->isInput());
    EXPECT_TRUE(shelf.getArgument(1)->isOrdered());
    EXPECT_EQ(shelf.getArgument(1)->getUpper(), UNBOUNDED);
    EXPECT_EQ(shelf.getClass(0)->getOperationsByName(u"lend").size(), 1u);
}

TEST_F(MetamodelFromRows, GivesLiteralsAllThatTheirRowsSay)
{
    shelf.ensureBuilt();

    EXPECT_EQ(shelf.getEnum(0)->getUnderlyingType(), meta::StandardTypes::integerMeta);
    EXPECT_EQ(shelf.getEnum(0)->findLiteralByValue(-4), shelf.getEnumLiteral(1));
    EXPECT_EQ(shelf.getEnum(0)->findLiteralByPublicIdentifier(u"m"), shelf.getEnumLiteral(1));
    EXPECT_FALSE(shelf.getEnumLiteral(0)->getPublicIdentifier());
}

TEST_F(MetamodelFromRows, IsBuiltOnce)
{
    shelf.ensureBuilt();
    Class const novel = shelf.getClass(0);
    std::size_t const count = elementCount();

    shelf.ensureBuilt();

    EXPECT_EQ(shelf.getClass(0), novel);
    EXPECT_EQ(elementCount(), count);
}

TEST_F(MetamodelFromRows, TakesThePlaceOfAnEarlierInstance)
{
    shelf.ensureBuilt();
    Class const stale = shelf.getClass(0);
    std::size_t const count = elementCount();

    Shelf again;
    again.ensureBuilt();

    EXPECT_FALSE(stale);
    EXPECT_FALSE(shelf.getRootPackage());
    EXPECT_EQ(registry.getType(u"shelf.Novel"), again.getClass(0));
    EXPECT_EQ(registry.getRootPackage(meta::SchemaBase + u"shelf/20260101"),
              again.getRootPackage());
    EXPECT_EQ(elementCount(), count);
    again.destroy();
    shelf.ensureBuilt();  // does nothing: it has been built
    EXPECT_FALSE(registry.getType(u"shelf.Novel"));
}

TEST_F(MetamodelFromRows, LeavesNothingBehindWhenATypeIsMissingAndTriesAgain)
{
    constexpr char16_t const* required[] = {u"Integer", u"shelf_missing"};
    PackageRows rows = shelfRows;
    rows.requiredTypes = required;
    Shelf incomplete(rows);
    std::size_t const count = elementCount();

    EXPECT_RAISES_WITH(messages::NoSuchType, incomplete.ensureBuilt(), u"shelf_missing");

    EXPECT_FALSE(incomplete.isBuilt());
    EXPECT_FALSE(incomplete.getRootPackage());
    EXPECT_FALSE(incomplete.getClass(0));
    EXPECT_EQ(elementCount(), count);
    EXPECT_FALSE(registry.getRootPackage(meta::SchemaBase + u"shelf/20260101"));
    EXPECT_THAT(registry.getModel()->checkInvariants(), ::testing::IsEmpty());

    {
        tarnkiln::tests::RegistryElement<meta::PrimitiveType> const missing(u"shelf_missing");
        registry.registerType(missing, nullptr, nullptr);
        incomplete.ensureBuilt();
    }
    EXPECT_EQ(registry.getType(u"shelf.Book"), incomplete.getClass(1));
    incomplete.destroy();
}

TEST_F(MetamodelFromRows, TakesRegisteredTypesBackWhenALaterRowFails)
{
    StructuredTypeRow wrongClasses[] = {classes[0], classes[1]};
    wrongClasses[1].superclass = {u"shelf_missing"};
    PackageRows rows = shelfRows;
    rows.classes = wrongClasses;
    Shelf wrong(rows);
    std::size_t const count = elementCount();

    EXPECT_RAISES_WITH(messages::NoSuchType, wrong.ensureBuilt(), u"shelf_missing");
    EXPECT_EQ(elementCount(), count);
    EXPECT_FALSE(registry.getType(u"shelf.Novel"));

    shelf.ensureBuilt();
    EXPECT_EQ(registry.getType(u"shelf.Novel"), shelf.getClass(0));
}

TEST_F(MetamodelFromRows, RefusesAForeignPropertyThatItsClassLacks)
{
    PropertyRow wrongProperties[std::size(properties)];
    std::copy(std::begin(properties), std::end(properties), wrongProperties);
    wrongProperties[1].qualifiedBy = {u"tarn.kiln.meta.NamedElement", u"nickname"};
    PackageRows rows = shelfRows;
    rows.properties = wrongProperties;
    Shelf wrong(rows);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, wrong.ensureBuilt(), u"nickname",
                       u"tarn.kiln.meta.NamedElement");
    EXPECT_FALSE(wrong.isBuilt());
}

TEST_F(MetamodelFromRows, RefusesARowWhoseUuidIsNone)
{
    PrimitiveTypeRow wrongTypes[] = {primitiveTypes[0]};
    wrongTypes[0].uuid = "no-uuid";
    PackageRows rows = shelfRows;
    rows.primitiveTypes = wrongTypes;
    Shelf wrong(rows);
    std::size_t const count = elementCount();

    EXPECT_THROW(wrong.ensureBuilt(), boost::bad_lexical_cast);
    EXPECT_EQ(elementCount(), count);
}

/// Refuses every change of the registry's model.
struct Refusal final : Listener
{
    bool transactionValidating(ReportData&) { return false; }
};

TEST_F(MetamodelFromRows, IsTakenBackWhenAListenerRefusesIt)
{
    Refusal refusal;
    registry.getModel()->addListener(&refusal);
    std::size_t const count = elementCount();

    EXPECT_THROW(shelf.ensureBuilt(), std::runtime_error);

    registry.getModel()->removeListener(&refusal);
    EXPECT_FALSE(shelf.isBuilt());
    EXPECT_EQ(elementCount(), count);
    EXPECT_FALSE(registry.getRootPackage(meta::SchemaBase + u"shelf/20260101"));
    shelf.ensureBuilt();
    EXPECT_TRUE(shelf.getClass(0));
}

/// Asks for itself while it is being built, as its own elements do.
class Narcissus final : public RowPackage
{
public:
    explicit Narcissus(PackageRows const& rows) : RowPackage(rows) {}
    using RowPackage::ensureBuilt;

    bool sawItself = false;
};
Narcissus* narcissus = nullptr;

TEST_F(MetamodelFromRows, LetsTheBuildingThreadPassToTheHalfBuiltOne)
{
    static constexpr void (*imports[])() = {[] {
        narcissus->ensureBuilt();
        narcissus->sawItself = !narcissus->isBuilt();
    }};
    PackageRows rows = shelfRows;
    rows.imports = imports;
    Narcissus built(rows);
    narcissus = &built;

    built.ensureBuilt();

    EXPECT_TRUE(built.sawItself);
    EXPECT_TRUE(built.isBuilt());
    RegistrySession session;
    registry.unregisterRootPackage(built.getRootPackage()->getUri());
    built.getRootPackage()->destroy();
    session.commit();
}
}  // namespace
}  // namespace tarn::kiln::support
