/// \file
/// The base of all collections of references to elements.
#pragma once
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/collections/GenericCollectionInterface.h"

#include <vector>

namespace tarn::kiln {

/// A collection of references that keeps the other end of the association, or the container link
/// of what it holds, in step with each public change.
///
/// The operations called `basic...` do without that upkeep; the element classes and data sources
/// use them, clients do not.
///
/// Threads: as the element's model.
class TARNKILN_EXPORT ReferenceCollection : public AbstractOwnedCollection
{
public:
    ~ReferenceCollection() override;

    // AbstractOwnedCollection
    void copyContents(AbstractOwnedCollection const& other) override;

    /// \name Reading
    /// @{
    /// The resolved entries. A sequence resolves its proxies first, and leaves out those that it
    /// can not resolve.
    virtual std::vector<ModelElement> getAllValues() const = 0;
    /// All entries; proxies as they stand. Resolves and loads nothing.
    virtual std::vector<ModelElement> getAllValuesAndProxies() const;
    /// The view for code that knows no element class; belongs to this collection.
    virtual GenericCollectionInterface* getGenericInterface() const = 0;
    bool isComposite() const { return getCollectionFeature().isComposite(); }
    /// The other end of the association; none if there is none.
    Feature const& getOpposite() const { return m_opposite; }
    /// @}

    /// \name Element class
    /// @{
    /// The class that entries must have; empty while its metamodel is being built.
    virtual meta::Class const& getElementClass() const = 0;
    /// Whether the class of `element`, which must not be null, suits.
    virtual bool acceptsElement(ModelElement const& element) const = 0;
    /// \throws tarnkiln::messages::CannotAddIncompatibleTypes  unless the class of `element`, which
    ///     must not be null, suits; with the qualified names of both classes.
    void checkElementClass(ModelElement const& element) const
    {
        if (!acceptsElement(element))
            refuseElementClass(element);
    }
    /// \throws tarnkiln::messages::CannotCreateCrossModelAssociation, CircularContainment  if the
    ///     owner may not refer to `element` by this property. Nothing for a snapshot.
    void checkCompatibleModel(ModelElement::Impl* element) const;
    /// @}

    /// \name Proxies
    /// @{
    /// The element that `proxy` names, loaded if need be; `proxy` itself if it can't be resolved.
    ModelElement resolveProxy(ModelElement const& proxy) const;
    /// The same among what is in memory.
    ModelElement peekResolveProxy(ModelElement const& proxy) const;
    /// Puts a resolved element in the place of a proxy: at `index` in a sequence, else of the proxy
    /// that names the element.
    virtual void replaceProxy(ModelElement const& element, unsigned long index) = 0;
    /// Resolves all proxies that can be, loading what is needed.
    virtual void resolveAll() = 0;
    /// Resolves the proxies that name elements of the owner's model.
    virtual void resolveLocal() = 0;
    /// Adds an element or a proxy without upkeep of the other end; for data sources.
    virtual void basicAddWithProxy(ModelElement const& element);
    /// @}

    /// Destroys all elements in the collection, which is empty before the first one dies.
    void destroyAllContents();

protected:
    /// \param owner     null makes a snapshot.
    /// \param opposite  none, if there is no other end.
    ReferenceCollection(ModelElement::Impl* owner, Feature const& feature, Feature const& opposite);

    friend class ModelElement::Impl;

    /// \name Change without upkeep of the other end; announced all the same
    /// @{
    virtual void basicAdd(ModelElement const& element) = 0;
    virtual void basicRemove(ModelElement const& element) = 0;
    virtual void basicClear() = 0;
    /// Replaces the contents by a copy of those of `other`, a collection of the same class.
    virtual void basicCopyValues(ReferenceCollection const& other) = 0;
    /// Whether a proxy in here means `target`, which then takes the place of the proxy.
    virtual bool basicContainsProxyTo(ModelElement const& target) = 0;
    /// @}

    /// \name Upkeep
    /// All do nothing for a snapshot.
    /// @{
    /// Whether adding and removing reaches beyond this collection.
    bool hasUpkeep() const { return m_owner && (m_opposite || isComposite()); }
    /// Tells the other end, or the element itself, that it is in here now.
    void linkAdded(ModelElement const& element) const;
    /// Tells the other end, or the element itself, that it leaves. Proxies and dead elements are
    /// not told.
    void unlinkRemoved(ModelElement const& element) const;
    /// Whether `element` refers to the owner by the opposite, which must be a single reference.
    bool isReferredBackBy(ModelElement const& element) const;
    /// Whether the upper bound of the opposite is 1, so that `isReferredBackBy` can answer.
    bool hasSingleOpposite() const { return m_owner && m_opposite && m_opposite.isSingle(); }
    /// The element that may take the place of `proxy` in here; empty if there is none, or if the
    /// other end does not refer back.
    ModelElement resolveEntry(ModelElement const& proxy) const;
    /// @}

    static ModelElement::Impl* implOf(ModelElement const& element) { return element.getImpl(); }
    static bool isProxy(ModelElement const& element)
    {
        return element.getImpl() && element.getImpl()->isProxy();
    }
    /// Whether the id of `proxy` has a model part.
    static bool namesModel(ModelElement const& proxy);

    /// \name Failures, raised with the ids of their names
    /// @{
    [[noreturn]] static void reportCannotAddIncompatibleObjectSubset();
    [[noreturn]] static void reportCannotAddNonExistentObject();
    [[noreturn]] static void reportCannotAddSecondObject();
    [[noreturn]] static void reportCannotCreateCrossModelAssociation();
    [[noreturn]] static void reportUniquenessConstraint();
    /// @}

private:
    [[noreturn]] void refuseElementClass(ModelElement const& element) const;

    Feature const m_opposite;
};
}  // namespace tarn::kiln
