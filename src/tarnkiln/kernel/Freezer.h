/// \file
/// Scopes in which a model refuses changes, or takes them again.
#pragma once
#include "tarnkiln/kernel/Model.h"

#include <memory>

namespace tarn::kiln {

/// Keeps a model frozen for as long as it lives: changes fail with `ModelFrozen`, reads go on.
///
/// Movable; freezers of one model add up.
class TARNKILN_EXPORT Model::Freezer
{
public:
    explicit Freezer(Model const& model);
    Freezer(Freezer&& other) noexcept = default;
    /// Deactivates this freezer first.
    Freezer& operator=(Freezer&& other) noexcept;
    ~Freezer();

    /// Ends the freeze early, and with it that of all its thawers.
    void deactivate();
    /// Takes this freezer's freeze back for as long as the result lives. Thawers nest.
    Thawer thaw();

private:
    friend class Model::Thawer;
    struct State;

    std::shared_ptr<State> m_state;  ///< Shared with thawers, since both may be moved.
};

/// Takes the freeze of one freezer back; only the outermost of several does any work.
class TARNKILN_EXPORT Model::Thawer
{
public:
    Thawer(Thawer&& other) noexcept = default;
    Thawer& operator=(Thawer&& other) noexcept;
    ~Thawer();

    void deactivate();

private:
    friend class Model::Freezer;
    explicit Thawer(std::shared_ptr<Freezer::State> state);

    std::shared_ptr<Freezer::State> m_state;
};
}  // namespace tarn::kiln
