/// \file
/// A service that a test offers by hand.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/services/internal/DiscoverServices.h"

namespace tarn::kiln::services {
class ElementIdResolver;
class ModelIdNormalizer;
}  // namespace tarn::kiln::services

namespace tarn::kiln::internal {

/// While it lives, look-ups with exactly that filter find the service, after those attached before.
///
/// Threads: may be used from all threads.
template <class Interface> class TARNKILN_TESTED AttachedService
{
public:
    AttachedService(string const& filter, std::shared_ptr<Interface> service,
                    std::optional<int> priority = {});
    AttachedService(AttachedService const&) = delete;
    AttachedService& operator=(AttachedService const&) = delete;
    ~AttachedService();
};

extern template class AttachedService<services::ElementIdResolver>;
extern template class AttachedService<services::ModelIdNormalizer>;
}  // namespace tarn::kiln::internal
