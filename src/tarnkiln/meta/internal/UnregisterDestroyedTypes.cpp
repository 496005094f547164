#include "tarnkiln/meta/internal/UnregisterDestroyedTypes.h"

#include "tarnkiln/kernel/ShallowChangeReport.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/TypeImpl.h"

namespace tarn::kiln::internal {

UnregisterDestroyedTypes::UnregisterDestroyedTypes(meta::MetaRegistry& registry)
    : m_registry(registry)
{}

UnregisterDestroyedTypes::~UnregisterDestroyedTypes() = default;

void UnregisterDestroyedTypes::transactionCommitted(ShallowChangeReport<meta::Type>& report)
{
    auto const remember = [this](meta::Type const& type) {
        m_names.insert_or_assign(type, type->getQualifiedName());
    };
    report.doProcess(remember, report.getCreated());
    report.doProcess(remember, report.getChanged());

    auto const unregister = [this](meta::Type const& type) {
        auto const position = m_names.find(type);
        if (position == m_names.end())
            return;
        m_registry.unregisterType(type, position->second);
        m_names.erase(position);
    };
    report.doProcess(unregister, report.getDestroyed());
}
}  // namespace tarn::kiln::internal
