// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `Type`.
#pragma once
#include "tarnkiln/meta/NamedElementImpl.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of a `Type`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Type::Impl : public support::Dispatched<Type::Impl, NamedElement::Impl>
{
public:
    class BuilderImpl;                         // TypeBuilder.h
    template <class Final> class BuilderBase;  // TypeBuilder.h

    using Handle = Type;
    using Storage = support::Record<Impl, NamedElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 4;
    static Slot const IS_VOBJ_HIDDEN;
    static Slot const OWNING_PACKAGE;
    static Slot const QUALIFIED_NAME;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The names from the root package on, separated by dots.
    ustring getQualifiedName() const;

    /// Whether displays leave it out.
    bool isVobjHidden() const { return m_isVobjHidden; }
    void setIsVobjHidden(bool vobjHidden);

    /// The package that has it.
    Package getOwningPackage() const;
    Package::Impl* getOwningPackageImpl() const;
    /// Whether there is one and it is live.
    bool hasOwningPackage() const;
    void setOwningPackage(Package const& owningPackage);

    /// Gives it another name, under which the owner then keeps it.
    ///
    /// \throws tarnkiln::messages::UniquenessConstraint  if the owner has another such name.
    void setName(ustring const& name) override;

    /// Whether this is `other` or a class that extends it. All but classes are only ever
    /// themselves.
    virtual bool isA(Type const& other) const;

    /// The qualified name.
    ustring identifier() const override;

private:
    bool m_isVobjHidden = false;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_isVobjHidden, IS_VOBJ_HIDDEN, &Impl::setIsVobjHidden>,
        support::Container<Package, OWNING_PACKAGE, &Impl::setOwningPackage>>;
    using ComputedRows = support::RowList<
        support::Computed<&Impl::getQualifiedName, QUALIFIED_NAME>>;
};

inline Type::Type(Impl* impl) : NamedElement(impl) {}
inline Type::Impl* Type::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Type::Impl* Type::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Type::Impl, tarn::kiln::meta::NamedElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Type::Impl, tarn::kiln::meta::NamedElement::Impl>;
