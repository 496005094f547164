/// \file
/// A model id normalizer that a test installs for as long as it lives.
#pragma once
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/services/ModelIdNormalizer.h"
#include "tarnkiln/services/internal/AttachedService.h"
#include "tarnkiln/services/internal/ModelIdNormalizerTable.h"

#include <functional>
#include <memory>
#include <vector>

namespace testkit {

/// Answers by the functions that a test puts into it; declines where there is none.
class FakeNormalizer : public tarn::kiln::services::ModelIdNormalizer
{
public:
    using Text = tarn::kiln::ustring;

    boost::optional<Text> toLocationModelId(Text const& id) override
    {
        return toLocation ? toLocation(id) : boost::none;
    }
    boost::optional<Text> toExternalModelId(Text const& id) override
    {
        return toExternal ? toExternal(id) : boost::none;
    }
    tarn::kiln::Model loadModel(Text const& location) override
    {
        loads.push_back(location);
        return load ? load(location) : tarn::kiln::Model();
    }
    bool saveModel(tarn::kiln::Model const& model, Text const& location) override
    {
        saves.push_back(location);
        return save && save(model, location);
    }

    std::function<boost::optional<Text>(Text const&)> toLocation;
    std::function<boost::optional<Text>(Text const&)> toExternal;
    std::function<tarn::kiln::Model(Text const&)> load;
    std::function<bool(tarn::kiln::Model const&, Text const&)> save;
    std::vector<Text> loads;
    std::vector<Text> saves;
};

/// Makes a normalizer the only one of the process for as long as it lives.
class InstalledNormalizer
{
public:
    InstalledNormalizer() : m_attached("(bundle.tarnkiln.modelIdNormalizer=*)", normalizer)
    {
        table().reset();
        table().load();
    }
    InstalledNormalizer(InstalledNormalizer const&) = delete;
    InstalledNormalizer& operator=(InstalledNormalizer const&) = delete;
    ~InstalledNormalizer() { table().reset(); }

    FakeNormalizer* operator->() const { return normalizer.get(); }

    std::shared_ptr<FakeNormalizer> const normalizer = std::make_shared<FakeNormalizer>();

private:
    static tarn::kiln::internal::ModelIdNormalizerTable& table()
    {
        return tarn::kiln::internal::ModelIdNormalizerTable::getInstance();
    }

    tarn::kiln::internal::AttachedService<tarn::kiln::services::ModelIdNormalizer> m_attached;
};
}  // namespace testkit
