// Made from garden.json by `metagen.py`; do not edit.
#include "acme/garden/GardenMetaPackageRows.h"

#include "acme/garden/BedBuilder.h"
#include "acme/garden/BedImpl.h"
#include "acme/garden/PlantImpl.h"
#include "acme/garden/Season.h"
#include "acme/garden/Size.h"
#include "acme/garden/SizeDatatypeSerializer.h"
#include "acme/garden/TreeBuilder.h"
#include "acme/garden/TreeImpl.h"
#include "tarnkiln/support/ElementInstantiator.h"
#include "tarnkiln/support/InvokerInstaller.h"
#include "tarnkiln/support/PrimitiveInstantiator.h"
#include "tarnkiln/support/SerializerInstaller.h"

namespace acme::garden {
namespace {

using enum support::OperationFlag;
using enum support::PropertyFlag;
using enum support::TypeTable;

constexpr support::PackageRow packages[] = {
    {.name = u"acme", .uri = u"garden/2", .uuid = "452f57c0-11c0-5356-9135-38ec867d48b2"},
    {.name = u"garden", .parent = 0, .uri = u"garden/2/acme.garden"},
};

constexpr support::StructuredTypeRow classes[] = {
    {.name = u"Bed", .vobjName = "acme.garden.Bed", .package = 1, .superclass = {u"ModelElement"},
     .properties = {0, 4}, .operations = {0, 2}, .collection = support::makeElementCollection<Bed>,
     .builder = Bed::Builder::instantiate, .uuid = "1d8e7d08-cfd0-5623-8ce7-ee4119a75436"},
    {.name = u"Plant", .vobjName = "acme.garden.Plant", .package = 1,
     .superclass = {u"ModelElement"}, .isAbstract = true, .properties = {4, 6},
     .operations = {2, 1}, .collection = support::makeElementCollection<Plant>,
     .uuid = "8a0c9272-52c5-5b82-bd12-8fbecb4c898a"},
    {.name = u"Tree", .vobjName = "acme.garden.Tree", .package = 1,
     .superclass = {Classes, rows::classes::Plant}, .properties = {10, 3}, .operations = {3, 1},
     .collection = support::makeElementCollection<Tree>, .builder = Tree::Builder::instantiate,
     .uuid = "285336f1-7fb2-5a18-ab68-d01bd62d6293"},
};

constexpr support::StructuredTypeRow dataTypes[] = {
    {.name = u"Size", .vobjName = "acme.garden.Size", .package = 1, .properties = {13, 2},
     .collection = support::makePrimitiveCollection<Size>,
     .serializers = support::installDatatypeSerializer<SizeDatatypeSerializer>,
     .uuid = "a73bc9c9-68cd-5d1b-8342-a2b3b68d4b3a"},
};

constexpr support::PropertyRow properties[] = {
    {.name = u"plants", .index = 1, .type = {Classes, rows::classes::Plant}, .lower = 0,
     .upper = support::UNBOUNDED, .flags = UNIQUE | COMPOSITE,
     .opposite = {rows::properties::PlantBed}, .qualifiedBy = {rows::properties::PlantName},
     .uuid = "5ebb345b-8d22-578f-b366-48423ec97bfb"},
    {.name = u"size", .index = 2, .type = {DataTypes, rows::dataTypes::Size}, .lower = 1,
     .upper = 1, .flags = ORDERED | UNIQUE, .uuid = "fc126246-ee9f-5982-a1a2-a0c2a3e97799"},
    {.name = u"neighbours", .index = 3, .type = {Classes, rows::classes::Bed}, .lower = 0,
     .upper = support::UNBOUNDED, .flags = UNIQUE, .uuid = "98b51526-5518-528b-b0e5-431ab132884c"},
    {.name = u"area", .type = {u"Real"}, .lower = 1, .upper = 1,
     .flags = ORDERED | UNIQUE | DERIVED | READ_ONLY,
     .uuid = "7c441bf0-d1a7-55bd-ba8c-4ea6fa544f95"},
    {.name = u"name", .index = 1, .type = {u"String"}, .lower = 1, .upper = 1,
     .flags = ORDERED | UNIQUE, .uuid = "22d2cac2-6374-5170-9dd4-f99e0287186c"},
    {.name = u"bed", .index = 2, .type = {Classes, rows::classes::Bed}, .lower = 1, .upper = 1,
     .flags = ORDERED | UNIQUE, .opposite = {rows::properties::BedPlants},
     .uuid = "6763bdae-4685-50a8-80b0-292dc6eee232"},
    {.name = u"sown", .index = 3, .type = {Enumerations, rows::enumerations::Season}, .lower = 1,
     .upper = 1, .flags = ORDERED | UNIQUE, .defaultText = u"autumn",
     .uuid = "462c262e-84f6-5af5-90ec-724dad76d3eb"},
    {.name = u"height", .index = 4, .type = {u"Integer"}, .lower = 0, .upper = 1,
     .flags = ORDERED | UNIQUE, .uuid = "59486b4a-d4e8-5d66-ae87-268148bbe3ad"},
    {.name = u"isHardy", .index = 5, .type = {u"Boolean"}, .lower = 1, .upper = 1,
     .flags = ORDERED | UNIQUE, .defaultText = u"true",
     .uuid = "48927530-3b85-5288-a436-e6d3642fcd78"},
    {.name = u"notes", .index = 6, .type = {u"String"}, .lower = 0, .upper = support::UNBOUNDED,
     .flags = ORDERED, .uuid = "07772907-ec6c-5a5e-a46c-ab8da75d7253"},
    {.name = u"planted", .index = 7, .type = {u"DateTime"}, .lower = 1, .upper = 1,
     .flags = ORDERED | UNIQUE | READ_ONLY | SET_ONCE,
     .uuid = "f220c06d-5e85-59f1-a5a3-065dac3956e7"},
    {.name = u"graft", .index = 8, .type = {Classes, rows::classes::Tree}, .lower = 1, .upper = 1,
     .flags = ORDERED | UNIQUE, .opposite = {rows::properties::TreeStock},
     .uuid = "c9619d9d-c1ec-5f03-9df6-8855ca3ad942"},
    {.name = u"stock", .index = 9, .type = {Classes, rows::classes::Tree}, .lower = 1, .upper = 1,
     .flags = ORDERED | UNIQUE, .opposite = {rows::properties::TreeGraft},
     .uuid = "fc7e82c7-b8f2-5391-aaec-546574d60e5b"},
    {.name = u"length", .type = {u"Real"}, .lower = 1, .upper = 1, .flags = ORDERED | UNIQUE,
     .uuid = "dc58f193-5f60-50f2-8f7e-6c5e09b11508"},
    {.name = u"width", .type = {u"Real"}, .lower = 0, .upper = 1, .flags = ORDERED | UNIQUE,
     .uuid = "1faed78d-c477-5fdb-948d-8283024ceda4"},
};

constexpr support::OperationRow operations[] = {
    {.name = u"water", .arguments = {0, 1}, .invoker = support::makeInvokerOf<&Bed::Impl::water>,
     .uuid = "ff604fa5-d75c-5b2c-bdb6-a140a2e2e74f"},
    {.name = u"dug", .flags = EVENT, .arguments = {1, 4},
     .invoker = support::makeInvokerOf<&Bed::Impl::dug>,
     .uuid = "7c495795-a6bb-5ccd-b34d-266eda459aee"},
    {.name = u"yield", .type = {u"Real"}, .lower = 1, .upper = 1, .flags = ABSTRACT,
     .invoker = support::makeInvokerOf<&Plant::Impl::yield>,
     .uuid = "77dd4122-cefa-55c6-92f7-25dfa060f077"},
    {.name = u"yield", .type = {u"Real"}, .lower = 1, .upper = 1,
     .invoker = support::makeInvokerOf<&Tree::Impl::yield>,
     .uuid = "a0d3e7e4-0a07-56d0-aea0-6c14db0b02ad"},
};

constexpr support::ArgumentRow arguments[] = {
    {.name = u"litres", .type = {u"Integer"}, .lower = 1, .upper = 1,
     .uuid = "4d90f59f-5cf3-5f94-8e35-88479df013a9"},
    {.name = u"depth", .type = {u"Integer"}, .lower = 1, .upper = 1,
     .uuid = "a979860f-f188-52af-84f5-36aba7e0aec7"},
    {.name = u"moved", .type = {Classes, rows::classes::Plant}, .lower = 1, .upper = 1,
     .uuid = "1cc9575f-bd36-5331-9c6d-5255e04ef250"},
    {.name = u"tools", .type = {u"String"}, .lower = 0, .upper = support::UNBOUNDED,
     .isOrdered = true, .uuid = "9dc75992-357a-5dea-be9c-e2904b5cff7b"},
    {.name = u"season", .type = {Enumerations, rows::enumerations::Season}, .lower = 1, .upper = 1,
     .uuid = "5b4d1053-e5b4-55d4-acf0-5c65e330aa56"},
};

constexpr support::EnumRow enumerations[] = {
    {.name = u"Season", .package = 1, .underlyingType = {u"Integer"}, .literals = {0, 2},
     .collection = support::makePrimitiveCollection<Season>,
     .serializers = support::installEnumSerializers<Season>,
     .uuid = "465affcb-2f11-5766-ad98-9dc2ebb1484a"},
};

constexpr support::LiteralRow literals[] = {
    {.name = u"spring", .value = 0, .uuid = "c7d5ae3e-282b-571a-9077-5b9a3cfaccb8"},
    {.name = u"autumn", .value = 4, .uuid = "8699f219-0340-5230-9ff8-c9e2bb234ccb"},
};

constexpr support::PackageRows allRows{
    .packages = packages, .classes = classes, .dataTypes = dataTypes, .properties = properties,
    .operations = operations, .arguments = arguments, .enumerations = enumerations,
    .literals = literals};
}  // namespace

support::PackageRows const& rows::all()
{
    return allRows;
}
}  // namespace acme::garden
