/// \file
/// Keeps the table of types free of destroyed ones.
#pragma once
#include "tarnkiln/kernel/Listener.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/Type.h"

#include <unordered_map>

namespace tarn::kiln {
template <class T> class ShallowChangeReport;
}

namespace tarn::kiln::internal {

/// Remembers the names of types as transactions leave them, and unregisters a type under its last
/// name when it is destroyed.
///
/// A type that no transaction has created or changed since the listener was added is unknown to it.
///
/// Threads: called under the registry's lock, by the thread that commits.
class UnregisterDestroyedTypes final : public Listener
{
public:
    using ElementType = meta::Type;

    explicit UnregisterDestroyedTypes(meta::MetaRegistry& registry);
    ~UnregisterDestroyedTypes() override;

    void transactionCommitted(ShallowChangeReport<meta::Type>& report);

private:
    meta::MetaRegistry& m_registry;
    std::unordered_map<meta::Type, ustring, std::hash<ModelElement>> m_names;
};
}  // namespace tarn::kiln::internal
