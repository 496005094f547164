#include "tarnkiln/kernel/Model.h"

#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProgressIndicators.h"

namespace tarn::kiln {

Model::Model(Impl* impl) : ElementHandle(impl) {}

Model Model::create(ModelConstellation const& constellation)
{
    return create(UUID{}, constellation);
}

Model Model::create(UUID const& id, ModelConstellation const& constellation)
{
    ModelConstellation const home = constellation ? constellation : ModelConstellation::create();
    Model const model(new Impl(id, home));
    home->addModelToConstellation(model.getImpl());
    return model;
}

Model Model::createRegistryModel(ustring const& uri, UUID const& id)
{
    Model const model(new Impl(id, ModelConstellation()));
    model->m_modelURI = uri;
    model->m_locationModelId = uri;
    return model;
}

Model Model::createTransientModel(UUID const& id)
{
    return Model(new Impl(id, ModelConstellation()));
}

// ---------------------------------------------------------------------------- freezers

struct Model::Freezer::State
{
    Model model;
    int thawCount = 0;
};

Model::Freezer::Freezer(Model const& model) : m_state(std::make_shared<State>(State{model}))
{
    ++model->m_freezeCount;
}

Model::Freezer& Model::Freezer::operator=(Freezer&& other) noexcept
{
    if (this != &other)
    {
        deactivate();
        m_state = std::move(other.m_state);
    }
    return *this;
}

Model::Freezer::~Freezer()
{
    deactivate();
}

void Model::Freezer::deactivate()
{
    if (!m_state)
        return;
    Model const model = std::move(m_state->model);
    if (model && m_state->thawCount == 0)
        --model->m_freezeCount;
    m_state.reset();
}

Model::Thawer Model::Freezer::thaw()
{
    return Thawer(m_state);
}

Model::Thawer::Thawer(std::shared_ptr<Freezer::State> state) : m_state(std::move(state))
{
    if (m_state && ++m_state->thawCount == 1 && m_state->model)
        --m_state->model->m_freezeCount;
}

Model::Thawer& Model::Thawer::operator=(Thawer&& other) noexcept
{
    if (this != &other)
    {
        deactivate();
        m_state = std::move(other.m_state);
    }
    return *this;
}

Model::Thawer::~Thawer()
{
    deactivate();
}

void Model::Thawer::deactivate()
{
    if (m_state && --m_state->thawCount == 0 && m_state->model)
        ++m_state->model->m_freezeCount;
    m_state.reset();
}

// ---------------------------------------------------------------------------- progress

Model::ParseInProgressIndicator::ParseInProgressIndicator(Model const& model) : m_model(model)
{
    ++m_model->m_parseCount;
}

Model::ParseInProgressIndicator::~ParseInProgressIndicator()
{
    if (m_model.getImpl())
        --m_model->m_parseCount;
}

Model::DataSourceLoadingInProgressIndicator::DataSourceLoadingInProgressIndicator(
    Model const& model)
    : m_model(model)
{
    ++m_model->m_dataSourceLoadCount;
}

Model::DataSourceLoadingInProgressIndicator::~DataSourceLoadingInProgressIndicator()
{
    if (m_model.getImpl())
        --m_model->m_dataSourceLoadCount;
}
}  // namespace tarn::kiln
