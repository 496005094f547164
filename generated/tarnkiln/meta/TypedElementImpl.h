// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `TypedElement`.
#pragma once
#include "tarnkiln/meta/NamedElementImpl.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/meta/TypedElement.h"
#include "tarnkiln/support/Dispatch.h"

#include <cstdint>

namespace tarn::kiln::meta {

/// The properties of a `TypedElement`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT TypedElement::Impl
    : public support::Dispatched<TypedElement::Impl, NamedElement::Impl>
{
public:
    class BuilderImpl;                         // TypedElementBuilder.h
    template <class Final> class BuilderBase;  // TypedElementBuilder.h

    using Handle = TypedElement;
    using Storage = support::Record<Impl, NamedElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 6;
    static Slot const TYPE;
    static Slot const LOWER;
    static Slot const UPPER;
    static Slot const IS_ORDERED;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The type of the value.
    Type getType() const;
    /// Null if there is none; a proxy stays one.
    Type::Impl* getTypeImpl() const { return m_type.get(); }
    /// Whether there is one and it is live.
    bool hasType() const;
    void setType(Type const& type);

    /// The least number of values.
    std::uint32_t getLower() const { return m_lower; }
    void setLower(std::uint32_t lower);

    /// The greatest number of values; 0xFFFFFFFF means unbounded.
    std::uint32_t getUpper() const { return m_upper; }
    void setUpper(std::uint32_t upper);

    /// Whether the values have positions.
    bool isOrdered() const { return m_isOrdered; }
    void setIsOrdered(bool ordered);

private:
    mutable support::CountedPointer<Type::Impl> m_type;
    std::uint32_t m_lower = 0;
    std::uint32_t m_upper = 0;
    bool m_isOrdered = false;

public:
    using Rows = support::RowList<
        support::Reference<Type, &Impl::m_type, TYPE, &Impl::setType>,
        support::Scalar<&Impl::m_lower, LOWER, &Impl::setLower>,
        support::Scalar<&Impl::m_upper, UPPER, &Impl::setUpper>,
        support::Scalar<&Impl::m_isOrdered, IS_ORDERED, &Impl::setIsOrdered>>;
};

inline TypedElement::TypedElement(Impl* impl) : NamedElement(impl) {}
inline TypedElement::Impl* TypedElement::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline TypedElement::Impl* TypedElement::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::TypedElement::Impl, tarn::kiln::meta::NamedElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::TypedElement::Impl, tarn::kiln::meta::NamedElement::Impl>;
