/// \file
/// How an element that outlives its model learns that it is gone.
#pragma once
#include "tarnkiln/kernel/Model.h"

#include <atomic>
#include <cstdint>

namespace tarn::kiln::support {

/// Points to a model for as long as that is in memory. A model has one, in which each of its dead
/// elements has a share.
///
/// Threads: shares may be dropped anywhere; all else happens on the thread of the model.
class ModelAnchor
{
public:
    explicit ModelAnchor(Model::Impl* model)
        : m_model(model)
    {
    }
    ModelAnchor(ModelAnchor const&) = delete;
    ModelAnchor& operator=(ModelAnchor const&) = delete;

    /// Null once the model is gone.
    Model::Impl* getModel() const { return m_model; }
    void modelIsGone() { m_model = nullptr; }

    void addRef() { m_refCount.fetch_add(1); }
    void removeRef()
    {
        if (m_refCount.fetch_sub(1) == 1)
            delete this;
    }

private:
    ~ModelAnchor() = default;

    Model::Impl* m_model;
    std::atomic<std::uint32_t> m_refCount{0};
};
} // namespace tarn::kiln::support
