// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `StructuredType`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/meta/Operation.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/StructuredType.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/support/Dispatch.h"

#include <memory>
#include <vector>

namespace tarn::kiln::meta {

/// The properties of a `StructuredType`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT StructuredType::Impl
    : public support::Dispatched<StructuredType::Impl, Type::Impl>
{
public:
    class BuilderImpl;                         // StructuredTypeBuilder.h
    template <class Final> class BuilderBase;  // StructuredTypeBuilder.h

    using Handle = StructuredType;
    using Storage = support::Record<Impl, Type::Impl::Storage>;

    static constexpr unsigned long SLOTS = 9;
    static Slot const VOBJ_NAME;
    static Slot const OWNED_ATTRIBUTES;
    static Slot const OWNED_OPERATIONS;
    static Slot const VOBJ_COMPACT_DISPLAY;
    static Slot const VOBJ_DISP_CATEGORIES;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The name of the C++ class.
    string const& getVobjName() const { return m_vobjName; }
    void setVobjName(string const& vobjName);

    /// The properties declared here, by name.
    ElementMap<ustring, Property>& getOwnedAttributes() const;
    /// Whether the collection was made, as its getter does.
    bool hasOwnedAttributes() const { return m_ownedAttributes.get(); }

    /// The operations declared here, by name, which several may share.
    ElementMultimap<ustring, Operation>& getOwnedOperations() const;
    /// Whether the collection was made, as its getter does.
    bool hasOwnedOperations() const { return m_ownedOperations.get(); }

    /// Whether displays show it in one line.
    bool getVobjCompactDisplay() const { return m_vobjCompactDisplay; }
    void setVobjCompactDisplay(bool vobjCompactDisplay);

    /// The display groups, in the order of display.
    PrimitiveSequence<string>& getVobjDispCategories() const;
    /// Whether the collection was made, as its getter does.
    bool hasVobjDispCategories() const { return m_vobjDispCategories.get(); }

    /// The property of that name; empty if there is none. A subclass hides those above it.
    virtual Property getPropertyByName(ustring const& name) const;

    /// The live operations of that name. A class that declares one hides all those above it.
    virtual std::vector<Operation> getOperationsByName(ustring const& name) const;

    /// Whether elements or values of this type have `property`.
    virtual bool isATypeOf(Property const& property) const;

private:
    static std::unique_ptr<ElementMap<ustring, Property>> makeOwnedAttributes(Impl* owner);
    static std::unique_ptr<ElementMultimap<ustring, Operation>> makeOwnedOperations(Impl* owner);
    static std::unique_ptr<PrimitiveSequence<string>> makeVobjDispCategories(Impl* owner);

    string m_vobjName;
    mutable support::LazyCollection<ElementMap<ustring, Property>> m_ownedAttributes;
    mutable support::LazyCollection<ElementMultimap<ustring, Operation>> m_ownedOperations;
    bool m_vobjCompactDisplay = false;
    mutable support::LazyCollection<PrimitiveSequence<string>> m_vobjDispCategories;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_vobjName, VOBJ_NAME, &Impl::setVobjName>,
        support::References<
            &Impl::m_ownedAttributes, OWNED_ATTRIBUTES, &Impl::makeOwnedAttributes,
            &Impl::getOwnedAttributes>,
        support::References<
            &Impl::m_ownedOperations, OWNED_OPERATIONS, &Impl::makeOwnedOperations,
            &Impl::getOwnedOperations>,
        support::Scalar<
            &Impl::m_vobjCompactDisplay, VOBJ_COMPACT_DISPLAY, &Impl::setVobjCompactDisplay>,
        support::Values<
            &Impl::m_vobjDispCategories, VOBJ_DISP_CATEGORIES, &Impl::makeVobjDispCategories,
            &Impl::getVobjDispCategories>>;
};

inline StructuredType::StructuredType(Impl* impl) : Type(impl) {}
inline StructuredType::Impl* StructuredType::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline StructuredType::Impl* StructuredType::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::StructuredType::Impl, tarn::kiln::meta::Type::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::StructuredType::Impl, tarn::kiln::meta::Type::Impl>;
