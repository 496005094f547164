// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `DateTimeAttribute` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/DateTimeAttributeImpl.h"

namespace tarn::kiln::meta {

/// The values of a `DateTimeAttribute` to be.
class TARNKILN_EXPORT DateTimeAttribute::Impl::BuilderImpl
    : public support::BuilderValues<DateTimeAttribute::Impl, Attribute::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetValue(boost::posix_time::ptime const& value) { m_value = value; }

private:
    boost::posix_time::ptime m_value;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_value>;
};

/// The setters of what a `DateTimeAttribute` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class DateTimeAttribute::Impl::BuilderBase : public Attribute::Impl::BuilderBase<Final>
{
    using Above = Attribute::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The value.
    Final& setValue(boost::posix_time::ptime const& value)
    {
        return this->give(VALUE, &BuilderImpl::doSetValue, value);
    }
};

/// Describes a `DateTimeAttribute` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT DateTimeAttribute::Builder final
    : public DateTimeAttribute::Impl::BuilderBase<DateTimeAttribute::Builder>
{
public:
    using Handle = DateTimeAttribute;

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
    tarn::kiln::meta::DateTimeAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::DateTimeAttribute::Builder>;
