/// \file
/// What the tests of destruction share.
#pragma once
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/PlainElement.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace testkit {

/// Traces what elements are asked to do, for as long as it lives.
class TraceScope
{
public:
    TraceScope() { Plain::Impl::trace = &steps; }
    ~TraceScope()
    {
        Plain::Impl::trace = nullptr;
        Plain::Impl::whenAboutToDestroy = nullptr;
    }

    std::vector<std::string> steps;
};

class Destruction : public ::testing::Test
{
protected:
    Plain make(std::string const& name) const
    {
        Plain const result = Plain::create(model);
        result->name = name;
        return result;
    }

    Model const model = Model::create(ModelConstellation());
};
}  // namespace testkit
