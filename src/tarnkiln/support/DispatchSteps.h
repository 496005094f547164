/// \file
/// The bodies of `Dispatched` and `Record`.
///
/// Only the source of a class includes this; see Dispatch.h.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/support/Dispatch.h"
#include "tarnkiln/support/RowSteps.h"

#include <boost/optional.hpp>

#include <type_traits>
#include <typeinfo>
#include <utility>

namespace tarn::kiln::support {

/// Calls `step(steps)` for the row whose property is at `slot`; false if there is none.
template <class Rows, class Step> bool atSlot(Slot const& slot, Step step)
{
    return Rows::any([&](auto row) {
        using Row = Steps<decltype(row)>;
        return &Row::slot() == &slot && (step(Row()), true);
    });
}

/// Calls `step(steps, row)` for the row of `property`; false if there is none.
template <class Rows, class Step> bool atRow(meta::Property const& property, Step step)
{
    return Rows::any([&](auto row) {
        using Row = Steps<decltype(row)>;
        return isPropertyOf(Row::slot(), property) && (step(Row(), row), true);
    });
}

/// Calls `step(steps)` for the row of `property`; false if there is none.
template <class Rows, class Step> bool atProperty(meta::Property const& property, Step step)
{
    return atRow<Rows>(property, [&](auto steps, auto /*row*/) { step(steps); });
}

template <class Class> struct ComputedRowsOf
{
    using Type = RowList<>;
};
template <class Class>
requires requires
{
    typename Class::ComputedRows;
}
struct ComputedRowsOf<Class>
{
    using Type = typename Class::ComputedRows;
};

/// Calls `step(steps)` for the row of `property`, be it stored or computed; false if there is none.
template <class Class, class Step> bool atReadable(meta::Property const& property, Step step)
{
    return atProperty<typename Class::Rows>(property, step) ||
           atProperty<typename ComputedRowsOf<Class>::Type>(property, step);
}

/// Whether `tag` allows to read `property`.
inline bool mayRead(meta::Property const& property, internal::ReflectionPrivateTag const& tag)
{
    return property &&
           (property->isPublicAccessor() || !(tag == ModelElement::Impl::PUBLIC_ACCESS));
}

/// Whether `tag` allows to set `property`.
inline bool maySet(meta::Property const& property, internal::ReflectionPrivateTag const& tag)
{
    if (!property || !(tag == ModelElement::Impl::PUBLIC_ACCESS))
        return static_cast<bool>(property);
    return property->isPublicMutator() && !(property->isReadOnly() && !property->isSetOnce());
}

/// What `record` keeps for the row `Row`; null if that is nothing.
template <class Row> auto* oldValueOf(auto& record)
{
    return record.oldValues().template find<typename Row::Old>(Steps<Row>::slot().index);
}

template <class Owner, class Base> Record<Owner, Base>::~Record() = default;

template <class Owner, class Base>
bool Record<Owner, Base>::revertUnchanged(ModelElement::Impl* element)
{
    Owner::Rows::each([&](auto row) {
        using Row = Steps<decltype(row)>;
        unsigned long const index = Row::slot().index;
        if (this->isSlotChanged(index) && Row::isReverted(static_cast<Owner const&>(*element),
                                                          *this, oldValueOf<decltype(row)>(*this)))
            this->clearModified(index);
    });
    return Base::revertUnchanged(element);
}

template <class Owner, class Base>
Value Record<Owner, Base>::getOldValue(meta::Property const& property,
                                       internal::ReflectionPrivateTag const& tag) const
{
    Value (*old)(Record const&, meta::Property const&) = nullptr;
    atRow<typename Owner::Rows>(property, [&](auto steps, auto row) {
        old = [](Record const& record, meta::Property const& of) {
            return record.isSlotChanged(decltype(steps)::slot().index)
                       ? decltype(steps)::old(record, oldValueOf<decltype(row)>(record), of)
                       : Value::createEmptyValue(of);
        };
    });
    return old ? old(*this, property) : Base::getOldValue(property, tag);
}

template <class Derived, class Base>
meta::Class const& Dispatched<Derived, Base>::getMetaClass() const
{
    return Derived::Handle::metaClass();
}

template <class Derived, class Base> void Dispatched<Derived, Base>::invalidate()
{
    Derived::Rows::each([&](auto row) {
        if (AbstractOwnedCollection* const made = Steps<decltype(row)>::collection(self()))
            this->collectionInvalidated(made);
    });
    Base::invalidate();
}

template <class Derived, class Base>
bool Dispatched<Derived, Base>::hasPropertyValue(meta::Property const& property,
                                                 internal::ReflectionPrivateTag const& tag) const
{
    bool has = false;
    if (mayRead(property, tag) &&
        atReadable<Derived>(property, [&](auto row) { has = row.has(self()); }))
        return has;
    return Base::hasPropertyValue(property, tag);
}

template <class Derived, class Base>
Value Dispatched<Derived, Base>::getPropertyValue(meta::Property const& property,
                                                  internal::ReflectionPrivateTag const& tag) const
{
    using Tag = internal::ReflectionPrivateTag;
    Value (*get)(Derived const&, meta::Property const&, Tag const&) = nullptr;
    if (mayRead(property, tag))
        atReadable<Derived>(property, [&](auto row) {
            get = [](Derived const& self, meta::Property const& of, Tag const& by) {
                return decltype(row)::get(self, of, by);
            };
        });
    return get ? get(self(), property, tag) : Base::getPropertyValue(property, tag);
}

/// Whether `Impl` and the classes above leave what `Dispatched` says of metaclass and values alone.
template <class Impl> constexpr bool isUnaltered()
{
    if constexpr (std::is_same_v<Impl, ModelElement::Impl>)
        return true;
    else if constexpr (requires { &Impl::getPropertyValue, &Impl::getMetaClass; })
        return std::is_base_of_v<typename Impl::Dispatch, Impl> &&
               std::is_same_v<typename Impl::Dispatch, Dispatched<Impl, typename Impl::Above>> &&
               std::is_same_v<decltype(&Impl::getPropertyValue),
                              decltype(&Impl::Dispatch::getPropertyValue)> &&
               std::is_same_v<decltype(&Impl::getMetaClass),
                              decltype(&Impl::Dispatch::getMetaClass)> &&
               isUnaltered<typename Impl::Above>();
    else
        return false;
}

template <class Derived, class Base> bool Dispatched<Derived, Base>::isReadByFields() const
{
    // A class of a client that derives from `Derived` may override what it likes.
    return isUnaltered<Derived>() && typeid(*this) == typeid(Derived);
}

template <class Derived, class Base>
StoredField Dispatched<Derived, Base>::findStoredField(meta::Property const& property) const
{
    StoredField field;
    if (property && atReadable<Derived>(property, [&](auto row) { field = row.stored(self()); }))
        return field;
    return Base::findStoredField(property);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::setPropertyValue(meta::Property const& property, Value const& value,
                                                 internal::ReflectionPrivateTag const& tag)
{
    bool done = false;
    if (maySet(property, tag))
        atProperty<typename Derived::Rows>(property,
                                           [&](auto row) { done = row.set(self(), value); });
    if (!done)
        Base::setPropertyValue(property, value, tag);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::doDestroy(bool keepIncoming, bool multiModel)
{
    Derived::Rows::each(
        [&](auto row) { Steps<decltype(row)>::destroy(self(), keepIncoming, multiModel); });
    if constexpr (!std::is_same_v<Base, ModelElement::Impl>)
        Base::doDestroy(keepIncoming, multiModel);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::inverseAdd(ModelElement const& element,
                                           meta::Property const& property)
{
    if (!atProperty<typename Derived::Rows>(property,
                                            [&](auto row) { row.inverseAdd(self(), element); }))
        Base::inverseAdd(element, property);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::inverseRemove(ModelElement const& element,
                                              meta::Property const& property)
{
    if (!atProperty<typename Derived::Rows>(property,
                                            [&](auto row) { row.inverseRemove(self(), element); }))
        Base::inverseRemove(element, property);
}

template <class Derived, class Base>
bool Dispatched<Derived, Base>::inverseContainsProxyTo(ModelElement const& element,
                                                       meta::Property const& property) const
{
    bool contains = false;
    if (atProperty<typename Derived::Rows>(
            property, [&](auto row) { contains = row.inverseContains(self(), element); }))
        return contains;
    return Base::inverseContainsProxyTo(element, property);
}

template <class Derived, class Base> void Dispatched<Derived, Base>::disassociateIncoming()
{
    Derived::Rows::each([&](auto row) { Steps<decltype(row)>::disassociate(self()); });
    Base::disassociateIncoming();
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::convertReferencesToProxies(bool multiModel,
                                                           boost::optional<ProxyId>& cachedId)
{
    Derived::Rows::each(
        [&](auto row) { Steps<decltype(row)>::convertReferences(self(), multiModel, cachedId); });
    Base::convertReferencesToProxies(multiModel, cachedId);
}

template <class Derived, class Base> void Dispatched<Derived, Base>::basicDisassociateAll()
{
    Derived::Rows::each([&](auto row) { Steps<decltype(row)>::drop(self()); });
    Base::basicDisassociateAll();
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::convertToProxy(meta::Property const& property, ProxyId const& id,
                                               ModelElement const& element)
{
    if (!atProperty<typename Derived::Rows>(
            property, [&](auto row) { row.convertToProxy(self(), id, element); }))
        Base::convertToProxy(property, id, element);
}

template <class Derived, class Base>
ModelElement::Impl::Changes* Dispatched<Derived, Base>::createChanges() const
{
    return new ModelElement::Impl::Changes(self(), Derived::SLOTS);
}

template <class Derived, class Base>
ModelElement::Impl::Storage* Dispatched<Derived, Base>::createStorage() const
{
    return new typename Derived::Storage(self(), Derived::SLOTS);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::copyValue(ModelElement::Impl::Storage* storage,
                                          unsigned long index) const
{
    bool const found = Derived::Rows::any([&](auto row) {
        using Row = Steps<decltype(row)>;
        return Row::slot().index == index && (Row::copyOld(self(), storage->oldValues()), true);
    });
    if (!found)
        Base::copyValue(storage, index);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::copyStateFromStorage(ModelElement::Impl::Storage* storage)
{
    Derived::Rows::each([&](auto row) {
        using Row = Steps<decltype(row)>;
        if (storage->isSlotChanged(Row::slot().index))
            Row::restore(self(), oldValueOf<decltype(row)>(*storage));
    });
    Base::copyStateFromStorage(storage);
}

template <class Derived, class Base>
meta::Property Dispatched<Derived, Base>::getPropertyByIndex(unsigned long index) const
{
    meta::Property property;
    bool const found = Derived::Rows::any([&](auto row) {
        Slot const& slot = Steps<decltype(row)>::slot();
        if (slot.index != index)
            return false;
        if (slot.property)
            property = slot.property();
        return true;
    });
    return found ? property : Base::getPropertyByIndex(index);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::inverseAddSlot(ModelElement const& element, Slot const& slot)
{
    if (!atSlot<typename Derived::Rows>(slot, [&](auto row) { row.inverseAdd(self(), element); }))
        Base::inverseAddSlot(element, slot);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::inverseRemoveSlot(ModelElement const& element, Slot const& slot)
{
    if (!atSlot<typename Derived::Rows>(slot,
                                        [&](auto row) { row.inverseRemove(self(), element); }))
        Base::inverseRemoveSlot(element, slot);
}

template <class Derived, class Base>
bool Dispatched<Derived, Base>::inverseContainsProxyToSlot(ModelElement const& element,
                                                           Slot const& slot) const
{
    bool contains = false;
    if (atSlot<typename Derived::Rows>(
            slot, [&](auto row) { contains = row.inverseContains(self(), element); }))
        return contains;
    return Base::inverseContainsProxyToSlot(element, slot);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::convertToProxySlot(Slot const& slot, ProxyId const& id,
                                                   ModelElement const& element)
{
    if (!atSlot<typename Derived::Rows>(slot,
                                        [&](auto row) { row.convertToProxy(self(), id, element); }))
        Base::convertToProxySlot(slot, id, element);
}

template <class Derived, class Base>
ModelElement::Impl* Dispatched<Derived, Base>::basicGetReference(Slot const& slot) const
{
    ModelElement::Impl* target = nullptr;
    if (atSlot<typename Derived::Rows>(slot, [&](auto row) { target = row.reference(self()); }))
        return target;
    return Base::basicGetReference(slot);
}

template <class Derived, class Base>
void Dispatched<Derived, Base>::visitReferences(
    ModelElement::Impl::ReferenceVisitor const& visit) const
{
    Derived::Rows::each([&](auto row) { Steps<decltype(row)>::visit(self(), visit); });
    Base::visitReferences(visit);
}
}  // namespace tarn::kiln::support
