/// \file
/// What the invalidate callback was told.
#pragma once
#include "tarnkiln/kernel/ElementImpl.h"

#include <utility>
#include <vector>

namespace testkit {

/// Collects the calls of the process's one invalidate callback for as long as it lives; innermost
/// first. The callback is installed for good by the first of these.
class InvalidationLog
{
public:
    using Call = std::pair<tarn::kiln::ElementImpl*, tarn::kiln::AbstractOwnedCollection*>;

    InvalidationLog() : m_previous(std::exchange(current(), this))
    {
        tarn::kiln::ElementImpl::setInvalidateCallback(&InvalidationLog::record);
    }
    ~InvalidationLog() { current() = m_previous; }
    InvalidationLog(InvalidationLog const&) = delete;
    InvalidationLog& operator=(InvalidationLog const&) = delete;

    std::vector<Call> const& calls() const { return m_calls; }
    /// How often the death of `element` itself was told.
    long deathsOf(tarn::kiln::ElementImpl const* element) const
    {
        long result = 0;
        for (Call const& call : m_calls)
            result += call.first == element && !call.second;
        return result;
    }

private:
    static InvalidationLog*& current()
    {
        static InvalidationLog* log = nullptr;
        return log;
    }
    static void record(tarn::kiln::ElementImpl* element,
                       tarn::kiln::AbstractOwnedCollection* collection)
    {
        if (current())
            current()->m_calls.emplace_back(element, collection);
    }

    InvalidationLog* m_previous;
    std::vector<Call> m_calls;
};

/// Takes the callback away for as long as it lives, whoever has installed it.
class WithoutInvalidationLog : private tarn::kiln::ElementImpl
{
public:
    class Scope
    {
    public:
        Scope() : m_callback(std::exchange(installed(), nullptr)) {}
        ~Scope() { installed() = m_callback; }
        Scope(Scope const&) = delete;
        Scope& operator=(Scope const&) = delete;

    private:
        InvalidateCallback const m_callback;
    };

private:
    static InvalidateCallback& installed() { return m_callback; }
};
}  // namespace testkit
