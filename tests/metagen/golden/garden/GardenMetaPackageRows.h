// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// The rows of the metamodel, and their numbers by the names of what they stand for.
#pragma once
#include "acme/garden/Fwd.h"
#include "tarnkiln/support/PackageRows.h"

#include <cstddef>

namespace acme::garden {

/// The number of each row in its table.
namespace rows {

/// The tables that the metamodel is built from.
support::PackageRows const& all();

namespace packages {
enum Row : std::size_t
{
    Acme,
    Garden1
};
}  // namespace packages

namespace classes {
enum Row : std::size_t
{
    Bed,
    Plant,
    Tree
};
}  // namespace classes

namespace dataTypes {
enum Row : std::size_t
{
    Size
};
}  // namespace dataTypes

namespace properties {
enum Row : std::size_t
{
    BedPlants,
    BedSize,
    BedNeighbours,
    BedArea,
    PlantName,
    PlantBed,
    PlantSown,
    PlantHeight,
    PlantIsHardy,
    PlantNotes,
    TreePlanted,
    TreeGraft,
    TreeStock,
    SizeLength,
    SizeWidth
};
}  // namespace properties

namespace operations {
enum Row : std::size_t
{
    BedWater,
    BedDug,
    PlantYield,
    TreeYield
};
}  // namespace operations

namespace arguments {
enum Row : std::size_t
{
    BedWaterLitres,
    BedDugDepth,
    BedDugMoved,
    BedDugTools,
    BedDugSeason
};
}  // namespace arguments

namespace enumerations {
enum Row : std::size_t
{
    Season
};
}  // namespace enumerations

namespace literals {
enum Row : std::size_t
{
    SeasonSpring,
    SeasonAutumn
};
}  // namespace literals
}  // namespace rows
}  // namespace acme::garden
