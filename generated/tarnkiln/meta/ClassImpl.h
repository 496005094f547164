// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `Class`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DynamicExtensions.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"
#include "tarnkiln/support/Dispatch.h"

#include <memory>
#include <vector>

namespace tarn::kiln::meta {

/// The properties of a `Class`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Class::Impl : public support::Dispatched<Class::Impl, StructuredType::Impl>
{
public:
    class BuilderImpl;                         // ClassBuilder.h
    template <class Final> class BuilderBase;  // ClassBuilder.h

    using Handle = Class;
    using Storage = support::Record<Impl, StructuredType::Impl::Storage>;

    static constexpr unsigned long SLOTS = 12;
    static Slot const SUPERCLASS;
    static Slot const EXTENSIONS;
    static Slot const IS_ABSTRACT;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The class that this one extends.
    Class getSuperclass() const;
    /// Null if there is none; a proxy stays one.
    Class::Impl* getSuperclassImpl() const { return m_superclass.get(); }
    /// Whether there is one and it is live.
    bool hasSuperclass() const;
    void setSuperclass(Class const& superclass);

    /// What models add to the class, by the models' ids.
    ElementMap<unsigned long, DynamicExtensions>& getExtensions() const;
    /// Whether the collection was made, as its getter does.
    bool hasExtensions() const { return m_extensions.get(); }

    /// Whether no element can be made of exactly this class.
    bool isAbstract() const { return m_isAbstract; }
    void setIsAbstract(bool abstract);
    bool isA(Type const& other) const override;
    Property getPropertyByName(ustring const& name) const override;
    std::vector<Operation> getOperationsByName(ustring const& name) const override;
    bool isATypeOf(Property const& property) const override;

    /// What builds elements of this class; null if the registry knows no builder for it, as for
    /// all classes without generated code.
    std::unique_ptr<ModelElement::Builder> instantiateBuilder(Model const& model) const;

    /// Builds an element; the empty handle if there is no builder. The nil UUID stands for a fresh
    /// one.
    ModelElement instantiate(Model const& model, UUID const& id) const;

private:
    static std::unique_ptr<ElementMap<unsigned long, DynamicExtensions>>
    makeExtensions(Impl* owner);

    mutable support::CountedPointer<Class::Impl> m_superclass;
    mutable support::LazyCollection<ElementMap<unsigned long, DynamicExtensions>> m_extensions;
    bool m_isAbstract = false;

public:
    using Rows = support::RowList<
        support::Reference<Class, &Impl::m_superclass, SUPERCLASS, &Impl::setSuperclass>,
        support::References<
            &Impl::m_extensions, EXTENSIONS, &Impl::makeExtensions, &Impl::getExtensions>,
        support::Scalar<&Impl::m_isAbstract, IS_ABSTRACT, &Impl::setIsAbstract>>;
};

inline Class::Class(Impl* impl) : StructuredType(impl) {}
inline Class::Impl* Class::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Class::Impl* Class::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Class::Impl, tarn::kiln::meta::StructuredType::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Class::Impl, tarn::kiln::meta::StructuredType::Impl>;
