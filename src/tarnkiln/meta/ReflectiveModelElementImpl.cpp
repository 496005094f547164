#include "tarnkiln/meta/ReflectiveModelElementImpl.h"

#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"

namespace tarn::kiln {

using internal::isCollection;
using internal::isPlain;
using internal::ReflectiveCells;
using internal::ReflectiveLayout;

void ReflectiveModelElementImpl::CellsDeleter::operator()(ReflectiveCells* cells) const
{
    ReflectiveCells::Deleter()(cells);
}

ReflectiveModelElementImpl::ReflectiveModelElementImpl(Model const& model,
                                                       meta::Class const& metaClass, UUID const& id)
    : ModelElement::Impl(model, id),
      m_cells(ReflectiveCells::create(ReflectiveLayout::of(metaClass)).release())
{
    for (ReflectiveSlot const& slot : layout().slots())
    {
        if (isPlain(slot.kind()))
            m_cells->set(slot, slot.keepInitial());
    }
}

ReflectiveModelElementImpl::~ReflectiveModelElementImpl() = default;

internal::ReflectiveLayout const& ReflectiveModelElementImpl::layout() const
{
    return m_cells->layout();
}

meta::Class const& ReflectiveModelElementImpl::getMetaClass() const
{
    return layout().getMetaClass();
}

void ReflectiveModelElementImpl::invalidate()
{
    for (ReflectiveSlot const* slot : layout().slotsByIndex())
    {
        if (!isCollection(slot->kind()))
            continue;
        if (AbstractOwnedCollection* const present = m_cells->getCollection(*slot))
            collectionInvalidated(present);
    }
    ModelElement::Impl::invalidate();
}

meta::Property ReflectiveModelElementImpl::getPropertyByIndex(unsigned long index) const
{
    ReflectiveSlot const* const slot = layout().findByIndex(index);
    return slot ? slot->property() : meta::Property();
}
}  // namespace tarn::kiln
