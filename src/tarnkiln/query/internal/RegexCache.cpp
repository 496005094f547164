#include "tarnkiln/query/internal/RegexCache.h"

#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace tarn::kiln::internal {
namespace {

Comparator const* regexpOf(meta::Type const& type)
{
    return query::ValueComparatorRegistry::getInstance().findComparator(
        query::ValueMatchRelation::regexp, type, /*required=*/true);
}
}  // namespace

RegexCache::RegexCache()
    : m_plainBytes(regexpOf(meta::StandardTypes::stdstringMeta)),
      m_plainUnits(regexpOf(meta::StandardTypes::stringMeta)),
      m_matchBytes([this](Value const& text, Value const& pattern) {
          string const subject = text.getValue<string>();
          return ofBytes(pattern.getValue<string>()).matches(subject);
      }),
      m_findUnits([this](Value const& text, Value const& pattern) {
          ustring const subject = text.getValue<ustring>();
          return ofUnits(pattern.getValue<ustring>()).isFoundIn(subject);
      })
{}

ByteRegex const& RegexCache::ofBytes(string const& pattern)
{
    auto const found = m_ofBytes.find(pattern);
    return found != m_ofBytes.end() ? found->second
                                    : m_ofBytes.emplace(pattern, ByteRegex(pattern)).first->second;
}

textkit::regex::Pattern const& RegexCache::ofUnits(ustring const& pattern)
{
    auto const found = m_ofUnits.find(pattern);
    return found != m_ofUnits.end()
               ? found->second
               : m_ofUnits.emplace(pattern, textkit::regex::Pattern(pattern)).first->second;
}

Comparator const& RegexCache::withCache(Comparator const& comparator) const
{
    if (&comparator == m_plainBytes)
        return m_matchBytes;
    return &comparator == m_plainUnits ? m_findUnits : comparator;
}
}  // namespace tarn::kiln::internal
