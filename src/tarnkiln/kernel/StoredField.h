/// \file
/// Where the elements of a generated class keep a property.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

#include <cstddef>
#include <typeinfo>

namespace tarn::kiln {

/// Lets a reader of many elements find a value without a `Value` for each.
///
/// Holds for all elements of the same C++ class. What it leads to may be read only: nothing that is
/// written there is announced or kept in step.
struct StoredField
{
    /// Of a plain field: a scalar, a value of a data type, or a `boost::optional` of one of these.
    /// An enumeration is given by the integer type behind it. Null for everything else.
    std::type_info const* type = nullptr;
    bool isLiteral = false;     ///< Whether `type` stands for an enumeration.
    std::ptrdiff_t offset = 0;  ///< Of a plain field: bytes from the `ModelElement::Impl`.
    /// Of a single reference: gives the target as it is, proxy or not. Null for everything else.
    ModelElement::Impl* (*target)(ModelElement::Impl const&) = nullptr;
};
}  // namespace tarn::kiln
