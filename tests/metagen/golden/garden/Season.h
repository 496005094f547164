// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// The literals of `Season`.
#pragma once
#include "tarnkiln/meta/StandardTypeOf.h"

namespace acme::garden {

/// A time of the year.
enum class Season : int
{
    /// When it is sown.
    Spring = 0,
    Autumn = 4
};
}  // namespace acme::garden

namespace tarn::kiln::meta {
template <> Type const& standardTypeOf<acme::garden::Season>();
}  // namespace tarn::kiln::meta
