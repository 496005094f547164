/// \file
/// How the primitive types are made.
#include "tarnkiln/meta/StandardTypes.h"

#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/support/PrimitiveInstantiator.h"

#include <boost/date_time/posix_time/ptime.hpp>
#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

namespace tarn::kiln::meta {
namespace {

struct PrimitiveTypeRow
{
    char16_t const* name;
    PrimitiveType& handle;
    MetaRegistry::CollectionInstantiator collection;
    char const* uuid;
};

/// In the order in which they are made.
PrimitiveTypeRow const primitiveTypes[] = {
    {u"String", StandardTypes::stringMeta, support::makePrimitiveCollection<ustring>,
     "27118326-006d-3829-a67a-400ad23d5d98"},
    {u"Integer", StandardTypes::integerMeta, support::makePrimitiveCollection<int>,
     "a0faef08-51b4-394c-86f2-b94bb1cb2044"},
    {u"Integer8", StandardTypes::integer8Meta, support::makePrimitiveCollection<signed char>,
     "e947a7ba-71a2-33ab-8f62-3d4d0bf7b6a2"},
    {u"Integer16", StandardTypes::integer16Meta, support::makePrimitiveCollection<short>,
     "d091ae36-3561-36ae-8534-6911788386b0"},
    {u"Integer64", StandardTypes::integer64Meta, support::makePrimitiveCollection<long>,
     "e05dbd56-1db0-3328-a53c-683faf477cc8"},
    {u"Real", StandardTypes::realMeta, support::makePrimitiveCollection<double>,
     "7f80fcc4-52c2-31ed-abb5-1b39d0864df1"},
    {u"Boolean", StandardTypes::booleanMeta, support::makePrimitiveCollection<bool>,
     "27226c86-4bac-3454-a850-4f8edb15d95b"},
    {u"UnlimitedNatural", StandardTypes::unlimitedNaturalMeta,
     support::makePrimitiveCollection<unsigned int>, "12f53a6e-cbef-3cef-86c9-167ddf077352"},
    {u"UInteger8", StandardTypes::uinteger8Meta, support::makePrimitiveCollection<unsigned char>,
     "8022a4b3-3633-3db0-851c-9ab097896d6e"},
    {u"UInteger16", StandardTypes::uinteger16Meta, support::makePrimitiveCollection<unsigned short>,
     "53c2e25b-6eec-3dd7-816f-ae7fc783d8db"},
    {u"UInteger64", StandardTypes::uinteger64Meta, support::makePrimitiveCollection<unsigned long>,
     "d8b128b8-1317-31e9-a462-a746d47f0edc"},
    {u"UUID", StandardTypes::uuidMeta, support::makePrimitiveCollection<UUID>,
     "5a54d9ad-87f7-34c1-870c-8f05b9515d5a"},
    {u"DateTime", StandardTypes::dateTimeMeta,
     support::makePrimitiveCollection<boost::posix_time::ptime>,
     "8cf10d23-41ed-3149-a506-085688270c1e"},
    {u"StdString", StandardTypes::stdstringMeta, support::makePrimitiveCollection<string>,
     "a086f8f6-1e47-393b-9568-53fd3aca2ecb"},
    {u"HostArray", StandardTypes::hostArrayMeta, nullptr, "7a5961aa-7ed6-34af-9264-4e7077041245"},
    {u"JsonValue", StandardTypes::jsonValueMeta, nullptr, "447f4487-0ed8-3620-8417-f0a4ac88e7d0"},
    {u"StringToStringMap", StandardTypes::stringToStringMapMeta, nullptr,
     "3747d0cf-9265-3618-8ba6-c0bb60cbe556"},
};
}  // namespace

void StandardTypes::initializeTypes(MetaRegistry& registry)
{
    MetaRegistry::LockedModel const locked(registry);
    for (PrimitiveTypeRow const& row : primitiveTypes)
    {
        UUID const id = boost::lexical_cast<UUID>(row.uuid);
        PrimitiveType const type = PrimitiveType::create(locked.getModel(), id);
        type->setName(row.name);
        row.handle = type;
        registry.registerType(type, row.collection, /*builder=*/nullptr);
    }
}

Type StandardTypes::getIntegralType(bool isSigned, int bits)
{
    MetaRegistry::getInstance();
    switch (bits)
    {
    case 8:
        return isSigned ? integer8Meta : uinteger8Meta;
    case 16:
        return isSigned ? integer16Meta : uinteger16Meta;
    case 32:
        return isSigned ? integerMeta : unlimitedNaturalMeta;
    case 64:
        return isSigned ? integer64Meta : uinteger64Meta;
    default:
        return {};
    }
}
}  // namespace tarn::kiln::meta
