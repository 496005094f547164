/// \file
/// One stored property of the elements of a class that is known at run time.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/meta/internal/PayloadAccess.h"
#include "tarnkiln/meta/internal/ReferenceCollectionRecipe.h"
#include "tarnkiln/meta/internal/ReflectiveCell.h"
#include "tarnkiln/meta/internal/SlotKind.h"

#include <boost/optional.hpp>

#include <cstdint>
#include <cstring>
#include <memory>
#include <vector>

namespace tarn::kiln::internal {

/// What was decided about a property when the layout of its class was made, and how its cells are
/// read, kept and freed.
///
/// Access rights, shape and opposite are asked of the property itself, each time.
///
/// Threads: immutable once its layout is made.
class ReflectiveSlot
{
public:
    /// \throws tarnkiln::messages::CannotUsePropertyWithoutType  (name) if the type is not live.
    /// \throws tarnkiln::messages::UnsupportedQualification  as `ReferenceCollectionRecipe`, and as
    ///     the registry for collections of data types.
    /// \throws tarnkiln::messages::InvalidValue  if a single value has none to start with.
    explicit ReflectiveSlot(meta::Property const& property);

    meta::Property const& property() const { return m_property; }
    /// Of plain values, as it was when the layout was made.
    meta::Type const& type() const { return m_type; }
    SlotKind kind() const { return m_kind; }
    /// Its place among the slots of its layout.
    std::uint16_t number() const { return m_number; }
    /// Where the word and the state of its cell lie, in bytes before the `ReflectiveCells` of
    /// an element. Containers, which the element's link tells, have no cell; theirs are 0.
    std::size_t wordAt() const { return m_wordAt; }
    std::size_t stateAt() const { return m_stateAt; }
    void setPlaces(std::size_t number, std::size_t wordAt, std::size_t stateAt);
    /// The slot in change records: the property's index; `NO_INDEX` for -1.
    unsigned long index() const { return m_index; }
    /// The slots whose elements keep this element by the key that is this slot's value.
    std::vector<std::uint16_t> const& dependents() const { return m_dependents; }
    void addDependent(std::uint16_t slot) { m_dependents.push_back(slot); }
    /// The property that qualifies the opposite; empty if there is none.
    meta::Property const& oppositeQualifier() const { return m_oppositeQualifier; }

    /// What a new element starts with, kept as an element keeps it.
    ReflectiveCell keepInitial() const;
    /// The same if it is one word for all, of which no ownership converter is told; else null.
    ReflectiveCell const* sharedInitial() const { return m_initialCell.get_ptr(); }

    /// \name Cells of plain values
    /// @{
    /// The same value as was kept.
    Value read(ReflectiveCell cell) const;
    /// Whether all there is to the value is its payload, as the word of the cell.
    bool isWord(ReflectiveCell cell) const { return m_wordPayload && cell.isPacked(); }
    /// As `read`, of such a cell.
    Value readWord(ReflectiveCell cell) const
    {
        auto const flags =
            cell.state == CellState::Single ? ValueFlags::Single : ValueFlags::OptionalSingle;
        return support::PayloadAccess::makeOfWord(m_type, flags, *m_wordPayload, cell.word);
    }
    /// Whether the cell of `value` would be such a one, which `cell` becomes then.
    bool packWord(Value const& value, ReflectiveCell& cell) const
    {
        ValueFlags const flags = value.getFlags();
        bool const isShaped = flags == ValueFlags::Single || flags == ValueFlags::OptionalSingle;
        if (!m_wordPayload || !isShaped || value.isReflective() || !value.isManaged() ||
            value.getType() != m_type)
            return false;
        void const* const payload = support::PayloadAccess::ofKind(value, *m_wordPayload);
        if (!payload)
            return false;
        std::memcpy(&cell.word, payload, sizeof cell.word);
        cell.word &= m_wordMask;
        cell.state = flags == ValueFlags::Single ? CellState::Single : CellState::Optional;
        return true;
    }
    /// Whether two cells that `packWord` could have made hold equal payloads in the same shape.
    bool isSameWord(ReflectiveCell left, ReflectiveCell right) const;
    /// A copy of `value` as cells hold it.
    ReflectiveCell keep(Value const& value) const;
    /// The same of what the ownership converter makes of `value`.
    ReflectiveCell keepOwn(Value const& value) const;
    /// The same value as `value`, with the shape `Single` if it has the shape `OptionalSingle` and
    /// holds something.
    Value asRequired(Value const& value) const;
    /// Whether `read` would give a value equal to `value`.
    bool holds(ReflectiveCell cell, Value const& value) const;
    /// @}

    /// \name All cells
    /// @{
    /// Frees what the cell holds, after the ownership converter of a plain value was told.
    void release(ReflectiveCell cell) const noexcept;
    /// A copy for a record: plain values pass the ownership converter, references are counted,
    /// collections give a snapshot.
    ReflectiveCell copy(ReflectiveCell cell) const;
    /// A new collection for the slot; may be null for plain values of types that have none.
    std::unique_ptr<AbstractOwnedCollection> makeCollection(ModelElement::Impl* owner) const;
    /// @}

private:
    bool isEmpty(Value const& value) const;
    bool isPackable(Value const& value) const;
    bool isInitialShared() const;
    void findWordPayload();
    bool owns(ReflectiveCell cell) const;
    void free(ReflectiveCell cell) const noexcept;
    ReflectiveCell copyPlain(ReflectiveCell cell) const;

    meta::Property m_property;
    meta::Type m_type;  ///< Of the property when the layout was made.
    meta::Property m_oppositeQualifier;
    SlotKind m_kind;
    std::uint16_t m_number = 0;
    std::uint32_t m_wordAt = 0;
    std::uint32_t m_stateAt = 0;
    std::uint64_t m_wordMask = 0;  ///< The bits of a word that the payload takes.
    /// What values do with the payload; null unless it lies in the word and is nothing but bytes.
    ValuePayload::Functions const* m_wordPayload = nullptr;
    unsigned long m_index;
    boost::optional<ReferenceCollectionRecipe> m_recipe;  ///< Of `References`.
    boost::optional<Value> m_empty;  ///< What `CellState::Empty` stands for; optional values only.
    boost::optional<Value> m_initial;  ///< None, if it is to be found anew for each element.
    /// `m_initial` as it is kept, where that is nothing but a word.
    boost::optional<ReflectiveCell> m_initialCell;
    std::vector<std::uint16_t> m_dependents;
};
}  // namespace tarn::kiln::internal
