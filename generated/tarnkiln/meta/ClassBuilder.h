// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Class` and makes it.
#pragma once
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/StructuredTypeBuilder.h"

#include <memory>
#include <utility>

namespace tarn::kiln::meta {

/// The values of a `Class` to be.
class TARNKILN_EXPORT Class::Impl::BuilderImpl
    : public support::BuilderValues<Class::Impl, StructuredType::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetSuperclass(Class const& superclass) { m_superclass = superclass; }
    void doAddExtensions(std::unique_ptr<ModelElement::Builder> extensions)
    {
        support::addNested(m_extensions, std::move(extensions));
    }
    void doClearExtensions() { m_extensions.clear(); }
    void doSetIsAbstract(bool abstract) { m_isAbstract = abstract; }

private:
    Class m_superclass;
    support::NestedBuilders m_extensions;
    bool m_isAbstract = false;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_superclass, &BuilderImpl::m_extensions, &BuilderImpl::m_isAbstract>;
};

/// The setters of what a `Class` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Class::Impl::BuilderBase : public StructuredType::Impl::BuilderBase<Final>
{
    using Above = StructuredType::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The class that this one extends.
    Final& setSuperclass(Class const& superclass)
    {
        return this->give(SUPERCLASS, &BuilderImpl::doSetSuperclass, superclass);
    }

    /// What models add to the class, by the models' ids.
    Final& addExtensions(std::unique_ptr<ModelElement::Builder> extensions)
    {
        return this->give(EXTENSIONS, &BuilderImpl::doAddExtensions, std::move(extensions));
    }
    Final& clearExtensions() { return this->give(EXTENSIONS, &BuilderImpl::doClearExtensions); }

    /// Whether no element can be made of exactly this class.
    Final& setIsAbstract(bool abstract)
    {
        return this->give(IS_ABSTRACT, &BuilderImpl::doSetIsAbstract, abstract);
    }
};

/// Describes a `Class` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Class::Builder final : public Class::Impl::BuilderBase<Class::Builder>
{
public:
    using Handle = Class;

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
    tarn::kiln::meta::Class::Impl, tarn::kiln::meta::StructuredType::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Class::Builder>;
