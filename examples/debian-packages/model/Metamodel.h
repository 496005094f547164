/// \file
/// The metamodel of package indexes, in the registry.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/Property.h"

#include <array>
#include <cstddef>

namespace debian::model {

using namespace tarn::kiln;

/// The classes and properties, made and registered when first asked for.
///
/// Threads: may be asked for on any thread.
class Metamodel
{
public:
    static constexpr std::size_t PROPERTY_COUNT = 23;

    static Metamodel const& getInstance();

    meta::Package root;
    meta::Class packageIndex;
    meta::Class package;
    meta::Class release;
    meta::Class dependencyGroup;
    meta::Class alternative;
    std::array<meta::Property, PROPERTY_COUNT> properties;  ///< Class by class, by index.

private:
    Metamodel();
};

/// The property in that row of the table.
template <std::size_t ROW> meta::Property const& propertyAt()
{
    return Metamodel::getInstance().properties[ROW];
}
}  // namespace debian::model
