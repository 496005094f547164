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
          return matches(compiled(pattern.getValue<string>()), subject);
      }),
      m_findUnits([this](Value const& text, Value const& pattern) {
          ustring const subject = text.getValue<ustring>();
          return matches(compiled(pattern.getValue<ustring>()), subject);
      })
{}

Comparator const& RegexCache::withCache(Comparator const& comparator) const
{
    if (&comparator == m_plainBytes)
        return m_matchBytes;
    return &comparator == m_plainUnits ? m_findUnits : comparator;
}
}  // namespace tarn::kiln::internal
