/// \file
/// What the values of a member are compared with, and how that becomes a `Value`.
#pragma once
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/reportException.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/support/PlainField.h"

#include <boost/none_t.hpp>
#include <boost/optional.hpp>

#include <concepts>
#include <string_view>
#include <type_traits>
#include <utility>

namespace tarn::kiln::query {

/// Texts of either width.
template <class T>
concept Text = support::OneOf<T, ustring, string>;

/// The integers that have a value and are no characters.
template <class T>
concept Number =
    std::integral<T> && !support::OneOf<T, bool, char, wchar_t, char8_t, char16_t, char32_t>;

/// Values of data types, which have several fields.
template <class T>
concept Composed =
    support::isDataType<T> || support::OneOf<T, meta::TransactionOrigin, meta::ExtensionPrototype>;

/// Whether a `V` can be written as a value of `T`: the same type, a text of the same width, or
/// a number where numbers are kept.
template <class V, class T>
concept ValueFor =
    std::same_as<V, T> ||
    (Text<T>&& std::convertible_to<V const&, std::basic_string_view<typename T::value_type>>) ||
    (Number<T> && Number<V>) || (std::same_as<T, double> && (Number<V> || std::floating_point<V>));

template <class V> inline constexpr bool isOptional = false;
template <class V> inline constexpr bool isOptional<boost::optional<V>> = true;
template <> inline constexpr bool isOptional<boost::none_t> = true;

/// The same, or an optional one, or none.
template <class V, class T>
concept OperandFor = ValueFor<V, T> || std::same_as<V, boost::none_t> ||
    (isOptional<V>&& requires(V const& value) {
        requires ValueFor<std::remove_cvref_t<decltype(*value)>, T>;
    });

/// `value` as a `T`.
///
/// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the property's type)
///     if it is a number that no `T` can be.
template <class T, ValueFor<T> V> T toPlain(meta::Property const& property, V const& value)
{
    if constexpr (std::same_as<V, T>)
        return value;
    else if constexpr (Text<T>)
        return T(std::basic_string_view<typename T::value_type>(value));
    else if constexpr (Number<T>)
    {
        if (!std::in_range<T>(value))
            reportException(tarnkiln::messages::CannotCastIncompatibleTypes(
                property->getType()->getQualifiedName()));
        return static_cast<T>(value);
    }
    else
        return static_cast<T>(value);
}

template <class T, OperandFor<T> V>
boost::optional<T> toOptional(meta::Property const& property, V const& operand)
{
    if constexpr (std::same_as<V, boost::none_t>)
        return boost::none;
    else if constexpr (ValueFor<V, T>)
        return toPlain<T>(property, operand);
    else
        return operand ? boost::optional<T>(toPlain<T>(property, *operand)) : boost::none;
}

/// A value that equals the one that an element with `operand` in `property` answers with, or such
/// an entry if the property has many values: type, shape and payload are the same.
template <class T>
Value operandValue(meta::Property const& property, boost::optional<T> const& operand)
{
    bool const isOptional = ValueMeta::doGetFlags(property) == ValueFlags::OptionalSingle;
    if (isOptional || !operand)
        return support::PlainField<boost::optional<T>>::toValue(property, operand);
    return support::PlainField<T>::toValue(property, *operand);
}
}  // namespace tarn::kiln::query
