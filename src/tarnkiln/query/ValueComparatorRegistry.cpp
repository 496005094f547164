#include "tarnkiln/query/ValueComparatorRegistry.h"

#include "sill/i18n/StringConversion.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/query/Messages.h"
#include "tarnkiln/query/internal/ByteRegex.h"
#include "textkit/regex/RegexSearch.h"

#include <boost/container_hash/hash.hpp>
#include <boost/date_time/posix_time/posix_time_types.hpp>
#include <boost/optional.hpp>

#include <algorithm>
#include <locale>
#include <unordered_map>
#include <utility>

namespace tarn::kiln::query {
namespace {

using Comparator = ValueComparatorRegistry::Comparator;

bool isEqual(Value const& left, Value const& right)
{
    return left == right;
}

bool isNotEqual(Value const& left, Value const& right)
{
    return !(left == right);
}

/// `compare` on the payloads; both are required.
template <class T, class Compare> bool compareRequired(Value const& left, Value const& right)
{
    T const first = left.getValue<T>();
    return Compare()(first, right.getValue<T>());
}

/// False if one is absent.
template <class T, class Compare> bool compareOptional(Value const& left, Value const& right)
{
    auto const first = left.getValue<boost::optional<T>>();
    auto const second = right.getValue<boost::optional<T>>();
    return first && second && Compare()(*first, *second);
}

/// The number of a literal, of which there must be one.
int literalOf(Value const& value)
{
    if (value.getFlags() != ValueFlags::Single)
        value.checkCompatible<long>();  // raises
    return static_cast<int>(value.getEnumNumber().value_or(0));
}

bool isEqualLiteral(Value const& left, Value const& right)
{
    int const first = literalOf(left);
    return first == literalOf(right);
}

bool isOtherLiteral(Value const& left, Value const& right)
{
    return !isEqualLiteral(left, right);
}

/// The answer for two literals of which one may be absent: `compare` on the numbers if there are
/// two, true if there are none.
template <class Compare> bool compareOptionalLiterals(Value const& left, Value const& right)
{
    auto const first = left.getEnumNumber();
    auto const second = right.getEnumNumber();
    if (first && second)
        return Compare()(static_cast<int>(*first), static_cast<int>(*second));
    return !first && !second;
}

bool isEqualNocase(string const& left, string const& right)
{
    std::locale const locale;
    auto const& letters = std::use_facet<std::ctype<char>>(locale);
    return std::equal(
        left.begin(), left.end(), right.begin(), right.end(),
        [&](char first, char second) { return letters.toupper(first) == letters.toupper(second); });
}

bool isEqualNocase(ustring const& left, ustring const& right)
{
    return isEqualNocase(sill::i18n::to_string(left), sill::i18n::to_string(right));
}

template <class Text> struct EqualNocase
{
    bool operator()(Text const& left, Text const& right) const
    {
        return isEqualNocase(left, right);
    }
};

template <class Text> bool isOptionalEqualNocase(Value const& left, Value const& right)
{
    auto const first = left.getValue<boost::optional<Text>>();
    auto const second = right.getValue<boost::optional<Text>>();
    if (first && second)
        return isEqualNocase(*first, *second);
    return !first && !second;
}

/// Whether all of an 8-bit text matches.
struct MatchBytes
{
    bool operator()(string const& text, string const& pattern) const
    {
        return internal::ByteRegex(pattern).matches(text);
    }
};

/// Whether the pattern is found in a UTF-16 text.
struct FindUnits
{
    bool operator()(ustring const& text, ustring const& pattern) const
    {
        return textkit::regex::regex_search(text, pattern, /*caseSensitive=*/true, /*options=*/0);
    }
};

struct Key
{
    meta::Type type;
    bool required;
    ValueMatchRelation relation;

    bool operator==(Key const& other) const = default;
};

struct KeyHash
{
    std::size_t operator()(Key const& key) const
    {
        std::size_t hash = 0;
        boost::hash_combine(hash, key.type.getElementImpl());
        boost::hash_combine(hash, key.required);
        boost::hash_combine(hash, static_cast<int>(key.relation));
        return hash;
    }
};

class ValueComparatorRegistryLocal final : public ValueComparatorRegistry
{
public:
    ValueComparatorRegistryLocal();

    Comparator const* findComparator(ValueMatchRelation relation, meta::Type const& type,
                                     bool required) const override;

private:
    template <class T> void registerComparatorsForType(meta::Type const& type);
    void add(meta::Type const& type, bool required, ValueMatchRelation relation,
             Comparator comparator);

    std::unordered_map<Key, Comparator, KeyHash> m_comparators;
};

ValueComparatorRegistryLocal::ValueComparatorRegistryLocal()
{
    using enum ValueMatchRelation;
    using meta::StandardTypes;

    registerComparatorsForType<ustring>(StandardTypes::stringMeta);
    registerComparatorsForType<int>(StandardTypes::integerMeta);
    registerComparatorsForType<signed char>(StandardTypes::integer8Meta);
    registerComparatorsForType<short>(StandardTypes::integer16Meta);
    registerComparatorsForType<long>(StandardTypes::integer64Meta);
    registerComparatorsForType<double>(StandardTypes::realMeta);
    registerComparatorsForType<bool>(StandardTypes::booleanMeta);
    registerComparatorsForType<unsigned char>(StandardTypes::uinteger8Meta);
    registerComparatorsForType<unsigned short>(StandardTypes::uinteger16Meta);
    registerComparatorsForType<unsigned int>(StandardTypes::unlimitedNaturalMeta);
    registerComparatorsForType<unsigned long>(StandardTypes::uinteger64Meta);
    registerComparatorsForType<UUID>(StandardTypes::uuidMeta);
    registerComparatorsForType<boost::posix_time::ptime>(StandardTypes::dateTimeMeta);
    registerComparatorsForType<string>(StandardTypes::stdstringMeta);

    meta::Type const ofClasses = meta::Class::metaClass();
    add(ofClasses, true, equal, isEqual);
    add(ofClasses, true, notEqual, isNotEqual);

    meta::Type const ofEnums = meta::Enum::metaClass();
    add(ofEnums, true, equal, isEqualLiteral);
    add(ofEnums, false, equal, compareOptionalLiterals<std::equal_to<>>);
    add(ofEnums, true, notEqual, isOtherLiteral);
    add(ofEnums, false, notEqual, compareOptionalLiterals<std::not_equal_to<>>);

    meta::Type const bytes = StandardTypes::stdstringMeta;
    meta::Type const units = StandardTypes::stringMeta;
    add(bytes, true, equalStringNocase, compareRequired<string, EqualNocase<string>>);
    add(bytes, false, equalStringNocase, isOptionalEqualNocase<string>);
    add(units, true, equalStringNocase, compareRequired<ustring, EqualNocase<ustring>>);
    add(units, false, equalStringNocase, isOptionalEqualNocase<ustring>);
    add(bytes, true, regexp, compareRequired<string, MatchBytes>);
    add(units, true, regexp, compareRequired<ustring, FindUnits>);
}

template <class T>
void ValueComparatorRegistryLocal::registerComparatorsForType(meta::Type const& type)
{
    using enum ValueMatchRelation;

    for (bool const required : {true, false})
    {
        add(type, required, equal, isEqual);
        add(type, required, notEqual, isNotEqual);
    }
    add(type, true, greater, compareRequired<T, std::greater<>>);
    add(type, true, greaterOrEqual, compareRequired<T, std::greater_equal<>>);
    add(type, true, less, compareRequired<T, std::less<>>);
    add(type, true, lessOrEqual, compareRequired<T, std::less_equal<>>);
    add(type, false, greater, compareOptional<T, std::greater<>>);
    add(type, false, greaterOrEqual, compareOptional<T, std::greater_equal<>>);
    add(type, false, less, compareOptional<T, std::less<>>);
    add(type, false, lessOrEqual, compareOptional<T, std::less_equal<>>);
}

void ValueComparatorRegistryLocal::add(meta::Type const& type, bool required,
                                       ValueMatchRelation relation, Comparator comparator)
{
    m_comparators.emplace(Key{type, required, relation}, std::move(comparator));
}

Comparator const* ValueComparatorRegistryLocal::findComparator(ValueMatchRelation relation,
                                                               meta::Type const& type,
                                                               bool required) const
{
    if (!type.getElementImpl())
        return nullptr;
    meta::Class const& kind = type->getMetaClass();
    Key key{type, required, relation};
    if (kind == meta::Class::metaClass())
        key = {kind, true, relation};
    else if (kind == meta::Enum::metaClass())
        key.type = kind;
    auto const found = m_comparators.find(key);
    return found == m_comparators.end() ? nullptr : &found->second;
}
}  // namespace

ValueComparatorRegistry const& ValueComparatorRegistry::getInstance()
{
    // The catalogue takes the registry's lock, and whoever holds that may come here.
    meta::StandardTypes::ensureInitialized();
    meta::Enum::metaClass();
    static auto const* const instance = new ValueComparatorRegistryLocal();
    return *instance;
}

Comparator const* ValueComparatorRegistry::getComparator(ValueMatchRelation relation,
                                                         meta::Type const& type,
                                                         bool required) const
{
    Comparator const* const found = findComparator(relation, type, required);
    if (!found)
        reportException(tarnkiln::query::RelationAndTypeNotSupported(
            ValueMatchRelationName(ValueMatchRelation::less),
            type.getElementImpl() ? type->getName() : ustring()));
    return found;
}
}  // namespace tarn::kiln::query
