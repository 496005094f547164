/// \file
/// The barest change of an element: announced and made, without a transaction of its own.
#pragma once
#include "tests/support/PlainElement.h"

namespace testkit {

/// Sets the value of `element` in the open transaction, or in none.
inline void change(Plain const& element, int value)
{
    element->notifyModifying(Plain::Impl::VALUE);
    element->fields.value = value;
}

/// The elements of a list of a report, as `Plain`s.
inline std::vector<Plain> plains(std::vector<ModelElement> const& elements)
{
    std::vector<Plain> result;
    for (ModelElement const& element : elements)
        result.push_back(Plain::cast(element));
    return result;
}
}  // namespace testkit
