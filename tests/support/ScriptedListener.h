/// \file
/// A listener whose reactions each test writes itself.
#pragma once
#include "tarnkiln/kernel/Listener.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ReportData.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace testkit {

using namespace tarn::kiln;

using Report = std::shared_ptr<ReportData>;
/// What happened, in order, as "name phase".
using Trace = std::vector<std::string>;

/// Tells a trace of each phase and then does what the test has put into it. Listens to one model at
/// a time and leaves it when it goes.
class ScriptedListener : public Listener
{
public:
    explicit ScriptedListener(std::string name = "listener", Trace* trace = nullptr)
        : name(std::move(name)),
          trace(trace)
    {}

    ~ScriptedListener() override
    {
        onRemoved = nullptr;
        trace = nullptr;
        if (model)
            model->removeListener(this);
    }

    void listenerRemoved() override
    {
        model = nullptr;
        ++removals;
        tell("removed");
        if (onRemoved)
            onRemoved();
    }

    void tell(char const* phase)
    {
        if (trace)
            trace->push_back(name + ' ' + phase);
    }

    std::string name;
    Trace* trace;
    Model::Impl* model = nullptr;  ///< Whom it listens to.
    std::function<void(Report const&)> onPrepare;
    std::function<bool(Report const&)> onValidate;
    std::function<void(Report const&)> onCommitted;
    std::function<void(bool deep, Report const&)> onRolledBack;
    std::function<void()> onRemoved;
    /// The reports of each phase, kept if `keepsReports`.
    std::vector<Report> prepared, validated, committed, rolledBack;
    bool keepsReports = true;
    int removals = 0;
};

/// Which calls a listener gets, and whether it needs old values.
struct Wants
{
    bool shallow = false;
    bool prepare = true;
    bool validate = true;
    bool notify = true;
    bool owned = false;
};

class ScriptedHolder final : public ListenerHolderBase
{
public:
    ScriptedHolder(ScriptedListener* listener, Wants const& wants)
        : ListenerHolderBase(listener, wants.shallow, wants.prepare, wants.validate, wants.notify,
                             wants.owned),
          m_listener(listener)
    {}

    // A reaction may delete this holder: it is called from a copy, and nothing is touched after it.
    void prepare(Report const& report) override
    {
        enter("prepare", m_listener->prepared, report);
        if (auto const react = m_listener->onPrepare)
            react(report);
    }
    bool validate(Report const& report) override
    {
        enter("validate", m_listener->validated, report);
        auto const react = m_listener->onValidate;
        return !react || react(report);
    }
    void committed(Report const& report) override
    {
        enter("committed", m_listener->committed, report);
        if (auto const react = m_listener->onCommitted)
            react(report);
    }
    void rolledBack(bool deep, Report const& report) override
    {
        enter("rolledBack", m_listener->rolledBack, report);
        if (auto const react = m_listener->onRolledBack)
            react(deep, report);
    }

private:
    void enter(char const* phase, std::vector<Report>& reports, Report const& report)
    {
        m_listener->tell(phase);
        if (m_listener->keepsReports)
            reports.push_back(report);
    }

    ScriptedListener* m_listener;
};

inline void listen(Model const& model, ScriptedListener& listener, Wants const& wants = {})
{
    model->addListenerHolder(std::make_unique<ScriptedHolder>(&listener, wants));
    listener.model = model.getImpl();
}
}  // namespace testkit
