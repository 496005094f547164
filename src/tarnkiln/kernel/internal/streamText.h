/// \file
/// The parts of which everything that is shown to people is made.
#pragma once
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/kernel/Text.h"

#include <cstddef>
#include <iomanip>
#include <ostream>

namespace tarn::kiln::internal {

/// As many entries of a collection as anybody reads.
constexpr std::size_t SHOWN_ENTRIES = 32;

/// `text` in quotes, with quotes and backslashes escaped.
inline void streamQuoted(std::ostream& out, ustring const& text)
{
    out << std::quoted(toUtf8(text));
}

/// The first entries of `range` in braces, each by `stream(entry)`.
template <class Range, class Stream>
void streamEntries(std::ostream& out, Range const& range, Stream stream)
{
    out << '{';
    std::size_t place = 0;
    for (auto const& entry : range)
    {
        if (place == SHOWN_ENTRIES)
        {
            out << ", and " << range.size() - place << " more";
            break;
        }
        out << (place++ ? ", " : "");
        stream(entry);
    }
    out << '}';
}

/// What `value` holds, without its type.
void streamContents(std::ostream& out, Value const& value);
}  // namespace tarn::kiln::internal
