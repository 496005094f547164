// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Enum` and makes it.
#pragma once
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/TypeBuilder.h"

#include <memory>
#include <utility>

namespace tarn::kiln::meta {

/// The values of an `Enum` to be.
class TARNKILN_EXPORT Enum::Impl::BuilderImpl
    : public support::BuilderValues<Enum::Impl, Type::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doAddLiterals(std::unique_ptr<ModelElement::Builder> literals)
    {
        support::addNested(m_literals, std::move(literals));
    }
    void doClearLiterals() { m_literals.clear(); }
    void doSetUnderlyingType(PrimitiveType const& underlyingType)
    {
        m_underlyingType = underlyingType;
    }

private:
    support::NestedBuilders m_literals;
    PrimitiveType m_underlyingType;

public:
    using Fields = support::BuilderFields<&BuilderImpl::m_literals, &BuilderImpl::m_underlyingType>;
};

/// The setters of what an `Enum` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Enum::Impl::BuilderBase : public Type::Impl::BuilderBase<Final>
{
    using Above = Type::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The literals, by name.
    Final& addLiterals(std::unique_ptr<ModelElement::Builder> literals)
    {
        return this->give(LITERALS, &BuilderImpl::doAddLiterals, std::move(literals));
    }
    Final& clearLiterals() { return this->give(LITERALS, &BuilderImpl::doClearLiterals); }

    /// The type of the literals' values.
    Final& setUnderlyingType(PrimitiveType const& underlyingType)
    {
        return this->give(UNDERLYING_TYPE, &BuilderImpl::doSetUnderlyingType, underlyingType);
    }
};

/// Describes an `Enum` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Enum::Builder final : public Enum::Impl::BuilderBase<Enum::Builder>
{
public:
    using Handle = Enum;

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
    tarn::kiln::meta::Enum::Impl, tarn::kiln::meta::Type::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Enum::Builder>;
