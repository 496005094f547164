#include "tarnkiln/meta/internal/ReflectiveLayout.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/RecentSlots.h"

#include <algorithm>
#include <limits>
#include <memory>
#include <mutex>
#include <unordered_map>
#include <utility>

namespace tarn::kiln::internal {
namespace {

using Layouts = std::unordered_map<meta::Class::Impl const*, ReflectiveLayout::Handle>;

/// The layouts that this thread made last, by class. A class that is in here can not be freed and
/// its address not be used again.
thread_local Layouts latest;
/// Often the next element is of the same class. One of `latest`, or null.
thread_local constinit ReflectiveLayout const* last = nullptr;

std::atomic<std::uint64_t> lastId{0};

std::mutex knowing;  ///< Held by the one who remembers facts.
}  // namespace

ReflectiveLayout::Handle ReflectiveLayout::of(meta::Class const& metaClass)
{
    if (last && last->getMetaClass() == metaClass && last->isCurrent())
        return Handle(last);
    auto const known = latest.find(metaClass.getImpl());
    if (known != latest.end() && known->second.get()->isCurrent())
    {
        last = known->second.get();
        return known->second;
    }
    Handle const made(new ReflectiveLayout(metaClass));
    last = nullptr;
    std::erase_if(latest, [](auto const& entry) { return !entry.second.get()->getMetaClass(); });
    return latest.insert_or_assign(metaClass.getImpl(), made).first->second;
}

constinit thread_local std::array<RecentSlots::Entry, RecentSlots::NUMBER> RecentSlots::entries;

ReflectiveLayout::ReflectiveLayout(meta::Class const& metaClass)
    : m_id(++lastId),
      m_metaClass(metaClass)
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
    numberSlots();
    listReferences();
    listInitials();
    tieDependents();
    buildIndex();
    listModels();
}

ReflectiveLayout::~ReflectiveLayout()
{
    for (Known const* known = m_known.load(); known;)
        delete std::exchange(known, known->earlier);
}

void ReflectiveLayout::listModels()
{
    auto const add = [this](ModelElement::Impl const* element) {
        if (!element || !element->getModelImpl())
            return;
        auto const& anchor = element->getModelImpl()->getAnchor();
        if (std::none_of(m_models.begin(), m_models.end(),
                         [&](auto const& listed) { return listed.get() == anchor.get(); }))
            m_models.push_back(anchor);
    };
    for (meta::Class const& member : m_chain)
        add(member.getImpl());
    for (ModelElement const& pinned : m_pins)
        add(pinned.getImpl());
    if (m_models.size() == 1)
        m_onlyModel = m_models.front().get();
}

/// Remembers only what has not changed while it was asked.
SlotFacts ReflectiveLayout::askFacts(ReflectiveSlot const& slot) const
{
    if (std::uint64_t const version = getSettledVersion())
        remember(version);
    return SlotFacts(m_metaClass, slot);
}

void ReflectiveLayout::remember(std::uint64_t version) const
{
    auto made = std::make_unique<Known>();
    made->version = version;
    for (ReflectiveSlot const& slot : m_slots)
        made->facts.emplace_back(m_metaClass, slot);
    if (getSettledVersion() != version)
        return;

    std::lock_guard const lock(knowing);
    Known const* const known = m_known.load(std::memory_order_relaxed);
    if (known && known->facts == made->facts)
    {
        known->version.store(version, std::memory_order_relaxed);
        return;
    }
    made->earlier = known;
    m_known.store(made.release(), std::memory_order_release);
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

void ReflectiveLayout::numberSlots()
{
    TARNKILN_ASSERT(m_slots.size() <= std::numeric_limits<std::uint16_t>::max(),
                    "a class has fewer properties", m_slots.size());
    auto const hasCell = [](ReflectiveSlot const& slot) {
        return slot.kind() != SlotKind::Container;
    };
    constexpr std::size_t WORD = sizeof(std::uint64_t);
    auto const cells = std::count_if(m_slots.begin(), m_slots.end(), hasCell);
    std::size_t stateAt = 0;
    std::size_t wordAt = (static_cast<std::size_t>(cells) + WORD - 1) / WORD * WORD;
    for (std::size_t number = 0; number < m_slots.size(); ++number)
        m_slots[number].setPlaces(number, 0, 0);
    // What is read without following it lies next to the element.
    for (bool const isNear : {true, false})
    {
        for (std::size_t number = 0; number < m_slots.size(); ++number)
        {
            if (!hasCell(m_slots[number]) || isInPlace(m_slots[number].kind()) != isNear)
                continue;
            stateAt += sizeof(CellState);
            wordAt += WORD;
            m_slots[number].setPlaces(number, wordAt, stateAt);
        }
    }
    m_cellBytes = wordAt + LINK_SIZE;
}

void ReflectiveLayout::listReferences()
{
    for (ReflectiveSlot const& slot : m_slots)
    {
        if (slot.kind() == SlotKind::Reference || slot.kind() == SlotKind::References)
            m_references.push_back(&slot);
    }
}

void ReflectiveLayout::listInitials()
{
    for (ReflectiveSlot const& slot : m_slots)
    {
        if (isPlain(slot.kind()))
            (slot.sharedInitial() ? m_sharedInitials : m_ownInitials).push_back(&slot);
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
    std::size_t size = 4;
    while (size < 2 * m_slots.size())
        size *= 2;
    m_index.resize(size);
    m_indexMask = size - 1;
    for (ReflectiveSlot const& slot : m_slots)
    {
        std::size_t place = hash(slot.property().getImpl());
        while (m_index[place].slot)
            place = (place + 1) & m_indexMask;
        m_index[place] = {slot.property().getImpl(), &slot};
        m_slotsByIndex.push_back(&slot);
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
    std::uint64_t const version = getSettledVersion();
    if (version != 0 && version == m_currentVersion.load(std::memory_order_relaxed))
        return true;
    if (!isUnchanged())
        return false;
    m_currentVersion.store(version, std::memory_order_relaxed);
    return true;
}

bool ReflectiveLayout::isUnchanged() const
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
