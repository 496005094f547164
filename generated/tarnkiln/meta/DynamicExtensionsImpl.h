// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `DynamicExtensions`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DynamicExtensions.h"
#include "tarnkiln/meta/Extension.h"
#include "tarnkiln/support/Dispatch.h"

#include <memory>

namespace tarn::kiln::meta {

/// The properties of a `DynamicExtensions`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT DynamicExtensions::Impl
    : public support::Dispatched<DynamicExtensions::Impl, ModelElement::Impl>
{
public:
    class BuilderImpl;                         // DynamicExtensionsBuilder.h
    template <class Final> class BuilderBase;  // DynamicExtensionsBuilder.h

    using Handle = DynamicExtensions;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 4;
    static Slot const MODEL_ID;
    static Slot const EXTENSIONS;
    static Slot const OWNING_CLASS;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The id of the model that declares them.
    /// \throws tarnkiln::messages::UniquenessConstraint  if the owner has another such key.
    unsigned long getModelID() const { return m_modelID; }
    void setModelID(unsigned long modelID);

    /// The extensions, by name.
    ElementMap<ustring, Extension>& getExtensions() const;
    /// Whether the collection was made, as its getter does.
    bool hasExtensions() const { return m_extensions.get(); }

    /// The class that they extend.
    Class getOwningClass() const;
    Class::Impl* getOwningClassImpl() const;
    /// Whether there is one and it is live.
    bool hasOwningClass() const;
    void setOwningClass(Class const& owningClass);

private:
    static std::unique_ptr<ElementMap<ustring, Extension>> makeExtensions(Impl* owner);

    unsigned long m_modelID = 0;
    mutable support::LazyCollection<ElementMap<ustring, Extension>> m_extensions;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_modelID, MODEL_ID, &Impl::setModelID>,
        support::References<
            &Impl::m_extensions, EXTENSIONS, &Impl::makeExtensions, &Impl::getExtensions>,
        support::Container<Class, OWNING_CLASS, &Impl::setOwningClass>>;
};

inline DynamicExtensions::DynamicExtensions(Impl* impl) : ModelElement(impl) {}
inline DynamicExtensions::Impl* DynamicExtensions::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline DynamicExtensions::Impl* DynamicExtensions::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::DynamicExtensions::Impl, tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::DynamicExtensions::Impl, tarn::kiln::ModelElement::Impl>;
