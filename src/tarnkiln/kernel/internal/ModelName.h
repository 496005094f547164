/// \file
/// The model parts of the ids that proxies carry.
#pragma once
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/support/CountedPointer.h"
#include "tarnkiln/support/Shared.h"

#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

namespace tarn::kiln::internal {

/// A model part, shared by proxies, and what it was found to mean.
///
/// Threads: shares may be dropped anywhere; all else happens on the thread of the models.
class ModelName : public support::Shared<ModelName>
{
public:
    explicit ModelName(ustring text) : m_text(std::move(text)) {}

    ustring const& text() const { return m_text; }

    /// \name The model that is meant
    /// It depends on the model that asks, and stays the same while the version of the constellation
    /// does.
    /// @{
    /// Null if it is not remembered. May be dead.
    Model::Impl const* getModel(Model::Impl const* asker, std::uint64_t version) const
    {
        return asker == m_asker && version == m_version ? m_model : nullptr;
    }
    void remember(Model::Impl const* asker, std::uint64_t version, Model::Impl const* model) const
    {
        m_asker = asker;
        m_version = version;
        m_model = model;
    }
    /// @}

private:
    friend class support::Shared<ModelName>;

    ~ModelName() = default;

    ustring const m_text;
    mutable Model::Impl const* m_asker = nullptr;
    mutable Model::Impl const* m_model = nullptr;
    mutable std::uint64_t m_version = 0;
};

/// The names that were used last, so that equal ones are shared.
class ModelNames
{
public:
    using Handle = support::CountedPointer<ModelName const>;

    Handle get(ustring const& text);

private:
    static constexpr std::size_t MOST = 8;

    std::vector<Handle> m_recent;
    std::size_t m_next = 0;  ///< Gives way to the next one, once there are so many.
};
}  // namespace tarn::kiln::internal
