/// \file
/// The iterator of `PrimitiveSequence`.
#pragma once
#include <type_traits>
#include <vector>

namespace tarn::kiln::internal {

/// A position in a sequence of plain values, with random access; `Reverse` walks from the end.
///
/// Does not survive a change of the sequence.
template <class T, bool Reverse>
using SequenceIteratorPrimitive =
    std::conditional_t<Reverse, typename std::vector<T>::const_reverse_iterator,
                       typename std::vector<T>::const_iterator>;
}  // namespace tarn::kiln::internal
