// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `AttributeMapAttribute` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/AttributeMapAttributeImpl.h"

#include <memory>
#include <utility>

namespace tarn::kiln::meta {

/// The values of an `AttributeMapAttribute` to be.
class TARNKILN_EXPORT AttributeMapAttribute::Impl::BuilderImpl
    : public support::BuilderValues<AttributeMapAttribute::Impl, Attribute::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetValue(AttributeMap const& value) { m_value = value; }
    void doAddValue(std::unique_ptr<ModelElement::Builder> value) { m_value = std::move(value); }

private:
    support::NestedElement<AttributeMap> m_value;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_value>;
};

/// The setters of what an `AttributeMapAttribute` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class AttributeMapAttribute::Impl::BuilderBase : public Attribute::Impl::BuilderBase<Final>
{
    using Above = Attribute::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The map inside.
    Final& setValue(AttributeMap const& value)
    {
        return this->give(VALUE, &BuilderImpl::doSetValue, value);
    }
    Final& setValue(std::unique_ptr<ModelElement::Builder> value)
    {
        return this->give(VALUE, &BuilderImpl::doAddValue, std::move(value));
    }
};

/// Describes an `AttributeMapAttribute` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT AttributeMapAttribute::Builder final
    : public AttributeMapAttribute::Impl::BuilderBase<AttributeMapAttribute::Builder>
{
public:
    using Handle = AttributeMapAttribute;

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
    tarn::kiln::meta::AttributeMapAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<
    tarn::kiln::meta::AttributeMapAttribute::Builder>;
