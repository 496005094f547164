/// \file
/// The transactions that commit or roll back as a unit.
#pragma once
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/TransactionOrigin.h"

#include <boost/container/small_vector.hpp>

namespace tarn::kiln::internal {

/// The open transactions of the models of one constellation, in the order of their locations, or
/// the one transaction of a model without a constellation while it is being ended.
///
/// A commit runs its phases over all members: prepare all, prohibit changes in all, validate all,
/// end all, notify all, run the deferred invocations of all. While it runs, no call from a listener
/// starts another one.
class TransactionGroup
{
public:
    /// \param constellation  null for a group that lives only to end one transaction.
    TransactionGroup(ModelConstellation::Impl* constellation, bool deep,
                     meta::TransactionOrigin const& origin);
    TransactionGroup(TransactionGroup const&) = delete;
    TransactionGroup& operator=(TransactionGroup const&) = delete;
    ~TransactionGroup();

    bool isDeep() const { return m_deep; }
    meta::TransactionOrigin const& getOrigin() const { return m_origin; }

    void addMember(TransactionImpl* member);
    bool isEmpty() const { return m_members.empty(); }
    /// The departure may make the rest ready.
    void removeMember(TransactionImpl* member);

    /// Commits if all members are ready; rolls back at once if one can not be committed.
    TransactionResult tryCommit(boost::optional<Value> const& message);
    /// Ends the group if all members are ready, by a rollback if one can not be committed.
    TransactionResult commitIfComplete(boost::optional<Value> const& message);
    TransactionResult rollBack();
    void markRollBackOnly();
    bool anyRollBackOnly() const;

private:
    class Ended;
    using Members = boost::container::small_vector<TransactionImpl*, 2>;
    using Pins = boost::container::small_vector<Transaction, 2>;

    bool allReady() const;
    bool anyInStep() const;
    TransactionResult finishCommit(boost::optional<Value> const& message);
    bool prepareAll(boost::optional<Value> const& message);
    bool validateAll(boost::optional<Value> const& message);
    void prohibitChanges();
    void pinMembers();
    /// Ends all members and lets the constellation delete this object.
    Ended endAll();
    Pins takePins();

    ModelConstellation::Impl* m_constellation;
    Members m_members;  ///< Not owned; those without handles are kept by the group's being open.
    Pins m_pins;  ///< While the group is ending: of all members, those that left meanwhile too.
    bool m_deep;
    bool m_rollBackOnly = false;
    bool m_ending = false;  ///< A commit or rollback is running.
    bool m_prohibited = false;
    meta::TransactionOrigin m_origin;
};
}  // namespace tarn::kiln::internal
