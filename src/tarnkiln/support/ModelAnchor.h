/// \file
/// What can be known of a model that may be gone.
#pragma once
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/support/Shared.h"

#include <atomic>
#include <cstdint>

namespace tarn::kiln::support {

/// Points to a model for as long as that is in memory, and counts its changes. A model has one, in
/// which each of its dead elements has a share, and whoever remembers something that was true of
/// the model.
///
/// Threads: shares may be dropped, and the version be asked, anywhere; all else happens on the
/// thread of the model.
class ModelAnchor : public Shared<ModelAnchor>
{
public:
    explicit ModelAnchor(Model::Impl* model) : m_model(model) {}

    /// Null once the model is gone.
    Model::Impl* getModel() const { return m_model; }
    void modelIsGone()
    {
        m_model = nullptr;
        m_version.store(IN_CHANGE, std::memory_order_release);
    }

    /// \name Changes
    /// @{
    /// As long as this is the same, nothing in the model has changed; 0 while a transaction is
    /// open, and when the model is gone.
    std::uint64_t getSettledVersion() const
    {
        std::uint64_t const version = m_version.load(std::memory_order_acquire);
        return version & IN_CHANGE ? 0 : version;
    }
    void transactionBegan()
    {
        m_version.store(m_version.load(std::memory_order_relaxed) | IN_CHANGE,
                        std::memory_order_release);
    }
    void transactionEnded()
    {
        m_version.store((m_version.load(std::memory_order_relaxed) & ~IN_CHANGE) + STEP,
                        std::memory_order_release);
    }
    /// Of a model without an open transaction too.
    void changed()
    {
        std::uint64_t const version = m_version.load(std::memory_order_relaxed);
        if (!(version & IN_CHANGE))
            m_version.store(version + STEP, std::memory_order_release);
    }
    /// @}

private:
    friend class Shared<ModelAnchor>;

    ~ModelAnchor() = default;

    static constexpr std::uint64_t IN_CHANGE = 1;
    static constexpr std::uint64_t STEP = 2;

    Model::Impl* m_model;
    std::atomic<std::uint64_t> m_version{STEP};
};
}  // namespace tarn::kiln::support
