/// \file
/// What stands behind a `Model`.
#pragma once
#include "tarnkiln/kernel/FindElementBehavior.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/TransactionOrigin.h"
#include "tarnkiln/support/CountedPointer.h"
#include "tarnkiln/support/ElementRegistry.h"
#include "tarnkiln/support/ModelAnchor.h"
#include "tarnkiln/support/TopLevelElements.h"

#include <boost/optional.hpp>

#include <atomic>
#include <functional>
#include <memory>
#include <unordered_set>
#include <vector>

namespace tarn::kiln {
class AbstractTransactionFactoryImpl;
namespace datasource {
class DataSource;
}
namespace internal {
class DeclaredExtensions;
struct DeclaredExtensionRecord;
class LocalTransactionFactoryImpl;
class ModelName;
class StandIns;
}  // namespace internal

/// The registry of a model's elements, its transaction, its listeners and its place in a
/// constellation.
///
/// Threads: as `Model`.
class TARNKILN_EXPORT Model::Impl : public ElementImpl
{
public:
    /// Only factories can name it, so that only they can begin transactions.
    class PrivateTag
    {
        PrivateTag() = default;
        friend class internal::LocalTransactionFactoryImpl;
    };

    Impl(UUID const& id, ModelConstellation const& constellation);
    ~Impl() override;

    // ElementImpl
    Model getModel() const override;
    meta::Class const& getMetaClass() const override;
    void removeRef() override;

    /// \name Elements
    /// @{
    /// The element of that UUID; empty if there is none.
    ModelElement findElement(UUID const& id,
                             FindElementBehavior behavior = FindElementBehavior::InMemory) const;
    /// The element of exactly that class that `id` names, by the resolvers of its type.
    ModelElement findElement(meta::Class const& metaClass, ElementId const& id) const;
    /// The element of that UUID in memory, or null; takes no reference.
    ModelElement::Impl* findElementImpl(UUID const& id) const { return m_elements.find(id); }
    /// A copy, in no promised order.
    std::vector<ModelElement> getTopLevelElements() const;
    std::size_t getElementCount() const { return m_elements.size(); }
    /// Handles of all elements, in no promised order.
    std::vector<ModelElement> getAllElements() const;
    /// The same in the same order, without a share in them.
    std::vector<ModelElement::Impl*> getAllElementImpls() const;
    /// @}

    /// \name Transactions
    /// @{
    /// Begins a transaction, or one nested in the open one, which then decides the depth.
    ///
    /// \param revertible  whether it must be possible to roll the changes back.
    /// \throws tarnkiln::messages::ModelFrozen  if the model is dead.
    Transaction beginTransaction(bool revertible);
    Transaction innerBeginTransaction(PrivateTag const& tag, meta::TransactionOrigin const& origin,
                                      bool deep);
    void doBeginTransaction(internal::TransactionGroup* group,
                            meta::TransactionOrigin const& origin);
    /// Fails unless the model may be changed now.
    ///
    /// \throws tarnkiln::messages::ModelFrozen        if the model is frozen.
    /// \throws tarnkiln::messages::NoOpenTransaction  if none is open and the model has a listener
    ///     or shares its constellation with others.
    void validateTransaction() const
    {
        if (!m_currentTransaction || m_freezeCount != 0)
            refuseInvalidChange();
    }
    /// Whether a change that is made now could neither fail nor be heard of, kept or taken back;
    /// then it need not be announced. Never so outside a transaction.
    bool isChangedInSilence() const;
    void transactionEnded();
    internal::TransactionImpl* getCurrentTransaction() const { return m_currentTransaction; }
    AbstractTransactionFactoryImpl& getDefaultTransactionFactory() const;
    /// Lets another party begin this model's transactions; null restores the default.
    void setTransactionFactory(std::unique_ptr<AbstractTransactionFactoryImpl> factory);
    bool isFactoryLocal() const { return m_isFactoryLocal; }
    /// Whether a transaction for one change, begun now, would tell nobody and keep nothing.
    bool isUnwatched() const;
    /// A change has ended that was made without a transaction, as nobody would have heard of it.
    void unwatchedChangeEnded();
    /// Between these a rollback that can't be avoided waits (OpenStep.h).
    void openStep() { ++m_openSteps; }
    void closeStep() { --m_openSteps; }
    bool isInStep() const { return m_openSteps != 0; }
    /// Makes the next default transaction ask the listeners again whether it must be deep.
    void resetTransactionDepth() { m_transactionDepth = 0; }
    /// @}

    /// \name Notification, for elements
    /// @{
    void elementCreated(ModelElement::Impl* element, bool topLevel);
    void elementDestroying(ModelElement::Impl* element);
    void allElementsDestroying();
    void elementModifying(ModelElement::Impl* element, unsigned long index);
    void elementModifying(ModelElement::Impl* element, meta::Extension const& extension);
    void elementMadeTopLevel(ModelElement::Impl* element);
    void elementNoLongerTopLevel(ModelElement::Impl* element);
    void remove(ModelElement::Impl* element);
    void resurrectElement(ModelElement::Impl* element);
    /// @}

    /// \name Listeners (ListenerHolder.h has the typed forms)
    /// @{
    /// Appends `holder`, whose listener must not be on the list.
    ///
    /// A listener hears of transactions that begin after this call.
    void addListenerHolder(std::unique_ptr<ListenerHolderBase> holder);
    /// Adds a listener that is told of commits, and needs no old values. Ignores one that is on
    /// the list.
    template <class L> void addShallowListener(L* listener);
    /// Adds a listener for what it has methods for; transactions become deep. Ignores one that is
    /// on the list.
    template <class L> void addListener(L* listener);
    /// The same, and deletes the listener when it is removed.
    template <class L> void addOwnedListener(std::unique_ptr<L> listener);
    /// Takes the listener off the list; it is told by `listenerRemoved`. Safe at any time, from
    /// within a notification too.
    void removeListener(Listener* listener);
    void removeListenerFromTransaction(ListenerHolderBase* holder);
    bool isListening(Listener const* listener) const;
    bool hasListeners() const { return !m_listeners.empty(); }
    std::vector<std::unique_ptr<ListenerHolderBase>> const& getListeners() const
    {
        return m_listeners;
    }
    /// @}

    /// \name Extensions
    /// Properties that this model adds to classes of the registry, for its own elements. They are
    /// changes of the registry's model: transactions of this model do not take them back. They end
    /// with `unextendMetaclass` or with this model.
    /// @{
    /// Adds a property to `extended` and to the classes below it. Listeners are told after that.
    ///
    /// \param defaultValue  what elements have as long as nothing is set; must be there for a
    /// single
    ///     value that is no reference. A single reference is empty at first, whatever is given.
    /// \throws tarnkiln::messages::CannotCreateWithoutModel  unless `extended` is a live class of
    ///     the registry.
    /// \throws tarnkiln::messages::NoSuchType  (type name) if no type has that name.
    /// \throws tarnkiln::messages::ExtensionMustHaveName
    /// \throws tarnkiln::messages::ExtensionNameMustBeUnique  if this model has an extension of the
    ///     name on a class above or below.
    /// \throws tarnkiln::messages::ExtensionMustHaveDefaultValue
    /// \throws tarnkiln::messages::InvalidValue, CannotCastIncompatibleTypes  if the default does
    ///     not suit.
    /// \throws tarnkiln::messages::CannotInstantiateCollection  (qualified name of the type) if
    ///     many values were asked for and the type has no collections.
    /// \throws tarnkiln::messages::NoOpenTransaction  if a transaction of the registry is open; the
    ///     declaration then belongs to that.
    void extendMetaclass(meta::Class const& extended, meta::ExtensionPrototype const& prototype,
                         boost::optional<Value> const& defaultValue);
    /// Takes away a property that this model added to exactly `extended`. Listeners are told before
    /// that.
    ///
    /// \throws tarnkiln::messages::CannotCreateWithoutModel, NoOpenTransaction  as above.
    /// \throws tarnkiln::messages::NoSuchExtension  (name, qualified class name)
    void unextendMetaclass(meta::Class const& extended, ustring const& name);
    /// The extension of exactly that class; empty if there is none.
    meta::Extension getDeclaredExtension(meta::Class const& extended, ustring const& name) const;
    /// The extension of that class, or else of the next class above that has one; empty if there is
    /// none.
    meta::Extension getExtension(meta::Class const& metaClass, ustring const& name) const;
    /// What elements of `metaClass` have as long as nothing is set.
    ///
    /// \throws tarnkiln::messages::NoSuchExtension  (name, qualified class name) if there is no
    /// such
    ///     extension, or none with a default.
    Value getExtensionDefault(meta::Class const& metaClass, ustring const& name) const;
    /// What stands in this model for `extension`, which another model declared: an extension of
    /// this model that has the same name and shape and is on the same class or above; `extension`
    /// itself if there is no such name; empty if there is another extension of that name that
    /// differs, or that is on a class below.
    ///
    /// \param defaultValue  of `extension`. Both must be absent or equal, unless the type is a
    ///     class or there are many values.
    meta::Extension validateExtension(meta::Extension const& extension,
                                      boost::optional<Value> const& defaultValue) const;
    /// Tells all listeners that there is a new extension.
    void notifyExtensionAdded(meta::Extension const& extension);
    /// Not owned; one that is there is not added again.
    void addExtensionListener(ExtensionListener* listener);
    void removeExtensionListener(ExtensionListener* listener);
    /// @}

    /// \name Identity
    /// @{
    ustring const& getModelURI() const { return m_modelURI; }
    /// Renames the model; the stored URI is the normalised form of `uri`. Is no transaction.
    ///
    /// \throws tarnkiln::messages::InvalidValue  if the model has no constellation.
    /// \throws tarnkiln::messages::UniquenessConstraint  if another model of it has that location.
    void setModelURI(ustring const& uri);
    ustring const& getLocationModelId() const { return m_locationModelId; }
    ModelConstellation getModelConstellation() const;
    ModelConstellation::Impl* getModelConstellationImpl() const { return m_constellation; }
    void basicSetModelConstellation(ModelConstellation::Impl* constellation);
    bool isRegistryModel() const { return !m_constellation && !m_modelURI.empty(); }
    bool isTransientModel() const { return !m_constellation && m_modelURI.empty(); }
    /// Moves the model into another constellation. Is no transaction.
    ///
    /// \throws tarnkiln::messages::CannotMigrateModel  if a transaction is open, if the model has
    ///     no constellation or shares it, or if `target` is not live.
    /// \throws tarnkiln::messages::CannotJoinShallowTransaction, UniquenessConstraint  as for a
    ///     new model.
    void migrateToConstellation(ModelConstellation const& target);
    /// Moves all elements into another model, with their UUIDs, proxies and extension values; there
    /// they count as created, in the open transaction or in one of its own. This model is empty
    /// afterwards, has no extensions and can be used. Its dead elements stay dead elements of it.
    ///
    /// Extensions go along; one that `target` has already, in the same shape, is taken instead. A
    /// failure leaves both models as they were. Danger: what the transaction of `target` takes back
    /// later, or a listener of `target` refuses at its end, is lost; it does not return to here.
    /// \throws tarnkiln::messages::CannotChangeModel  if `target` is this model or not live, if
    ///     this model has a listener or an open transaction, or if a listener of the registry
    ///     refuses that the extensions move.
    /// \throws tarnkiln::messages::ExtensionNameMustBeUnique  if `target` has another extension of
    ///     a name that this model has, on the same line of inheritance.
    /// \throws tarnkiln::messages::ModelFrozen   if `target` is frozen.
    /// \throws tarnkiln::messages::UUIDConflict  if `target` has an element with the UUID of one.
    /// \throws tarnkiln::messages::CreateWithDestroyAll, ChangesProhibited  as for a new element.
    void moveAllContentsTo(Model const& target);
    /// Whether other models change together with this one.
    bool isMultiModel() const;
    unsigned long getModelCounter() const { return m_modelCounter; }
    /// @}

    /// \name Packages in use
    /// @{
    std::vector<meta::Package> getUsedPackages() const;
    std::vector<ustring> getUsedPackageUris() const;
    /// The URIs of the used packages and of all that they import.
    std::vector<ustring> getDescriptivePackageURIClosure() const;
    static std::vector<ustring>
    getImportedPackageClosure(std::vector<meta::Package> const& packages);
    void setUsageProvider(std::unique_ptr<meta::DataModelUsageProvider> provider);
    /// @}

    /// \name Freezing and progress (Freezer.h, ProgressIndicators.h)
    /// @{
    /// Refuses changes for as long as the result lives.
    Freezer freeze();
    bool isFrozen() const { return m_freezeCount != 0; }
    ParseInProgressIndicator startParse();
    DataSourceLoadingInProgressIndicator startDataSourceLoading();
    bool isParsing() const { return m_parseCount != 0; }
    bool isDataSourceLoading() const { return m_dataSourceLoadCount != 0; }
    /// Whether listeners that are told of a finished transaction find the model frozen.
    void setFreezeOnNotify(bool freeze) { m_freezeOnNotify = freeze; }
    bool isFrozenOnNotify() const { return m_freezeOnNotify; }
    /// Whether reports leave out elements that were changed back.
    void setRevertUnchangedOnReport(bool revert) { m_revertUnchangedOnReport = revert; }
    bool isUnchangedRevertedOnReport() const { return m_revertUnchangedOnReport; }
    /// @}

    /// \name Proxies
    /// @{
    /// The element that `proxy` names, loading what is needed; the proxy itself if there is none.
    ModelElement resolveProxy(ModelElement::Impl const* source, ModelElement const& proxy) const;
    /// The same as `resolveProxy` among what is in memory.
    ModelElement peekResolveProxy(ModelElement::Impl const* source,
                                  ModelElement const& proxy) const;
    ProxyId getPersistentProxyId(ModelElement::Impl const* element, bool omitModel) const;
    /// @}

    /// \name Data source
    /// @{
    void setDataSource(std::unique_ptr<datasource::DataSource> source);
    void resetDataSource();
    datasource::DataSource* getDataSource() const { return m_dataSource.get(); }
    /// @}

    /// \name Destruction
    /// @{
    /// Destroys all elements, in one transaction; the model stays.
    void destroyAllContents();
    /// Destroys the model: listeners go first and are not told of the elements.
    void destroy();
    /// @}

    /// Verifies registry, containment tree, top-level set, opposites, keys and side tables.
    ///
    /// Resolves, loads and makes nothing; does not depend on the size of the call stack.
    /// \returns a sentence for each violation; empty if all is well.
    std::vector<string> checkInvariants() const;
    /// Runs `checkInvariants` and asserts on it, in checked builds, unless this is in the middle of
    /// a change: always up to 2000 elements, above that when the number of ended transactions is a
    /// power of two.
    void checkInvariantsAtEnd();

    /// Tells of the model when it is gone, and whether it has changed.
    support::CountedPointer<support::ModelAnchor> const& getAnchor() const { return m_anchor; }

private:
    friend class Model;
    friend class Model::Freezer;
    friend class Model::Thawer;
    friend class Model::ParseInProgressIndicator;
    friend class Model::DataSourceLoadingInProgressIndicator;
    friend class ModelElement::Impl;
    friend class internal::InvariantChecker;
    friend class internal::TransactionImpl;

    void forgetListener(ListenerHolderBase* holder);
    void removeAllListeners();
    class ContentsMove;  // ModelMoving.cpp

    internal::DeclaredExtensionRecord const* findExtensionRecord(meta::Class const& metaClass,
                                                                 ustring const& name) const;
    meta::Extension findExtensionInRegistry(meta::Class const& metaClass,
                                            ustring const& name) const;
    std::vector<ModelElement> getElementsInOrder() const;
    void tellExtensionListeners(std::function<void(ExtensionListener&)> const& tell);
    void destroyExtensions();
    void convertAllReferencesToProxies(bool multiModel);
    void destroyElements(bool multiModel);
    Impl const* findNamedModel(internal::ModelName const* name) const;
    /// What `resolveProxy` finds, if the registries of models and elements are all that has to be
    /// asked; else null. Takes no reference.
    ModelElement::Impl* findKnownTarget(ModelElement::Impl const& proxy) const;
    bool isRecording() const { return m_currentTransaction && m_dataSourceLoadCount == 0; }
    void refuseInvalidChange() const;

    support::TopLevelElements m_topLevelElements;  ///< Strong: keeps top-level elements alive.
    support::ElementRegistry m_elements;           ///< Everything the model holds, by UUID; weak.
    std::unique_ptr<internal::StandIns> const m_proxies;  ///< Proxies that point to this model.
    internal::TransactionImpl* m_currentTransaction = nullptr;
    internal::TransactionImpl* m_telling =
        nullptr;  ///< The last to end of those telling listeners.
    std::vector<std::unique_ptr<ListenerHolderBase>> m_listeners;
    signed char m_transactionDepth = 1;  ///< 0 ask the listeners, 1 shallow, 2 deep.
    bool m_freezeOnNotify = false;
    bool m_revertUnchangedOnReport = false;
    unsigned long const m_modelCounter;
    std::atomic<int> m_freezeCount{0};
    unsigned int m_dataSourceLoadCount = 0;
    unsigned int m_parseCount = 0;
    unsigned int m_openSteps = 0;
    support::CountedPointer<support::ModelAnchor> const m_anchor;
    unsigned long m_endedTransactions = 0;
    std::unique_ptr<internal::DeclaredExtensions> const m_extensions;
    std::unordered_set<ExtensionListener*> m_extensionListeners;
    std::unique_ptr<meta::DataModelUsageProvider> m_usageProvider;
    std::unique_ptr<AbstractTransactionFactoryImpl> m_transactionFactory;
    bool m_isFactoryLocal = true;  ///< Not brought by a client.
    ModelConstellation::Impl* m_constellation = nullptr;
    ustring m_modelURI;
    ustring m_locationModelId;  ///< The form of the URI by which the constellation finds the model.
    std::unique_ptr<datasource::DataSource> m_dataSource;
};

inline Model::Impl* Model::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Model::Impl* Model::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln
