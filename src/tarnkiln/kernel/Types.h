/// \file
/// The texts and identifiers of the whole library.
#pragma once
// Else the templates that the library instantiates for UUIDs would be as hidden as their argument.
#pragma GCC visibility push(default)
#include <boost/uuid/uuid.hpp>
#pragma GCC visibility pop

#include <string>

namespace tarn::kiln {

/// UTF-16 text, as all names and text in a model are.
using ustring = std::u16string;

/// 8-bit text; UTF-8 unless said otherwise.
using string = std::string;

/// What tells the elements of a model apart.
using UUID = boost::uuids::uuid;
}  // namespace tarn::kiln
