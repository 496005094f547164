/// \file
/// The ways to write a literal of an enumeration.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::support {

/// One of the ways, for any enumeration.
///
/// | Way | Text of a number | Literal of a text |
/// |---|---|---|
/// | `NAME` | the name of the first literal, by name, with that number | the one of that name |
/// | `VALUE` | the number | the first one, by name, with that number |
/// | `PUBLIC_ID` | the literal's public identifier, or else its name | the first one, by name, |
/// |             |                                                   | with that identifier |
///
/// A number without a literal has the empty text as a name and as an identifier. A literal without
/// an identifier can't be read back from its name as one.
struct TARNKILN_EXPORT EnumText
{
    ustring (*textOf)(meta::Enum const& enumeration, long number);
    /// \throws std::bad_cast  if there is no such literal, or the text is no number.
    meta::EnumLiteral (*literalOf)(meta::Enum const& enumeration, ustring const& text);

    static EnumText const NAME;
    static EnumText const VALUE;
    static EnumText const PUBLIC_ID;
};
}  // namespace tarn::kiln::support
