#include "tarnkiln/kernel/Feature.h"

#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln {

Feature::Feature(meta::Property const& property) : Feature(property ? property.getImpl() : nullptr)
{}

Feature::Feature(meta::Property::Impl* property)
    : m_bits(reinterpret_cast<std::uintptr_t>(property))
{}

meta::Property::Impl* Feature::propertyImpl() const
{
    if (Slot const* const known = slot())
        return known->property ? known->property().getImpl() : nullptr;
    return reinterpret_cast<meta::Property::Impl*>(m_bits);
}

meta::Property Feature::property() const
{
    return meta::Property(propertyImpl());
}

Feature::operator bool() const
{
    return m_bits != 0 && (slot() || propertyImpl()->isLive());
}

bool Feature::operator==(Feature const& other) const
{
    if (m_bits == other.m_bits)
        return true;
    // Each property has one slot, so two slots are two properties.
    if (slot() && other.slot())
        return false;
    meta::Property::Impl const* const mine = propertyImpl();
    return mine && mine == other.propertyImpl();
}

unsigned long Feature::index() const
{
    if (Slot const* const known = slot())
        return known->index;
    return static_cast<unsigned long>(propertyImpl()->getPropertyIndex());
}

bool Feature::isComposite() const
{
    if (Slot const* const known = slot())
        return known->composite;
    return *this && propertyImpl()->isComposite();
}

bool Feature::isSingle() const
{
    if (Slot const* const known = slot())
        return known->single;
    return *this && propertyImpl()->getUpper() == 1;
}

bool Feature::isKeyed() const
{
    if (Slot const* const known = slot())
        return known->keyed;
    return *this && propertyImpl()->hasQualifiedBy();
}

Feature Feature::opposite() const
{
    if (Slot const* const known = slot())
        return known->opposite ? Feature(*known->opposite) : Feature();
    if (!*this || !propertyImpl()->hasOpposite())
        return Feature();
    return Feature(propertyImpl()->getOppositeImpl());
}
}  // namespace tarn::kiln
