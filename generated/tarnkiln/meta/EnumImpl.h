// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `Enum`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/EnumLiteral.h"
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/support/Dispatch.h"

#include <memory>

namespace tarn::kiln::meta {

/// The properties of an `Enum`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Enum::Impl : public support::Dispatched<Enum::Impl, Type::Impl>
{
public:
    class BuilderImpl;                         // EnumBuilder.h
    template <class Final> class BuilderBase;  // EnumBuilder.h

    using Handle = Enum;
    using Storage = support::Record<Impl, Type::Impl::Storage>;

    static constexpr unsigned long SLOTS = 6;
    static Slot const LITERALS;
    static Slot const UNDERLYING_TYPE;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The literals, by name.
    ElementMap<ustring, EnumLiteral>& getLiterals() const;
    /// Whether the collection was made, as its getter does.
    bool hasLiterals() const { return m_literals.get(); }

    /// The type of the literals' values.
    PrimitiveType getUnderlyingType() const;
    /// Null if there is none; a proxy stays one.
    PrimitiveType::Impl* getUnderlyingTypeImpl() const { return m_underlyingType.get(); }
    /// Whether there is one and it is live.
    bool hasUnderlyingType() const;
    void setUnderlyingType(PrimitiveType const& underlyingType);

    /// The first literal, by name, with that value; empty if there is none.
    virtual EnumLiteral findLiteralByValue(int value) const;

    /// The first literal, by name, with that public identifier; empty if there is none.
    virtual EnumLiteral findLiteralByPublicIdentifier(ustring const& identifier) const;

private:
    static std::unique_ptr<ElementMap<ustring, EnumLiteral>> makeLiterals(Impl* owner);

    mutable support::LazyCollection<ElementMap<ustring, EnumLiteral>> m_literals;
    mutable support::CountedPointer<PrimitiveType::Impl> m_underlyingType;

public:
    using Rows = support::RowList<
        support::References<&Impl::m_literals, LITERALS, &Impl::makeLiterals, &Impl::getLiterals>,
        support::Reference<
            PrimitiveType, &Impl::m_underlyingType, UNDERLYING_TYPE, &Impl::setUnderlyingType>>;
};

inline Enum::Enum(Impl* impl) : Type(impl) {}
inline Enum::Impl* Enum::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Enum::Impl* Enum::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Enum::Impl, tarn::kiln::meta::Type::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Enum::Impl, tarn::kiln::meta::Type::Impl>;
