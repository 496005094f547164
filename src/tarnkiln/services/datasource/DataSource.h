/// \file
/// What brings the contents of a model into memory when they are first touched.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/collections/Fwd.h"
#include "tarnkiln/kernel/ModelElementImpl.h"

namespace tarn::kiln::datasource {

class LoadingTransaction;

/// A lazy loader behind one model; clients derive from it and give it to
/// `Model::Impl::setDataSource`.
///
/// The kernel asks it for elements and collections that are not in memory. What it creates and
/// fills in a `LoadingTransaction` counts as loaded, not as changed. A loading transaction that is
/// not committed makes an outer transaction fail: commit on every road, even if nothing was found.
/// A frozen model cannot load.
///
/// Threads: as the model.
class TARNKILN_EXPORT DataSource
{
public:
    /// How loaders read and write what is in memory: past all access rights, leaving proxies alone.
    static ModelElement::Impl::ReflectionPrivateTag const& privilegedTag;
    /// The same, with proxies resolved.
    static ModelElement::Impl::ReflectionPrivateTag const& privilegedTagWithResolve;

    DataSource(DataSource const&) = delete;
    DataSource& operator=(DataSource const&) = delete;
    virtual ~DataSource();

    /// The element of that UUID, of whatever class; not live if there is none.
    ///
    /// The base asks `lookupElement` for a `ModelElement` with the text form of the UUID.
    virtual ModelElement fetchElement(UUID const& id);
    /// The element of class `metaClass`, or of one derived from it, that `id` names; not live if
    /// there is none.
    virtual ModelElement lookupElement(meta::Class const& metaClass, ElementId const& id) = 0;
    /// Fills a collection that is about to be read for the first time.
    virtual void loadCollectionContents(ReferenceCollection* collection) = 0;
    /// Whether a many-valued property has entries, asked while its collection is not in memory.
    virtual bool hasPropertyContents(ModelElement const& element,
                                     meta::Property const& property) = 0;
    /// Brings everything below `element` into memory, before it is destroyed.
    ///
    /// The base reads all references, then all contents, and calls itself for each of these.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (type) if a property does not hold
    ///     what its bounds promise.
    virtual void loadElementSubtree(ModelElement const& element);

protected:
    /// \param model  the model that is going to own this data source.
    explicit DataSource(Model::Impl* model);

    Model::Impl* getModelImpl() const { return m_model; }
    /// Puts the model in its loading state and opens a shallow transaction.
    LoadingTransaction beginLoadingTransaction();
    /// Adds an element, or a stand-in for one, without upkeep of the other end.
    static void doBasicAddWithProxy(ReferenceCollection& collection, ModelElement& element);
    /// Makes `owner` the container of a loaded element, without upkeep of `owner`'s property.
    static void doSetContained(ModelElement const& child, ModelElement const& owner,
                               meta::Property const& property);

private:
    Model::Impl* m_model;
};
}  // namespace tarn::kiln::datasource
