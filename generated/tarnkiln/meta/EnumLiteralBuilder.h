// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `EnumLiteral` and makes it.
#pragma once
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/NamedElementBuilder.h"

namespace tarn::kiln::meta {

/// The values of an `EnumLiteral` to be.
class TARNKILN_EXPORT EnumLiteral::Impl::BuilderImpl
    : public support::BuilderValues<EnumLiteral::Impl, NamedElement::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doSetValue(int value) { m_value = value; }
    void doSetParentEnum(Enum const& parentEnum) { m_parentEnum = parentEnum; }
    void doSetPublicIdentifier(boost::optional<ustring> const& publicIdentifier)
    {
        m_publicIdentifier = publicIdentifier;
    }

private:
    int m_value = 0;
    Enum m_parentEnum;
    boost::optional<ustring> m_publicIdentifier;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_value, &BuilderImpl::m_parentEnum, &BuilderImpl::m_publicIdentifier>;
};

/// The setters of what an `EnumLiteral` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class EnumLiteral::Impl::BuilderBase : public NamedElement::Impl::BuilderBase<Final>
{
    using Above = NamedElement::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The number; a sibling may have the same.
    Final& setValue(int value) { return this->give(VALUE, &BuilderImpl::doSetValue, value); }

    /// The owner.
    Final& setParentEnum(Enum const& parentEnum)
    {
        return this->give(PARENT_ENUM, &BuilderImpl::doSetParentEnum, parentEnum);
    }

    /// What documents may write in place of the name.
    Final& setPublicIdentifier(boost::optional<ustring> const& publicIdentifier)
    {
        return this->give(PUBLIC_IDENTIFIER, &BuilderImpl::doSetPublicIdentifier, publicIdentifier);
    }
    Final& setPublicIdentifier(ustring const& publicIdentifier)
    {
        return this->give(PUBLIC_IDENTIFIER, &BuilderImpl::doSetPublicIdentifier, publicIdentifier);
    }
};

/// Describes an `EnumLiteral` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT EnumLiteral::Builder final
    : public EnumLiteral::Impl::BuilderBase<EnumLiteral::Builder>
{
public:
    using Handle = EnumLiteral;

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
    tarn::kiln::meta::EnumLiteral::Impl, tarn::kiln::meta::NamedElement::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::EnumLiteral::Builder>;
