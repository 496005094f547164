// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `PrimitiveType` and makes it.
#pragma once
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/TypeBuilder.h"

namespace tarn::kiln::meta {

/// The values of a `PrimitiveType` to be.
class TARNKILN_EXPORT PrimitiveType::Impl::BuilderImpl
    : public support::BuilderValues<PrimitiveType::Impl, Type::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    using Fields = support::BuilderFields<>;
};

/// The setters of what a `PrimitiveType` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class PrimitiveType::Impl::BuilderBase : public Type::Impl::BuilderBase<Final>
{
    using Above = Type::Impl::BuilderBase<Final>;

public:
    using Above::Above;
};

/// Describes a `PrimitiveType` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT PrimitiveType::Builder final
    : public PrimitiveType::Impl::BuilderBase<PrimitiveType::Builder>
{
public:
    using Handle = PrimitiveType;

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
    tarn::kiln::meta::PrimitiveType::Impl, tarn::kiln::meta::Type::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::PrimitiveType::Builder>;
