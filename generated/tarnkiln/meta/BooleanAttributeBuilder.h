// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `BooleanAttribute` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/BooleanAttributeImpl.h"

namespace tarn::kiln::meta {

/// The values of a `BooleanAttribute` to be.
class TARNKILN_EXPORT BooleanAttribute::Impl::BuilderImpl
    : public support::BuilderValues<BooleanAttribute::Impl, Attribute::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetValue(bool value) { m_value = value; }

private:
    bool m_value = false;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_value>;
};

/// The setters of what a `BooleanAttribute` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class BooleanAttribute::Impl::BuilderBase : public Attribute::Impl::BuilderBase<Final>
{
    using Above = Attribute::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The value.
    Final& setValue(bool value) { return this->give(VALUE, &BuilderImpl::doSetValue, value); }
};

/// Describes a `BooleanAttribute` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT BooleanAttribute::Builder final
    : public BooleanAttribute::Impl::BuilderBase<BooleanAttribute::Builder>
{
public:
    using Handle = BooleanAttribute;

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
    tarn::kiln::meta::BooleanAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::BooleanAttribute::Builder>;
