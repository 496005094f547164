// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `DataType` and makes it.
#pragma once
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/StructuredTypeBuilder.h"

namespace tarn::kiln::meta {

/// The values of a `DataType` to be.
class TARNKILN_EXPORT DataType::Impl::BuilderImpl
    : public support::BuilderValues<DataType::Impl, StructuredType::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    using Fields = support::BuilderFields<>;
};

/// The setters of what a `DataType` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class DataType::Impl::BuilderBase : public StructuredType::Impl::BuilderBase<Final>
{
    using Above = StructuredType::Impl::BuilderBase<Final>;

public:
    using Above::Above;
};

/// Describes a `DataType` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT DataType::Builder final
    : public DataType::Impl::BuilderBase<DataType::Builder>
{
public:
    using Handle = DataType;

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
    tarn::kiln::meta::DataType::Impl, tarn::kiln::meta::StructuredType::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::DataType::Builder>;
