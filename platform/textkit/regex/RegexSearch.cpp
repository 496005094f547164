#include "textkit/regex/RegexSearch.h"

#include "textkit/regex/Pattern.h"
#include "textkit/regex/RegexError.h"

namespace textkit::regex {

bool regex_search(std::u16string const& subject, std::u16string const& pattern, bool caseSensitive,
                  int options)
{
    if (options != 0)
        throw RegexError("unknown options " + std::to_string(options), pattern);
    return Pattern(pattern, caseSensitive).isFoundIn(subject);
}
}  // namespace textkit::regex
