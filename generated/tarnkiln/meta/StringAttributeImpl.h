// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `StringAttribute`.
#pragma once
#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/meta/StringAttribute.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of a `StringAttribute`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT StringAttribute::Impl
    : public support::Dispatched<StringAttribute::Impl, Attribute::Impl>
{
public:
    class BuilderImpl;                         // StringAttributeBuilder.h
    template <class Final> class BuilderBase;  // StringAttributeBuilder.h

    using Handle = StringAttribute;
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
    ustring const& getValue() const { return m_value; }
    void setValue(ustring const& value);
    Type getType() const override;

private:
    ustring m_value;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_value, VALUE, &Impl::setValue>>;
};

inline StringAttribute::StringAttribute(Impl* impl) : Attribute(impl) {}
inline StringAttribute::Impl* StringAttribute::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline StringAttribute::Impl* StringAttribute::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::StringAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::StringAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
