/// \file
/// What runs when an operation is called by reflection.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/meta/Operation.h"

#include <boost/optional/optional_fwd.hpp>

#include <vector>

namespace tarn::kiln::meta {

/// Calls one operation of a class with values. An `Operation` owns its invoker.
///
/// Metamodels install an `InvokerImpl` for each method. Code without methods, such as a bridge to
/// another language, derives its own.
///
/// Threads: as the elements on which it is invoked; one invoker may run on several threads at once.
class TARNKILN_EXPORT AbstractMethodInvoker
{
public:
    AbstractMethodInvoker() = default;
    AbstractMethodInvoker(AbstractMethodInvoker const&) = delete;
    AbstractMethodInvoker& operator=(AbstractMethodInvoker const&) = delete;
    virtual ~AbstractMethodInvoker();

    /// Calls the operation on `self`. Whether `self` has the operation, and whether the caller may
    /// use it, was tested before.
    ///
    /// \returns the result; none if the operation has none.
    virtual boost::optional<Value> invoke(ModelElement const& self,
                                          std::vector<Value> const& arguments) const = 0;

    /// The operation that this one was given to last; empty before.
    Operation getOperation() const;

private:
    friend class Operation::Impl;

    /// Not counted: the operation owns this, and owners that own each other never go.
    Operation::Impl* m_operation = nullptr;
};
}  // namespace tarn::kiln::meta
