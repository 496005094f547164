/// \file
/// The record of what a reflective element was before a transaction.
#pragma once
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"

namespace tarn::kiln {

/// The old cells of the slots that changed, and of no others. Reports may keep it alive longer than
/// the element.
class ReflectiveModelElementImpl::ReflectiveStorage final : public ModelElement::Impl::Storage
{
public:
    explicit ReflectiveStorage(ReflectiveModelElementImpl const& element);
    ~ReflectiveStorage() override;

    /// The empty value for a property of the class that did not change.
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  (property, class) if it is none of the class.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the type) for a
    ///     many-valued property that did not change.
    Value getOldValue(meta::Property const& property,
                      ReflectionPrivateTag const& tag) const override;

    /// Keeps a copy of the cell, unless one is kept.
    void keep(internal::ReflectiveSlot const& slot, internal::ReflectiveCell cell);
    /// Exchanges what is kept and what `cells` hold. Allocates nothing.
    void swapWith(internal::ReflectiveCells& cells) noexcept;

private:
    using Word = decltype(internal::ReflectiveCell::word);

    /// Under what `oldValues` keeps the word of the cell; the state of the cell goes with it.
    static unsigned long keyOf(internal::ReflectiveSlot const& slot) { return slot.number() + 1UL; }
    /// Calls `visit(slot, word, state)` for each cell that is kept.
    template <class Visit> void forEachCell(Visit const& visit);
    Value oldContainerBy(meta::Property const& property) const;

    internal::ReflectiveLayout::Handle const m_layout;
};
}  // namespace tarn::kiln
