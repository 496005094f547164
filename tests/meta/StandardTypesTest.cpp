/// \file
/// The primitive types that are always there.
#include "tarnkiln/meta/StandardTypes.h"

#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/PrimitiveSet.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tests/meta/RegistrySession.h"

#include <boost/date_time/posix_time/ptime.hpp>
#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

namespace tarn::kiln::meta {
namespace {

using tarnkiln::tests::RegistryElement;
using tarnkiln::tests::RegistrySession;

MetaRegistry& registry()
{
    return MetaRegistry::getInstance();
}

struct Row
{
    char const* name;
    PrimitiveType const& handle;
    char const* uuid;
};

Row const rows[] = {
    {"String", StandardTypes::stringMeta, "27118326-006d-3829-a67a-400ad23d5d98"},
    {"Integer", StandardTypes::integerMeta, "a0faef08-51b4-394c-86f2-b94bb1cb2044"},
    {"Integer8", StandardTypes::integer8Meta, "e947a7ba-71a2-33ab-8f62-3d4d0bf7b6a2"},
    {"Integer16", StandardTypes::integer16Meta, "d091ae36-3561-36ae-8534-6911788386b0"},
    {"Integer64", StandardTypes::integer64Meta, "e05dbd56-1db0-3328-a53c-683faf477cc8"},
    {"Real", StandardTypes::realMeta, "7f80fcc4-52c2-31ed-abb5-1b39d0864df1"},
    {"Boolean", StandardTypes::booleanMeta, "27226c86-4bac-3454-a850-4f8edb15d95b"},
    {"UnlimitedNatural", StandardTypes::unlimitedNaturalMeta,
     "12f53a6e-cbef-3cef-86c9-167ddf077352"},
    {"UInteger8", StandardTypes::uinteger8Meta, "8022a4b3-3633-3db0-851c-9ab097896d6e"},
    {"UInteger16", StandardTypes::uinteger16Meta, "53c2e25b-6eec-3dd7-816f-ae7fc783d8db"},
    {"UInteger64", StandardTypes::uinteger64Meta, "d8b128b8-1317-31e9-a462-a746d47f0edc"},
    {"UUID", StandardTypes::uuidMeta, "5a54d9ad-87f7-34c1-870c-8f05b9515d5a"},
    {"DateTime", StandardTypes::dateTimeMeta, "8cf10d23-41ed-3149-a506-085688270c1e"},
    {"StdString", StandardTypes::stdstringMeta, "a086f8f6-1e47-393b-9568-53fd3aca2ecb"},
    {"HostArray", StandardTypes::hostArrayMeta, "7a5961aa-7ed6-34af-9264-4e7077041245"},
    {"JsonValue", StandardTypes::jsonValueMeta, "447f4487-0ed8-3620-8417-f0a4ac88e7d0"},
    {"StringToStringMap", StandardTypes::stringToStringMapMeta,
     "3747d0cf-9265-3618-8ba6-c0bb60cbe556"}};

class StandardType : public ::testing::TestWithParam<Row>
{
protected:
    void SetUp() override { registry(); }
};

TEST_P(StandardType, IsRegisteredUnderItsNameWithAFixedUuid)
{
    Row const& row = GetParam();
    std::string const bytes = row.name;
    ustring const name(bytes.begin(), bytes.end());

    ASSERT_TRUE(row.handle);
    EXPECT_EQ(row.handle->getName(), name);
    EXPECT_EQ(row.handle->getUuid(), boost::lexical_cast<UUID>(row.uuid));
    EXPECT_EQ(row.handle->getModel(), registry().getModel());
    EXPECT_EQ(registry().getPrimitiveType(name), row.handle);
}

INSTANTIATE_TEST_SUITE_P(All, StandardType, ::testing::ValuesIn(rows),
                         [](auto const& info) { return std::string(info.param.name); });

/// A many-valued property of the registry for the length of a test.
class ManyValued : public RegistryElement<Property>
{
public:
    ManyValued(Type const& type, bool ordered, bool unique) : RegistryElement(u"values")
    {
        RegistrySession session;
        get()->setType(type);
        get()->setUpper(2);
        get()->setIsOrdered(ordered);
        get()->setIsUnique(unique);
        session.commit();
    }

    /// A snapshot for the property, as the registry makes it.
    std::unique_ptr<AbstractOwnedCollection> instantiate() const
    {
        return std::unique_ptr<AbstractOwnedCollection>(
            registry().instantiateDynamicCollection(ModelElement(), get()));
    }
};

template <class T, PrimitiveType* Handle> struct Primitive
{
    using Payload = T;
    static PrimitiveType const& type()
    {
        registry();
        return *Handle;
    }
};

template <class P> class StandardTypeCollection : public ::testing::Test
{};

using PrimitivesWithCollections = ::testing::Types<
    Primitive<ustring, &StandardTypes::stringMeta>, Primitive<int, &StandardTypes::integerMeta>,
    Primitive<signed char, &StandardTypes::integer8Meta>,
    Primitive<short, &StandardTypes::integer16Meta>, Primitive<long, &StandardTypes::integer64Meta>,
    Primitive<double, &StandardTypes::realMeta>, Primitive<bool, &StandardTypes::booleanMeta>,
    Primitive<unsigned int, &StandardTypes::unlimitedNaturalMeta>,
    Primitive<unsigned char, &StandardTypes::uinteger8Meta>,
    Primitive<unsigned short, &StandardTypes::uinteger16Meta>,
    Primitive<unsigned long, &StandardTypes::uinteger64Meta>,
    Primitive<UUID, &StandardTypes::uuidMeta>,
    Primitive<boost::posix_time::ptime, &StandardTypes::dateTimeMeta>,
    Primitive<string, &StandardTypes::stdstringMeta>>;
TYPED_TEST_SUITE(StandardTypeCollection, PrimitivesWithCollections);

TYPED_TEST(StandardTypeCollection, IsASequenceForAnOrderedProperty)
{
    using Sequence = PrimitiveSequence<typename TypeParam::Payload>;
    ManyValued const repeating(TypeParam::type(), /*ordered=*/true, /*unique=*/false);
    ManyValued const unique(TypeParam::type(), /*ordered=*/true, /*unique=*/true);

    auto const repeatingValues = repeating.instantiate();
    auto const uniqueValues = unique.instantiate();

    auto const* const repeatingSequence = dynamic_cast<Sequence*>(repeatingValues.get());
    auto const* const uniqueSequence = dynamic_cast<Sequence*>(uniqueValues.get());
    ASSERT_TRUE(repeatingSequence && uniqueSequence);
    EXPECT_FALSE(repeatingSequence->isUnique());
    EXPECT_TRUE(uniqueSequence->isUnique());
    EXPECT_EQ(repeatingSequence->getCollectionProperty(), repeating.get());
    EXPECT_EQ(repeatingSequence->getCollectionType(), TypeParam::type());
}

TYPED_TEST(StandardTypeCollection, IsASetForAnUnorderedProperty)
{
    ManyValued const property(TypeParam::type(), /*ordered=*/false, /*unique=*/false);

    auto const values = property.instantiate();

    auto const* const set = dynamic_cast<PrimitiveSet<typename TypeParam::Payload>*>(values.get());
    ASSERT_NE(set, nullptr);
    EXPECT_EQ(set->getCollectionProperty(), property.get());
}

TEST(StandardTypesWithoutCollections, AreThoseOfOpaquePayloads)
{
    registry();
    for (Type const& type : {StandardTypes::hostArrayMeta, StandardTypes::jsonValueMeta,
                             StandardTypes::stringToStringMapMeta})
    {
        EXPECT_EQ(ManyValued(type, /*ordered=*/true, /*unique=*/false).instantiate(), nullptr);
        EXPECT_EQ(ManyValued(type, /*ordered=*/false, /*unique=*/false).instantiate(), nullptr);
    }
}

TEST(IntegralTypes, AreFoundByTheirWidth)
{
    EXPECT_EQ(StandardTypes::getIntegralType(true, 8), StandardTypes::integer8Meta);
    EXPECT_EQ(StandardTypes::getIntegralType(true, 16), StandardTypes::integer16Meta);
    EXPECT_EQ(StandardTypes::getIntegralType(true, 32), StandardTypes::integerMeta);
    EXPECT_EQ(StandardTypes::getIntegralType(true, 64), StandardTypes::integer64Meta);
    EXPECT_EQ(StandardTypes::getIntegralType(false, 8), StandardTypes::uinteger8Meta);
    EXPECT_EQ(StandardTypes::getIntegralType(false, 16), StandardTypes::uinteger16Meta);
    EXPECT_EQ(StandardTypes::getIntegralType(false, 64), StandardTypes::uinteger64Meta);
}

TEST(IntegralTypes, HaveUnlimitedNaturalAsTheUnsignedOneOf32Bits)
{
    EXPECT_EQ(StandardTypes::getIntegralType(false, 32), registry().getType(u"UnlimitedNatural"));
}

TEST(IntegralTypes, AreEmptyForOtherWidths)
{
    for (int const bits : {0, 7, 24, 128, -8})
    {
        EXPECT_EQ(StandardTypes::getIntegralType(true, bits), Type());
        EXPECT_EQ(StandardTypes::getIntegralType(false, bits), Type());
    }
}
}  // namespace
}  // namespace tarn::kiln::meta
