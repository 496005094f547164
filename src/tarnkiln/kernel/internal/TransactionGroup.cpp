#include "tarnkiln/kernel/internal/TransactionGroup.h"

#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"

#include <algorithm>

namespace tarn::kiln::internal {

namespace {

TransactionImpl& memberOf(Transaction const& pin)
{
    return static_cast<TransactionImpl&>(*pin.getImpl());
}

}  // namespace

/// The members of a group that has ended; each model knows its own until all listeners are told.
class TransactionGroup::Ended
{
public:
    explicit Ended(Pins&& pins) : m_pins(std::move(pins)) {}
    Ended(Ended const&) = delete;
    Ended& operator=(Ended const&) = delete;
    ~Ended() { forEach(&TransactionImpl::finishTelling); }

    template <class... Arguments>
    void forEach(void (TransactionImpl::*step)(Arguments...), Arguments... arguments) const
    {
        for (Transaction const& pin : m_pins)
            (memberOf(pin).*step)(arguments...);
    }

private:
    Pins const m_pins;
};

TransactionGroup::TransactionGroup(ModelConstellation::Impl* constellation, bool deep,
                                   meta::TransactionOrigin const& origin)
    : m_constellation(constellation),
      m_deep(deep),
      m_origin(origin)
{}

TransactionGroup::~TransactionGroup() = default;

void TransactionGroup::addMember(TransactionImpl* member)
{
    m_members.reserve(m_members.size() + 1);
    m_pins.reserve(std::max(m_members.size(), m_pins.size()) + 1);
    m_members.push_back(member);
    if (m_ending)
        m_pins.emplace_back(member);
    if (m_prohibited)
        member->prohibitChanges();
}

void TransactionGroup::removeMember(TransactionImpl* member)
{
    auto const end = std::remove(m_members.begin(), m_members.end(), member);
    if (end == m_members.end())
        return;
    m_members.erase(end, m_members.end());
    tryCommit(boost::none);
}

bool TransactionGroup::allReady() const
{
    return std::all_of(m_members.begin(), m_members.end(),
                       [](TransactionImpl const* member) { return member->isReady(); });
}

bool TransactionGroup::anyRollBackOnly() const
{
    return std::any_of(m_members.begin(), m_members.end(),
                       [](TransactionImpl const* member) { return member->isRollBackOnly(); });
}

bool TransactionGroup::anyInStep() const
{
    return std::any_of(m_members.begin(), m_members.end(),
                       [](TransactionImpl const* member) { return member->isInStep(); });
}

TransactionResult TransactionGroup::tryCommit(boost::optional<Value> const& message)
{
    if (m_ending)
        return TransactionResult::NotCompleted;
    if (anyRollBackOnly() && !anyInStep())
        return rollBack();
    return commitIfComplete(message);
}

TransactionResult TransactionGroup::commitIfComplete(boost::optional<Value> const& message)
{
    if (m_ending || !allReady())
        return TransactionResult::NotCompleted;
    return finishCommit(message);
}

TransactionResult TransactionGroup::finishCommit(boost::optional<Value> const& message)
{
    if (anyRollBackOnly())
        return rollBack();
    ModelConstellation const keepConstellation(m_constellation);
    pinMembers();
    bool accepted = prepareAll(message) && !anyRollBackOnly();
    if (accepted)
    {
        prohibitChanges();
        accepted = validateAll(message) && !anyRollBackOnly();
    }
    if (!accepted)
    {
        m_ending = false;
        return rollBack();
    }
    Ended const ended = endAll();  // this object may be gone
    ended.forEach(&TransactionImpl::checkInvariants);
    ended.forEach<boost::optional<Value> const&>(&TransactionImpl::notifyCommitted, message);
    ended.forEach(&TransactionImpl::runDeferredInvocations);
    return TransactionResult::Committed;
}

// Listeners may destroy models, whose transactions leave the members, and create others. The pins
// only grow.

bool TransactionGroup::prepareAll(boost::optional<Value> const& message)
{
    try
    {
        for (std::size_t i = 0; i < m_pins.size(); ++i)
            memberOf(m_pins[i]).prepare(message);
    }
    catch (...)
    {
        return false;
    }
    return true;
}

bool TransactionGroup::validateAll(boost::optional<Value> const& message)
{
    for (std::size_t i = 0; i < m_pins.size(); ++i)
    {
        if (!memberOf(m_pins[i]).validate(message))
            return false;
    }
    return true;
}

void TransactionGroup::prohibitChanges()
{
    m_prohibited = true;
    for (TransactionImpl* const member : m_members)
        member->prohibitChanges();
}

void TransactionGroup::pinMembers()
{
    m_ending = true;
    for (std::size_t i = m_pins.size(); i < m_members.size(); ++i)
        m_pins.emplace_back(m_members[i]);
}

TransactionGroup::Ended TransactionGroup::endAll()
{
    for (TransactionImpl* const member : m_members)
        member->end();
    m_members.clear();
    return Ended(takePins());
}

/// Lets the constellation delete this object.
TransactionGroup::Pins TransactionGroup::takePins()
{
    Pins pins = std::move(m_pins);
    if (m_constellation)
        m_constellation->transactionGroupCompleted();
    return pins;
}

TransactionResult TransactionGroup::rollBack()
{
    if (m_ending)
        return TransactionResult::NotCompleted;
    ModelConstellation const keepConstellation(m_constellation);
    pinMembers();
    prohibitChanges();
    for (std::size_t i = 0; i < m_members.size(); ++i)
        m_members[i]->prepareRollBackReport();
    TransactionResult result = TransactionResult::NotCompleted;
    for (TransactionImpl* const member : m_members)
    {
        TransactionResult const undone = member->undo();
        if (undone != TransactionResult::NotCompleted)
            result = undone;
    }
    Ended const ended = endAll();  // this object may be gone
    ended.forEach(&TransactionImpl::checkInvariants);
    ended.forEach(&TransactionImpl::notifyRolledBack);
    return result;
}

void TransactionGroup::markRollBackOnly()
{
    if (m_rollBackOnly)
        return;
    m_rollBackOnly = true;
    for (TransactionImpl* const member : m_members)
        member->markRollBackOnly();
}
}  // namespace tarn::kiln::internal
