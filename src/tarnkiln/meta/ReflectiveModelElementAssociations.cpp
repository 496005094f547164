// How reflective elements keep step with the other ends of their references, and how they end.
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tarnkiln/meta/internal/DependentCollections.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"

#include <algorithm>
#include <ranges>

namespace tarn::kiln {

using internal::DependentCollections;
using internal::SlotKind;

namespace {

/// The slots of references that are not empty and of collections that are there.
auto usedReferences(internal::ReflectiveCells const& cells)
{
    return cells.layout().references() |
           std::views::filter(
               [&cells](internal::ReflectiveSlot const* slot) { return cells.word(*slot) != 0; });
}

bool isDying(ModelElement::Impl const& source, ModelElement const& target)
{
    return target && !target->isProxy() && target->getModelImpl() != source.getModelImpl();
}
}  // namespace

void ReflectiveModelElementImpl::inverseAdd(ModelElement const& element,
                                            meta::Property const& property)
{
    ReflectiveSlot const* const slot = getCells().layout().find(property);
    switch (slot ? slot->kind() : SlotKind::Other)
    {
    case SlotKind::References:
        _basicAdd(&loaded(*slot), element);
        return;
    case SlotKind::Container: {
        if (containerBy(*slot) == element.getImpl())
            return;
        ModelElement const self(this);
        notifyModifying(slot->index());
        makeUncontained();
        basicSetContainer(element.getImpl(), Feature(property).opposite(), slot->index());
        return;
    }
    case SlotKind::Reference: {
        ModelElement const removed(cells().target(*slot));
        if (removed == element)
            return;
        ModelElement const self(this);
        notifyModifying(slot->index());
        if (removed)
        {
            if (Feature const opposite = Feature(property).opposite())
                _inverseRemoveThis(removed.getImpl(), opposite);
        }
        cells().setTarget(*slot, element);
        return;
    }
    default:
        ModelElement::Impl::inverseAdd(element, property);
    }
}

void ReflectiveModelElementImpl::inverseRemove(ModelElement const& element,
                                               meta::Property const& property)
{
    ReflectiveSlot const* const slot = getCells().layout().find(property);
    ModelElement const self(this);
    switch (slot ? slot->kind() : SlotKind::Other)
    {
    case SlotKind::References:
        _basicRemove(&loaded(*slot), element);
        return;
    case SlotKind::Container:
        if (containerBy(*slot) != element.getImpl())
            return;
        notifyModifying(slot->index());
        basicSetContainer(nullptr, Feature(), NO_INDEX);
        return;
    case SlotKind::Reference:
        if (!refersTo(*slot, element))
            return;
        notifyModifying(slot->index());
        cells().setTarget(*slot, ModelElement());
        return;
    default:
        ModelElement::Impl::inverseRemove(element, property);
    }
}

bool ReflectiveModelElementImpl::inverseContainsProxyTo(ModelElement const& element,
                                                        meta::Property const& property) const
{
    ReflectiveSlot const* const slot = getCells().layout().find(property);
    switch (slot ? slot->kind() : SlotKind::Other)
    {
    case SlotKind::References: {
        if (_basicContainsProxyTo(&loaded(*slot), element))
            return true;
        std::vector<ModelElement> const present = members(*slot);
        return std::find(present.begin(), present.end(), element) != present.end();
    }
    case SlotKind::Container:
        return true;
    case SlotKind::Reference:
        if (!refersTo(*slot, element))
            return false;
        cells().setTarget(*slot, element);
        return true;
    default:
        return ModelElement::Impl::inverseContainsProxyTo(element, property);
    }
}

// ---------------------------------------------------------------------------- the end

/// Collections that keep this element by a reference go first, while that still tells the key.
void ReflectiveModelElementImpl::disassociateIncoming()
{
    Layout const& layout = getCells().layout();
    for (ReflectiveSlot const* const slot : layout.references())
    {
        if (slot->kind() == SlotKind::Reference && !slot->dependents().empty())
            DependentCollections(*this, *slot).leave();
    }
    for (ReflectiveSlot const* const used : usedReferences(getCells()))
    {
        ReflectiveSlot const& slot = *used;
        internal::SlotFacts const facts = layout.factsOf(slot);
        if (facts.isComposite || !facts.opposite)
            continue;
        auto const leave = [&](ModelElement const& target) {
            if (target)
                _inverseRemoveThis(target.getImpl(), facts.opposite);
        };
        if (slot.kind() == SlotKind::Reference)
        {
            ModelElement const target(cells().target(slot));
            notifyModifying(slot.index());
            leave(target);
            cells().setTarget(slot, ModelElement());
            continue;
        }
        std::vector<ModelElement> const targets = members(slot);
        if (targets.empty())
            continue;
        notifyModifying(slot.index());
        std::for_each(targets.begin(), targets.end(), leave);
        _basicClear(&loaded(slot));
    }
}

void ReflectiveModelElementImpl::doDestroy(bool keepIncoming, bool multiModel)
{
    for (ReflectiveSlot const* const used : usedReferences(getCells()))
    {
        ReflectiveSlot const& slot = *used;
        bool const isComposite = getCells().layout().factsOf(slot).isComposite;
        if (slot.kind() == SlotKind::Reference)
        {
            if (isComposite)
                cells().target(slot)->destroyRecursively(keepIncoming,
                                                         /*removeFromContainer=*/false, multiModel);
            notifyModifying(slot.index());
            cells().setTarget(slot, ModelElement());
            continue;
        }
        std::vector<ModelElement> children = members(slot);
        if (children.empty())
            continue;
        if (isComposite)
            _destroyEach(std::move(children), keepIncoming, multiModel);
        _basicClear(static_cast<ReferenceCollection*>(cells().getCollection(slot)));
    }
}

void ReflectiveModelElementImpl::convertReferencesToProxies(bool multiModel,
                                                            boost::optional<ProxyId>& cachedId)
{
    for (ReflectiveSlot const* const used : usedReferences(getCells()))
    {
        ReflectiveSlot const& slot = *used;
        if (getCells().layout().factsOf(slot).isComposite)
            continue;
        if (multiModel)
            leaveProxies(slot, cachedId);
        if (slot.kind() == SlotKind::Reference)
            cells().setTarget(slot, ModelElement());
        else
            _basicClear(static_cast<ReferenceCollection*>(cells().getCollection(slot)));
    }
}

/// Puts a proxy for this element into those of other models that refer to it by the slot's
/// opposite.
void ReflectiveModelElementImpl::leaveProxies(ReflectiveSlot const& slot,
                                              boost::optional<ProxyId>& cachedId)
{
    Feature const opposite = layout().factsOf(slot).opposite;
    if (!opposite)
        return;
    std::vector<ModelElement> const targets =
        slot.kind() == SlotKind::Reference
            ? std::vector<ModelElement>(1, ModelElement(cells().target(slot)))
            : members(slot);
    for (ModelElement const& target : targets)
    {
        if (!isDying(*this, target))
            continue;
        if (!cachedId)
            cachedId = _getPersistentProxyId();
        _convertToProxy(target.getImpl(), opposite, *cachedId);
    }
}

void ReflectiveModelElementImpl::convertToProxy(meta::Property const&, ProxyId const&,
                                                ModelElement const&)
{}

void ReflectiveModelElementImpl::basicDisassociateAll()
{
    for (ReflectiveSlot const& slot : layout().slots())
    {
        if (slot.kind() == SlotKind::Reference)
            cells().setTarget(slot, ModelElement());
        else if (slot.kind() != SlotKind::References)
            continue;
        else if (AbstractOwnedCollection* const present = cells().getCollection(slot))
            present->basicDropContents();
    }
}
}  // namespace tarn::kiln
