// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Operation` and makes it.
#pragma once
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/TypedElementBuilder.h"

#include <memory>
#include <utility>

namespace tarn::kiln::meta {

/// The values of an `Operation` to be.
class TARNKILN_EXPORT Operation::Impl::BuilderImpl
    : public support::BuilderValues<Operation::Impl, TypedElement::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doAddArguments(std::unique_ptr<ModelElement::Builder> arguments)
    {
        support::addNested(m_arguments, std::move(arguments));
    }
    void doClearArguments() { m_arguments.clear(); }
    void doSetOwningType(StructuredType const& owningType) { m_owningType = owningType; }
    void doSetIsAbstract(bool abstract) { m_isAbstract = abstract; }
    void doSetIsStatic(bool value) { m_isStatic = value; }
    void doSetIsPublic(bool value) { m_isPublic = value; }
    void doSetIsEvent(bool event) { m_isEvent = event; }

private:
    support::NestedBuilders m_arguments;
    StructuredType m_owningType;
    bool m_isAbstract = false;
    bool m_isStatic = false;
    bool m_isPublic = true;
    bool m_isEvent = false;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_arguments, &BuilderImpl::m_owningType, &BuilderImpl::m_isAbstract,
        &BuilderImpl::m_isStatic, &BuilderImpl::m_isPublic, &BuilderImpl::m_isEvent>;
};

/// The setters of what an `Operation` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Operation::Impl::BuilderBase : public TypedElement::Impl::BuilderBase<Final>
{
    using Above = TypedElement::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The arguments, in the order of the call.
    Final& addArguments(std::unique_ptr<ModelElement::Builder> arguments)
    {
        return this->give(ARGUMENTS, &BuilderImpl::doAddArguments, std::move(arguments));
    }
    Final& clearArguments() { return this->give(ARGUMENTS, &BuilderImpl::doClearArguments); }

    /// The type that offers it.
    Final& setOwningType(StructuredType const& owningType)
    {
        return this->give(OWNING_TYPE, &BuilderImpl::doSetOwningType, owningType);
    }

    /// Whether only subclasses supply a body.
    Final& setIsAbstract(bool abstract)
    {
        return this->give(IS_ABSTRACT, &BuilderImpl::doSetIsAbstract, abstract);
    }

    /// Whether it needs no element.
    Final& setIsStatic(bool value)
    {
        return this->give(IS_STATIC, &BuilderImpl::doSetIsStatic, value);
    }

    /// Whether any client may call it.
    Final& setIsPublic(bool value)
    {
        return this->give(IS_PUBLIC, &BuilderImpl::doSetIsPublic, value);
    }

    /// Whether a call is deferred to the end of the transaction.
    Final& setIsEvent(bool event)
    {
        return this->give(IS_EVENT, &BuilderImpl::doSetIsEvent, event);
    }
};

/// Describes an `Operation` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Operation::Builder final
    : public Operation::Impl::BuilderBase<Operation::Builder>
{
public:
    using Handle = Operation;

    /// For a builder inside another one, whose model it takes.
    Builder();
    explicit Builder(Model const& model);
    ~Builder() override;

private:
    friend class support::BuilderTop<Builder>;

    Impl::BuilderImpl m_values{*this};
};
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Operation::Impl, tarn::kiln::meta::TypedElement::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Operation::Builder>;
