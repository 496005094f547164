/// \file
/// How the elements of a class that is known at run time keep their properties.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/internal/PropertyFacts.h"
#include "tarnkiln/meta/internal/ReflectiveSlot.h"
#include "tarnkiln/support/CountedPointer.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace tarn::kiln::internal {

/// The slots of a class, its own first, then those of each superclass; in each class by name.
///
/// Elements of a class share one layout until the class changes, and each keeps the one it was made
/// with: a property that the class gains later is none of theirs.
///
/// Threads: immutable; handles to it may be copied and dropped anywhere.
class ReflectiveLayout
{
public:
    using Handle = support::CountedPointer<ReflectiveLayout const>;

    /// The layout for new elements of `metaClass`.
    ///
    /// \throws tarnkiln::messages::CannotUsePropertyWithoutType, UnsupportedQualification,
    ///     InvalidValue  as `ReflectiveSlot`, for the first property that is at fault.
    static Handle of(meta::Class const& metaClass);

    ReflectiveLayout(ReflectiveLayout const&) = delete;
    ReflectiveLayout& operator=(ReflectiveLayout const&) = delete;

    meta::Class const& getMetaClass() const { return m_metaClass; }
    std::vector<ReflectiveSlot> const& slots() const { return m_slots; }
    std::size_t numberOf(ReflectiveSlot const& slot) const
    {
        return static_cast<std::size_t>(&slot - m_slots.data());
    }
    /// Null if the property has no slot.
    ReflectiveSlot const* find(meta::Property::Impl const* property) const
    {
        std::size_t place = hash(property);
        while (m_index[place] != NONE)
        {
            ReflectiveSlot const& slot = m_slots[m_index[place]];
            if (slot.property().getImpl() == property)
                return &slot;
            place = (place + 1) & m_indexMask;
        }
        return nullptr;
    }
    ReflectiveSlot const* find(meta::Property const& property) const
    {
        return find(property.getImpl());
    }
    /// The same slots in the order of their property indices.
    std::vector<ReflectiveSlot const*> const& slotsByIndex() const { return m_slotsByIndex; }
    /// The first slot of that property index; null if there is none.
    ReflectiveSlot const* findByIndex(unsigned long index) const;
    /// The slots of the change records of elements.
    unsigned long getRecordSize() const { return m_recordSize; }

    void addRef() const { m_refCount.fetch_add(1, std::memory_order_relaxed); }
    void removeRef() const
    {
        if (m_refCount.fetch_sub(1, std::memory_order_acq_rel) == 1)
            delete this;
    }

private:
    static constexpr std::uint16_t NONE = 0xFFFF;

    explicit ReflectiveLayout(meta::Class const& metaClass);
    ~ReflectiveLayout() = default;

    bool isCurrent() const;
    bool isOnChain(meta::Class::Impl const* metaClass) const;
    void addSlots(meta::Class const& owner);
    void tieDependents();
    void buildIndex();
    std::size_t hash(meta::Property::Impl const* property) const
    {
        auto const address = reinterpret_cast<std::uintptr_t>(property);
        return (address >> 6 ^ address >> 12) & m_indexMask;
    }

    meta::Class m_metaClass;
    std::vector<meta::Class> m_chain;    ///< The class and its superclasses.
    std::vector<PropertyFacts> m_facts;  ///< Of all owned attributes of the chain, in order.
    std::vector<ModelElement> m_pins;    ///< Keeps what the facts point to from being another one.
    std::vector<ReflectiveSlot> m_slots;
    std::vector<ReflectiveSlot const*> m_slotsByIndex;
    std::vector<std::uint16_t> m_index;  ///< Slot numbers, hashed by the address of the property.
    std::size_t m_indexMask = 0;
    unsigned long m_recordSize = 0;
    mutable std::atomic<std::uint32_t> m_refCount{0};
};
}  // namespace tarn::kiln::internal
