/// \file
/// How the elements of a class that is known at run time keep their properties.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/internal/Slabs.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/internal/PropertyFacts.h"
#include "tarnkiln/meta/internal/ReflectiveSlot.h"
#include "tarnkiln/meta/internal/SlotFacts.h"
#include "tarnkiln/support/CountedPointer.h"
#include "tarnkiln/support/ModelAnchor.h"
#include "tarnkiln/support/Shared.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace tarn::kiln::internal {

/// The slots of a class, its own first, then those of each superclass; in each class by name.
///
/// Elements of a class share one layout until the class changes, and each keeps the one it was made
/// with: a property that the class gains later is none of theirs.
///
/// Threads: any; handles to it may be copied and dropped anywhere.
class ReflectiveLayout : public support::Shared<ReflectiveLayout>
{
public:
    using Handle = support::CountedPointer<ReflectiveLayout const>;

    /// The link to the layout goes between the cells of an element and the element.
    static constexpr std::size_t LINK_SIZE = sizeof(void*);

    /// The layout for new elements of `metaClass`.
    ///
    /// \throws tarnkiln::messages::CannotUsePropertyWithoutType, UnsupportedQualification,
    ///     InvalidValue  as `ReflectiveSlot`, for the first property that is at fault.
    static Handle of(meta::Class const& metaClass);

    /// Never 0, and never that of another layout, gone or not.
    std::uint64_t id() const { return m_id; }
    meta::Class const& getMetaClass() const { return m_metaClass; }
    std::vector<ReflectiveSlot> const& slots() const { return m_slots; }
    /// Those of them that refer to elements, one or many: all but the references to containers.
    std::vector<ReflectiveSlot const*> const& references() const { return m_references; }
    /// Those of plain values, by how new elements come to theirs: all the same word, or each one
    /// of its own.
    std::vector<ReflectiveSlot const*> const& sharedInitials() const { return m_sharedInitials; }
    std::vector<ReflectiveSlot const*> const& ownInitials() const { return m_ownInitials; }
    /// What the cells of an element take, the link to this included.
    std::size_t cellBytes() const { return m_cellBytes; }
    /// Null if the property has no slot.
    ReflectiveSlot const* find(meta::Property::Impl const* property) const
    {
        std::size_t place = hash(property);
        while (m_index[place].slot && m_index[place].property != property)
            place = (place + 1) & m_indexMask;
        return m_index[place].slot;
    }
    ReflectiveSlot const* find(meta::Property const& property) const
    {
        return find(property.getImpl());
    }
    /// The same slots in the order of their property indices.
    std::vector<ReflectiveSlot const*> const& slotsByIndex() const { return m_slotsByIndex; }
    /// The first slot of that property index; null if there is none.
    ReflectiveSlot const* findByIndex(unsigned long index) const;
    /// What is true of the slot now: asked of the metamodel once, and again when that has changed.
    SlotFacts factsOf(ReflectiveSlot const& slot) const
    {
        SlotFacts const* const known = knownFacts(slot);
        return known ? *known : askFacts(slot);
    }
    /// The same in their place, if they are known, else in `room`.
    SlotFacts const& factsOf(ReflectiveSlot const& slot, std::optional<SlotFacts>& room) const
    {
        SlotFacts const* const known = knownFacts(slot);
        return known ? *known : room.emplace(askFacts(slot));
    }
    /// Whether the property of the slot may be read now.
    bool mayRead(ReflectiveSlot const& slot,
                 ModelElement::Impl::ReflectionPrivateTag const& tag) const
    {
        return isKnownToBeReadable(slot, tag) || factsOf(slot).mayRead(tag);
    }
    /// The same; false also where the metamodel would have to be asked.
    bool isKnownToBeReadable(ReflectiveSlot const& slot,
                             ModelElement::Impl::ReflectionPrivateTag const& tag) const
    {
        SlotFacts const* const known = knownFacts(slot);
        return known && known->mayRead(tag);
    }
    /// The slots of the change records of elements.
    unsigned long getRecordSize() const { return m_recordSize; }
    /// Where elements lie, and where those do that have room for more.
    Slabs& elements() const { return m_elements; }
    Slabs& largerElements() const { return m_largerElements; }

private:
    friend class support::Shared<ReflectiveLayout>;

    struct IndexEntry
    {
        meta::Property::Impl const* property = nullptr;
        ReflectiveSlot const* slot = nullptr;
    };
    /// The facts of all slots, and the version of the models for which they hold.
    struct Known
    {
        std::vector<SlotFacts> facts;
        Known const* earlier = nullptr;  ///< Owned, for a reader may still be at it.
        mutable std::atomic<std::uint64_t> version;
    };

    explicit ReflectiveLayout(meta::Class const& metaClass);
    ~ReflectiveLayout();

    /// As long as it is the same, nothing in the models that the class depends on has changed; 0
    /// while one of them is being changed.
    std::uint64_t getSettledVersion() const
    {
        if (m_onlyModel)
            return m_onlyModel->getSettledVersion();
        std::uint64_t sum = 0;
        for (auto const& model : m_models)
        {
            std::uint64_t const version = model.get()->getSettledVersion();
            if (version == 0)
                return 0;
            sum += version;
        }
        return sum;
    }
    /// Null if they must be asked.
    SlotFacts const* knownFacts(ReflectiveSlot const& slot) const
    {
        Known const* const known = m_known.load(std::memory_order_acquire);
        if (!known || known->version.load(std::memory_order_relaxed) != getSettledVersion())
            return nullptr;
        return &known->facts[slot.number()];
    }
    SlotFacts askFacts(ReflectiveSlot const& slot) const;
    void remember(std::uint64_t version) const;
    void listModels();
    bool isCurrent() const;
    bool isUnchanged() const;
    bool isOnChain(meta::Class::Impl const* metaClass) const;
    void addSlots(meta::Class const& owner);
    void numberSlots();
    void listReferences();
    void listInitials();
    void tieDependents();
    void buildIndex();
    std::size_t hash(meta::Property::Impl const* property) const
    {
        auto const address = reinterpret_cast<std::uintptr_t>(property);
        return (address >> 6 ^ address >> 12) & m_indexMask;
    }

    std::uint64_t const m_id;
    meta::Class m_metaClass;
    std::vector<meta::Class> m_chain;    ///< The class and its superclasses.
    std::vector<PropertyFacts> m_facts;  ///< Of all owned attributes of the chain, in order.
    std::vector<ModelElement> m_pins;    ///< Keeps what the facts point to from being another one.
    std::vector<ReflectiveSlot> m_slots;
    std::vector<ReflectiveSlot const*> m_references;
    std::vector<ReflectiveSlot const*> m_sharedInitials;
    std::vector<ReflectiveSlot const*> m_ownInitials;
    std::vector<ReflectiveSlot const*> m_slotsByIndex;
    std::vector<IndexEntry> m_index;  ///< Hashed by the address of the property.
    std::size_t m_indexMask = 0;
    std::size_t m_cellBytes = 0;
    unsigned long m_recordSize = 0;
    std::vector<support::CountedPointer<support::ModelAnchor>> m_models;  ///< Of all of the above.
    support::ModelAnchor const* m_onlyModel = nullptr;       ///< Of `m_models`, if it is one.
    mutable std::atomic<std::uint64_t> m_currentVersion{0};  ///< When the facts were last the same.
    mutable std::atomic<Known const*> m_known{nullptr};
    mutable Slabs m_elements;
    mutable Slabs m_largerElements;
};
}  // namespace tarn::kiln::internal
