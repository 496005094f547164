// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `Extension`.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DynamicExtensions.h"
#include "tarnkiln/meta/Extension.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of an `Extension`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Extension::Impl : public support::Dispatched<Extension::Impl, Property::Impl>
{
public:
    class BuilderImpl;                         // ExtensionBuilder.h
    template <class Final> class BuilderBase;  // ExtensionBuilder.h

    using Handle = Extension;
    using Storage = support::Record<Impl, Property::Impl::Storage>;

    static constexpr unsigned long SLOTS = 27;
    static Slot const OWNER;
    static Slot const EXTENDED_METACLASS;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The class that it extends.
    Class getExtendedMetaclass() const;

    /// The group that it belongs to.
    DynamicExtensions getOwner() const;
    DynamicExtensions::Impl* getOwnerImpl() const;
    /// Whether there is one and it is live.
    bool hasOwner() const;
    void setOwner(DynamicExtensions const& owner);

    /// Gives it another name, under which the owner then keeps it.
    ///
    /// \throws tarnkiln::messages::UniquenessConstraint  if the owner has another such name.
    void setName(ustring const& name) override;

    /// The detached description of this extension; an upper bound above 1 counts as unbounded.
    ExtensionPrototype createPrototype() const;

private:
public:
    using Rows = support::RowList<
        support::Container<DynamicExtensions, OWNER, &Impl::setOwner>>;
    using ComputedRows = support::RowList<
        support::Computed<&Impl::getExtendedMetaclass, EXTENDED_METACLASS>>;
};

inline Extension::Extension(Impl* impl) : Property(impl) {}
inline Extension::Impl* Extension::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Extension::Impl* Extension::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Extension::Impl, tarn::kiln::meta::Property::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Extension::Impl, tarn::kiln::meta::Property::Impl>;
