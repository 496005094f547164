// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `DataType`.
#pragma once
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of a `DataType`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT DataType::Impl
    : public support::Dispatched<DataType::Impl, StructuredType::Impl>
{
public:
    class BuilderImpl;                         // DataTypeBuilder.h
    template <class Final> class BuilderBase;  // DataTypeBuilder.h

    using Handle = DataType;
    using Storage = support::Record<Impl, StructuredType::Impl::Storage>;

    static constexpr unsigned long SLOTS = 9;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

private:
public:
    using Rows = support::RowList<>;
};

inline DataType::DataType(Impl* impl) : StructuredType(impl) {}
inline DataType::Impl* DataType::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline DataType::Impl* DataType::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::DataType::Impl, tarn::kiln::meta::StructuredType::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::DataType::Impl, tarn::kiln::meta::StructuredType::Impl>;
