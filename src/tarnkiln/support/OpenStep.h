/// \file
/// The mark on a model in the middle of a change.
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"

#include <utility>

namespace tarn::kiln::support {

/// Marks a model as being in the middle of one change that is made in several steps.
///
/// A nested commit finds out that its transaction can only be rolled back, and does that at once;
/// but not between two steps, of which the second would go on where nothing is left of the first.
class OpenStep
{
public:
    /// \param model  null marks nothing; must outlive this mark.
    explicit OpenStep(Model::Impl* model) : m_model(model)
    {
        if (m_model)
            m_model->openStep();
    }
    OpenStep(OpenStep const&) = delete;
    OpenStep& operator=(OpenStep const&) = delete;
    ~OpenStep() { close(); }

    /// Takes the mark away before the end of the scope.
    void close()
    {
        if (Model::Impl* const model = std::exchange(m_model, nullptr))
            model->closeStep();
    }

private:
    Model::Impl* m_model;
};
}  // namespace tarn::kiln::support
