/// \file
/// A model, for the tests of what models do.
#pragma once
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"

#include <gtest/gtest.h>

namespace testkit {

using namespace tarn::kiln;

class ModelFixture : public ::testing::Test
{
protected:
    Model const model = Model::create(ModelConstellation());
};
}  // namespace testkit
