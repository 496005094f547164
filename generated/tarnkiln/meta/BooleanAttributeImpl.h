// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `BooleanAttribute`.
#pragma once
#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/meta/BooleanAttribute.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of a `BooleanAttribute`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT BooleanAttribute::Impl
    : public support::Dispatched<BooleanAttribute::Impl, Attribute::Impl>
{
public:
    class BuilderImpl;                         // BooleanAttributeBuilder.h
    template <class Final> class BuilderBase;  // BooleanAttributeBuilder.h

    using Handle = BooleanAttribute;
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
    bool getValue() const { return m_value; }
    void setValue(bool value);
    Type getType() const override;

private:
    bool m_value = false;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_value, VALUE, &Impl::setValue>>;
};

inline BooleanAttribute::BooleanAttribute(Impl* impl) : Attribute(impl) {}
inline BooleanAttribute::Impl* BooleanAttribute::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline BooleanAttribute::Impl* BooleanAttribute::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::BooleanAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::BooleanAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
