#include "tarnkiln/services/ModelIdNormalizer.h"

#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/services/internal/ModelIdNormalizerTable.h"

namespace tarn::kiln::services {
namespace {

using internal::ModelIdNormalizerTable;

ModelIdNormalizerTable const& loadedTable()
{
    ModelIdNormalizerTable& table = ModelIdNormalizerTable::getInstance();
    table.load();
    return table;
}

/// The first form of `id` that a normalizer gives by `conversion`; `id` if none does.
ustring convert(ustring const& id,
                boost::optional<ustring> (ModelIdNormalizer::*conversion)(ustring const&))
{
    boost::optional<ustring> converted;
    loadedTable().askUntil([&](ModelIdNormalizer& normalizer) {
        converted = (normalizer.*conversion)(id);
        return converted.has_value();
    });
    return converted ? *converted : id;
}
}  // namespace

ModelIdNormalizer::~ModelIdNormalizer() = default;

ustring ModelIdNormalizer::convertToLocationModelId(ustring const& id)
{
    return convert(id, &ModelIdNormalizer::toLocationModelId);
}

ustring ModelIdNormalizer::convertToExternalModelId(ustring const& id)
{
    return convert(id, &ModelIdNormalizer::toExternalModelId);
}

Model ModelIdNormalizer::load(ustring const& id)
{
    ustring const location = convertToLocationModelId(id);
    Model loaded;
    loadedTable().askUntil([&](ModelIdNormalizer& normalizer) {
        loaded = normalizer.loadModel(location);
        return static_cast<bool>(loaded);
    });
    return loaded ? loaded : Model();
}

void ModelIdNormalizer::save(Model const& model, ustring const& id)
{
    ModelIdNormalizerTable::getInstance().askUntil(
        [&](ModelIdNormalizer& normalizer) { return normalizer.saveModel(model, id); });
}
}  // namespace tarn::kiln::services
