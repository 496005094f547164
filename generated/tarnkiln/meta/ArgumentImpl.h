// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `Argument`.
#pragma once
#include "tarnkiln/meta/Argument.h"
#include "tarnkiln/meta/Operation.h"
#include "tarnkiln/meta/TypedElementImpl.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of an `Argument`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Argument::Impl
    : public support::Dispatched<Argument::Impl, TypedElement::Impl>
{
public:
    class BuilderImpl;                         // ArgumentBuilder.h
    template <class Final> class BuilderBase;  // ArgumentBuilder.h

    using Handle = Argument;
    using Storage = support::Record<Impl, TypedElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 8;
    static Slot const OPERATION;
    static Slot const IS_INPUT;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The operation whose argument this is.
    Operation getOperation() const;
    Operation::Impl* getOperationImpl() const;
    /// Whether there is one and it is live.
    bool hasOperation() const;
    void setOperation(Operation const& value);

    /// Whether the caller supplies it.
    bool isInput() const { return m_isInput; }
    void setIsInput(bool input);

private:
    bool m_isInput = true;

public:
    using Rows = support::RowList<
        support::Container<Operation, OPERATION, &Impl::setOperation>,
        support::Scalar<&Impl::m_isInput, IS_INPUT, &Impl::setIsInput>>;
};

inline Argument::Argument(Impl* impl) : TypedElement(impl) {}
inline Argument::Impl* Argument::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Argument::Impl* Argument::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Argument::Impl, tarn::kiln::meta::TypedElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Argument::Impl, tarn::kiln::meta::TypedElement::Impl>;
