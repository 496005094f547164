/// \file
/// What stands behind a `ModelConstellation`.
#pragma once
#include "tarnkiln/kernel/ConstellationListener.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelElement.h"

#include <cstdint>
#include <map>
#include <memory>
#include <vector>

namespace tarn::kiln {

/// One listener of a constellation; tells it when it is removed.
class TARNKILN_EXPORT ConstellationListenerHolder
{
public:
    ConstellationListenerHolder(ConstellationListener* listener,
                                ModelConstellation::Impl* constellation, bool owned);
    ConstellationListenerHolder(ConstellationListenerHolder const&) = delete;
    ConstellationListenerHolder& operator=(ConstellationListenerHolder const&) = delete;
    ~ConstellationListenerHolder();

    ConstellationListener* getListener() const { return m_listener; }

private:
    ConstellationListener* m_listener;
    ModelConstellation::Impl* m_constellation;
    bool m_owned;
};

/// The models of a constellation by location, the history of their URIs, and the open group of
/// transactions.
class TARNKILN_EXPORT ModelConstellation::Impl : public ElementImpl
{
public:
    Impl();
    ~Impl() override;

    // ElementImpl
    Model getModel() const override;  ///< Empty: a constellation lies in no model.
    meta::Class const& getMetaClass() const override;
    void removeRef() override;

    /// \name Models
    /// @{
    bool isMultiModelConstellation() const { return m_models.size() > 1; }
    /// Whether anyone holds a handle to one of the models.
    bool hasAliveModels();
    std::vector<Model> getModels() const;
    /// The model of that URI in memory; empty if there is none.
    Model peekModel(ustring const& uri) const;
    /// Loads the model of that URI by the normalizers, renames it to that and takes it in.
    ///
    /// A registry model is returned as it is; a transient one counts as none.
    /// \throws tarnkiln::messages::CannotMigrateModel  if it shares another constellation or is in
    ///     a transaction.
    Model fetchModel(ustring const& uri);
    void saveModels();
    /// Takes a model in, and into the open transaction.
    ///
    /// \throws tarnkiln::messages::CannotJoinShallowTransaction  if a shallow group is open.
    /// \throws tarnkiln::messages::UniquenessConstraint  if its location is taken.
    void addModelToConstellation(Model::Impl* model);
    void modelIsDestroyed(Model::Impl* model);
    void modelIsNotExternallyReferenced(Model::Impl* model);
    void modelURIAboutToChange(ustring const& oldId, ustring const& newId);
    /// Where a model that once had the URI is now, or would be reloaded from.
    ustring getLatestModelURI(ustring const& uri) const;
    /// The model that has the URI or once had it, if no normalizer needs to be asked; else null.
    /// May be dead.
    Model::Impl* findListed(ustring const& uri) const;
    /// As long as it is the same, each model of this constellation has the URIs that it had; no two
    /// constellations have the same one.
    std::uint64_t getNamesVersion() const { return m_namesVersion; }
    void namesChanged() { m_namesVersion = nextNamesVersion(); }
    ModelElement resolveProxy(ModelElement const& proxy);
    /// @}

    /// \name Listeners, told in the order of their adding
    /// @{
    void addConstellationListener(ConstellationListener* listener);
    void addOwnedConstellationListener(std::unique_ptr<ConstellationListener> listener);
    void removeConstellationListener(ConstellationListener* listener);
    /// @}

    /// \name Transactions
    /// @{
    void createTransactionGroup(bool deep, meta::TransactionOrigin const& origin);
    void transactionGroupCompleted();
    internal::TransactionGroup* getTransactionGroup() const { return m_group.get(); }
    /// @}

    /// Destroys all models, then the constellation.
    void destroy();

private:
    struct UriRecord
    {
        Model::Impl* model = nullptr;
        ustring forwardingUri;
    };

    class ListenerWalk;

    static std::uint64_t nextNamesVersion();
    ustring const& latestModelURI(ustring const& uri) const;

    /// Calls `tell(listener)` for each; listeners may come and go meanwhile.
    template <class Tell> void forEachListener(Tell const& tell);

    std::map<ustring, Model::Impl*> m_models;  ///< By location.
    std::unique_ptr<internal::TransactionGroup> m_group;
    std::map<ustring, UriRecord> m_uriHistory;  ///< Where a URI has gone.
    std::uint64_t m_namesVersion = nextNamesVersion();
    std::vector<std::unique_ptr<ConstellationListenerHolder>> m_listeners;
    int m_listenerWalks = 0;  ///< Under way: who is removed meanwhile leaves a null.
};

inline ModelConstellation::Impl* ModelConstellation::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline ModelConstellation::Impl* ModelConstellation::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln
