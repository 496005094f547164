/// \file
/// What stands behind a `ModelElement`: its place in the containment tree, and the hooks by which
/// its class takes part in changes, rollback, associations and destruction.
#pragma once
#include "tarnkiln/kernel/Feature.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/ReflectionPrivateTag.h"
#include "tarnkiln/kernel/StoredField.h"
#include "tarnkiln/support/ModelAnchor.h"

#include <boost/optional.hpp>

#include <functional>
#include <memory>
#include <unordered_map>
#include <vector>

namespace tarn::kiln {

namespace internal {
class ExtensionValues;
class InvariantChecker;
class StandIn;
}  // namespace internal
namespace support {
class TopLevelElements;
}

/// The implementation of an element; each class of a metamodel derives its own.
///
/// Names: `basicX` works without upkeep of the other end, `_x` serves generated and collection
/// code, and the virtual functions are the steps that a class supplies.
///
/// Threads: as the model.
class TARNKILN_EXPORT ModelElement::Impl : public ElementImpl
{
public:
    class Changes;       // Changes.h
    class Storage;       // Changes.h
    class DynamicValue;  // DynamicValue.h

    using ReflectionPrivateTag = internal::ReflectionPrivateTag;
    static ReflectionPrivateTag const PUBLIC_ACCESS;      ///< What any client may do.
    static ReflectionPrivateTag const PRIVILEGED_ACCESS;  ///< Passes accessor and mutator rights.
    static ReflectionPrivateTag const NO_PROXY_RESOLVE;   ///< Privileged; leaves proxies alone.
    static ReflectionPrivateTag const IN_MEMORY_ONLY;     ///< Privileged; loads nothing.

    /// Stands for "no property": a change under it is not recorded.
    static constexpr unsigned long NO_INDEX = ~0UL;

    /// \param id  the nil UUID stands for a fresh one.
    /// \throws tarnkiln::messages::CannotCreateWithoutModel  if `model` is empty or dead.
    Impl(Model const& model, UUID const& id);
    /// Also tells the builder's orchestrator, which thus builds each builder once.
    Impl(Builder& builder, UUID const& id);
    ~Impl() override;

    // ElementImpl
    Model getModel() const override;
    void invalidate() override;

    /// \name Reflection
    /// The base class knows no property but the extensions of its model, under other tags than
    /// `PUBLIC_ACCESS`: each of these fails with `NoSuchProperty` for all others. Setting an
    /// extension of another class does nothing.
    /// @{
    virtual bool hasPropertyValue(meta::Property const& property,
                                  ReflectionPrivateTag const& tag) const;
    virtual Value getPropertyValue(meta::Property const& property,
                                   ReflectionPrivateTag const& tag) const;
    virtual void setPropertyValue(meta::Property const& property, Value const& value,
                                  ReflectionPrivateTag const& tag);
    /// @}
    /// Whether all elements of this C++ class are of one metaclass, and `getPropertyValue` gives
    /// what `findStoredField` leads to. Not so in classes that override one of the two by hand.
    virtual bool isReadByFields() const { return false; }
    /// Where this element keeps the value of `property`; nothing if it is computed or unknown. To
    /// be asked only if `isReadByFields`.
    virtual StoredField findStoredField(meta::Property const& property) const;
    /// Calls an operation by reflection, and gives its result if it has one.
    ///
    /// \throws tarnkiln::messages::NoSuchOperation  (operation, qualified class name) if the
    ///     operation is not live or has nothing to run, if this class has not got it, and if it is
    ///     not public and `tag` is `PUBLIC_ACCESS`. The name of an empty operation is empty.
    /// \throws tarnkiln::messages::InvalidValue, CannotCastIncompatibleTypes  if the arguments do
    ///     not suit. What the operation itself throws passes unchanged.
    virtual boost::optional<Value> invoke(meta::Operation const& operation,
                                          std::vector<Value> const& arguments,
                                          ReflectionPrivateTag const& tag);
    /// A readable identifier; empty unless the class has one.
    virtual ustring identifier() const;

    /// \name Steps of a class
    /// @{
    /// Destroys what composite properties contain and empties all own references.
    virtual void doDestroy(bool keepIncoming, bool multiModel) = 0;
    /// Takes `element` in at this end of an association, without a call back.
    virtual void inverseAdd(ModelElement const& element, meta::Property const& property);
    virtual void inverseRemove(ModelElement const& element, meta::Property const& property);
    /// Whether this end refers to `element`, be it by a proxy, which is then resolved.
    virtual bool inverseContainsProxyTo(ModelElement const& element,
                                        meta::Property const& property) const;
    virtual void notifyDestroying();
    /// Clears plain references and removes this element from the opposite side of each.
    virtual void disassociateIncoming();
    /// Empties plain references before the model dies; other models' references to this element
    /// become proxies with `cachedId`, which is made when first needed.
    virtual void convertReferencesToProxies(bool multiModel, boost::optional<ProxyId>& cachedId);
    virtual void aboutToDestroy();
    virtual void didCreate();
    /// Drops all references silently, when the creation of this element is undone.
    virtual void basicDisassociateAll();
    /// Replaces `element` in `property`'s value by a proxy with `id`.
    virtual void convertToProxy(meta::Property const& property, ProxyId const& id,
                                ModelElement const& element);
    /// A record for a shallow transaction; owned by the caller.
    virtual Changes* createChanges() const = 0;
    /// A record for a deep transaction; owned by the caller.
    virtual Storage* createStorage() const = 0;
    /// Keeps the present value of the slot `index` in `storage`.
    virtual void copyValue(Storage* storage, unsigned long index) const;
    /// The same for an extension. A value that was kept before stays.
    void copyValue(Storage* storage, meta::Extension const& extension) const;
    /// Writes the old values back, then the link to the container. Announces nothing.
    virtual void copyStateFromStorage(Storage* storage);
    virtual meta::Property getPropertyByIndex(unsigned long index) const;
    /// @}

    /// \name The same ends of associations, for properties given by a slot
    /// The base finds the property and calls the function above.
    /// @{
    virtual void inverseAddSlot(ModelElement const& element, Slot const& slot);
    virtual void inverseRemoveSlot(ModelElement const& element, Slot const& slot);
    virtual bool inverseContainsProxyToSlot(ModelElement const& element, Slot const& slot) const;
    virtual void convertToProxySlot(Slot const& slot, ProxyId const& id,
                                    ModelElement const& element);
    /// The target of the single reference `slot`, unresolved; null if empty or not this class's.
    virtual Impl* basicGetReference(Slot const& slot) const;
    /// @}

    /// Calls `visit(reference, feature)` for each element that this one refers to, resolved or
    /// not, without loading, resolving or making anything.
    using ReferenceVisitor = std::function<void(ModelElement const&, Feature const&)>;
    virtual void visitReferences(ReferenceVisitor const& visit) const;

    /// \name Containment
    /// @{
    bool isTopLevel() const { return m_containmentFeature.isNull(); }
    Impl* basicContainer() const { return isTopLevel() ? nullptr : m_container; }
    ModelElement container() const;
    Impl* containerImpl() const { return basicContainer(); }
    /// The property of this element that refers to its container; empty if there is none.
    meta::Property containerProperty() const;
    meta::Property containerFeature() const { return containerProperty(); }
    /// The property of the container that holds this element.
    meta::Property containmentFeature() const;
    meta::Property::Impl* containmentFeatureImpl() const;
    /// The same as a feature; null for a top-level element.
    Feature const& getContainment() const { return m_containmentFeature; }

    /// Links this element to another container, or to none, and records the old link.
    ///
    /// \param index  the slot of this element that changes with it, or `NO_INDEX`.
    /// \throws tarnkiln::messages::CannotChangeModel  if the container lies in another model.
    void basicSetContainer(Impl* newContainer, Feature const& feature, unsigned long index);
    /// Restores the link that `storage` kept. Announces and records nothing.
    void basicSetContainer(Storage const* storage);
    /// Leaves the container, whose collection lets go, and becomes top-level.
    void makeUncontained();
    /// Fails with `CircularContainment` if `candidate`, the future container, is this element or
    /// lies below it.
    void checkCircularContainment(ModelElement const& candidate) const;
    /// Fails unless a reference to `other` may be stored in `feature` of this element.
    ///
    /// \throws tarnkiln::messages::CannotCreateCrossModelAssociation  between models that may not
    ///     be tied by this property.
    /// \throws tarnkiln::messages::CircularContainment  if a composite would contain itself.
    void checkCompatibleModel(Impl* other, Feature const& feature) const;
    /// @}

    /// \name Change
    /// @{
    /// Announces a change of the slot `index` before it is made. Only a `Valid` element's are.
    ///
    /// \throws tarnkiln::messages::ModelFrozen, NoOpenTransaction, ChangesProhibited  if the model
    ///     may not be changed now.
    void notifyModifying(unsigned long index);
    /// The same for an extension, of any element.
    void notifyModifying(meta::Extension const& extension);
    /// Makes a constructed element `Valid` and enters it in its model, top-level.
    ///
    /// \throws tarnkiln::messages::UUIDConflict  if its model has an element with its UUID.
    void notifyCreated();
    /// Destroys the element and all that it contains, in the open transaction or its own.
    void destroy();
    void destroyRecursively(bool keepIncoming, bool removeFromContainer, bool multiModel);
    /// Destroys each of `elements`, which stay in their containers, and lets go of it at once.
    static void _destroyEach(std::vector<ModelElement> elements, bool keepIncoming,
                             bool multiModel);
    /// @}

    /// \name Extensions
    /// The values of the properties that the model has added to the class of this element; names
    /// are those of `Model::Impl::getExtension`. An element has what it was given, else the
    /// default, which is never stored; and loses it when the extension goes.
    ///
    /// Setting fails with `CannotModifyProxy` for a proxy, and does nothing for a dead element.
    /// Elements that are values are kept in memory until this one is destroyed.
    /// @{
    /// The value, or the default. Many values are a collection, which belongs to this element and
    /// is made at the first call; changes go through it.
    ///
    /// \throws tarnkiln::messages::NoSuchExtension  (name, qualified class name) if the class has
    ///     no such extension, or that no default or no collection.
    Value getExtension(ustring const& name) const;
    /// Gives the extension, which has a single value, another one, in the open transaction or in
    /// one of its own. The default takes away what was set.
    ///
    /// What fails after a transaction was joined dooms that.
    /// \throws tarnkiln::messages::NoSuchExtension  (name, qualified class name) if the class has
    ///     no such extension, or it has many values.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes, InvalidValue  if the value does not
    ///     suit, as `Value::checkCompatibleWithProperty` says.
    /// \throws tarnkiln::messages::ModelFrozen, ChangesProhibited  if the model may not be changed
    ///     now.
    void setExtension(ustring const& name, Value const& value);
    /// The same; `InvalidValue` for an extension that is no more.
    void setExtension(meta::Extension const& extension, Value const& value);
    /// Whether it has another value than the default; of many values, whether there are any. False
    /// if the class has no such extension.
    bool hasNonDefaultExtension(ustring const& name) const;
    /// The names of the extensions of which this element holds a value or a collection, in
    /// ascending order. Among them may be some that are no more.
    std::vector<ustring> _extensionNames() const;
    /// Makes values of the first extension of each pair, which is one of the model that the element
    /// comes from, those of the second.
    void updateDynamicValuesOnMoveToAnotherModel(
        std::unordered_map<meta::Extension, meta::Extension> const& mapping);
    /// @}

    /// \name Proxies
    /// @{
    bool isProxy() const { return m_aside == Aside::StandIn; }
    boost::optional<ProxyId> getProxyId() const;
    /// Null unless this is a proxy; lives as long as that.
    ProxyId const* getProxyIdImpl() const;
    /// The same as it is kept; takes less to ask.
    internal::StandIn const* getStandIn() const { return isProxy() ? m_standIn : nullptr; }
    /// The id by which a proxy would name this element; a proxy's own id.
    ProxyId getPersistentProxyId(bool omitModel) const;
    ProxyId _getPersistentProxyId() const { return getPersistentProxyId(/*omitModel=*/false); }
    /// Keeps the present link in `storage`, for the transaction.
    void recordOldContainer(Storage& storage) const;
    /// Turns an element that its model does not know into a stand-in for the one that `id` names.
    void _becomeProxy(ProxyId const& id, ElementValidity validity);
    /// @}

    /// \name The other end of an association, for generated and collection code
    /// All do nothing for a null `other` and for a proxy.
    /// @{
    void _inverseAddThis(Impl* other, Feature const& feature, bool force);
    void _inverseRemoveThis(Impl* other, Feature const& feature);
    bool _inverseContainsThis(Impl* other, Feature const& feature) const;
    void _setContainedByThis(Impl* child, Feature const& feature);
    void _basicSetUncontained(Impl* child);
    void _convertToProxy(Impl* target, Feature const& feature, ProxyId const& id);
    /// Without the parse rule and the tests for null and proxies.
    void _callInverseAdd(Impl& other, Feature const& feature);
    void _callInverseRemove(Impl& other, Feature const& feature);
    /// @}

    /// \name Gateways to collections
    /// @{
    static void _basicAdd(ReferenceCollection* collection, ModelElement const& element);
    static void _basicRemove(ReferenceCollection* collection, ModelElement const& element);
    static bool _basicContainsProxyTo(ReferenceCollection* collection, ModelElement const& element);
    static void _basicClear(ReferenceCollection* collection);
    /// A null `source` clears the target.
    static void _basicCopyValues(ReferenceCollection* target, ReferenceCollection const* source);
    /// Asks the model's data source, if there is one, to fill `collection`.
    void _loadCollectionContents(ReferenceCollection* collection) const;
    /// @}

    /// The model; null for a proxy or a dead element whose model is gone.
    Model::Impl* getModelImpl() const { return m_aside < Aside::Anchor ? m_model : asideModel(); }

protected:
    /// Tells the invalidate callback, if there is one, that `collection` dies with this element.
    void collectionInvalidated(AbstractOwnedCollection* collection);
    /// Gives an element that is about to become a proxy room for what makes it one, in its own
    /// memory and for as long as that lasts.
    void offerRoom(void* room);

private:
    friend class ChangeRecords;
    friend class internal::InvariantChecker;
    friend class support::TopLevelElements;
    friend class Model::Impl;
    friend class Storage;

    void announceContainerChange();
    void storeLink(Impl* container, Feature const& feature);
    void pinContainer();
    void unpinContainer();
    void anchor();
    void unanchor();
    support::ModelAnchor* anchorImpl() const;
    Model::Impl* asideModel() const;

    /// Null as long as there are none.
    internal::ExtensionValues* extensionValues() const
    {
        return m_aside == Aside::Extensions ? m_extensionValues : nullptr;
    }
    internal::ExtensionValues& makeExtensionValues() const;
    void destroyExtensionValues();
    meta::Extension findExtension(ustring const& name) const;
    DynamicValue* findExtensionValue(ustring const& name, meta::Extension const& extension) const;
    AbstractOwnedCollection* makeExtensionCollection(meta::Extension const& extension) const;
    bool isExtensionOfClass(meta::Extension const& extension) const;
    void recordEndingExtensions();
    void dropEndingExtensions();
    void restoreExtensions(Storage& storage);

    static constexpr std::uint32_t NOT_TOP_LEVEL = ~std::uint32_t{0};
    static constexpr std::uint32_t NOT_RECORDED = ~std::uint32_t{0};

    /// What the members of the union share their place for.
    enum class Aside : unsigned char
    {
        Nothing,
        Room,       ///< Where the stand-in may be made.
        StandIn,    ///< Of a proxy, dead or not.
        Anchor,     ///< Of any other dead element.
        Extensions  ///< Of an element that was given any, dead or not; with the anchor.
    };

    bool m_containerPinned : 1 = false;      ///< A dead element keeps its container in memory.
    bool m_everContainer : 1 = false;        ///< Some element was in it once.
    bool m_isStandInInside : 1 = false;      ///< In memory of the element's own.
    mutable Aside m_aside = Aside::Nothing;  ///< Reading an extension may make its collection.
    std::uint32_t m_topLevelIndex = NOT_TOP_LEVEL;
    std::uint32_t m_recordPlace = NOT_RECORDED;  ///< In the last transaction that recorded it.
    Impl* m_container = nullptr;
    Feature m_containmentFeature;  ///< The container's; null for a top-level element.
    Model::Impl* m_model;          ///< Not to be followed in a dead element, which has an anchor.
    union
    {
        internal::StandIn* m_standIn = nullptr;                ///< Owned.
        support::ModelAnchor* m_anchor;                        ///< Counted.
        mutable internal::ExtensionValues* m_extensionValues;  ///< Owned.
    };
};

inline ModelElement::ModelElement(Impl* impl) : ElementHandle(impl) {}
inline ModelElement::Impl* ModelElement::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline ModelElement::Impl* ModelElement::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln
