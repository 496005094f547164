// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Attribute` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/support/Builder.h"

namespace tarn::kiln::meta {

/// The values of an `Attribute` to be.
class TARNKILN_EXPORT Attribute::Impl::BuilderImpl
    : public support::BuilderValues<Attribute::Impl, support::BuilderRoot>
{
public:
    using BuilderValues::BuilderValues;

    void doSetKey(ustring const& key) { m_key = key; }
    void doSetOwner(AttributeMap const& owner) { m_owner = owner; }

private:
    ustring m_key;
    AttributeMap m_owner;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_key, &BuilderImpl::m_owner>;
};

/// The setters of what an `Attribute` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Attribute::Impl::BuilderBase : public support::BuilderTop<Final>
{
    using Above = support::BuilderTop<Final>;

public:
    using Above::Above;

    /// What the map knows the attribute by.
    Final& setKey(ustring const& key) { return this->give(KEY, &BuilderImpl::doSetKey, key); }

    /// The map that holds it.
    Final& setOwner(AttributeMap const& owner)
    {
        return this->give(OWNER, &BuilderImpl::doSetOwner, owner);
    }
};

/// Describes an `Attribute` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Attribute::Builder final
    : public Attribute::Impl::BuilderBase<Attribute::Builder>
{
public:
    using Handle = Attribute;

    /// For a builder inside another one, whose model it takes.
    Builder();
    explicit Builder(Model const& model);
    ~Builder() override;

private:
    friend class support::BuilderTop<Builder>;

    Impl::BuilderImpl m_values{*this};
};
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Attribute::Impl, tarn::kiln::support::BuilderRoot>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Attribute::Builder>;
