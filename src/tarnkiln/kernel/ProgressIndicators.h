/// \file
/// Scopes that tell a model what is being done to it.
#pragma once
#include "tarnkiln/kernel/Model.h"

namespace tarn::kiln {

/// Lives while a document is read into a model: plain many-valued references are then written from
/// the side that the document lists, not from the other end.
class TARNKILN_EXPORT Model::ParseInProgressIndicator
{
public:
    explicit ParseInProgressIndicator(Model const& model);
    ParseInProgressIndicator(ParseInProgressIndicator&& other) noexcept = default;
    ParseInProgressIndicator& operator=(ParseInProgressIndicator&& other) noexcept = default;
    ~ParseInProgressIndicator();

private:
    Model m_model;
};

/// Lives while a data source loads: what is loaded is no change and is not recorded.
class TARNKILN_EXPORT Model::DataSourceLoadingInProgressIndicator
{
public:
    explicit DataSourceLoadingInProgressIndicator(Model const& model);
    DataSourceLoadingInProgressIndicator(DataSourceLoadingInProgressIndicator&& other) noexcept =
        default;
    DataSourceLoadingInProgressIndicator&
    operator=(DataSourceLoadingInProgressIndicator&& other) noexcept = default;
    ~DataSourceLoadingInProgressIndicator();

private:
    Model m_model;
};
}  // namespace tarn::kiln
