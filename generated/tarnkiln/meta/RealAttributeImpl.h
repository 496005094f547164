// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `RealAttribute`.
#pragma once
#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/meta/RealAttribute.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of a `RealAttribute`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT RealAttribute::Impl
    : public support::Dispatched<RealAttribute::Impl, Attribute::Impl>
{
public:
    class BuilderImpl;                         // RealAttributeBuilder.h
    template <class Final> class BuilderBase;  // RealAttributeBuilder.h

    using Handle = RealAttribute;
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
    double getValue() const { return m_value; }
    void setValue(double value);
    Type getType() const override;

private:
    double m_value = 0;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_value, VALUE, &Impl::setValue>>;
};

inline RealAttribute::RealAttribute(Impl* impl) : Attribute(impl) {}
inline RealAttribute::Impl* RealAttribute::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline RealAttribute::Impl* RealAttribute::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::RealAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::RealAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
