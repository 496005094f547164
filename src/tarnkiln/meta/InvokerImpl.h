/// \file
/// Invokers that call a method of an element class.
///
///     operation->setInvoker(meta::makeInvoker(&Book::Impl::lend));
///     book->invoke(operation, {Value(reader.getMetaClass(), reader)}, PUBLIC_ACCESS);
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/AbstractMethodInvoker.h"
#include "tarnkiln/support/Invocation.h"

#include <memory>
#include <tuple>
#include <type_traits>
#include <utility>

namespace tarn::kiln::meta {

/// What all invokers of methods share that may change their element.
template <class R, class CImpl, class... Args> class Invoker : public AbstractMethodInvoker
{
protected:
    using Method = R (CImpl::*)(Args...);
};

/// What all invokers of methods share that leave their element as it is.
template <class R, class CImpl, class... Args> class ConstInvoker : public AbstractMethodInvoker
{
protected:
    using Method = R (CImpl::*)(Args...) const;
};

/// Calls a method of `CImpl`, or, if it is virtual, the override of the element's own class.
///
/// Arguments are read as `Value::getValue` does for the type of each parameter: plain values,
/// elements, models, optional values, containers of values, and literals of enumerations. A result
/// becomes a value of the operation's type; an element one of its own class, so that the
/// operation's type is needed for an empty handle only. `std::vector`s become unmanaged sequences.
///
/// \tparam R  void, or a value of these kinds.
template <class R, class CImpl, bool isConst, class... Args>
class InvokerImpl final : public std::conditional_t<isConst, ConstInvoker<R, CImpl, Args...>,
                                                    Invoker<R, CImpl, Args...>>
{
    using Base =
        std::conditional_t<isConst, ConstInvoker<R, CImpl, Args...>, Invoker<R, CImpl, Args...>>;

public:
    using typename Base::Method;

    explicit InvokerImpl(Method method) : m_method(method) {}

    /// All arguments are converted, from left to right, before the method runs. Its exceptions pass
    /// unchanged.
    ///
    /// \throws tarnkiln::messages::InvalidValue  if the number of arguments is not the method's, or
    ///     if `self` is no `CImpl`.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the argument's
    ///     type) for the first argument that does not suit; (qualified name of the operation's
    ///     type) if the result does not suit that.
    boost::optional<Value> invoke(ModelElement const& self,
                                  std::vector<Value> const& arguments) const override
    {
        support::requireArguments(arguments, sizeof...(Args));
        auto* const target = dynamic_cast<CImpl*>(self.getImpl());
        support::requireInstance(target != nullptr);
        return call(*target, arguments, std::index_sequence_for<Args...>());
    }

private:
    template <std::size_t... AT>
    boost::optional<Value> call(CImpl& target, [[maybe_unused]] std::vector<Value> const& arguments,
                                std::index_sequence<AT...>) const
    {
        // Braces, since they alone promise the order of conversion.
        [[maybe_unused]] std::tuple<support::Converted<Args>...> const converted{
            support::convertArgument<Args>(arguments[AT])...};
        if constexpr (std::is_void_v<R>)
        {
            (target.*m_method)(std::get<AT>(converted)...);
            return boost::none;
        }
        else
        {
            return support::toResult<std::remove_cvref_t<R>>(
                (target.*m_method)(std::get<AT>(converted)...), this->getOperation());
        }
    }

    Method const m_method;
};

/// The invoker of a method.
template <class R, class CImpl, class... Args>
std::unique_ptr<AbstractMethodInvoker> makeInvoker(R (CImpl::*method)(Args...))
{
    return std::make_unique<InvokerImpl<R, CImpl, false, Args...>>(method);
}

template <class R, class CImpl, class... Args>
std::unique_ptr<AbstractMethodInvoker> makeInvoker(R (CImpl::*method)(Args...) const)
{
    return std::make_unique<InvokerImpl<R, CImpl, true, Args...>>(method);
}
}  // namespace tarn::kiln::meta
