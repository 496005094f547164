#include "tarnkiln/query/internal/ValueTest.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/PackedPayload.h"
#include "tarnkiln/meta/internal/PayloadAccess.h"

#include <cstring>
#include <functional>

namespace tarn::kiln::internal {
namespace {

using Answer = ValueTest::Answer;
using support::PayloadAccess;

template <class T, class Compare> bool comparePayloads(KeptValue const& value, void const* other)
{
    return Compare()(payloadOf<T>(value), *static_cast<T const*>(other));
}

template <class Compare> bool compareLiterals(KeptValue const& value, void const* other)
{
    int number = 0;
    std::memcpy(&number, value.payload, sizeof number);
    return Compare()(number, *static_cast<int const*>(other));
}

Answer answer(bool yes)
{
    return yes ? Answer::Yes : Answer::No;
}

/// Whether the comparators of the registry take the value for a `T`.
template <class T> bool isReadable(Value const& value)
{
    try
    {
        value.checkCompatible<T>();
    }
    catch (tarnkiln::messages::CannotCastIncompatibleTypes const&)
    {
        return false;
    }
    return true;
}

/// Equality is that of `Value`: of type and shape too.
template <class T> ValueTest makeEquality(Value const& other, meta::Type const& type, bool wanted)
{
    ValueTest test;
    T const* const payload = PayloadAccess::get<T>(other);
    if (PayloadAccess::address(other) && !payload)
        return test;
    bool const isSameType = other.getType() == type;
    auto const forShape = [&](ValueFlags shape) {
        return isSameType && payload && other.getFlags() == shape ? Answer::Compare
                                                                  : answer(!wanted);
    };
    test.single = forShape(ValueFlags::Single);
    test.optional = forShape(ValueFlags::OptionalSingle);
    bool const isSameAbsence =
        isSameType && !payload && other.getFlags() == ValueFlags::OptionalSingle;
    test.absent = answer(isSameAbsence == wanted);
    test.compare =
        wanted ? comparePayloads<T, std::equal_to<>> : comparePayloads<T, std::not_equal_to<>>;
    test.other = payload;
    return test;
}
}  // namespace

template <class T>
ValueTest ValueTests::makeOrdering(PropertyRelationValueConstraint const& constraint, bool required,
                                   bool (*compare)(KeptValue const&, void const*))
{
    ValueTest test;
    Value const& other = constraint.getValue();
    T const* const payload = PayloadAccess::get<T>(other);
    if (required ? !isReadable<T>(other) || !payload : !isReadable<boost::optional<T>>(other))
        return test;
    test.single = payload ? Answer::Compare : Answer::No;
    if (!required)
    {
        test.optional = test.single;
        test.absent = Answer::No;
    }
    test.compare = compare;
    test.other = payload;
    return test;
}

template <class Text>
ValueTest ValueTests::makeRegexp(PropertyRelationValueConstraint const& constraint)
{
    ValueTest test;
    Text const* const pattern = PayloadAccess::get<Text>(constraint.getValue());
    if (!pattern || !isReadable<Text>(constraint.getValue()))
        return test;
    test.single = Answer::Compare;
    auto& regexes = std::get<std::deque<LazyRegex<Text>>>(m_lazyRegexes);
    test.other = &regexes.emplace_back(LazyRegex<Text>{m_regexes, *pattern});
    test.compare = [](KeptValue const& value, void const* other) {
        return static_cast<LazyRegex<Text> const*>(other)->matches(Text(payloadOf<Text>(value)));
    };
    return test;
}

ValueTest ValueTests::makeForLiteral(PropertyRelationValueConstraint const& constraint,
                                     bool required)
{
    ValueTest test;
    Value const& other = constraint.getValue();
    bool const wanted = constraint.getRelation() == ValueMatchRelation::equal;
    boost::optional<long> number;
    try
    {
        number = other.getEnumNumber();
    }
    catch (tarnkiln::messages::CannotCastIncompatibleTypes const&)
    {
        return test;
    }
    if (required && (other.getFlags() != ValueFlags::Single || !number))
        return test;

    test.single = number ? Answer::Compare : Answer::No;
    if (!required)
    {
        test.optional = test.single;
        test.absent = answer(!number);
    }
    test.compare = wanted ? compareLiterals<std::equal_to<>> : compareLiterals<std::not_equal_to<>>;
    test.other = &m_numbers.emplace_back(static_cast<int>(number.value_or(0)));
    return test;
}

template <class T>
ValueTest ValueTests::makeFor(PropertyRelationValueConstraint const& constraint,
                              meta::Type const& type)
{
    auto const& registry = query::ValueComparatorRegistry::getInstance();
    ValueMatchRelation const relation = constraint.getRelation();
    // What was required when the constraint was made may be optional by now.
    bool const required =
        &constraint.getComparator() == registry.findComparator(relation, type, true);
    bool const isOptional =
        &constraint.getComparator() == registry.findComparator(relation, type, false);
    if (!required && !isOptional)
        return ValueTest();

    switch (relation)
    {
    case ValueMatchRelation::equal:
        return makeEquality<T>(constraint.getValue(), type, /*wanted=*/true);
    case ValueMatchRelation::notEqual:
        return makeEquality<T>(constraint.getValue(), type, /*wanted=*/false);
    case ValueMatchRelation::greater:
        return makeOrdering<T>(constraint, required, comparePayloads<T, std::greater<>>);
    case ValueMatchRelation::greaterOrEqual:
        return makeOrdering<T>(constraint, required, comparePayloads<T, std::greater_equal<>>);
    case ValueMatchRelation::less:
        return makeOrdering<T>(constraint, required, comparePayloads<T, std::less<>>);
    case ValueMatchRelation::lessOrEqual:
        return makeOrdering<T>(constraint, required, comparePayloads<T, std::less_equal<>>);
    case ValueMatchRelation::regexp:
        if constexpr (std::is_same_v<T, string> || std::is_same_v<T, ustring>)
            return makeRegexp<T>(constraint);
        break;
    default:
        break;
    }
    return ValueTest();
}

ValueTest ValueTests::make(PropertyRelationValueConstraint const& constraint, SlotKind kind,
                           meta::Type const& type)
{
    if (kind == SlotKind::Enumeration)
    {
        auto const& registry = query::ValueComparatorRegistry::getInstance();
        auto const isComparator = [&](bool required) {
            return &constraint.getComparator() ==
                   registry.findComparator(constraint.getRelation(), type, required);
        };
        if (isComparator(true) || isComparator(false))
            return makeForLiteral(constraint, isComparator(true));
        return ValueTest();
    }
    return withPayloadType(kind, [&]<class T>() { return makeFor<T>(constraint, type); });
}
}  // namespace tarn::kiln::internal
