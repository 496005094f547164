// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `PrimitiveType`.
#pragma once
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of a `PrimitiveType`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT PrimitiveType::Impl
    : public support::Dispatched<PrimitiveType::Impl, Type::Impl>
{
public:
    class BuilderImpl;                         // PrimitiveTypeBuilder.h
    template <class Final> class BuilderBase;  // PrimitiveTypeBuilder.h

    using Handle = PrimitiveType;
    using Storage = support::Record<Impl, Type::Impl::Storage>;

    static constexpr unsigned long SLOTS = 4;

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

inline PrimitiveType::PrimitiveType(Impl* impl) : Type(impl) {}
inline PrimitiveType::Impl* PrimitiveType::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline PrimitiveType::Impl* PrimitiveType::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::PrimitiveType::Impl, tarn::kiln::meta::Type::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::PrimitiveType::Impl, tarn::kiln::meta::Type::Impl>;
