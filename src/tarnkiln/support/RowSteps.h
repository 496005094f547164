/// \file
/// What each kind of row does in the steps of `ModelElement::Impl`.
///
/// Only the source of a class includes this; see Dispatch.h.
#pragma once
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/support/Field.h"
#include "tarnkiln/support/PlainField.h"
#include "tarnkiln/support/Record.h"
#include "tarnkiln/support/Rows.h"

#include <algorithm>
#include <type_traits>
#include <typeinfo>
#include <utility>
#include <vector>

namespace tarn::kiln::support {

/// Whether `property` is the metamodel's element for `slot`; false while there is none.
inline bool isPropertyOf(Slot const& slot, meta::Property const& property)
{
    return slot.property && property && slot.property() == property;
}

/// `element` as a target of class `Target`; null if it is empty.
///
/// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if it is of another class.
template <class Target> typename Target::Impl* targetOf(ModelElement const& element)
{
    auto* const target = dynamic_cast<typename Target::Impl*>(element.getImpl());
    if (!target && element.getImpl())
    {
        meta::Class const& expected = Target::metaClass();
        reportException(tarnkiln::messages::CannotCastIncompatibleTypes(
            expected ? expected->getQualifiedName() : ustring()));
    }
    return target;
}

/// `value` as a plain value of a field. A Boolean takes a value that holds nothing for false.
template <class Plain> Plain plainOf(Value const& value)
{
    bool const isFalse = std::is_same_v<Plain, bool> && value.isAbsent();
    return isFalse ? Plain() : PlainField<Plain>::fromValue(value);
}

/// Whether a dying element of another model is to stand in this reference as a proxy.
inline bool leavesProxy(ModelElement::Impl const& element, ModelElement::Impl const* target)
{
    return target && target->isLive() && !target->isProxy() &&
           target->getModelImpl() != element.getModelImpl();
}

/// What a row does unless its kind says otherwise: nothing.
template <Slot const& SLOT> struct NoSteps
{
    static Slot const& slot() { return SLOT; }
    /// Keeps the present value.
    static void copyOld(auto const& /*element*/, OldValues& /*values*/) {}
    /// Puts `old` in the place of the present value, which ends up there.
    static void restore(auto& /*element*/, auto* /*old*/) {}
    /// Whether a single reference has the target that it had before.
    static bool isReverted(auto const& /*element*/, auto const& /*record*/, auto const* /*old*/)
    {
        return false;
    }
    static void inverseAdd(auto& /*element*/, ModelElement const& /*other*/) {}
    static void inverseRemove(auto& /*element*/, ModelElement const& /*other*/) {}
    static bool inverseContains(auto const& /*element*/, ModelElement const& /*other*/)
    {
        return false;
    }
    static void convertToProxy(auto& /*element*/, ProxyId const& /*id*/,
                               ModelElement const& /*other*/)
    {}
    /// Leaves the elements that refer back.
    static void disassociate(auto& /*element*/) {}
    static void convertReferences(auto& /*element*/, bool /*multiModel*/,
                                  boost::optional<ProxyId>& /*cachedId*/)
    {}
    /// Destroys what is contained and drops all references, each announced.
    static void destroy(auto& /*element*/, bool /*keepIncoming*/, bool /*multiModel*/) {}
    /// Drops all references without a word.
    static void drop(auto& /*element*/) {}
    static void visit(auto const& /*element*/,
                      ModelElement::Impl::ReferenceVisitor const& /*visit*/)
    {}
    static AbstractOwnedCollection* collection(auto const& /*element*/) { return nullptr; }
    /// The target of a single reference, unresolved.
    static ModelElement::Impl* reference(auto const& /*element*/) { return nullptr; }
    static StoredField stored(auto const& /*element*/) { return {}; }
    /// Stores `value`; false if the property has no setter.
    static bool set(auto& /*element*/, Value const& /*value*/) { return false; }
};

/// Each kind of row also has
///
///     static bool has(auto const& element);                     // whether there is a value
///     static Value get(auto const& element, property, tag);     // the value
///     static Value old(auto const& record, auto const* old, property);  // the value in a record
///
/// The `old` that a step takes is what the record keeps for the row, null if that is nothing.
template <class Row> struct Steps;

/// Puts the contents of the snapshot `old`, of which there is none for a collection that was made
/// later, in the place of the present ones, which end up in the snapshot.
template <class Collection>
void restoreContents(LazyCollection<Collection>& field, std::unique_ptr<Collection>* old) noexcept
{
    Collection* const present = field.get();
    if (present && old)
        present->basicSwapContents(**old);
    else if (present)
        present->basicDropContents();
}

/// What all single values share.
template <auto FIELD, Slot const& SLOT> struct FieldSteps : NoSteps<SLOT>
{
    using Owner = FieldOwner<FIELD>;

    static void copyOld(Owner const& element, OldValues& values)
    {
        values.keep<FieldType<FIELD>>(SLOT.index, element.*FIELD);
    }
    static void restore(Owner& element, FieldType<FIELD>* old)
    {
        if (old)
            std::swap(element.*FIELD, *old);
    }
};

/// The type by which a `StoredField` is given: a literal's is that of its number.
template <class Plain> StoredField fieldOfType()
{
    if constexpr (std::is_enum_v<Plain> && Literals<Plain>)
        return {.type = &typeid(std::underlying_type_t<Plain>), .isLiteral = true};
    else
        return {.type = &typeid(Plain)};
}

template <auto FIELD, Slot const& SLOT> struct PlainFieldSteps : FieldSteps<FIELD, SLOT>
{
    using Owner = FieldOwner<FIELD>;
    using Plain = FieldType<FIELD>;

    static Value get(Owner const& element, meta::Property const& property,
                     internal::ReflectionPrivateTag const& /*tag*/)
    {
        return PlainField<Plain>::toValue(property, element.*FIELD);
    }
    static StoredField stored(Owner const& element)
    {
        StoredField field = fieldOfType<Plain>();
        field.offset =
            reinterpret_cast<char const*>(&(element.*FIELD)) -
            reinterpret_cast<char const*>(static_cast<ModelElement::Impl const*>(&element));
        return field;
    }
    static Value old(auto const& /*record*/, Plain const* old, meta::Property const& property)
    {
        return old ? PlainField<Plain>::toValue(property, *old) : Value::createEmptyValue(property);
    }
};

template <auto FIELD, Slot const& SLOT, auto SETTER>
struct Steps<Scalar<FIELD, SLOT, SETTER>> : PlainFieldSteps<FIELD, SLOT>
{
    using Owner = FieldOwner<FIELD>;
    using Plain = FieldType<FIELD>;

    static bool has(Owner const& /*element*/) { return true; }
    static bool set(Owner& element, Value const& value)
    {
        (element.*SETTER)(plainOf<Plain>(value));
        return true;
    }
};

template <auto FIELD, Slot const& SLOT, auto SETTER>
struct Steps<Optional<FIELD, SLOT, SETTER>> : PlainFieldSteps<FIELD, SLOT>
{
    using Owner = FieldOwner<FIELD>;

    static bool has(Owner const& element) { return (element.*FIELD).has_value(); }
    static bool set(Owner& element, Value const& value)
    {
        (element.*SETTER)(PlainField<FieldType<FIELD>>::fromValue(value));
        return true;
    }
};

/// What single references share, contained or not.
template <class Target, auto FIELD, Slot const& SLOT>
struct SingleReferenceSteps : FieldSteps<FIELD, SLOT>
{
    using Owner = FieldOwner<FIELD>;
    using Pointer = FieldType<FIELD>;

    static bool has(Owner const& element)
    {
        return (element.*FIELD) && (element.*FIELD).get()->isLive();
    }
    static Value get(Owner const& element, meta::Property const& property,
                     internal::ReflectionPrivateTag const& tag)
    {
        return Value::createElementValue(property, Target(target(element, tag)));
    }
    static StoredField stored(Owner const& /*element*/)
    {
        return {.target = [](ModelElement::Impl const& element) -> ModelElement::Impl* {
            return (static_cast<Owner const&>(element).*FIELD).get();
        }};
    }
    static Value old(auto const& /*record*/, Pointer const* old, meta::Property const& property)
    {
        return Value::createElementValue(property, Target(old ? old->get() : nullptr));
    }

    static bool isReverted(Owner const& element, auto const& /*record*/, Pointer const* old)
    {
        return old && old->get() == (element.*FIELD).get();
    }
    static void inverseAdd(Owner& element, ModelElement const& other)
    {
        Pointer const added(targetOf<Target>(other));
        Pointer const removed = element.*FIELD;
        if (added.get() == removed.get())
            return;
        ModelElement const self(&element);
        element.notifyModifying(SLOT.index);
        if (removed && removed.get()->isLive() && SLOT.opposite)
            element._inverseRemoveThis(removed.get(), *SLOT.opposite);
        element.*FIELD = added;
    }
    static void inverseRemove(Owner& element, ModelElement const& other)
    {
        if (!refersTo(element, other))
            return;
        ModelElement const self(&element);
        element.notifyModifying(SLOT.index);
        element.*FIELD = Pointer();
    }
    static bool inverseContains(Owner const& element, ModelElement const& other)
    {
        if (!refersTo(element, other))
            return false;
        const_cast<Owner&>(element).*FIELD = Pointer(targetOf<Target>(other));
        return true;
    }
    static void drop(Owner& element) { element.*FIELD = Pointer(); }
    static ModelElement::Impl* reference(Owner const& element) { return (element.*FIELD).get(); }
    static void visit(Owner const& element, ModelElement::Impl::ReferenceVisitor const& visit)
    {
        if (element.*FIELD)
            visit(ModelElement((element.*FIELD).get()), SLOT);
    }

protected:
    /// The target, which takes the place of its proxy as far as `tag` allows.
    static typename Target::Impl* target(Owner const& element,
                                         internal::ReflectionPrivateTag const& tag)
    {
        Pointer& field = const_cast<Owner&>(element).*FIELD;
        if (tag == ModelElement::Impl::NO_PROXY_RESOLVE)
            return field.get();
        return resolve(element, field, SLOT, /*load=*/!(tag == ModelElement::Impl::IN_MEMORY_ONLY));
    }
    /// Whether the target is `other` or a proxy to it.
    static bool refersTo(Owner const& element, ModelElement const& other)
    {
        auto* const target = (element.*FIELD).get();
        if (!target || target == other.getImpl())
            return target != nullptr;
        return target->isProxy() && element.getModelImpl() &&
               element.getModelImpl()->peekResolveProxy(&element, ModelElement(target)) == other;
    }
    static void clear(Owner& element)
    {
        if (!(element.*FIELD))
            return;
        element.notifyModifying(SLOT.index);
        element.*FIELD = Pointer();
    }
};

template <class Target, auto FIELD, Slot const& SLOT, auto SETTER>
struct Steps<Reference<Target, FIELD, SLOT, SETTER>> : SingleReferenceSteps<Target, FIELD, SLOT>
{
    using Base = SingleReferenceSteps<Target, FIELD, SLOT>;
    using typename Base::Owner;
    using typename Base::Pointer;

    static bool set(Owner& element, Value const& value)
    {
        (element.*SETTER)(value.getValue<Target>());
        return true;
    }
    static void convertToProxy(Owner& element, ProxyId const& id, ModelElement const& other)
    {
        if ((element.*FIELD).get() != other.getImpl())
            return;
        ModelElement const proxy =
            ModelElement::createProxy(element.getModel(), other->getMetaClass(), id);
        element.*FIELD = Pointer(targetOf<Target>(proxy));
    }
    static void disassociate(Owner& element)
    {
        Pointer const target = element.*FIELD;
        if (!target || !SLOT.opposite)
            return;
        element.notifyModifying(SLOT.index);
        if (target.get()->isLive())
            element._inverseRemoveThis(target.get(), *SLOT.opposite);
        element.*FIELD = Pointer();
    }
    static void convertReferences(Owner& element, bool multiModel,
                                  boost::optional<ProxyId>& cachedId)
    {
        Pointer const target = element.*FIELD;
        if (multiModel && SLOT.opposite && leavesProxy(element, target.get()))
        {
            if (!cachedId)
                cachedId = element._getPersistentProxyId();
            element._convertToProxy(target.get(), *SLOT.opposite, *cachedId);
        }
        element.*FIELD = Pointer();
    }
    static void destroy(Owner& element, bool /*keepIncoming*/, bool /*multiModel*/)
    {
        Base::clear(element);
    }
};

template <class Target, auto FIELD, Slot const& SLOT, auto SETTER>
struct Steps<CompositeReference<Target, FIELD, SLOT, SETTER>>
    : SingleReferenceSteps<Target, FIELD, SLOT>
{
    using Base = SingleReferenceSteps<Target, FIELD, SLOT>;
    using typename Base::Owner;

    static bool set(Owner& element, Value const& value)
    {
        (element.*SETTER)(value.getValue<Target>());
        return true;
    }
    static void destroy(Owner& element, bool keepIncoming, bool multiModel)
    {
        auto const child = element.*FIELD;
        if (!child)
            return;
        child.get()->destroyRecursively(keepIncoming, /*removeFromContainer=*/false, multiModel);
        Base::clear(element);
    }
};

template <class Target, Slot const& SLOT, auto SETTER>
struct Steps<Container<Target, SLOT, SETTER>> : NoSteps<SLOT>
{
    using Element = ModelElement::Impl;
    using Owner = FieldOwner<SETTER>;

    static bool has(Element const& element)
    {
        return container(element) && container(element)->isLive();
    }
    static Value get(Element const& element, meta::Property const& property,
                     internal::ReflectionPrivateTag const& /*tag*/)
    {
        return Value::createElementValue(property, ModelElement(container(element)));
    }
    static StoredField stored(Element const& /*element*/) { return {.target = target}; }
    static Value old(auto const& record, NoOldValue const* /*old*/, meta::Property const& property)
    {
        return Value::createElementValue(property, ModelElement(oldContainer(record)));
    }
    static bool set(Owner& element, Value const& value)
    {
        (element.*SETTER)(value.getValue<Target>());
        return true;
    }
    static bool isReverted(Element const& element, auto const& record, NoOldValue const* /*old*/)
    {
        return !record.isContainerChanged() || oldContainer(record) == container(element);
    }
    static void inverseAdd(Element& element, ModelElement const& other)
    {
        if (container(element) == other.getImpl())
            return;
        ModelElement const self(&element);
        element.notifyModifying(SLOT.index);
        element.makeUncontained();
        element.basicSetContainer(other.getImpl(), *SLOT.opposite, SLOT.index);
    }
    static void inverseRemove(Element& element, ModelElement const& other)
    {
        if (container(element) != other.getImpl())
            return;
        ModelElement const self(&element);
        element.notifyModifying(SLOT.index);
        element.basicSetContainer(nullptr, Feature(), Element::NO_INDEX);
    }
    static bool inverseContains(Element const& /*element*/, ModelElement const& /*other*/)
    {
        return true;
    }
    static Element* reference(Element const& element) { return container(element); }

private:
    static Element* container(Element const& element)
    {
        return containerOf<Element>(element, SLOT);
    }
    static Element* target(ModelElement::Impl const& element) { return container(element); }
    static Element* oldContainer(ModelElement::Impl::Storage const& record)
    {
        bool const wasHeld =
            record.isContainerChanged() && record.getOldContainment() == Feature(*SLOT.opposite);
        return wasHeld ? record.getOldContainer().getImpl() : nullptr;
    }
};

template <auto FIELD, Slot const& SLOT, auto MAKE, auto GETTER>
struct Steps<References<FIELD, SLOT, MAKE, GETTER>> : NoSteps<SLOT>
{
    using Row = References<FIELD, SLOT, MAKE, GETTER>;
    using Owner = FieldOwner<FIELD>;

    static ReferenceCollection& made(Owner const& element)
    {
        return madeCollection(element, const_cast<Owner&>(element).*FIELD, MAKE);
    }
    static std::vector<ModelElement> members(Owner const& element)
    {
        auto* const present = (element.*FIELD).get();
        return present ? present->getAllValuesAndProxies() : std::vector<ModelElement>();
    }
    static bool has(Owner const& element)
    {
        bool const mayHaveMembers = (element.*FIELD).get() || hasDataSource(element);
        return mayHaveMembers && made(element).getGenericInterface()->genericSize() > 0;
    }
    static Value get(Owner const& element, meta::Property const& property,
                     internal::ReflectionPrivateTag const& tag)
    {
        bool const resolves = !(tag == ModelElement::Impl::NO_PROXY_RESOLVE ||
                                tag == ModelElement::Impl::IN_MEMORY_ONLY);
        ReferenceCollection& shown = resolves ? (element.*GETTER)() : made(element);
        return Value::createCollectionValue(property, &shown);
    }
    static Value old(auto const& /*record*/, auto const* old, meta::Property const& property)
    {
        if (!old)
            return Value::createEmptyValue(property);
        Value value = Value::createCollectionValue(property, old->get());
        value.setReflective();
        return value;
    }
    static bool isPlain()
    {
        return !SLOT.composite && !(SLOT.opposite && SLOT.opposite->composite);
    }

    static void copyOld(Owner const& element, OldValues& values)
    {
        auto* const present = (element.*FIELD).get();
        if (!present)
            return;
        typename Row::Old old = MAKE(nullptr);
        ModelElement::Impl::_basicCopyValues(old.get(), present);
        values.keep<typename Row::Old>(SLOT.index, std::move(old));
    }
    static void restore(Owner& element, auto* old) { restoreContents(element.*FIELD, old); }
    static void inverseAdd(Owner& element, ModelElement const& other)
    {
        ModelElement::Impl::_basicAdd(&made(element), other);
    }
    static void inverseRemove(Owner& element, ModelElement const& other)
    {
        ModelElement::Impl::_basicRemove(&made(element), other);
    }
    static bool inverseContains(Owner const& element, ModelElement const& other)
    {
        if (ModelElement::Impl::_basicContainsProxyTo(&made(element), other))
            return true;
        std::vector<ModelElement> const present = members(element);
        return std::find(present.begin(), present.end(), other) != present.end();
    }
    static void convertToProxy(Owner& element, ProxyId const& id, ModelElement const& other)
    {
        ReferenceCollection& collection = made(element);
        ModelElement const proxy =
            ModelElement::createProxy(element.getModel(), other->getMetaClass(), id);
        GenericCollectionInterface* const shown = collection.getGenericInterface();
        if (shown->isSequenceInterface())
        {
            int const place = static_cast<GenericSequenceInterface*>(shown)->genericIndexOf(other);
            if (place >= 0)
                collection.replaceProxy(proxy, static_cast<unsigned long>(place));
            return;
        }
        ModelElement::Impl::_basicRemove(&collection, other);
        collection.basicAddWithProxy(proxy);
    }
    static void disassociate(Owner& element)
    {
        std::vector<ModelElement> const present = members(element);
        if (!isPlain() || !SLOT.opposite || present.empty())
            return;
        element.notifyModifying(SLOT.index);
        for (ModelElement const& member : present)
            if (member)
                element._inverseRemoveThis(member.getImpl(), *SLOT.opposite);
        ModelElement::Impl::_basicClear(&made(element));
    }
    static void convertReferences(Owner& element, bool multiModel,
                                  boost::optional<ProxyId>& cachedId)
    {
        std::vector<ModelElement> const present = members(element);
        if (!isPlain() || present.empty())
            return;
        for (ModelElement const& member : present)
        {
            if (!multiModel || !SLOT.opposite || !leavesProxy(element, member.getImpl()))
                continue;
            if (!cachedId)
                cachedId = element._getPersistentProxyId();
            element._convertToProxy(member.getImpl(), *SLOT.opposite, *cachedId);
        }
        ModelElement::Impl::_basicClear(&made(element));
    }
    static void destroy(Owner& element, bool keepIncoming, bool multiModel)
    {
        std::vector<ModelElement> present = members(element);
        if (present.empty())
            return;
        if (SLOT.composite)
            ModelElement::Impl::_destroyEach(std::move(present), keepIncoming, multiModel);
        ModelElement::Impl::_basicClear(&made(element));
    }
    static void drop(Owner& element)
    {
        if (auto* const present = (element.*FIELD).get())
            present->basicDropContents();
    }
    static void visit(Owner const& element, ModelElement::Impl::ReferenceVisitor const& visit)
    {
        for (ModelElement const& member : members(element))
            visit(member, SLOT);
    }
    static AbstractOwnedCollection* collection(Owner const& element)
    {
        return (element.*FIELD).get();
    }
};

template <auto GETTER, Slot const& SLOT> struct Steps<Computed<GETTER, SLOT>> : NoSteps<SLOT>
{
    template <class Owner> static bool has(Owner const& element)
    {
        using Result = decltype((element.*GETTER)());
        if constexpr (std::is_base_of_v<ReferenceCollection, std::remove_cvref_t<Result>>)
            return (element.*GETTER)().size() > 0;
        else if constexpr (std::is_base_of_v<ModelElement, Result>)
            return static_cast<bool>((element.*GETTER)());
        else
            return true;
    }
    template <class Owner>
    static Value get(Owner const& element, meta::Property const& property,
                     internal::ReflectionPrivateTag const& /*tag*/)
    {
        using Result = decltype((element.*GETTER)());
        if constexpr (std::is_base_of_v<ReferenceCollection, std::remove_cvref_t<Result>>)
            return Value::createCollectionValue(property, &(element.*GETTER)());
        else if constexpr (std::is_base_of_v<ModelElement, Result>)
            return Value::createElementValue(property, (element.*GETTER)());
        else
            return Value::createPrimitiveValue(property, (element.*GETTER)());
    }
};

template <auto FIELD, Slot const& SLOT, auto MAKE, auto GETTER>
struct Steps<Values<FIELD, SLOT, MAKE, GETTER>> : NoSteps<SLOT>
{
    using Row = Values<FIELD, SLOT, MAKE, GETTER>;
    using Owner = FieldOwner<FIELD>;

    static bool has(Owner const& element)
    {
        auto* const present = (element.*FIELD).get();
        return present && present->size() > 0;
    }
    static Value get(Owner const& element, meta::Property const& property,
                     internal::ReflectionPrivateTag const& /*tag*/)
    {
        return Value::createCollectionValue(property, &(element.*GETTER)());
    }
    static Value old(auto const& /*record*/, auto const* old, meta::Property const& property)
    {
        return old ? Value::createCollectionValue(property, old->get())
                   : Value::createEmptyValue(property);
    }
    static void copyOld(Owner const& element, OldValues& values)
    {
        auto* const present = (element.*FIELD).get();
        if (!present)
            return;
        typename Row::Old old = MAKE(nullptr);
        old->copyContents(*present);
        values.keep<typename Row::Old>(SLOT.index, std::move(old));
    }
    static void restore(Owner& element, auto* old) { restoreContents(element.*FIELD, old); }
    static AbstractOwnedCollection* collection(Owner const& element)
    {
        return (element.*FIELD).get();
    }
};
}  // namespace tarn::kiln::support
