/// \file
/// A model id taken apart.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

#include <iosfwd>

namespace tarn::kiln {

/// The parts of a model id of the form "prefix@scheme:path", where "prefix@" may be missing.
///
/// A service for clients; the library itself treats the URIs of models as plain text.
struct TARNKILN_EXPORT ModelId
{
    ustring prefix;
    ustring scheme;
    ustring path;

    /// Takes `text` apart at its first '@', wherever that stands, and at the first ':' behind it.
    ///
    /// \throws tarnkiln::messages::InvalidValue  if there is no such ':'.
    static ModelId parse(ustring const& text);
};

/// Shows the whole id to people.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ModelId const& id);
}  // namespace tarn::kiln
