#include "tarnkiln/query/internal/likePattern.h"

#include "sill/i18n/StringConversion.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/query/Messages.h"

#include <algorithm>

namespace tarn::kiln::internal {
namespace {

void escape(string& pattern)
{
    constexpr char SPECIAL[] = "^$\\.*+?()[]{}|";
    // Goes on behind the character that the new backslash escapes.
    for (std::size_t at = pattern.find_first_of(SPECIAL); at != string::npos;
         at = pattern.find_first_of(SPECIAL, at + 2))
        pattern.insert(at, 1, '\\');
}

void replaceAnyText(string& pattern)
{
    for (std::size_t at = pattern.find('%'); at != string::npos; at = pattern.find('%', at + 2))
        pattern.replace(at, 1, ".*");
}
}  // namespace

string likeToRegex(string pattern)
{
    escape(pattern);
    std::replace(pattern.begin(), pattern.end(), '_', '.');
    replaceAnyText(pattern);
    return pattern;
}

Value likePattern(meta::Property const& property, Value const& pattern)
{
    if (pattern.getFlags() != ValueFlags::Single)
        reportException(tarnkiln::query::LikePatternNotSingle());
    meta::StandardTypes::ensureInitialized();
    meta::Type const type = property->getType();
    if (type == meta::StandardTypes::stringMeta)
        return Value(type, sill::i18n::to_ustring(
                               likeToRegex(sill::i18n::to_string(pattern.getValue<ustring>()))));
    if (type == meta::StandardTypes::stdstringMeta)
        return Value(type, likeToRegex(pattern.getValue<string>()));
    reportException(tarnkiln::query::LikePatternNotString());
}
}  // namespace tarn::kiln::internal
