// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `UUIDAttribute` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/UUIDAttributeImpl.h"

namespace tarn::kiln::meta {

/// The values of an `UUIDAttribute` to be.
class TARNKILN_EXPORT UUIDAttribute::Impl::BuilderImpl
    : public support::BuilderValues<UUIDAttribute::Impl, Attribute::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetValue(UUID const& value) { m_value = value; }

private:
    UUID m_value{};

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_value>;
};

/// The setters of what an `UUIDAttribute` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class UUIDAttribute::Impl::BuilderBase : public Attribute::Impl::BuilderBase<Final>
{
    using Above = Attribute::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The value.
    Final& setValue(UUID const& value)
    {
        return this->give(VALUE, &BuilderImpl::doSetValue, value);
    }
};

/// Describes an `UUIDAttribute` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT UUIDAttribute::Builder final
    : public UUIDAttribute::Impl::BuilderBase<UUIDAttribute::Builder>
{
public:
    using Handle = UUIDAttribute;

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
    tarn::kiln::meta::UUIDAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::UUIDAttribute::Builder>;
