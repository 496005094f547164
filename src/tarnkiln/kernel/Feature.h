/// \file
/// A property as containment links, collections and inverse calls name it.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/Property.h"

#include <cstdint>

namespace tarn::kiln {

/// What generated code knows about a property at compile time, so that it need not ask a metamodel
/// that may itself be under construction. One constant for each property.
struct Slot
{
    unsigned long index;  ///< `propertyIndex`; from 1. Or `NO_INDEX`.
    bool composite = false;
    bool single = true;                             ///< Upper bound 1.
    bool keyed = false;                             ///< A collection by a qualifying property.
    Slot const* opposite = nullptr;                 ///< The other end; null if there is none.
    meta::Property const& (*property)() = nullptr;  ///< Empty while its metamodel is being built.
};

/// One property, given by its metamodel element or by a generated `Slot`; or none.
///
/// One word that owns nothing: the property must outlive it.
class TARNKILN_EXPORT Feature
{
public:
    Feature() = default;
    Feature(meta::Property const& property);  ///< None, if `property` is not live.
    Feature(meta::Property::Impl* property);
    Feature(Slot const& slot) : m_bits(reinterpret_cast<std::uintptr_t>(&slot) | SLOT) {}

    /// Whether there is a property and it is not destroyed.
    explicit operator bool() const;
    /// The same property, however each side is given.
    bool operator==(Feature const& other) const;

    unsigned long index() const;
    bool isComposite() const;
    bool isSingle() const;     ///< Upper bound 1.
    bool isKeyed() const;      ///< Has a live qualifying property.
    Feature opposite() const;  ///< None, if it has no live opposite.
    /// The metamodel element; empty for a slot whose metamodel is being built.
    meta::Property property() const;
    meta::Property::Impl* propertyImpl() const;
    /// Null unless given by a slot.
    Slot const* slot() const
    {
        return m_bits & SLOT ? reinterpret_cast<Slot const*>(m_bits & ~SLOT) : nullptr;
    }
    bool isNull() const { return m_bits == 0; }

private:
    static constexpr std::uintptr_t SLOT = 1;

    std::uintptr_t m_bits = 0;
};
}  // namespace tarn::kiln
