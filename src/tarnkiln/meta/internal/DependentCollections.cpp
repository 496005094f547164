#include "tarnkiln/meta/internal/DependentCollections.h"

#include "tarnkiln/collections/QualifierKeys.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"

namespace tarn::kiln::internal {

void DependentCollections::find()
{
    for (std::uint16_t const number : m_slot.dependents())
    {
        ReflectiveSlot const& reference = m_element.layout().slots()[number];
        meta::Property const opposite = reference.property()->getOpposite();
        // A reference that is its own key moves from one collection to another by itself.
        if (&reference == &m_slot || !opposite)
            continue;
        for (ModelElement const& holder : m_element.referred(reference))
        {
            if (holder && !holder->isProxy())
                m_holders.push_back({holder, opposite});
        }
    }
}

void DependentCollections::check(Value const& value) const
{
    if (m_holders.empty())
        return;
    if (value.getFlags() == ValueFlags::OptionalSingle && value.isAbsent())
        support::reportMissingKey(m_slot.property());

    Value const key = ReflectiveModelElementImpl::unwrapKey(
        isPlain(m_slot.kind()) ? m_slot.asRequired(value) : value);
    for (Holder const& holder : m_holders)
        ReflectiveModelElementImpl::checkUniqueness(holder.element, holder.collection, key);
}

void DependentCollections::leaveAll() const
{
    for (Holder const& holder : m_holders)
        m_element._inverseRemoveThis(holder.element.getImpl(), holder.collection);
}

void DependentCollections::enterAll() const
{
    for (Holder const& holder : m_holders)
        m_element._inverseAddThis(holder.element.getImpl(), holder.collection, /*force=*/true);
}
}  // namespace tarn::kiln::internal
