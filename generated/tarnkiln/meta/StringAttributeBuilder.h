// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `StringAttribute` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/StringAttributeImpl.h"

namespace tarn::kiln::meta {

/// The values of a `StringAttribute` to be.
class TARNKILN_EXPORT StringAttribute::Impl::BuilderImpl
    : public support::BuilderValues<StringAttribute::Impl, Attribute::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetValue(ustring const& value) { m_value = value; }

private:
    ustring m_value;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_value>;
};

/// The setters of what a `StringAttribute` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class StringAttribute::Impl::BuilderBase : public Attribute::Impl::BuilderBase<Final>
{
    using Above = Attribute::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The value.
    Final& setValue(ustring const& value)
    {
        return this->give(VALUE, &BuilderImpl::doSetValue, value);
    }
};

/// Describes a `StringAttribute` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT StringAttribute::Builder final
    : public StringAttribute::Impl::BuilderBase<StringAttribute::Builder>
{
public:
    using Handle = StringAttribute;

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
    tarn::kiln::meta::StringAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::StringAttribute::Builder>;
