/// \file
/// The base of the exceptions of all catalogues, and the one way to raise them.
#pragma once
#include "bedrock/core/except/Exception.h"

#include <exception>

namespace tarn::kiln {

/// What the class `Id` of a catalogue derives from.
template <class Id>
using MessageException = bedrock::core::except::Exception<Id, std::exception, void>;

/// Raises a copy of `exception`. All failures of the library are raised here, so that a breakpoint
/// in this function sees each of them.
template <class Id> [[noreturn]] void reportException(Id const& exception)
{
    throw exception;
}
}  // namespace tarn::kiln
