#include "tarnkiln/services/internal/ModelIdNormalizerTable.h"

#include "tarnkiln/services/internal/DiscoverServices.h"

#include <algorithm>
#include <system_error>

namespace tarn::kiln::internal {
namespace {

/// Tells for its lifetime which thread is loading.
class LoaderScope
{
public:
    explicit LoaderScope(std::atomic<std::thread::id>& loader) : m_loader(loader)
    {
        m_loader = std::this_thread::get_id();
    }
    LoaderScope(LoaderScope const&) = delete;
    LoaderScope& operator=(LoaderScope const&) = delete;
    ~LoaderScope() { m_loader = std::thread::id(); }

private:
    std::atomic<std::thread::id>& m_loader;
};
}  // namespace

ModelIdNormalizerTable& ModelIdNormalizerTable::getInstance()
{
    static ModelIdNormalizerTable table;
    return table;
}

void ModelIdNormalizerTable::load()
{
    if (m_loaded.load(std::memory_order_acquire))
        return;
    if (m_loader == std::this_thread::get_id())
        throw std::system_error(std::make_error_code(std::errc::resource_deadlock_would_occur),
                                "a model id normalizer that is being started uses model ids");

    std::lock_guard const lock(m_mutex);
    if (m_loaded.load(std::memory_order_relaxed))
        return;
    LoaderScope const scope(m_loader);
    m_normalizers = discover();
    m_loaded.store(true, std::memory_order_release);
}

ModelIdNormalizerTable::Normalizers ModelIdNormalizerTable::discover()
{
    Normalizers found;
    for (auto const& [service, priority] :
         discoverServices<services::ModelIdNormalizer>("(bundle.tarnkiln.modelIdNormalizer=*)"))
    {
        // Several bundles may show the same service.
        auto const isThis = [&known = service](auto const& entry) { return entry.second == known; };
        if (std::none_of(found.begin(), found.end(), isThis))
            found.emplace(priority.value_or(0), service);
    }
    return found;
}

void ModelIdNormalizerTable::askUntil(
    std::function<bool(services::ModelIdNormalizer&)> const& ask) const
{
    if (!m_loaded.load(std::memory_order_acquire))
        return;
    for (auto entry = m_normalizers.rbegin(); entry != m_normalizers.rend(); ++entry)
    {
        if (ask(*entry->second))
            return;
    }
}

void ModelIdNormalizerTable::reset()
{
    std::lock_guard const lock(m_mutex);
    m_loaded = false;
    m_normalizers.clear();
}
}  // namespace tarn::kiln::internal
