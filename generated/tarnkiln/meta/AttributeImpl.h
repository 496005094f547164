// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `Attribute`.
#pragma once
#include "tarnkiln/meta/Attribute.h"
#include "tarnkiln/meta/AttributeMap.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of an `Attribute`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Attribute::Impl
    : public support::Dispatched<Attribute::Impl, ModelElement::Impl>
{
public:
    class BuilderImpl;                         // AttributeBuilder.h
    template <class Final> class BuilderBase;  // AttributeBuilder.h

    using Handle = Attribute;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 3;
    static Slot const KEY;
    static Slot const OWNER;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// What the map knows the attribute by.
    /// \throws tarnkiln::messages::UniquenessConstraint  if the owner has another such key.
    ustring const& getKey() const { return m_key; }
    void setKey(ustring const& key);

    /// The map that holds it.
    AttributeMap getOwner() const;
    AttributeMap::Impl* getOwnerImpl() const;
    /// Whether there is one and it is live.
    bool hasOwner() const;
    void setOwner(AttributeMap const& owner);

    /// The type of the value.
    virtual Type getType() const = 0;

private:
    ustring m_key;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_key, KEY, &Impl::setKey>,
        support::Container<AttributeMap, OWNER, &Impl::setOwner>>;
};

inline Attribute::Attribute(Impl* impl) : ModelElement(impl) {}
inline Attribute::Impl* Attribute::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Attribute::Impl* Attribute::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Attribute::Impl, tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Attribute::Impl, tarn::kiln::ModelElement::Impl>;
