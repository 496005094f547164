/// \file
/// Whether a regular expression is found in a UTF-16 text.
#pragma once
#include <string>

namespace textkit::regex {

/// Whether `pattern` is found anywhere in `subject`; `Pattern` tells what patterns mean.
///
/// Compiles the pattern at each call; who searches with one pattern often keeps a `Pattern`.
///
/// \param caseSensitive  false to find letters in either case.
/// \param options        further rules of syntax, as bits; there are none yet, so it is 0.
/// \throws RegexError  if the pattern or the options are no such thing, or the search is given up.
bool regex_search(std::u16string const& subject, std::u16string const& pattern, bool caseSensitive,
                  int options);
}  // namespace textkit::regex
