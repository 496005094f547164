// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `RealAttribute` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/RealAttributeImpl.h"

namespace tarn::kiln::meta {

/// The values of a `RealAttribute` to be.
class TARNKILN_EXPORT RealAttribute::Impl::BuilderImpl
    : public support::BuilderValues<RealAttribute::Impl, Attribute::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetValue(double value) { m_value = value; }

private:
    double m_value = 0;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_value>;
};

/// The setters of what a `RealAttribute` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class RealAttribute::Impl::BuilderBase : public Attribute::Impl::BuilderBase<Final>
{
    using Above = Attribute::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The value.
    Final& setValue(double value) { return this->give(VALUE, &BuilderImpl::doSetValue, value); }
};

/// Describes a `RealAttribute` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT RealAttribute::Builder final
    : public RealAttribute::Impl::BuilderBase<RealAttribute::Builder>
{
public:
    using Handle = RealAttribute;

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
    tarn::kiln::meta::RealAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::RealAttribute::Builder>;
