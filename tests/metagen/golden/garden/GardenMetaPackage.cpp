// Made from garden.json by `metagen.py`; do not edit.
#include "acme/garden/GardenMetaPackage.h"

#include "acme/garden/Season.h"
#include "acme/garden/Size.h"

namespace acme::garden {

GardenMetaPackage::GardenMetaPackage() : RowPackage(rows::all()) {}

GardenMetaPackage& GardenMetaPackage::getInstance()
{
    static auto* const package = new GardenMetaPackage;
    package->ensureBuilt();
    return *package;
}
}  // namespace acme::garden

namespace tarn::kiln::meta {

template <> Type const& standardTypeOf<acme::garden::Size>()
{
    return acme::garden::GardenMetaPackage::getInstance().getDataType(
        acme::garden::rows::dataTypes::Size);
}

template <> Type const& standardTypeOf<acme::garden::Season>()
{
    return acme::garden::GardenMetaPackage::getInstance().getEnum(
        acme::garden::rows::enumerations::Season);
}
}  // namespace tarn::kiln::meta
