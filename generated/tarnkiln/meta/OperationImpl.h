// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `Operation`.
#pragma once
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/meta/Argument.h"
#include "tarnkiln/meta/Operation.h"
#include "tarnkiln/meta/StructuredType.h"
#include "tarnkiln/meta/TypedElementImpl.h"
#include "tarnkiln/support/Dispatch.h"

#include <memory>

namespace tarn::kiln::meta {

/// The properties of an `Operation`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Operation::Impl
    : public support::Dispatched<Operation::Impl, TypedElement::Impl>
{
public:
    class BuilderImpl;                         // OperationBuilder.h
    template <class Final> class BuilderBase;  // OperationBuilder.h

    using Handle = Operation;
    using Storage = support::Record<Impl, TypedElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 12;
    static Slot const ARGUMENTS;
    static Slot const OWNING_TYPE;
    static Slot const IS_ABSTRACT;
    static Slot const IS_STATIC;
    static Slot const IS_PUBLIC;
    static Slot const IS_EVENT;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The arguments, in the order of the call.
    ElementSequence<Argument>& getArguments() const;
    /// Whether the collection was made, as its getter does.
    bool hasArguments() const { return m_arguments.get(); }

    /// The type that offers it.
    StructuredType getOwningType() const;
    StructuredType::Impl* getOwningTypeImpl() const;
    /// Whether there is one and it is live.
    bool hasOwningType() const;
    void setOwningType(StructuredType const& owningType);

    /// Whether only subclasses supply a body.
    bool isAbstract() const { return m_isAbstract; }
    void setIsAbstract(bool abstract);

    /// Whether it needs no element.
    bool isStatic() const { return m_isStatic; }
    void setIsStatic(bool value);

    /// Whether any client may call it.
    bool isPublic() const { return m_isPublic; }
    void setIsPublic(bool value);

    /// Whether a call is deferred to the end of the transaction.
    bool isEvent() const { return m_isEvent; }
    void setIsEvent(bool event);

    /// Gives it another name, under which the owner then keeps it.
    void setName(ustring const& name) override;

    /// Gives the operation what calls by reflection run, in place of what it had. Null takes that
    /// away. Is no change of the model: nothing is announced, recorded or copied.
    void setInvoker(std::unique_ptr<AbstractMethodInvoker> invoker);

    /// What calls by reflection run; null if there is nothing.
    std::shared_ptr<AbstractMethodInvoker> const& getInvoker() const { return m_invoker; }

private:
    static std::unique_ptr<ElementSequence<Argument>> makeArguments(Impl* owner);

    mutable support::LazyCollection<ElementSequence<Argument>> m_arguments;
    bool m_isAbstract = false;
    bool m_isStatic = false;
    bool m_isPublic = true;
    bool m_isEvent = false;
    std::shared_ptr<AbstractMethodInvoker> m_invoker;

public:
    using Rows = support::RowList<
        support::References<
            &Impl::m_arguments, ARGUMENTS, &Impl::makeArguments, &Impl::getArguments>,
        support::Container<StructuredType, OWNING_TYPE, &Impl::setOwningType>,
        support::Scalar<&Impl::m_isAbstract, IS_ABSTRACT, &Impl::setIsAbstract>,
        support::Scalar<&Impl::m_isStatic, IS_STATIC, &Impl::setIsStatic>,
        support::Scalar<&Impl::m_isPublic, IS_PUBLIC, &Impl::setIsPublic>,
        support::Scalar<&Impl::m_isEvent, IS_EVENT, &Impl::setIsEvent>>;
};

inline Operation::Operation(Impl* impl) : TypedElement(impl) {}
inline Operation::Impl* Operation::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Operation::Impl* Operation::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Operation::Impl, tarn::kiln::meta::TypedElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Operation::Impl, tarn::kiln::meta::TypedElement::Impl>;
