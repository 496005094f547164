/// \file
/// The container of `UnorderedElementSet`.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/UUIDHasher.h"

#include <cstddef>
#include <type_traits>
#include <unordered_set>

namespace tarn::kiln::support {

/// Hashes an element by its UUID; 0 for the empty handle.
///
/// It could be `noexcept` and must not be: the standard library then stores the hash in each node,
/// so that the set stays sound when the UUID of an element in it changes.
struct TARNKILN_EXPORT ElementHasher
{
    using is_transparent = void;

    std::size_t operator()(ModelElement const& element) const
    {
        return element.getImpl() ? internal::UUIDHasher()(element.getImpl()->getUuid()) : 0;
    }
};

/// Compares the objects behind two handles.
struct TARNKILN_EXPORT ElementEqual
{
    using is_transparent = void;

    bool operator()(ModelElement const& left, ModelElement const& right) const
    {
        return left == right;
    }
};

/// Elements of the handle class `T`, found by any handle.
template <class T> using ElementHashSet = std::unordered_set<T, ElementHasher, ElementEqual>;

#ifdef __GLIBCXX__
static_assert(std::__cache_default<ModelElement, ElementHasher>::value,
              "a set of elements stores the hash of each");
#endif
}  // namespace tarn::kiln::support
