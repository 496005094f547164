/// \file
/// The bodies of generated getters and setters.
///
/// All setters take the same road, and each step has its place: refuse what can not be done before
/// anything changes; return if nothing would change; join a transaction; announce the change while
/// the old value is still in place; store; bring the other end into step; commit.
#pragma once
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/support/CountedPointer.h"
#include "tarnkiln/support/JoiningTransaction.h"
#include "tarnkiln/support/LazyCollection.h"

#include <memory>
#include <type_traits>

namespace tarn::kiln::support {

/// Fails with `CannotModifyProxy` if `element` only stands in for another.
inline void refuseProxy(ModelElement::Impl const& element)
{
    if (element.isProxy())
        reportException(tarnkiln::messages::CannotModifyProxy());
}

/// Fails with `CannotSetReadOnlyProperty` if a property that can be set once has a value already.
/// A document that is read may set it nevertheless.
template <class T>
void refuseSecondValue(ModelElement::Impl const& element, T const& present,
                       ustring const& propertyName)
{
    refuseProxy(element);
    if (element.isLive() && !element.getModelImpl()->isParsing() && !(present == T()))
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(propertyName));
}

/// The same for a reference; the target that it has may be given again.
inline void refuseSecondTarget(ModelElement::Impl const& element, ModelElement::Impl const* present,
                               ModelElement::Impl const* target, ustring const& propertyName)
{
    refuseProxy(element);
    bool const isSet = present && present != target && present->isLive();
    if (element.isLive() && !element.getModelImpl()->isParsing() && isSet)
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(propertyName));
}

/// Stores a plain value. A destroyed element ignores it.
template <class T>
void setScalar(ModelElement::Impl& element, T& field, Slot const& slot,
               std::type_identity_t<T> const& value)
{
    refuseProxy(element);
    if (value == field || !element.isLive())
        return;
    if (std::is_nothrow_copy_assignable_v<T> && element.getModelImpl()->isChangedInSilence())
    {
        field = value;
        return;
    }
    JoiningTransaction transaction(element);
    element.notifyModifying(slot.index);
    field = value;
    transaction.commit();
}

/// The target of a single reference, which takes the place of its proxy if it can be found.
///
/// Finding it is no change of the model: nothing is announced.
///
/// \param load  whether its model may be loaded for that.
template <class Target>
Target* resolve(ModelElement::Impl const& element, CountedPointer<Target>& field, Slot const& slot,
                bool load = true)
{
    Target* const target = field.get();
    Model::Impl* const model = element.getModelImpl();
    if (!target || !target->isProxy() || !model)
        return target;
    ModelElement const proxy(target);
    ModelElement const found =
        load ? model->resolveProxy(&element, proxy) : model->peekResolveProxy(&element, proxy);
    auto* const resolved = dynamic_cast<Target*>(found.getImpl());
    if (!found || !resolved || resolved->isProxy())
        return target;
    if (slot.opposite && !slot.composite && !element._inverseContainsThis(resolved, *slot.opposite))
        return target;
    field = CountedPointer<Target>(resolved);
    model->getAnchor().get()->changed();
    return resolved;
}

/// Stores the target of a single reference, be it contained or not, and keeps the other end in
/// step.
///
/// \param requireFree  called before anything changes, if there is a target; fails if the other end
///                     has no room.
template <class Target, class RequireFree>
void setReference(ModelElement::Impl& element, CountedPointer<Target>& field, Slot const& slot,
                  std::type_identity_t<Target>* value, RequireFree requireFree)
{
    refuseProxy(element);
    if (value == field.get() || !element.isLive())
        return;
    ModelElement const self(&element);
    CountedPointer<Target> const added(value);
    CountedPointer<Target> const removed = field;
    if (value && value->isLive())
        requireFree();
    element.checkCompatibleModel(value, slot);

    JoiningTransaction transaction(element);
    element.notifyModifying(slot.index);
    bool const oldLives = removed && removed.get()->isLive();
    if (oldLives && slot.opposite)
        element._inverseRemoveThis(removed.get(), *slot.opposite);
    field = added;
    if (value && value->isLive() && slot.opposite)
        element._inverseAddThis(value, *slot.opposite, /*force=*/false);
    else if (value && value->isLive() && slot.composite)
        element._setContainedByThis(value, slot);
    if (oldLives && slot.composite && !slot.opposite)
        element._basicSetUncontained(removed.get());
    transaction.commit();
}

template <class Target>
void setReference(ModelElement::Impl& element, CountedPointer<Target>& field, Slot const& slot,
                  std::type_identity_t<Target>* value)
{
    setReference(element, field, slot, value, [] {});
}

/// The container, if the element is held by the property opposite of `slot`; else null.
template <class Target> Target* containerOf(ModelElement::Impl const& element, Slot const& slot)
{
    if (!element.containerImpl() || element.getContainment() != Feature(*slot.opposite))
        return nullptr;
    return static_cast<Target*>(element.containerImpl());
}

/// Moves the element into the property of `container` that is opposite of `slot`, or, if
/// `container` is null, to the top level.
///
/// \param requireFree  called before anything changes; fails if the container has no room.
template <class Target, class RequireFree>
void setContainer(ModelElement::Impl& element, Slot const& slot, Target* container,
                  RequireFree requireFree)
{
    refuseProxy(element);
    Target* const present = containerOf<Target>(element, slot);
    if (container == present || !element.isLive())
        return;
    if (container)
    {
        refuseProxy(*container);
        requireFree();
        element.checkCircularContainment(ModelElement(container));
        if (container->getModelImpl() != element.getModelImpl())
            reportException(tarnkiln::messages::CannotChangeModel());
    }
    ModelElement const self(&element);
    ModelElement const from(present);
    ModelElement const to(container);

    JoiningTransaction transaction(element);
    element.notifyModifying(slot.index);
    element.makeUncontained();
    if (container && container->isLive())
    {
        element.basicSetContainer(container, *slot.opposite, ModelElement::Impl::NO_INDEX);
        element._inverseAddThis(container, *slot.opposite, /*force=*/true);
    }
    transaction.commit();
}

template <class Target>
void setContainer(ModelElement::Impl& element, Slot const& slot, Target* container)
{
    setContainer(element, slot, container, [] {});
}

/// Whether a collection of `element` that was not made yet might be filled when it is.
inline bool hasDataSource(ModelElement::Impl const& element)
{
    Model::Impl* const model = element.getModelImpl();
    return model && model->getDataSource();
}

/// The collection in `field`, which `make(owner)` makes on its first use and the data source fills.
template <class Owner, class Collection, class Make>
Collection& madeCollection(Owner const& owner, LazyCollection<Collection>& field, Make make)
{
    if (Collection* const present = field.get())
        return *present;
    bool const first = field.publish(make(const_cast<Owner*>(&owner)));
    if constexpr (std::is_base_of_v<ReferenceCollection, Collection>)
    {
        if (first)
            owner._loadCollectionContents(field.get());
    }
    return *field.get();
}

/// The same for a getter: stand-ins whose targets are there by now have given way to them.
template <class Owner, class Collection, class Make>
Collection& shownCollection(Owner const& owner, LazyCollection<Collection>& field, Make make)
{
    refuseProxy(owner);
    Collection& collection = madeCollection(owner, field, make);
    constexpr bool keepsProxiesAside = requires(ModelElement const& proxy)
    {
        collection.removeProxy(proxy);
    };
    if constexpr (keepsProxiesAside)
    {
        Model::Impl* const model = owner.getModelImpl();
        if (model && !model->isParsing())
            collection.resolveAll();
    }
    return collection;
}
}  // namespace tarn::kiln::support
