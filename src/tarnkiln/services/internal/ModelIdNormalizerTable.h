/// \file
/// All model id normalizers of the process, by priority.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/services/ModelIdNormalizer.h"

#include <atomic>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <thread>

namespace tarn::kiln::internal {

/// Finds the normalizers once and asks them in order.
///
/// Threads: may be used from all threads; once loaded it never changes and is read without a lock.
class TARNKILN_TESTED ModelIdNormalizerTable
{
public:
    static ModelIdNormalizerTable& getInstance();

    /// Finds the normalizers, unless that was done; a failure leaves the table as it was.
    ///
    /// \throws std::system_error  (resource_deadlock_would_occur) if called by a normalizer that is
    ///     being started.
    void load();
    /// Calls `ask` with one normalizer after the other until it returns true: highest priority
    /// first, among equal ones the last found first. Asks none before the table is loaded.
    void askUntil(std::function<bool(services::ModelIdNormalizer&)> const& ask) const;
    /// Forgets all, so that the next `load` looks again. For tests; no other thread may use the
    /// table meanwhile.
    void reset();

private:
    using Normalizers = std::multimap<int, std::shared_ptr<services::ModelIdNormalizer>>;

    static Normalizers discover();

    Normalizers m_normalizers;  ///< Ascending; written once, before `m_loaded` is set.
    std::mutex m_mutex;         ///< Held while the normalizers are found.
    std::atomic<std::thread::id> m_loader{};
    std::atomic<bool> m_loaded{false};
};
}  // namespace tarn::kiln::internal
