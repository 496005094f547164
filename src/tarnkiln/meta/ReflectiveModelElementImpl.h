/// \file
/// What stands behind an element of a class that is known at run time only.
#pragma once
#include "tarnkiln/collections/Fwd.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/support/CountedPointer.h"

#include <cstddef>
#include <new>

namespace tarn::kiln {
namespace internal {
class ReflectiveCells;
class ReflectiveLayout;
class ReflectiveSlot;
class DependentCollections;
struct ReflectiveCell;
struct SlotFacts;
}  // namespace internal

/// An element whose class has no generated code; `ModelElement::createReflective` makes it.
///
/// It has the stored properties that its class and the superclasses have when it is made, and never
/// others. Values, references and collections are reached by `getPropertyValue` and
/// `setPropertyValue`; a many-valued property is changed through the collection that its value
/// shares. It may be of any class, abstract ones and those with generated code included, and must
/// then not be taken for an object of the generated class.
///
/// `setPropertyValue` opens no transaction of its own: where the model needs one, a caller without
/// one gets `NoOpenTransaction`. A change of a property by which collections of other elements keep
/// this one leaves these collections and enters them again under the new key, if they can be
/// reached from here.
///
/// Threads: as the element's model.
class TARNKILN_EXPORT ReflectiveModelElementImpl final : public ModelElement::Impl
{
public:
    class ReflectiveStorage;  // internal/ReflectiveStorage.h

    /// A new element, which no model knows yet.
    ///
    /// \throws tarnkiln::messages::CannotCreateWithoutModel  if `model` is empty or dead.
    /// \throws tarnkiln::messages::CannotUsePropertyWithoutType  (name) if a stored property has no
    ///     live type.
    /// \throws tarnkiln::messages::UnsupportedQualification  (qualified name of the type) if the
    ///     keys of a collection can not be of the type of its qualifying property.
    /// \throws tarnkiln::messages::InvalidValue  if a single property has a type without values.
    static ReflectiveModelElementImpl* create(Model const& model, meta::Class const& metaClass,
                                              UUID const& id);
    /// The same with an id of its own and with room for what is to make it a proxy.
    static ReflectiveModelElementImpl* createForProxy(Model const& model,
                                                      meta::Class const& metaClass);
    ~ReflectiveModelElementImpl() override;

    // ElementImpl
    meta::Class const& getMetaClass() const override;
    void invalidate() override;

    /// \name Values
    /// @{
    bool hasPropertyValue(meta::Property const& property,
                          ReflectionPrivateTag const& tag) const override;
    /// A value that shares the collection of a many-valued property; that of a reference
    /// collection is marked as reflective.
    ///
    /// A proxy in a single reference gives way to its target, if that is found, except under
    /// `NO_PROXY_RESOLVE`; under `IN_MEMORY_ONLY` nothing is loaded.
    /// \throws tarnkiln::messages::NoSuchProperty  (property, class) if the element has none such
    /// or
    ///     the caller may not read it.
    Value getPropertyValue(meta::Property const& property,
                           ReflectionPrivateTag const& tag) const override;
    /// Sets a single property. What fails has changed nothing; the failures in their order:
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  (property, class) if the element has none such,
    ///     it has many values, or the caller may not set it.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the property's
    ///     type) for a value of another type, and for an absent one if one is required.
    /// \throws tarnkiln::messages::InvalidValue  if `value` is a collection.
    /// \throws tarnkiln::messages::CannotModifyProxy  if this element, or the new container, only
    ///     stands in for another.
    /// \throws tarnkiln::messages::CannotSetReadOnlyProperty  (property) if it may be set once and
    ///     was.
    /// \throws tarnkiln::messages::UniquenessConstraint  if a keyed collection that this element is
    ///     in, or would be in, has another one of its new key.
    /// \throws tarnkiln::messages::CircularContainment, CannotChangeModel,
    ///     CannotCreateCrossModelAssociation  if the reference may not be stored.
    /// \throws tarnkiln::messages::ModelFrozen, NoOpenTransaction, ChangesProhibited  if the model
    ///     may not be changed now.
    void setPropertyValue(meta::Property const& property, Value const& value,
                          ReflectionPrivateTag const& tag) override;
    /// @}

    /// What it keeps for its properties, for readers of many elements.
    internal::ReflectiveCells const& getCells() const
    {
        return *reinterpret_cast<internal::ReflectiveCells const*>(
            reinterpret_cast<std::byte const*>(this) - sizeof(void*));
    }

    // ModelElement::Impl
    void doDestroy(bool keepIncoming, bool multiModel) override;
    void inverseAdd(ModelElement const& element, meta::Property const& property) override;
    void inverseRemove(ModelElement const& element, meta::Property const& property) override;
    bool inverseContainsProxyTo(ModelElement const& element,
                                meta::Property const& property) const override;
    void disassociateIncoming() override;
    void convertReferencesToProxies(bool multiModel, boost::optional<ProxyId>& cachedId) override;
    void basicDisassociateAll() override;
    /// Does nothing: a reference of this element to one of a dying model stays a dead handle.
    void convertToProxy(meta::Property const& property, ProxyId const& id,
                        ModelElement const& element) override;
    Changes* createChanges() const override;
    Storage* createStorage() const override;
    void copyValue(Storage* storage, unsigned long index) const override;
    void copyStateFromStorage(Storage* storage) override;
    meta::Property getPropertyByIndex(unsigned long index) const override;
    ModelElement::Impl* basicGetReference(Slot const& slot) const override;
    void visitReferences(ReferenceVisitor const& visit) const override;

    /// \name Collections, as elements of this class have them; the caller owns the result
    /// @{
    /// For a property with a class as type. Not `owned`, it is a snapshot: tied to no element.
    ///
    /// \throws tarnkiln::messages::UnsupportedQualification  as the constructor.
    AbstractOwnedCollection* instantiateCollection(meta::Property const& property,
                                                   bool owned) const;
    /// For a property of any other type; null if the type has no collections.
    AbstractOwnedCollection* instantiatePrimitiveCollection(meta::Property const& property,
                                                            bool owned) const;
    /// @}

    /// \name Keys
    /// @{
    /// What keyed collections file an element with this value of the qualifying property under: for
    /// a single element its UUID, nil for an empty or dead one; any other value itself.
    static Value unwrapKey(Value const& value);
    /// Does nothing unless `collectionProperty` keeps one element a key and `owner` is live.
    ///
    /// \throws tarnkiln::messages::UniquenessConstraint  if that collection of `owner` has a live
    ///     element under `key`.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if the property holds no
    ///     collection of references.
    static void checkUniqueness(ModelElement const& owner, meta::Property const& collectionProperty,
                                Value const& key);
    /// @}

private:
    friend class internal::DependentCollections;

    using Layout = internal::ReflectiveLayout;
    using ReflectiveSlot = internal::ReflectiveSlot;
    using SlotFacts = internal::SlotFacts;

    using LayoutHandle = support::CountedPointer<Layout const>;

    ReflectiveModelElementImpl(Model const& model, LayoutHandle const& layout, UUID const& id);
    /// Room for the cells too, which lie before the element, and for more behind it.
    static void* operator new(std::size_t size, LayoutHandle const& layout, std::size_t more);
    static void operator delete(void* element, LayoutHandle const& layout, std::size_t more);
    static void operator delete(ReflectiveModelElementImpl* element, std::destroying_delete_t);
    internal::ReflectiveCells& cells() const
    {
        return const_cast<internal::ReflectiveCells&>(getCells());
    }

    // Reading
    Layout const& layout() const;
    /// The slot of a property that may be read; else null.
    ReflectiveSlot const* readableSlot(meta::Property const& property,
                                       ReflectionPrivateTag const& tag) const;
    /// The same as `getPropertyValue`, for a property of which it is not known whether it has a
    /// slot and may be read.
    Value getUncertainValue(meta::Property const& property, ReflectionPrivateTag const& tag) const;
    Value getOtherValue(ReflectiveSlot const& slot, internal::ReflectiveCell cell,
                        ReflectionPrivateTag const& tag) const;
    Value valueOf(ReflectiveSlot const& slot, ModelElement const& element) const;
    ModelElement::Impl* containerBy(ReflectiveSlot const& slot) const;
    /// Resolves a proxy in its place as far as `tag` allows.
    ModelElement::Impl* target(ReflectiveSlot const& slot, ReflectionPrivateTag const& tag) const;
    /// Whether the reference is to `element`, be it by a proxy.
    bool refersTo(ReflectiveSlot const& slot, ModelElement const& element) const;
    /// Whether there is a collection, or a data source that might fill one. Makes none.
    bool mayHaveMembers(ReflectiveSlot const& slot) const;
    /// Made at the first call, and never null, unless plain values of that type have none.
    AbstractOwnedCollection* made(ReflectiveSlot const& slot) const;
    /// The same, filled by the data source.
    ReferenceCollection& loaded(ReflectiveSlot const& slot) const;
    ReferenceCollection& shown(ReflectiveSlot const& slot, ReflectionPrivateTag const& tag) const;
    /// All entries of the collection as it is, proxies too.
    std::vector<ModelElement> members(ReflectiveSlot const& slot) const;
    /// What the slot, of whatever kind, refers to now.
    std::vector<ModelElement> referred(ReflectiveSlot const& slot) const;

    void leaveProxies(ReflectiveSlot const& slot, boost::optional<ProxyId>& cachedId);

    // Writing
    static bool isOfType(ReflectiveSlot const& slot, SlotFacts const& facts, Value const& value);
    static void checkType(ReflectiveSlot const& slot, Value const& value);
    void checkOwnKey(ReflectiveSlot const& slot, ModelElement const& target) const;
    void setPlain(ReflectiveSlot const& slot, SlotFacts const& facts, Value const& value);
    bool setWord(ReflectiveSlot const& slot, SlotFacts const& facts, Value const& value);
    void storePlain(ReflectiveSlot const& slot, SlotFacts const& facts, Value const& value);
    // `self` is a handle of this element, here and in what follows.
    void setReference(ModelElement const& self, ReflectiveSlot const& slot, SlotFacts const& facts,
                      ModelElement const& target);
    void setContainer(ModelElement const& self, ReflectiveSlot const& slot, SlotFacts const& facts,
                      ModelElement const& container);
    void replace(ReflectiveSlot const& slot, internal::ReflectiveCell added);
    void applyReference(ModelElement const& self, ReflectiveSlot const& slot,
                        SlotFacts const& facts, ModelElement const& target);
    void applyContainer(ModelElement const& self, SlotFacts const& facts,
                        ModelElement const& container);
    void enterOtherEnd(ModelElement const& self, ModelElement const& target,
                       Feature const& opposite, bool force);
};
}  // namespace tarn::kiln
