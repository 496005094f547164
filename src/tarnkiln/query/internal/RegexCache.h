/// \file
/// The regular expressions of one run.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/query/internal/ByteRegex.h"
#include "tarnkiln/query/internal/findComparator.h"
#include "textkit/regex/Pattern.h"

#include <tuple>
#include <type_traits>
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

    /// What patterns for 8-bit and for UTF-16 texts are compiled to.
    template <class Text>
    using Compiled =
        std::conditional_t<std::is_same_v<Text, string>, ByteRegex, textkit::regex::Pattern>;

    /// Lives as long as this object.
    ///
    /// \throws std::regex_error  if `pattern`, an 8-bit text, is no regular expression.
    /// \throws textkit::regex::RegexError  if it is a UTF-16 text and none.
    template <class Text> Compiled<Text> const& compiled(Text const& pattern);

    /// Whether all of the text matches.
    static bool matches(ByteRegex const& regex, string const& text) { return regex.matches(text); }
    /// Whether a match is found somewhere in the text.
    static bool matches(textkit::regex::Pattern const& regex, ustring const& text)
    {
        return regex.isFoundIn(text);
    }

    /// What does the same as `comparator`, a comparator of the registry, without compiling patterns
    /// anew; lives as long as this object.
    Comparator const& withCache(Comparator const& comparator) const;

private:
    template <class Text> using Table = std::unordered_map<Text, Compiled<Text>>;

    std::tuple<Table<string>, Table<ustring>> m_tables;
    Comparator const* m_plainBytes;  ///< The registry's.
    Comparator const* m_plainUnits;
    Comparator m_matchBytes;
    Comparator m_findUnits;
};

template <class Text> RegexCache::Compiled<Text> const& RegexCache::compiled(Text const& pattern)
{
    auto& table = std::get<Table<Text>>(m_tables);
    auto const found = table.find(pattern);
    return found != table.end() ? found->second
                                : table.emplace(pattern, Compiled<Text>(pattern)).first->second;
}
}  // namespace tarn::kiln::internal
