// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `IntegerAttribute` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/IntegerAttributeImpl.h"

namespace tarn::kiln::meta {

/// The values of an `IntegerAttribute` to be.
class TARNKILN_EXPORT IntegerAttribute::Impl::BuilderImpl
    : public support::BuilderValues<IntegerAttribute::Impl, Attribute::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetValue(int value) { m_value = value; }

private:
    int m_value = 0;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_value>;
};

/// The setters of what an `IntegerAttribute` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class IntegerAttribute::Impl::BuilderBase : public Attribute::Impl::BuilderBase<Final>
{
    using Above = Attribute::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The value.
    Final& setValue(int value) { return this->give(VALUE, &BuilderImpl::doSetValue, value); }
};

/// Describes an `IntegerAttribute` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT IntegerAttribute::Builder final
    : public IntegerAttribute::Impl::BuilderBase<IntegerAttribute::Builder>
{
public:
    using Handle = IntegerAttribute;

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
    tarn::kiln::meta::IntegerAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::IntegerAttribute::Builder>;
