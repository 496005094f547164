/// \file
/// The metamodel of `Node` and `SpecialNode`, in the registry.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/Property.h"

#include <array>

namespace testkit {

/// The package, the classes and the properties, which are made when first asked for.
///
///     meta::Property const& count = NodeMetamodel::get().properties[Node::Impl::COUNT.index];
class NodeMetamodel
{
public:
    static constexpr unsigned long LAST_INDEX = 32;

    static NodeMetamodel const& get();

    tarn::kiln::meta::Package package;
    tarn::kiln::meta::Class node;
    tarn::kiln::meta::Class specialNode;
    std::array<tarn::kiln::meta::Property, LAST_INDEX + 1> properties;  ///< By index; 0 is empty.

private:
    NodeMetamodel();
};

/// The property with that index.
template <unsigned long INDEX> tarn::kiln::meta::Property const& propertyOf()
{
    return NodeMetamodel::get().properties[INDEX];
}
}  // namespace testkit
