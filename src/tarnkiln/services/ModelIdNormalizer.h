/// \file
/// Translates the identifiers of models, and loads and saves models by them.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/kernel/Types.h"

#include <boost/optional.hpp>

namespace tarn::kiln::services {

/// A service that knows some kind of model id: what stands in documents (the external form) and
/// where the model lies (the location form).
///
/// The static functions ask all normalizers that can be found, those of the highest priority first
/// and among equals the last found first. They are found once, by the first call of any of them but
/// `save`.
///
/// Threads: may be called from all threads at once. A normalizer must not call the static functions
/// while it is being started.
class TARNKILN_EXPORT ModelIdNormalizer
{
public:
    virtual ~ModelIdNormalizer();
    /// The location form of `id`; none if this normalizer does not know such ids.
    virtual boost::optional<ustring> toLocationModelId(ustring const& id) = 0;
    /// The external form of `id`; none if this normalizer does not know such ids.
    virtual boost::optional<ustring> toExternalModelId(ustring const& id) = 0;
    /// The model at a location; not live if this normalizer does not handle it.
    virtual Model loadModel(ustring const& location) = 0;
    /// Saves `model` at a location. \returns whether this normalizer handles it.
    virtual bool saveModel(Model const& model, ustring const& location) = 0;

    /// The location form of `id`; `id` itself if no normalizer knows it.
    static ustring convertToLocationModelId(ustring const& id);
    /// The external form of `id`; `id` itself if no normalizer knows it.
    static ustring convertToExternalModelId(ustring const& id);
    /// The model at the location form of `id`; empty if no normalizer handles it.
    static Model load(ustring const& id);
    /// Saves `model` by the first normalizer that handles it; says nothing if none does. Looks for
    /// no normalizers: it reaches only those that an earlier call of another function found.
    static void save(Model const& model, ustring const& id);
};
}  // namespace tarn::kiln::services
