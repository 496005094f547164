// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `AttributeMap`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/Attribute.h"
#include "tarnkiln/meta/AttributeMap.h"
#include "tarnkiln/support/Dispatch.h"

#include <memory>
#include <vector>

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
    class BuilderImpl;                         // AttributeMapBuilder.h
    template <class Final> class BuilderBase;  // AttributeMapBuilder.h

    using Handle = AttributeMap;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 2;
    static Slot const ATTRIBUTES;
    static Slot const OWNER;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The element that contains the map.
    ModelElement getOwner() const;

    /// The attributes, by key.
    ElementMap<ustring, Attribute>& getAttributes() const;
    /// Whether the collection was made, as its getter does.
    bool hasAttributes() const { return m_attributes.get(); }

    /// Takes in `attribute`, which may come from another map; null and destroyed ones are ignored.
    /// \throws tarnkiln::messages::UniquenessConstraint  if another one has its key.
    virtual void insert(Attribute const& attribute);

    /// The same, and destroys another one that has its key.
    virtual void insertOrReplace(Attribute const& attribute);

    /// Makes an attribute and takes it in under `key`: "Real" stands for a `RealAttribute`, and
    /// what has a dot is the qualified name of a class without its last word, "Attribute". Empty,
    /// and nothing is made, if no such class can be instantiated.
    /// \throws tarnkiln::messages::UniquenessConstraint  if the key is taken; then nothing is left
    /// of the new attribute.
    virtual Attribute emplace(ustring const& fqn, ustring const& key);

    /// The attribute under `key`; empty if there is none.
    virtual Attribute at(ustring const& key) const;

    /// The attribute at the end of a path of keys, all but the last of which lead to attributes
    /// with maps; empty if there is none.
    virtual Attribute recursiveAt(std::vector<ustring> const& keys) const;

    /// Lets go of an attribute or of a stand-in, which lives on without an owner.
    virtual void eraseValue(Attribute const& attribute);

    /// Lets go of the attribute under `key`, which lives on without an owner.
    virtual void erase(ustring const& key);

    /// Destroys an attribute of this map, and no other.
    virtual void removeValue(Attribute const& attribute);

    /// Destroys the attribute under `key`, if there is one.
    virtual void remove(ustring const& key);

    /// Follows the keys from `index`, counted from 0, to before `size`. Beyond the last there is
    /// nothing.
    virtual Attribute doRecurse(std::vector<ustring> const& keys, int index, int size) const;

private:
    static std::unique_ptr<ElementMap<ustring, Attribute>> makeAttributes(Impl* owner);

    mutable support::LazyCollection<ElementMap<ustring, Attribute>> m_attributes;

public:
    using Rows = support::RowList<
        support::References<
            &Impl::m_attributes, ATTRIBUTES, &Impl::makeAttributes, &Impl::getAttributes>>;
    using ComputedRows = support::RowList<
        support::Computed<&Impl::getOwner, OWNER>>;
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
