// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `StructuredType` and makes it.
#pragma once
#include "tarnkiln/meta/StructuredTypeImpl.h"
#include "tarnkiln/meta/TypeBuilder.h"

#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

namespace tarn::kiln::meta {

/// The values of a `StructuredType` to be.
class TARNKILN_EXPORT StructuredType::Impl::BuilderImpl
    : public support::BuilderValues<StructuredType::Impl, Type::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetVobjName(string const& vobjName) { m_vobjName = vobjName; }
    void doAddOwnedAttributes(std::unique_ptr<ModelElement::Builder> ownedAttributes)
    {
        support::addNested(m_ownedAttributes, std::move(ownedAttributes));
    }
    void doClearOwnedAttributes() { m_ownedAttributes.clear(); }
    void doAddOwnedOperations(std::unique_ptr<ModelElement::Builder> ownedOperations)
    {
        support::addNested(m_ownedOperations, std::move(ownedOperations));
    }
    void doClearOwnedOperations() { m_ownedOperations.clear(); }
    void doSetVobjCompactDisplay(bool vobjCompactDisplay)
    {
        m_vobjCompactDisplay = vobjCompactDisplay;
    }
    void doAddVobjDispCategories(string const& vobjDispCategories)
    {
        m_vobjDispCategories.push_back(vobjDispCategories);
    }
    void doClearVobjDispCategories() { m_vobjDispCategories.clear(); }

private:
    string m_vobjName;
    support::NestedBuilders m_ownedAttributes;
    support::NestedBuilders m_ownedOperations;
    bool m_vobjCompactDisplay = false;
    std::vector<string> m_vobjDispCategories;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_vobjName, &BuilderImpl::m_ownedAttributes, &BuilderImpl::m_ownedOperations,
        &BuilderImpl::m_vobjCompactDisplay, &BuilderImpl::m_vobjDispCategories>;
};

/// The setters of what a `StructuredType` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class StructuredType::Impl::BuilderBase : public Type::Impl::BuilderBase<Final>
{
    using Above = Type::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The name of the C++ class.
    Final& setVobjName(string const& vobjName)
    {
        return this->give(VOBJ_NAME, &BuilderImpl::doSetVobjName, vobjName);
    }

    /// The properties declared here, by name.
    Final& addOwnedAttributes(std::unique_ptr<ModelElement::Builder> ownedAttributes)
    {
        return this->give(
            OWNED_ATTRIBUTES, &BuilderImpl::doAddOwnedAttributes, std::move(ownedAttributes));
    }
    Final& clearOwnedAttributes()
    {
        return this->give(OWNED_ATTRIBUTES, &BuilderImpl::doClearOwnedAttributes);
    }

    /// The operations declared here, by name, which several may share.
    Final& addOwnedOperations(std::unique_ptr<ModelElement::Builder> ownedOperations)
    {
        return this->give(
            OWNED_OPERATIONS, &BuilderImpl::doAddOwnedOperations, std::move(ownedOperations));
    }
    Final& clearOwnedOperations()
    {
        return this->give(OWNED_OPERATIONS, &BuilderImpl::doClearOwnedOperations);
    }

    /// Whether displays show it in one line.
    Final& setVobjCompactDisplay(bool vobjCompactDisplay)
    {
        return this->give(
            VOBJ_COMPACT_DISPLAY, &BuilderImpl::doSetVobjCompactDisplay, vobjCompactDisplay);
    }

    /// The display groups, in the order of display.
    Final& addVobjDispCategories(string const& vobjDispCategories)
    {
        return this->give(
            VOBJ_DISP_CATEGORIES, &BuilderImpl::doAddVobjDispCategories, vobjDispCategories);
    }
    Final& addVobjDispCategories(std::initializer_list<string> vobjDispCategories)
    {
        return this->giveEach(
            VOBJ_DISP_CATEGORIES, &BuilderImpl::doAddVobjDispCategories, vobjDispCategories);
    }
    Final& clearVobjDispCategories()
    {
        return this->give(VOBJ_DISP_CATEGORIES, &BuilderImpl::doClearVobjDispCategories);
    }
};

/// Describes a `StructuredType` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT StructuredType::Builder final
    : public StructuredType::Impl::BuilderBase<StructuredType::Builder>
{
public:
    using Handle = StructuredType;

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
    tarn::kiln::meta::StructuredType::Impl, tarn::kiln::meta::Type::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::StructuredType::Builder>;
