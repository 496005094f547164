// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `AttributeMap` and makes it.
#pragma once
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/support/Builder.h"

#include <memory>
#include <utility>

namespace tarn::kiln::meta {

/// The values of an `AttributeMap` to be.
class TARNKILN_EXPORT AttributeMap::Impl::BuilderImpl
    : public support::BuilderValues<AttributeMap::Impl, support::BuilderRoot>
{
public:
    using BuilderValues::BuilderValues;

    void doAddAttributes(std::unique_ptr<ModelElement::Builder> attributes)
    {
        support::addNested(m_attributes, std::move(attributes));
    }
    void doClearAttributes() { m_attributes.clear(); }

private:
    support::NestedBuilders m_attributes;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_attributes>;
};

/// The setters of what an `AttributeMap` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class AttributeMap::Impl::BuilderBase : public support::BuilderTop<Final>
{
    using Above = support::BuilderTop<Final>;

public:
    using Above::Above;

    /// The attributes, by key.
    Final& addAttributes(std::unique_ptr<ModelElement::Builder> attributes)
    {
        return this->give(ATTRIBUTES, &BuilderImpl::doAddAttributes, std::move(attributes));
    }
    Final& clearAttributes() { return this->give(ATTRIBUTES, &BuilderImpl::doClearAttributes); }
};

/// Describes an `AttributeMap` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT AttributeMap::Builder final
    : public AttributeMap::Impl::BuilderBase<AttributeMap::Builder>
{
public:
    using Handle = AttributeMap;

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
    tarn::kiln::meta::AttributeMap::Impl, tarn::kiln::support::BuilderRoot>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::AttributeMap::Builder>;
