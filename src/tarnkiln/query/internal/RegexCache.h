/// \file
/// The regular expressions of one run.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/query/internal/ByteRegex.h"
#include "tarnkiln/query/internal/findComparator.h"
#include "textkit/regex/Pattern.h"

#include <unordered_map>

namespace tarn::kiln::internal {

/// Compiles each pattern when it is first used. One that can't be compiled fails at each use.
///
/// Must not be kept beyond a run: what a pattern means may depend on the global locale.
class RegexCache
{
public:
    RegexCache();
    RegexCache(RegexCache const&) = delete;
    RegexCache& operator=(RegexCache const&) = delete;

    /// \throws std::regex_error  if `pattern` is no regular expression.
    ByteRegex const& ofBytes(string const& pattern);
    /// \throws textkit::regex::RegexError  if `pattern` is no regular expression.
    textkit::regex::Pattern const& ofUnits(ustring const& pattern);

    /// What does the same as `comparator`, a comparator of the registry, without compiling patterns
    /// anew; lives as long as this object.
    Comparator const& withCache(Comparator const& comparator) const;

private:
    std::unordered_map<string, ByteRegex> m_ofBytes;
    std::unordered_map<ustring, textkit::regex::Pattern> m_ofUnits;
    Comparator const* m_plainBytes;  ///< The registry's.
    Comparator const* m_plainUnits;
    Comparator m_matchBytes;
    Comparator m_findUnits;
};
}  // namespace tarn::kiln::internal
