/// \file
/// A data source that notes down what it is asked.
#pragma once
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ElementId.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/services/datasource/DataSource.h"
#include "tarnkiln/services/datasource/LoadingTransaction.h"

#include <boost/uuid/uuid_io.hpp>

#include <functional>
#include <memory>
#include <vector>

namespace testkit {

using namespace tarn::kiln;

/// Gives the answers that a test sets, and opens to it what only data sources may do.
class RecordingDataSource final : public datasource::DataSource
{
public:
    struct Lookup
    {
        meta::Class metaClass;
        ElementId id;
    };

    /// A new one, that `model` owns.
    static RecordingDataSource& installIn(Model const& model)
    {
        auto source = std::make_unique<RecordingDataSource>(model);
        RecordingDataSource& installed = *source;
        model->setDataSource(std::move(source));
        return installed;
    }

    explicit RecordingDataSource(Model const& model) : DataSource(model.getImpl()) {}

    using DataSource::beginLoadingTransaction;
    using DataSource::doBasicAddWithProxy;
    using DataSource::doSetContained;

    ModelElement fetchElement(UUID const& id) override
    {
        fetches.push_back(id);
        return DataSource::fetchElement(id);
    }
    ModelElement lookupElement(meta::Class const& metaClass, ElementId const& id) override
    {
        lookups.push_back({metaClass, id});
        return answer;
    }
    void loadCollectionContents(ReferenceCollection* collection) override
    {
        loadedCollections.push_back(collection);
        if (fill)
            fill(*collection);
    }
    bool hasPropertyContents(ModelElement const&, meta::Property const&) override { return false; }
    void loadElementSubtree(ModelElement const& element) override
    {
        loadedSubtrees.push_back(element);
        if (element != cutAt)
            DataSource::loadElementSubtree(element);
    }

    ModelElement answer;  ///< What every look-up gives.
    ModelElement cutAt;   ///< Nothing below it is loaded.
    std::function<void(ReferenceCollection&)> fill;
    std::vector<UUID> fetches;
    std::vector<Lookup> lookups;
    std::vector<ReferenceCollection*> loadedCollections;
    std::vector<ModelElement> loadedSubtrees;
};

/// The text form of a UUID.
inline ustring textOf(UUID const& id)
{
    std::string const text = boost::uuids::to_string(id);
    return ustring(text.begin(), text.end());
}
}  // namespace testkit
