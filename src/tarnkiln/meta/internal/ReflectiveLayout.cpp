#include "tarnkiln/meta/internal/ReflectiveLayout.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <algorithm>
#include <limits>
#include <unordered_map>

namespace tarn::kiln::internal {
namespace {

using Layouts = std::unordered_map<meta::Class::Impl const*, ReflectiveLayout::Handle>;

/// The layouts that this thread made last, by class. A class that is in here can not be freed and
/// its address not be used again.
thread_local Layouts latest;
}  // namespace

ReflectiveLayout::Handle ReflectiveLayout::of(meta::Class const& metaClass)
{
    auto const known = latest.find(metaClass.getImpl());
    if (known != latest.end() && known->second.get()->isCurrent())
        return known->second;

    Handle const made(new ReflectiveLayout(metaClass));
    std::erase_if(latest, [](auto const& entry) { return !entry.second.get()->getMetaClass(); });
    return latest.insert_or_assign(metaClass.getImpl(), made).first->second;
}

ReflectiveLayout::ReflectiveLayout(meta::Class const& metaClass) : m_metaClass(metaClass)
{
    for (meta::Class at = metaClass; at && !isOnChain(at.getImpl()); at = at->getSuperclass())
    {
        m_chain.push_back(at);
        addSlots(at);
    }
    m_recordSize = m_facts.size();
    for (ReflectiveSlot const& slot : m_slots)
    {
        if (slot.index() <= std::numeric_limits<int>::max())  // no negative one
            m_recordSize = std::max(m_recordSize, slot.index() + 1);
    }
    tieDependents();
    buildIndex();
}

bool ReflectiveLayout::isOnChain(meta::Class::Impl const* metaClass) const
{
    return std::any_of(m_chain.begin(), m_chain.end(),
                       [&](meta::Class const& member) { return member.getImpl() == metaClass; });
}

void ReflectiveLayout::addSlots(meta::Class const& owner)
{
    for (auto const& [name, property] : owner->getOwnedAttributes())
    {
        if (!property->isDerived())
            m_slots.emplace_back(property);

        PropertyFacts const facts(*property.getImpl());
        m_facts.push_back(facts);
        m_pins.push_back(property);
        m_pins.emplace_back(property->getTypeImpl());
        m_pins.emplace_back(property->getOppositeImpl());
        m_pins.emplace_back(property->getQualifiedByImpl());
        if (facts.opposite)
            m_pins.emplace_back(facts.opposite->getQualifiedByImpl());
        if (facts.qualifier)
            m_pins.emplace_back(facts.qualifier->getTypeImpl());
    }
}

/// Enters each slot whose opposite is qualified by a property of the class with that property.
void ReflectiveLayout::tieDependents()
{
    for (std::size_t number = 0; number < m_slots.size(); ++number)
    {
        meta::Property const& qualifier = m_slots[number].oppositeQualifier();
        if (!qualifier)
            continue;
        for (ReflectiveSlot& slot : m_slots)
        {
            if (slot.property() == qualifier)
                slot.addDependent(static_cast<std::uint16_t>(number));
        }
    }
}

void ReflectiveLayout::buildIndex()
{
    TARNKILN_ASSERT(m_slots.size() < NONE, "a class has fewer properties", m_slots.size());
    std::size_t size = 4;
    while (size < 2 * m_slots.size())
        size *= 2;
    m_index.assign(size, NONE);
    m_indexMask = size - 1;
    for (std::size_t number = 0; number < m_slots.size(); ++number)
    {
        std::size_t place = hash(m_slots[number].property().getImpl());
        while (m_index[place] != NONE)
            place = (place + 1) & m_indexMask;
        m_index[place] = static_cast<std::uint16_t>(number);
        m_slotsByIndex.push_back(&m_slots[number]);
    }
    std::stable_sort(m_slotsByIndex.begin(), m_slotsByIndex.end(),
                     [](ReflectiveSlot const* left, ReflectiveSlot const* right) {
                         return left->index() < right->index();
                     });
}

ReflectiveSlot const* ReflectiveLayout::findByIndex(unsigned long index) const
{
    auto const found = std::lower_bound(
        m_slotsByIndex.begin(), m_slotsByIndex.end(), index,
        [](ReflectiveSlot const* slot, unsigned long wanted) { return slot->index() < wanted; });
    return found != m_slotsByIndex.end() && (*found)->index() == index ? *found : nullptr;
}

/// Whether a layout made now would be the same.
bool ReflectiveLayout::isCurrent() const
{
    auto known = m_facts.begin();
    meta::Class::Impl const* at = m_metaClass.getImpl();
    for (meta::Class const& member : m_chain)
    {
        if (member.getImpl() != at || !member)
            return false;
        for (auto const& [name, property] : at->getOwnedAttributes())
        {
            if (known == m_facts.end() || !(*known++ == PropertyFacts(*property.getImpl())))
                return false;
        }
        at = at->getSuperclassImpl();
    }
    return known == m_facts.end() && (!at || !at->isLive() || isOnChain(at));
}
}  // namespace tarn::kiln::internal
