// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `TypedElement` and makes it.
#pragma once
#include "tarnkiln/meta/NamedElementBuilder.h"
#include "tarnkiln/meta/TypedElementImpl.h"

namespace tarn::kiln::meta {

/// The values of a `TypedElement` to be.
class TARNKILN_EXPORT TypedElement::Impl::BuilderImpl
    : public support::BuilderValues<TypedElement::Impl, NamedElement::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetType(Type const& type) { m_type = type; }
    void doSetLower(std::uint32_t lower) { m_lower = lower; }
    void doSetUpper(std::uint32_t upper) { m_upper = upper; }
    void doSetIsOrdered(bool ordered) { m_isOrdered = ordered; }

private:
    Type m_type;
    std::uint32_t m_lower = 0;
    std::uint32_t m_upper = 0;
    bool m_isOrdered = false;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_type, &BuilderImpl::m_lower, &BuilderImpl::m_upper,
        &BuilderImpl::m_isOrdered>;
};

/// The setters of what a `TypedElement` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class TypedElement::Impl::BuilderBase : public NamedElement::Impl::BuilderBase<Final>
{
    using Above = NamedElement::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The type of the value.
    Final& setType(Type const& type) { return this->give(TYPE, &BuilderImpl::doSetType, type); }

    /// The least number of values.
    Final& setLower(std::uint32_t lower)
    {
        return this->give(LOWER, &BuilderImpl::doSetLower, lower);
    }

    /// The greatest number of values; 0xFFFFFFFF means unbounded.
    Final& setUpper(std::uint32_t upper)
    {
        return this->give(UPPER, &BuilderImpl::doSetUpper, upper);
    }

    /// Whether the values have positions.
    Final& setIsOrdered(bool ordered)
    {
        return this->give(IS_ORDERED, &BuilderImpl::doSetIsOrdered, ordered);
    }
};

/// Describes a `TypedElement` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT TypedElement::Builder final
    : public TypedElement::Impl::BuilderBase<TypedElement::Builder>
{
public:
    using Handle = TypedElement;

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
    tarn::kiln::meta::TypedElement::Impl, tarn::kiln::meta::NamedElement::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::TypedElement::Builder>;
