// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `NamedElement` and makes it.
#pragma once
#include "tarnkiln/meta/NamedElementImpl.h"
#include "tarnkiln/support/Builder.h"

namespace tarn::kiln::meta {

/// The values of a `NamedElement` to be.
class TARNKILN_EXPORT NamedElement::Impl::BuilderImpl
    : public support::BuilderValues<NamedElement::Impl, support::BuilderRoot>
{
public:
    using BuilderValues::BuilderValues;

    void doSetName(ustring const& name) { m_name = name; }

private:
    ustring m_name;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_name>;
};

/// The setters of what a `NamedElement` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class NamedElement::Impl::BuilderBase : public support::BuilderTop<Final>
{
    using Above = support::BuilderTop<Final>;

public:
    using Above::Above;

    /// The name.
    Final& setName(ustring const& name) { return this->give(NAME, &BuilderImpl::doSetName, name); }
};

/// Describes a `NamedElement` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT NamedElement::Builder final
    : public NamedElement::Impl::BuilderBase<NamedElement::Builder>
{
public:
    using Handle = NamedElement;

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
    tarn::kiln::meta::NamedElement::Impl, tarn::kiln::support::BuilderRoot>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::NamedElement::Builder>;
