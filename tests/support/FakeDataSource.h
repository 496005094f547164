/// \file
/// A data source that answers what a test tells it to, and notes what it is asked.
#pragma once
#include "tarnkiln/kernel/ElementId.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/services/datasource/DataSource.h"
#include "tarnkiln/services/datasource/LoadingTransaction.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace testkit {

class FakeDataSource : public tarn::kiln::datasource::DataSource
{
public:
    explicit FakeDataSource(tarn::kiln::Model const& model) : DataSource(model.getImpl()) {}
    ~FakeDataSource() override
    {
        if (onDeath)
            onDeath();
    }

    /// Gives `model` a new one and returns it.
    static FakeDataSource& installIn(tarn::kiln::Model const& model)
    {
        auto source = std::make_unique<FakeDataSource>(model);
        FakeDataSource& result = *source;
        model->setDataSource(std::move(source));
        return result;
    }

    tarn::kiln::ModelElement fetchElement(tarn::kiln::UUID const& id) override
    {
        calls.push_back("fetchElement");
        return onFetch ? onFetch(id) : DataSource::fetchElement(id);
    }
    tarn::kiln::ModelElement lookupElement(tarn::kiln::meta::Class const&,
                                           tarn::kiln::ElementId const& id) override
    {
        calls.push_back("lookupElement");
        return onLookup ? onLookup(id) : tarn::kiln::ModelElement();
    }
    void loadCollectionContents(tarn::kiln::ReferenceCollection*) override
    {
        calls.push_back("loadCollectionContents");
    }
    bool hasPropertyContents(tarn::kiln::ModelElement const&,
                             tarn::kiln::meta::Property const&) override
    {
        calls.push_back("hasPropertyContents");
        return false;
    }
    void loadElementSubtree(tarn::kiln::ModelElement const& element) override
    {
        calls.push_back("loadElementSubtree");
        if (onLoadSubtree)
            onLoadSubtree(element);
    }

    using DataSource::beginLoadingTransaction;

    std::vector<std::string> calls;
    std::function<tarn::kiln::ModelElement(tarn::kiln::UUID const&)> onFetch;
    std::function<tarn::kiln::ModelElement(tarn::kiln::ElementId const&)> onLookup;
    std::function<void(tarn::kiln::ModelElement const&)> onLoadSubtree;
    std::function<void()> onDeath;
};
}  // namespace testkit
