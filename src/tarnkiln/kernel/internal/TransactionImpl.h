/// \file
/// The transaction of one model.
#pragma once
#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/ChangeRecords.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ReportData.h"

#include <vector>

namespace tarn::kiln::internal {

/// Records what changes in one model, tells the listeners, and takes the changes back.
///
/// A model has at most one. It is ready to be committed when every handle has committed, that is,
/// when the count of its handles equals that of the attempts:
///
/// | Handle | handles | attempts |
/// |---|---|---|
/// | nested, open | 1 | 0 |
/// | nested, committed and held | 1 | 1 |
/// | nested, committed and dropped | 0 | 0 |
/// | nested, dropped uncommitted | 0 | 0, and it can only be rolled back |
/// | of a member that nobody touched | 0 | 0 |
class TransactionImpl final : public AbstractTransactionImpl
{
public:
    TransactionImpl(Model const& model, TransactionGroup* group,
                    meta::TransactionOrigin const& origin, bool deep);
    ~TransactionImpl() override;

    // AbstractTransactionImpl
    TransactionResult commit(boost::optional<Value> const& message) override;
    TransactionResult rollBack() override;
    bool isRollBackOnly() const override { return has(ROLL_BACK_ONLY); }
    void addFirstChangeCallback(std::function<void()> const& callback) override;
    void eventEmitted(std::unique_ptr<meta::AbstractDeferredInvocation> invocation) override;
    void removeRef() override;

    /// \name Recording
    /// Each fails with `ChangesProhibited` during validation and rollback, unless nothing is
    /// recorded at all.
    /// @{
    virtual void elementCreated(ModelElement::Impl* element);
    virtual void elementDestroying(ModelElement::Impl* element);
    virtual void allElementsDestroying();
    virtual void elementModifying(ModelElement::Impl* element, unsigned long index);
    virtual void elementModifying(ModelElement::Impl* element, meta::Extension const& extension);
    /// Keeps a stand-in, of which nothing else is recorded, in a deep transaction: it may have to
    /// come back into a container that does.
    void proxyDestroying(ModelElement::Impl* proxy);
    /// Keeps the present link to the container, in a deep transaction.
    void containerChanging(ModelElement::Impl* element);
    /// Takes back what `elementCreated` recorded, when the creation has failed after all.
    void forgetCreation(ModelElement::Impl const* element);
    /// @}

    /// Which listeners a report is built for.
    enum class ReportKind
    {
        Prepare = 0,
        Validate = 1,
        Notify = 2,
        Any = 3  ///< Built whoever listens.
    };
    /// Null if there is nothing to tell, or nobody of that kind to tell it.
    virtual std::shared_ptr<ReportData> createReport(boost::optional<Value> const& message,
                                                     ReportKind kind);

    /// \name Steps of the group
    /// @{
    bool isReady() const { return m_handleCount == m_commitCount; }
    void prepare(boost::optional<Value> const& message);
    void prohibitChanges() { set(CHANGES_PROHIBITED); }
    bool validate(boost::optional<Value> const& message);
    /// From here to `finishTelling`, a listener that leaves the model is also skipped here.
    void end();
    void finishTelling();
    void notifyCommitted(boost::optional<Value> const& message);
    void runDeferredInvocations();
    void prepareRollBackReport();
    TransactionResult undo();
    void notifyRolledBack();
    void markRollBackOnly();
    void checkInvariants();
    /// @}

    /// \name Steps of nested transactions
    /// @{
    TransactionResult nestedFailed();
    /// One that was counted as a handle is committed; to be followed by `forgetCommit`.
    void nestedCommitted();
    void forgetCommit() { --m_commitCount; }
    /// @}

    /// Ends without a commit, when the model is being destroyed.
    void abandon();
    void removeListener(ListenerHolderBase* holder);

    bool hasEnded() const { return has(ENDED); }
    bool isDeep() const { return has(DEEP); }
    bool isRolledBack() const { return has(ROLLED_BACK); }
    /// Whether it goes on whatever is changed now, and nobody would ever know. A group of several
    /// models is deep, so this one goes on alone.
    bool isSilent() const
    {
        constexpr unsigned LOUD = ROLLED_BACK | CHANGES_PROHIBITED | ROLL_BACK_ONLY | ENDED | HEARD;
        return (m_flags & LOUD) == 0 && m_handleCount > m_commitCount;
    }
    /// Whether anybody would ever know of a change.
    bool isHeard() const { return has(HEARD); }
    bool isInStep() const { return m_model->isInStep(); }
    bool isProhibited() const { return has(CHANGES_PROHIBITED); }
    TransactionGroup* getGroup() const { return m_group; }
    TransactionImpl* getPreviousTelling() const { return m_previousTelling; }

private:
    class FrozenForListeners;
    class LocalGroup;

    enum Flag : unsigned
    {
        DESTROY_ALL = 1,         ///< No element may be created any more.
        ROLLED_BACK = 2,         ///< Undo has begun: recording is silently ignored.
        CHANGES_PROHIBITED = 4,  ///< Validation or rollback: recording fails.
        HAS_CHANGES = 8,         ///< Something was recorded.
        REPORT_STALE = 16,       ///< Something was since the last report for preparing listeners.
        ROLL_BACK_ONLY = 32,
        ENDED = 64,
        FREEZE_ON_NOTIFY = 128,
        DEEP = 256,
        REVERT_UNCHANGED = 512,
        DESTROYED_SOME = 1024,  ///< Records keep destroyed elements.
        CREATED_SOME = 2048,
        HEARD = 4096,      ///< By a listener or the first callback, or for it is deep.
        MOVED_SOME = 8192  ///< Records keep former containers.
    };
    bool has(Flag flag) const { return (m_flags & flag) != 0; }
    void set(Flag flag) { m_flags |= flag; }
    void clear(Flag flag) { m_flags &= ~static_cast<unsigned>(flag); }

    void findHearers();
    bool startRecording();
    void announceFirstChange();
    template <class Fill> void record(ModelElement::Impl* element, Fill const& fill);
    /// Whether the record takes no more changes of values.
    bool isSettled(ModelElement::Impl::Changes const& record) const;
    bool hasNews() const;
    bool anyListener(ReportKind kind) const;
    bool belongsTo(ModelElement::Impl::Changes const& record,
                   ModelElement::Impl const* element) const;
    ModelElement::Impl* findElementOf(ModelElement::Impl::Changes const& record) const;
    void pinElements();
    void unpinElements();
    void undoInPlace();
    void takeBackCreated();
    void bringBackDestroyed();

    Model m_model;
    TransactionGroup* m_group;  ///< Null after the end, and for one that stands alone until then.
    std::function<void()> m_firstChangeCallback;
    bool m_inFirstChangeCallback = false;
    std::shared_ptr<ChangeRecords> m_changes;  ///< Those of destroyed elements keep them, until the
                                               ///< transaction is gone.
    std::vector<ModelElement> m_destroyedProxies;
    std::vector<ListenerHolderBase*> m_listeners;  ///< As at the beginning; null once removed.
    std::shared_ptr<ReportData::DeferredInvocations> m_deferredInvocations;
    std::shared_ptr<ReportData> m_rollBackReport;
    unsigned m_flags;
    std::uint32_t m_commitCount = 0;
    bool m_isTelling = false;
    TransactionImpl* m_previousTelling = nullptr;
};

/// The same as `model.isChangedInSilence()`, without a call.
inline bool isChangedInSilence(Model::Impl const& model)
{
    TransactionImpl const* const open = model.getCurrentTransaction();
    return open && open->isSilent() && model.isFactoryLocal() && !model.isFrozen();
}
}  // namespace tarn::kiln::internal
