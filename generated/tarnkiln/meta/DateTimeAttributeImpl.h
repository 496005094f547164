// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `DateTimeAttribute`.
#pragma once
#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/meta/DateTimeAttribute.h"
#include "tarnkiln/support/Dispatch.h"

#include <boost/date_time/posix_time/ptime.hpp>

namespace tarn::kiln::meta {

/// The properties of a `DateTimeAttribute`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT DateTimeAttribute::Impl
    : public support::Dispatched<DateTimeAttribute::Impl, Attribute::Impl>
{
public:
    class BuilderImpl;                         // DateTimeAttributeBuilder.h
    template <class Final> class BuilderBase;  // DateTimeAttributeBuilder.h

    using Handle = DateTimeAttribute;
    using Storage = support::Record<Impl, Attribute::Impl::Storage>;

    static constexpr unsigned long SLOTS = 4;
    static Slot const VALUE;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The value.
    boost::posix_time::ptime const& getValue() const { return m_value; }
    void setValue(boost::posix_time::ptime const& value);
    Type getType() const override;

private:
    boost::posix_time::ptime m_value;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_value, VALUE, &Impl::setValue>>;
};

inline DateTimeAttribute::DateTimeAttribute(Impl* impl) : Attribute(impl) {}
inline DateTimeAttribute::Impl* DateTimeAttribute::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline DateTimeAttribute::Impl* DateTimeAttribute::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::DateTimeAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::DateTimeAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
