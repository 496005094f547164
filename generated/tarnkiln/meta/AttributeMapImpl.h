// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `AttributeMap`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/Attribute.h"
#include "tarnkiln/meta/AttributeMap.h"
#include "tarnkiln/support/Dispatch.h"

#include <memory>

namespace tarn::kiln::meta {

/// The properties of an `AttributeMap`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT AttributeMap::Impl
    : public support::Dispatched<AttributeMap::Impl, ModelElement::Impl>
{
public:
    using Handle = AttributeMap;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 2;
    static Slot const ATTRIBUTES;

    Impl(Model const& model, UUID const& id);
    ~Impl() override;

    /// The element that contains the map.
    ModelElement getOwner() const;

    /// The attributes, by key.
    ElementMap<ustring, Attribute>& getAttributes() const;
    /// Whether the collection was made, as its getter does.
    bool hasAttributes() const { return m_attributes.get(); }

private:
    static std::unique_ptr<ElementMap<ustring, Attribute>> makeAttributes(Impl* owner);

    mutable support::LazyCollection<ElementMap<ustring, Attribute>> m_attributes;

public:
    using Rows = support::RowList<
        support::References<
            &Impl::m_attributes, ATTRIBUTES, &Impl::makeAttributes, &Impl::getAttributes>>;
};

inline AttributeMap::AttributeMap(Impl* impl) : ModelElement(impl) {}
inline AttributeMap::Impl* AttributeMap::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline AttributeMap::Impl* AttributeMap::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::AttributeMap::Impl, tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::AttributeMap::Impl, tarn::kiln::ModelElement::Impl>;
