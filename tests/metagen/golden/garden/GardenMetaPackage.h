// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// How the metamodel `acme.garden` gets into the registry.
#pragma once
#include "acme/garden/Fwd.h"
#include "acme/garden/GardenMetaPackageRows.h"
#include "tarnkiln/support/RowPackage.h"

namespace acme::garden {

/// Builds the metamodel at its first use and holds the handles of its elements.
///
/// Threads: any; see `support::RowPackage`.
class GardenMetaPackage final : public support::RowPackage
{
public:
    /// The metamodel, complete except on the thread that is just building it.
    static GardenMetaPackage& getInstance();

private:
    GardenMetaPackage();
};

/// The function that gives the property of a row, for the `Slot` of a generated class.
template <rows::properties::Row ROW>
inline constexpr auto propertyOf = &support::propertyAt<GardenMetaPackage, ROW>;
}  // namespace acme::garden
