/// \file
/// The steps of a call by reflection: from values to the arguments of a method, and from its result
/// to a value.
#pragma once
#include "tarnkiln/kernel/ElementImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Operation.h"

#include <cstddef>
#include <type_traits>
#include <vector>

namespace tarn::kiln::support {

/// Enumerations of metamodels travel as the number of a literal.
template <class T>
concept LiteralNumber = std::is_enum_v<T> && !Payload<T>;

/// What a call holds for a parameter while it runs.
template <class Parameter>
using Converted =
    std::conditional_t<CollectionReference<Parameter>, Parameter, std::remove_cvref_t<Parameter>>;

/// Fails with `InvalidValue` unless there are as many arguments as `expected`.
TARNKILN_EXPORT void requireArguments(std::vector<Value> const& arguments, std::size_t expected);
/// Fails with `InvalidValue` unless the element is of the method's class.
TARNKILN_EXPORT void requireInstance(bool isInstance);
/// The type of the result of `operation`; empty for an empty operation.
TARNKILN_EXPORT meta::Type resultTypeOf(meta::Operation const& operation);

/// `argument` as the method takes it.
///
/// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the argument's type)
///     if it is something else.
template <class Parameter> Converted<Parameter> convertArgument(Value const& argument)
{
    using Held = Converted<Parameter>;
    static_assert(!std::is_lvalue_reference_v<Parameter> || CollectionReference<Parameter> ||
                      std::is_const_v<std::remove_reference_t<Parameter>>,
                  "a method called by reflection can not give anything back in an argument");
    if constexpr (LiteralNumber<Held>)
        return static_cast<Held>(argument.getValue<long>());
    else
        return argument.getValue<Held>();
}

/// `result` as a value: of its own class if it is an element, else of the operation's type.
///
/// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the type) if the
///     result can not be of that type.
template <class R> Value toResult(R const& result, meta::Operation const& operation)
{
    if constexpr (ElementReference<R>)
    {
        ElementImpl const* const element = result.getElementImpl();
        return element ? Value(element->getMetaClass(), result)
                       : Value(resultTypeOf(operation), result);
    }
    else if constexpr (LiteralNumber<R>)
        return Value(resultTypeOf(operation), static_cast<long>(result));
    else
        return Value(resultTypeOf(operation), result);
}
}  // namespace tarn::kiln::support
