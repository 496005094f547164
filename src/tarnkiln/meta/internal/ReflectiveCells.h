/// \file
/// The values of one reflective element.
#pragma once
#include "tarnkiln/meta/internal/ReflectiveLayout.h"

#include <cstddef>
#include <cstdint>
#include <memory>

namespace tarn::kiln::internal {

/// The layout, before it a byte for the state of each slot that has a cell, and before them a word
/// for each.
///
/// Lies in one piece of memory just before the element, so that what is read first of an element
/// and its first words are neighbours.
///
/// Threads: as the element; collections may be entered by several threads at once.
class ReflectiveCells
{
public:
    /// All cells are empty.
    ///
    /// \param place  the end of as much room as the layout asks for.
    static ReflectiveCells* create(std::byte* place, ReflectiveLayout::Handle const& layout);
    /// Frees what the cells hold, and not the place.
    void destroy();

    ReflectiveCells(ReflectiveCells const&) = delete;
    ReflectiveCells& operator=(ReflectiveCells const&) = delete;

    ReflectiveLayout const& layout() const { return *m_layout.get(); }
    ReflectiveLayout::Handle const& layoutHandle() const { return m_layout; }

    /// Fetches the first words, for which one who must find a slot would wait only then.
    ///
    /// Not left to the compiler: GCC 12 drops calls of functions that do nothing else.
    [[gnu::always_inline]] void prefetch() const
    {
        __builtin_prefetch(reinterpret_cast<std::byte const*>(this) - 2 * sizeof(std::uint64_t));
    }
    /// Of a slot that has a cell, as in all that follows.
    ReflectiveCell get(ReflectiveSlot const& slot) const { return {word(slot), state(slot)}; }
    /// \name Where the two lie: in all elements of the layout as far before this
    /// @{
    std::uint64_t const& word(ReflectiveSlot const& slot) const
    {
        return const_cast<ReflectiveCells*>(this)->word(slot);
    }
    CellState const& state(ReflectiveSlot const& slot) const
    {
        return const_cast<ReflectiveCells*>(this)->state(slot);
    }
    /// @}
    /// Gives all plain values what a new element starts with.
    void fill();
    /// Frees nothing of what was there.
    void set(ReflectiveSlot const& slot, ReflectiveCell cell)
    {
        word(slot) = cell.word;
        state(slot) = cell.state;
    }
    /// What the reference refers to: a proxy as it stands, null for nothing.
    ModelElement::Impl* target(ReflectiveSlot const& slot) const
    {
        return reinterpret_cast<ModelElement::Impl*>(word(slot));
    }
    /// Changes nothing but the reference; putting a target in the place of its proxy is no change.
    void setTarget(ReflectiveSlot const& slot, ModelElement const& target)
    {
        ModelElement::Impl* const old = this->target(slot);
        if (target.getImpl())
            target.getImpl()->addRef();
        word(slot) = reinterpret_cast<std::uint64_t>(target.getImpl());
        if (old)
            old->release();
    }
    /// The collection of the slot; null while there is none.
    AbstractOwnedCollection* getCollection(ReflectiveSlot const& slot) const;
    /// Enters `made` unless another thread was first; returns the one that is there.
    AbstractOwnedCollection* publish(ReflectiveSlot const& slot,
                                     std::unique_ptr<AbstractOwnedCollection> made);
    /// Marks the collection of the slot as loaded; false if it was.
    bool markLoaded(ReflectiveSlot const& slot);

private:
    explicit ReflectiveCells(ReflectiveLayout::Handle const& layout) : m_layout(layout) {}
    ~ReflectiveCells() = default;

    std::byte* before(std::size_t place) { return reinterpret_cast<std::byte*>(this) - place; }
    std::uint64_t& word(ReflectiveSlot const& slot)
    {
        return *reinterpret_cast<std::uint64_t*>(before(slot.wordAt()));
    }
    CellState& state(ReflectiveSlot const& slot)
    {
        return *reinterpret_cast<CellState*>(before(slot.stateAt()));
    }

    ReflectiveLayout::Handle const m_layout;
};
static_assert(sizeof(ReflectiveCells) == ReflectiveLayout::LINK_SIZE);
}  // namespace tarn::kiln::internal
