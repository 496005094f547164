/// \file
/// The handle of a transaction.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"

#include <boost/optional.hpp>

#include <functional>
#include <iosfwd>
#include <memory>

namespace tarn::kiln {

/// What became of a call of `commit` or `rollBack`.
enum class TransactionResult : int
{
    NotCompleted = 0,  ///< Ended before, or other holders have not committed, or nothing to undo.
    Committed = 1,     ///< The changes are final.
    RolledBack = 2,    ///< The changes were undone.
    NotRevertible = 3  ///< The transaction ended, but it is shallow and its changes stay.
};

/// Shows the name of a result.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, TransactionResult result);

/// A bracket around changes of a model; `model->beginTransaction(revertible)` opens one.
///
/// Every handle must commit, or the handle that is dropped uncommitted takes the changes back:
///
///     Transaction transaction = model->beginTransaction(/*revertible=*/true);
///     book->setTitle(u"Emma");
///     transaction.commit();
///
/// It is neither a lock nor an isolation: changes are made in place and can be seen at once.
///
/// Threads: a transaction belongs to the thread of its model, its handles too.
class TARNKILN_EXPORT Transaction
{
public:
    Transaction() = default;
    explicit Transaction(AbstractTransactionImpl* impl);
    Transaction(Transaction const& other);
    Transaction(Transaction&& other) noexcept;
    ~Transaction()
    {
        if (m_impl)
            drop();
    }
    Transaction& operator=(Transaction other) noexcept;

    explicit operator bool() const { return m_impl != nullptr; }

    /// Commits this handle; the transaction ends when all handles have committed. Raises nothing.
    ///
    /// \param message  travels to the reports if this call ends the transaction.
    TransactionResult commit(boost::optional<Value> const& message) const;
    TransactionResult commit() const;
    /// Commits with a text as the message. A literal picks one of the two by its kind.
    TransactionResult commit(string const& message) const;
    TransactionResult commit(ustring const& message) const;
    TransactionResult commit(char const* message) const;
    TransactionResult commit(char16_t const* message) const;
    /// Takes all changes back at once, whatever other handles there are. Raises nothing.
    TransactionResult rollBack() const;
    /// Whether the transaction can only end in a rollback.
    bool isRollBackOnly() const;
    /// Replaces the function that runs once, before the first change is recorded.
    void addFirstChangeCallback(std::function<void()> const& callback) const;
    /// Adds an invocation that runs, after the others, once the transaction is committed.
    ///
    /// \throws tarnkiln::messages::ChangesProhibited  during validation and rollback.
    void eventEmitted(std::unique_ptr<meta::AbstractDeferredInvocation> invocation) const;

    AbstractTransactionImpl* operator->() const { return m_impl; }
    AbstractTransactionImpl* getImpl() const { return m_impl; }

private:
    void drop();

    AbstractTransactionImpl* m_impl = nullptr;
};
}  // namespace tarn::kiln
