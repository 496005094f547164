#include "tarnkiln/meta/ReflectiveModelElementImpl.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/StandIn.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"

namespace tarn::kiln {

using internal::isCollection;
using internal::ReflectiveCells;
using internal::ReflectiveLayout;

ReflectiveModelElementImpl*
ReflectiveModelElementImpl::create(Model const& model, meta::Class const& metaClass, UUID const& id)
{
    if (!model)
        reportException(tarnkiln::messages::CannotCreateWithoutModel());
    LayoutHandle const layout = ReflectiveLayout::of(metaClass);
    return new (layout, /*more=*/0) ReflectiveModelElementImpl(model, layout, id);
}

ReflectiveModelElementImpl* ReflectiveModelElementImpl::createForProxy(Model const& model,
                                                                       meta::Class const& metaClass)
{
    if (!model)
        reportException(tarnkiln::messages::CannotCreateWithoutModel());
    LayoutHandle const layout = ReflectiveLayout::of(metaClass);
    auto* const made = new (layout, sizeof(internal::StandIn))
        ReflectiveModelElementImpl(model, layout, ElementImpl::generateNewUuid());
    static_assert(alignof(internal::StandIn) <= alignof(ReflectiveModelElementImpl));
    made->offerRoom(made + 1);
    return made;
}

void* ReflectiveModelElementImpl::operator new(std::size_t size, LayoutHandle const& layout,
                                               std::size_t more)
{
    internal::Slabs& slabs = more == 0 ? layout.get()->elements() : layout.get()->largerElements();
    std::size_t const cells = layout.get()->cellBytes();
    return static_cast<std::byte*>(slabs.allocate(cells + size + more)) + cells;
}

void ReflectiveModelElementImpl::operator delete(void* element, LayoutHandle const& layout,
                                                 std::size_t /*more*/)
{
    internal::Slabs::free(static_cast<std::byte*>(element) - layout.get()->cellBytes());
}

/// The layout tells where the memory begins, owns it, and may go with the element.
void ReflectiveModelElementImpl::operator delete(ReflectiveModelElementImpl* element,
                                                 std::destroying_delete_t)
{
    LayoutHandle const layout = element->cells().layoutHandle();
    element->~ReflectiveModelElementImpl();
    operator delete(element, layout, /*more=*/0);
}

ReflectiveModelElementImpl::ReflectiveModelElementImpl(Model const& model,
                                                       LayoutHandle const& layout, UUID const& id)
    : ModelElement::Impl(model, id)
{
    static_assert(alignof(ReflectiveModelElementImpl) <= alignof(ReflectiveCells));
    ReflectiveCells* const made =
        ReflectiveCells::create(reinterpret_cast<std::byte*>(this), layout);
    try
    {
        made->fill();
    }
    catch (...)
    {
        made->destroy();
        throw;
    }
}

ReflectiveModelElementImpl::~ReflectiveModelElementImpl()
{
    cells().destroy();
}

internal::ReflectiveLayout const& ReflectiveModelElementImpl::layout() const
{
    return getCells().layout();
}

meta::Class const& ReflectiveModelElementImpl::getMetaClass() const
{
    return layout().getMetaClass();
}

void ReflectiveModelElementImpl::invalidate()
{
    if (m_callback)
    {
        for (ReflectiveSlot const* slot : layout().slotsByIndex())
        {
            if (!isCollection(slot->kind()))
                continue;
            if (AbstractOwnedCollection* const present = cells().getCollection(*slot))
                collectionInvalidated(present);
        }
    }
    ModelElement::Impl::invalidate();
}

meta::Property ReflectiveModelElementImpl::getPropertyByIndex(unsigned long index) const
{
    ReflectiveSlot const* const slot = layout().findByIndex(index);
    return slot ? slot->property() : meta::Property();
}
}  // namespace tarn::kiln
