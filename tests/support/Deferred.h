/// \file
/// A deferred invocation that runs a function.
#pragma once
#include "tarnkiln/meta/AbstractDeferredInvocation.h"

#include <functional>
#include <memory>
#include <utility>

namespace testkit {

class Deferred final : public tarn::kiln::meta::AbstractDeferredInvocation
{
public:
    explicit Deferred(std::function<void()> run) : m_run(std::move(run)) {}
    void invoke() override { m_run(); }

private:
    std::function<void()> m_run;
};

inline std::unique_ptr<Deferred> deferred(std::function<void()> run)
{
    return std::make_unique<Deferred>(std::move(run));
}
}  // namespace testkit
