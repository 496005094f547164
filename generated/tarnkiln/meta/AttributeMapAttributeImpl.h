// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `AttributeMapAttribute`.
#pragma once
#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/meta/AttributeMap.h"
#include "tarnkiln/meta/AttributeMapAttribute.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of an `AttributeMapAttribute`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT AttributeMapAttribute::Impl
    : public support::Dispatched<AttributeMapAttribute::Impl, Attribute::Impl>
{
public:
    class BuilderImpl;                         // AttributeMapAttributeBuilder.h
    template <class Final> class BuilderBase;  // AttributeMapAttributeBuilder.h

    using Handle = AttributeMapAttribute;
    using Storage = support::Record<Impl, Attribute::Impl::Storage>;

    static constexpr unsigned long SLOTS = 4;
    static Slot const VALUE;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The map inside.
    AttributeMap getValue() const;
    /// Null if there is none; a proxy stays one.
    AttributeMap::Impl* getValueImpl() const { return m_value.get(); }
    /// Whether there is one and it is live.
    bool hasValue() const;
    void setValue(AttributeMap const& value);
    Type getType() const override;

private:
    mutable support::CountedPointer<AttributeMap::Impl> m_value;

public:
    using Rows = support::RowList<
        support::CompositeReference<AttributeMap, &Impl::m_value, VALUE, &Impl::setValue>>;
};

inline AttributeMapAttribute::AttributeMapAttribute(Impl* impl) : Attribute(impl) {}
inline AttributeMapAttribute::Impl* AttributeMapAttribute::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline AttributeMapAttribute::Impl* AttributeMapAttribute::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::AttributeMapAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::AttributeMapAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
