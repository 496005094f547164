// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Extension` and makes it.
#pragma once
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/PropertyBuilder.h"

namespace tarn::kiln::meta {

/// The values of an `Extension` to be.
class TARNKILN_EXPORT Extension::Impl::BuilderImpl
    : public support::BuilderValues<Extension::Impl, Property::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetOwner(DynamicExtensions const& owner) { m_owner = owner; }

private:
    DynamicExtensions m_owner;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_owner>;
};

/// The setters of what an `Extension` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Extension::Impl::BuilderBase : public Property::Impl::BuilderBase<Final>
{
    using Above = Property::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The group that it belongs to.
    Final& setOwner(DynamicExtensions const& owner)
    {
        return this->give(OWNER, &BuilderImpl::doSetOwner, owner);
    }
};

/// Describes an `Extension` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Extension::Builder final
    : public Extension::Impl::BuilderBase<Extension::Builder>
{
public:
    using Handle = Extension;

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
    tarn::kiln::meta::Extension::Impl, tarn::kiln::meta::Property::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Extension::Builder>;
