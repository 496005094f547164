/// \file
/// The values of one reflective element.
#pragma once
#include "tarnkiln/meta/internal/ReflectiveLayout.h"

#include <cstddef>
#include <cstdint>
#include <memory>

namespace tarn::kiln::internal {

/// A block with the layout, a word for each slot, and behind them a byte for the state of each.
///
/// Threads: as the element; collections may be entered by several threads at once.
class ReflectiveCells
{
public:
    struct Deleter
    {
        void operator()(ReflectiveCells* cells) const { ReflectiveCells::destroy(cells); }
    };
    using Owner = std::unique_ptr<ReflectiveCells, Deleter>;

    /// All cells are empty.
    static Owner create(ReflectiveLayout::Handle const& layout);

    ReflectiveCells(ReflectiveCells const&) = delete;
    ReflectiveCells& operator=(ReflectiveCells const&) = delete;

    ReflectiveLayout const& layout() const { return *m_layout.get(); }
    ReflectiveLayout::Handle const& layoutHandle() const { return m_layout; }

    ReflectiveCell get(ReflectiveSlot const& slot) const
    {
        std::size_t const number = layout().numberOf(slot);
        return {words()[number], states()[number]};
    }
    /// Where the word of the slot lies, as long as the element lives.
    std::uint64_t const& word(ReflectiveSlot const& slot) const
    {
        return words()[layout().numberOf(slot)];
    }
    /// Frees nothing of what was there.
    void set(ReflectiveSlot const& slot, ReflectiveCell cell)
    {
        std::size_t const number = layout().numberOf(slot);
        words()[number] = cell.word;
        states()[number] = cell.state;
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
    static void destroy(ReflectiveCells* cells);
    static std::size_t sizeFor(std::size_t slots);

    std::uint64_t* words() { return reinterpret_cast<std::uint64_t*>(this + 1); }
    std::uint64_t const* words() const { return reinterpret_cast<std::uint64_t const*>(this + 1); }
    CellState* states() { return reinterpret_cast<CellState*>(words() + layout().slots().size()); }
    CellState const* states() const
    {
        return reinterpret_cast<CellState const*>(words() + layout().slots().size());
    }

    ReflectiveLayout::Handle const m_layout;
};
static_assert(sizeof(ReflectiveCells) % alignof(std::uint64_t) == 0);
}  // namespace tarn::kiln::internal
