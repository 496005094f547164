// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `DynamicExtensions` and makes it.
#pragma once
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/support/Builder.h"

#include <memory>
#include <utility>

namespace tarn::kiln::meta {

/// The values of a `DynamicExtensions` to be.
class TARNKILN_EXPORT DynamicExtensions::Impl::BuilderImpl
    : public support::BuilderValues<DynamicExtensions::Impl, support::BuilderRoot>
{
public:
    using BuilderValues::BuilderValues;

    void doSetModelID(unsigned long modelID) { m_modelID = modelID; }
    void doAddExtensions(std::unique_ptr<ModelElement::Builder> extensions)
    {
        support::addNested(m_extensions, std::move(extensions));
    }
    void doClearExtensions() { m_extensions.clear(); }
    void doSetOwningClass(Class const& owningClass) { m_owningClass = owningClass; }

private:
    unsigned long m_modelID = 0;
    support::NestedBuilders m_extensions;
    Class m_owningClass;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_modelID, &BuilderImpl::m_extensions, &BuilderImpl::m_owningClass>;
};

/// The setters of what a `DynamicExtensions` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class DynamicExtensions::Impl::BuilderBase : public support::BuilderTop<Final>
{
    using Above = support::BuilderTop<Final>;

public:
    using Above::Above;

    /// The id of the model that declares them.
    Final& setModelID(unsigned long modelID)
    {
        return this->give(MODEL_ID, &BuilderImpl::doSetModelID, modelID);
    }

    /// The extensions, by name.
    Final& addExtensions(std::unique_ptr<ModelElement::Builder> extensions)
    {
        return this->give(EXTENSIONS, &BuilderImpl::doAddExtensions, std::move(extensions));
    }
    Final& clearExtensions() { return this->give(EXTENSIONS, &BuilderImpl::doClearExtensions); }

    /// The class that they extend.
    Final& setOwningClass(Class const& owningClass)
    {
        return this->give(OWNING_CLASS, &BuilderImpl::doSetOwningClass, owningClass);
    }
};

/// Describes a `DynamicExtensions` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT DynamicExtensions::Builder final
    : public DynamicExtensions::Impl::BuilderBase<DynamicExtensions::Builder>
{
public:
    using Handle = DynamicExtensions;

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
    tarn::kiln::meta::DynamicExtensions::Impl, tarn::kiln::support::BuilderRoot>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::DynamicExtensions::Builder>;
