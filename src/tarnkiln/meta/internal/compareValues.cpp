#include "tarnkiln/meta/internal/compareValues.h"

#include "tarnkiln/collections/TotalLess.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/TransactionOrigin.h"
#include "tarnkiln/meta/internal/PayloadAccess.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <algorithm>
#include <cstddef>
#include <vector>

namespace tarn::kiln::internal {
namespace {

template <class T> int compareAs(T const& left, T const& right)
{
    constexpr support::TotalLess<T> LESS;
    return LESS(left, right) ? -1 : LESS(right, left) ? 1 : 0;
}

int compareAs(ReflectiveDataType const& left, ReflectiveDataType const& right)
{
    if (left.getDataType() != right.getDataType())
        return left.getDataType() < right.getDataType() ? -1 : 1;
    return left.compareWith(right);
}

/// Compares two payloads if both are a `T`; says whether they are.
template <class T> bool tryAs(Value const& left, Value const& right, int& result)
{
    T const* const mine = support::PayloadAccess::get<T>(left);
    T const* const theirs = support::PayloadAccess::get<T>(right);
    if (mine && theirs)
        result = compareAs(*mine, *theirs);
    return mine && theirs;
}

template <class... T> bool tryAll(Value const& left, Value const& right, int& result)
{
    return (tryAs<T>(left, right, result) || ...);
}

/// Literals keep negative numbers as great unsigned ones.
bool tryAsLiterals(Value const& left, Value const& right, int& result)
{
    bool const areLiterals = isEnumType(left.getType()) && isEnumType(right.getType());
    auto const* const mine = support::PayloadAccess::get<unsigned long>(left);
    auto const* const theirs = support::PayloadAccess::get<unsigned long>(right);
    if (!areLiterals || !mine || !theirs)
        return false;
    result = compareAs(static_cast<long>(*mine), static_cast<long>(*theirs));
    return true;
}

bool isOwnCollection(Value const& value)
{
    return !value.isManaged() && value.getFlags() > ValueFlags::Single && !value.isAbsent();
}

bool tryAsCollections(Value const& left, Value const& right, int& result)
{
    if (!isOwnCollection(left) || !isOwnCollection(right))
        return false;
    std::vector<Value> const mine = left.extractEntryValues();
    std::vector<Value> const theirs = right.extractEntryValues();
    result = 0;
    for (std::size_t i = 0; result == 0 && i < std::min(mine.size(), theirs.size()); ++i)
        result = compareValues(mine[i], theirs[i]);
    if (result == 0)
        result = compareAs(mine.size(), theirs.size());
    return true;
}

int comparePayloads(Value const& left, Value const& right)
{
    int result = 0;
    if (left.isAbsent() || right.isAbsent())
        return compareAs(!left.isAbsent(), !right.isAbsent());
    if (tryAsLiterals(left, right, result) || tryAsCollections(left, right, result) ||
        tryAll<bool, signed char, unsigned char, short, unsigned short, int, unsigned int, long,
               unsigned long, double, ustring, string, UUID, boost::posix_time::ptime,
               meta::TransactionOrigin, meta::ExtensionPrototype, Model, ModelElement,
               ReflectiveDataType>(left, right, result))
        return result;
    if (meta::DataType::cast(left.getType()) && meta::DataType::cast(right.getType()))
        return compareAs(left.toReflectiveDataType(), right.toReflectiveDataType());
    if (left.isManaged() && right.isManaged() && left.getFlags() > ValueFlags::Single)
        return compareAs(support::PayloadAccess::address(left),
                         support::PayloadAccess::address(right));
    return 0;
}
}  // namespace

int compareValues(Value const& left, Value const& right)
{
    if (int const difference = comparePayloads(left, right))
        return difference;
    if (left.getFlags() != right.getFlags())
        return left.getFlags() < right.getFlags() ? -1 : 1;
    if (left.getType() != right.getType())
        return left.getType() < right.getType() ? -1 : 1;
    return 0;
}
}  // namespace tarn::kiln::internal
