// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Type` and makes it.
#pragma once
#include "tarnkiln/meta/NamedElementBuilder.h"
#include "tarnkiln/meta/TypeImpl.h"

namespace tarn::kiln::meta {

/// The values of a `Type` to be.
class TARNKILN_EXPORT Type::Impl::BuilderImpl
    : public support::BuilderValues<Type::Impl, NamedElement::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetIsVobjHidden(bool vobjHidden) { m_isVobjHidden = vobjHidden; }
    void doSetOwningPackage(Package const& owningPackage) { m_owningPackage = owningPackage; }

private:
    bool m_isVobjHidden = false;
    Package m_owningPackage;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_isVobjHidden, &BuilderImpl::m_owningPackage>;
};

/// The setters of what a `Type` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Type::Impl::BuilderBase : public NamedElement::Impl::BuilderBase<Final>
{
    using Above = NamedElement::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// Whether displays leave it out.
    Final& setIsVobjHidden(bool vobjHidden)
    {
        return this->give(IS_VOBJ_HIDDEN, &BuilderImpl::doSetIsVobjHidden, vobjHidden);
    }

    /// The package that has it.
    Final& setOwningPackage(Package const& owningPackage)
    {
        return this->give(OWNING_PACKAGE, &BuilderImpl::doSetOwningPackage, owningPackage);
    }
};

/// Describes a `Type` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Type::Builder final : public Type::Impl::BuilderBase<Type::Builder>
{
public:
    using Handle = Type;

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
    tarn::kiln::meta::Type::Impl, tarn::kiln::meta::NamedElement::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Type::Builder>;
