/// \file
/// A listener of constellations that tells a trace.
#pragma once
#include "tarnkiln/kernel/ConstellationListener.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/support/ScriptedListener.h"

#include <functional>
#include <string>

namespace testkit {

/// Tells a trace of what it is told, and then does what the test has put into it.
class TracingListener : public ConstellationListener
{
public:
    explicit TracingListener(Trace& trace, std::string name = "listener")
        : m_trace(trace),
          m_name(std::move(name))
    {}
    ~TracingListener() override { m_trace.push_back(m_name + " gone"); }

    void modelAdded(ModelConstellation const& constellation, Model const& model) override
    {
        m_trace.push_back(m_name + " added");
        if (onAdded)
            onAdded(constellation, model);
    }
    void modelDestroyed(ModelConstellation const& constellation, Model const& model) override
    {
        m_trace.push_back(m_name + " destroyed");
        if (onDestroyed)
            onDestroyed(constellation, model);
    }
    void listenerRemoved(ModelConstellation const&) override
    {
        m_trace.push_back(m_name + " removed");
    }

    std::function<void(ModelConstellation const&, Model const&)> onAdded;
    std::function<void(ModelConstellation const&, Model const&)> onDestroyed;

private:
    Trace& m_trace;
    std::string m_name;
};
}  // namespace testkit
