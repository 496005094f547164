#include "tarnkiln/kernel/internal/TransactionImpl.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/Listener.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/TransactionGroup.h"

#include <algorithm>

namespace tarn::kiln::internal {

/// Freezes the model for as long as its listeners are told, if it is to be.
class TransactionImpl::FrozenForListeners
{
public:
    explicit FrozenForListeners(TransactionImpl const& transaction)
        : m_model(transaction.has(FREEZE_ON_NOTIFY) ? transaction.m_model.getImpl() : nullptr)
    {
        if (m_model)
            ++m_model->m_freezeCount;
    }
    FrozenForListeners(FrozenForListeners const&) = delete;
    FrozenForListeners& operator=(FrozenForListeners const&) = delete;
    ~FrozenForListeners()
    {
        if (m_model)
            --m_model->m_freezeCount;
    }

private:
    Model::Impl* m_model;
};

namespace {

/// Of a deep transaction.
void putBack(ModelElement::Impl& element, ModelElement::Impl::Changes& record)
{
    element.copyStateFromStorage(static_cast<ModelElement::Impl::Storage*>(&record));
}
}  // namespace

/// The group that ends a transaction which stands alone. While it lives, calls from listeners find
/// it running.
class TransactionImpl::LocalGroup
{
public:
    explicit LocalGroup(TransactionImpl& transaction)
        : m_group(nullptr, /*deep=*/false, transaction.m_origin),
          m_transaction(&transaction)
    {
        m_group.addMember(&transaction);
        transaction.m_group = &m_group;
    }
    LocalGroup(LocalGroup const&) = delete;
    LocalGroup& operator=(LocalGroup const&) = delete;
    ~LocalGroup()
    {
        if (!m_group.isEmpty())  // otherwise the transaction has ended and may be gone
            m_transaction->m_group = nullptr;
    }

    TransactionGroup* operator->() { return &m_group; }

private:
    TransactionGroup m_group;
    TransactionImpl* m_transaction;
};

TransactionImpl::TransactionImpl(Model const& model, TransactionGroup* group,
                                 meta::TransactionOrigin const& origin, bool deep)
    : AbstractTransactionImpl(origin),
      m_model(model),
      m_group(group),
      m_changes(std::make_shared<ChangeRecords>()),
      m_flags((model->isFrozenOnNotify() ? FREEZE_ON_NOTIFY : 0u) | (deep ? DEEP : 0u) |
              (model->isUnchangedRevertedOnReport() ? REVERT_UNCHANGED : 0u))
{
    for (auto const& holder : model->getListeners())
        m_listeners.push_back(holder.get());
    findHearers();
    if (m_group)
        m_group->addMember(this);
}

TransactionImpl::~TransactionImpl()
{
    if (has(DESTROYED_SOME))  // reports may hold the records longer
        m_changes->forEach([](ModelElement::Impl::Changes& record) { record.releaseElement(); });
}

// ---------------------------------------------------------------------------- recording

/// A listener that leaves stays on the list, as null.
void TransactionImpl::findHearers()
{
    if (has(DEEP) || !m_listeners.empty() || m_firstChangeCallback)
        set(HEARD);
    else
        clear(HEARD);
}

bool TransactionImpl::startRecording()
{
    if (has(ROLLED_BACK) || !isHeard())
        return false;
    if (has(CHANGES_PROHIBITED))
        reportException(tarnkiln::messages::ChangesProhibited());
    return true;
}

/// The callback may replace itself, and may end this transaction, which may be gone then.
void TransactionImpl::announceFirstChange()
{
    if (has(HAS_CHANGES) || !m_firstChangeCallback || m_inFirstChangeCallback)
        return;
    struct Guard
    {
        TransactionImpl* transaction;
        Model model;
        bool isCurrent() const { return model->getCurrentTransaction() == transaction; }
        ~Guard()
        {
            if (isCurrent())
                transaction->m_inFirstChangeCallback = false;
        }
    } const guard{this, m_model};
    std::function<void()> const callback = m_firstChangeCallback;
    m_inFirstChangeCallback = true;
    callback();
    if (!guard.isCurrent())
        reportException(tarnkiln::messages::NoOpenTransaction());
}

/// Lets `fill` write the element's record. A new one is entered last, so that a failure leaves the
/// transaction as it was.
template <class Fill> void TransactionImpl::record(ModelElement::Impl* element, Fill const& fill)
{
    if (ModelElement::Impl::Changes* const known = m_changes->find(element))
    {
        fill(*known);
    }
    else
    {
        ChangesHolder made(has(DEEP) ? element->createStorage() : element->createChanges());
        made->setElement(element);
        fill(*made);
        m_changes->append(element, std::move(made));
    }
    m_flags |= HAS_CHANGES | REPORT_STALE;
}

void TransactionImpl::elementCreated(ModelElement::Impl* element)
{
    if (!startRecording())
        return;
    if (has(DESTROY_ALL))
        reportException(tarnkiln::messages::CreateWithDestroyAll());
    announceFirstChange();
    record(element, [](ModelElement::Impl::Changes& changes) { changes.setCreated(); });
    set(CREATED_SOME);
}

void TransactionImpl::forgetCreation(ModelElement::Impl const* element)
{
    m_changes->forget(element);
}

void TransactionImpl::elementDestroying(ModelElement::Impl* element)
{
    if (!startRecording())
        return;
    announceFirstChange();
    record(element, [&](ModelElement::Impl::Changes& changes) {
        changes.setDestroyed();
        changes.keepElement(element);
    });
    set(DESTROYED_SOME);
}

void TransactionImpl::allElementsDestroying()
{
    if (!startRecording())
        return;
    announceFirstChange();
    m_flags |= DESTROY_ALL | HAS_CHANGES | REPORT_STALE;
}

void TransactionImpl::elementModifying(ModelElement::Impl* element, unsigned long index)
{
    if (index == 0 || !startRecording())
        return;
    announceFirstChange();
    record(element, [&](ModelElement::Impl::Changes& changes) {
        if (isSettled(changes) || changes.isSlotChanged(index))
            return;
        if (has(DEEP))
            element->copyValue(static_cast<ModelElement::Impl::Storage*>(&changes), index);
        changes.setModified(index);
    });
}

void TransactionImpl::elementModifying(ModelElement::Impl* element,
                                       meta::Extension const& extension)
{
    if (!startRecording())
        return;
    announceFirstChange();
    record(element, [&](ModelElement::Impl::Changes& changes) {
        if (isSettled(changes))
            return;
        if (has(DEEP))
            element->copyValue(static_cast<ModelElement::Impl::Storage*>(&changes), extension);
        changes.setModified(extension);
    });
}

bool TransactionImpl::isSettled(ModelElement::Impl::Changes const& record) const
{
    return record.isCreated() || (!has(DEEP) && record.isDestroyed());
}

void TransactionImpl::proxyDestroying(ModelElement::Impl* proxy)
{
    if (has(DEEP) && !has(ROLLED_BACK))
        m_destroyedProxies.emplace_back(proxy);
}

void TransactionImpl::containerChanging(ModelElement::Impl* element)
{
    if (!has(DEEP) || !startRecording())
        return;
    announceFirstChange();
    record(element, [&](ModelElement::Impl::Changes& changes) {
        if (!changes.isCreated())
            element->recordOldContainer(static_cast<ModelElement::Impl::Storage&>(changes));
    });
    set(MOVED_SOME);
}

void TransactionImpl::addFirstChangeCallback(std::function<void()> const& callback)
{
    std::function<void()> replacement(callback);
    m_firstChangeCallback.swap(replacement);
    findHearers();
}

void TransactionImpl::eventEmitted(std::unique_ptr<meta::AbstractDeferredInvocation> invocation)
{
    if (has(ROLLED_BACK))
        return;
    if (has(CHANGES_PROHIBITED))
        reportException(tarnkiln::messages::ChangesProhibited());
    if (!m_deferredInvocations)
        m_deferredInvocations = std::make_shared<ReportData::DeferredInvocations>();
    m_deferredInvocations->push_back(std::move(invocation));
}

// ---------------------------------------------------------------------------- ending

// A listener may drop the last handle: once the group has ended, this object may be gone.

TransactionResult TransactionImpl::commit(boost::optional<Value> const& message)
{
    if (has(ROLLED_BACK) || has(ENDED))
        return TransactionResult::NotCompleted;
    ++m_commitCount;
    return m_group ? m_group->tryCommit(message) : LocalGroup(*this)->tryCommit(message);
}

TransactionResult TransactionImpl::rollBack()
{
    if (has(ROLLED_BACK) || has(ENDED))
        return TransactionResult::NotCompleted;
    set(ROLL_BACK_ONLY);
    return m_group ? m_group->rollBack() : LocalGroup(*this)->rollBack();
}

TransactionResult TransactionImpl::nestedFailed()
{
    if (has(ENDED))
        return TransactionResult::NotCompleted;
    ++m_commitCount;
    set(ROLL_BACK_ONLY);
    return m_group ? m_group->commitIfComplete(boost::none)
                   : LocalGroup(*this)->commitIfComplete(boost::none);
}

void TransactionImpl::removeRef()
{
    if (--m_handleCount != 0)
        return;
    if (!has(ENDED))
    {
        if (m_group && m_commitCount == 0)
            return;  // stays a member without handles until the group ends
        m_handleCount = HANDLES_DELETING;
        try
        {
            rollBack();
        }
        catch (...)
        {
            // there is nobody to tell; the model is as the failure left it
        }
    }
    delete this;
}

void TransactionImpl::nestedCommitted()
{
    if (has(ROLLED_BACK) || has(ENDED))
        return;
    // Nearly always the outer one goes on, and there is nothing more to do.
    bool const goesOn = m_handleCount > m_commitCount + 1 && !has(ROLL_BACK_ONLY) &&
                        !(m_group && m_group->anyRollBackOnly());
    if (goesOn)
        ++m_commitCount;
    else
        commit(boost::none);
}

void TransactionImpl::markRollBackOnly()
{
    if (has(ROLL_BACK_ONLY) || has(ENDED))
        return;
    set(ROLL_BACK_ONLY);
    if (m_group)
        m_group->markRollBackOnly();
}

void TransactionImpl::end()
{
    m_group = nullptr;
    if (has(ENDED))
        return;
    set(ENDED);
    m_model->transactionEnded();
    m_previousTelling = std::exchange(m_model->m_telling, this);
    m_isTelling = true;
}

void TransactionImpl::finishTelling()
{
    if (!std::exchange(m_isTelling, false))
        return;
    TARNKILN_ASSERT(m_model->m_telling == this, "transactions tell their listeners inside one "
                                                "another");
    m_model->m_telling = m_previousTelling;
}

void TransactionImpl::abandon()
{
    Transaction const keep(this);
    std::fill(m_listeners.begin(), m_listeners.end(), nullptr);
    m_deferredInvocations.reset();
    set(ENDED);
    m_model->transactionEnded();
    if (TransactionGroup* const group = std::exchange(m_group, nullptr))
        group->removeMember(this);
}

void TransactionImpl::removeListener(ListenerHolderBase* holder)
{
    auto const found = std::find(m_listeners.begin(), m_listeners.end(), holder);
    if (found != m_listeners.end())
        *found = nullptr;
}

// ---------------------------------------------------------------------------- listeners

bool TransactionImpl::hasNews() const
{
    return has(HAS_CHANGES) || (m_deferredInvocations && !m_deferredInvocations->empty());
}

bool TransactionImpl::anyListener(ReportKind kind) const
{
    return std::any_of(m_listeners.begin(), m_listeners.end(), [&](ListenerHolderBase* holder) {
        return holder && (kind == ReportKind::Prepare    ? holder->wantsPrepare()
                          : kind == ReportKind::Validate ? holder->wantsValidate()
                                                         : holder->wantsNotify());
    });
}

std::shared_ptr<ReportData> TransactionImpl::createReport(boost::optional<Value> const& message,
                                                          ReportKind kind)
{
    if (!hasNews() || (kind != ReportKind::Any && !anyListener(kind)))
        return nullptr;
    auto report =
        std::make_shared<ReportData>(m_model, m_changes, message, has(REVERT_UNCHANGED), has(DEEP),
                                     m_deferredInvocations, has(DESTROY_ALL), m_origin);
    m_changes->forEach([&](ModelElement::Impl::Changes& record) {
        ModelElement const element =
            record.isDestroyed()
                ? ModelElement(record.getKeptElement())
                : m_model->findElement(record.getUuid(), FindElementBehavior::Fetch);
        // a listener of another model may have destroyed it since
        if (belongsTo(record, element.getImpl()))
            report->processElement(element, &record);
    });
    return report;
}

/// Whether `element`, which was found under the UUID of `record`, has no record of its own; false
/// for null.
bool TransactionImpl::belongsTo(ModelElement::Impl::Changes const& record,
                                ModelElement::Impl const* element) const
{
    ModelElement::Impl::Changes const* const own = element ? m_changes->find(element) : nullptr;
    return element && (!own || own == &record);
}

void TransactionImpl::prepare(boost::optional<Value> const& message)
{
    std::shared_ptr<ReportData> report;
    for (std::size_t i = 0; i < m_listeners.size() && !has(ENDED) && hasNews(); ++i)
    {
        if (!m_listeners[i] || !m_listeners[i]->wantsPrepare())
            continue;
        if (!report || has(REPORT_STALE))
        {
            report = createReport(message, ReportKind::Any);
            clear(REPORT_STALE);
        }
        if (!report->isEmpty())
            m_listeners[i]->prepare(report);
    }
}

bool TransactionImpl::validate(boost::optional<Value> const& message)
{
    if (!hasNews())
        return true;
    try
    {
        std::shared_ptr<ReportData> report;
        for (std::size_t i = 0; i < m_listeners.size() && !has(ENDED); ++i)
        {
            if (!m_listeners[i] || !m_listeners[i]->wantsValidate())
                continue;
            if (!report)
                report = createReport(message, ReportKind::Any);
            if (!report->isEmpty() && !m_listeners[i]->validate(report))
                return false;
        }
    }
    catch (...)
    {
        return false;
    }
    return true;
}

void TransactionImpl::notifyCommitted(boost::optional<Value> const& message)
{
    if (!hasNews() || !anyListener(ReportKind::Notify))
        return;
    FrozenForListeners const frozen(*this);
    std::shared_ptr<ReportData> report;
    for (std::size_t i = 0; i < m_listeners.size(); ++i)
    {
        if (!m_listeners[i] || !m_listeners[i]->wantsNotify())
            continue;
        try
        {
            if (!report)
                report = createReport(message, ReportKind::Any);
            if (!report->isEmpty())
                m_listeners[i]->committed(report);
        }
        catch (...)
        {
            // the changes are final, whatever a listener thinks of them
        }
    }
}

void TransactionImpl::runDeferredInvocations()
{
    if (!m_deferredInvocations)
        return;
    for (std::size_t i = 0; i < m_deferredInvocations->size(); ++i)
    {
        try
        {
            (*m_deferredInvocations)[i]->invoke();
        }
        catch (...)
        {
            // the next one runs all the same
        }
    }
}

void TransactionImpl::prepareRollBackReport()
{
    try
    {
        m_rollBackReport = createReport(boost::none, ReportKind::Notify);
    }
    catch (...)
    {
        m_rollBackReport = nullptr;  // the rollback matters more than its report
    }
}

void TransactionImpl::notifyRolledBack()
{
    if (!m_rollBackReport || !anyListener(ReportKind::Notify))
        return;
    FrozenForListeners const frozen(*this);
    for (std::size_t i = 0; i < m_listeners.size(); ++i)
    {
        if (!m_listeners[i] || !m_listeners[i]->wantsNotify())
            continue;
        try
        {
            m_listeners[i]->rolledBack(has(DEEP), m_rollBackReport);
        }
        catch (...)
        {
            // the changes are gone, whatever a listener thinks of it
        }
    }
}

void TransactionImpl::checkInvariants()
{
    if (m_model && m_model->getValidity() == ElementImpl::ElementValidity::Valid)
        m_model->checkInvariantsAtEnd();
}

// ---------------------------------------------------------------------------- undo

/// Null if the model has none under the UUID of the record, or another one.
ModelElement::Impl* TransactionImpl::findElementOf(ModelElement::Impl::Changes const& record) const
{
    ModelElement::Impl* const element = m_model->findElementImpl(record.getUuid());
    return belongsTo(record, element) ? element : nullptr;
}

/// No element may die from what is put back into another one.
void TransactionImpl::pinElements()
{
    m_changes->forEach([this](ModelElement::Impl::Changes& record) {
        if (record.isDestroyed())
            return;
        if (ModelElement::Impl* const element = findElementOf(record))
            record.keepElement(element);
    });
}

void TransactionImpl::unpinElements()
{
    m_changes->forEach([](ModelElement::Impl::Changes& record) {
        if (!record.isDestroyed())
            record.releaseElement();
    });
}

TransactionResult TransactionImpl::undo()
{
    for (ModelElement const& proxy : m_destroyedProxies)
        m_model->resurrectElement(proxy.getImpl());
    if (!has(HAS_CHANGES))
        return TransactionResult::NotCompleted;
    if (!has(DEEP))
        return TransactionResult::NotRevertible;
    set(ROLLED_BACK);
    if (!has(CREATED_SOME) && !has(DESTROYED_SOME) && !has(MOVED_SOME))
    {
        undoInPlace();
        return TransactionResult::RolledBack;
    }
    pinElements();
    // First what was created: it may have the UUID of what comes back.
    if (has(CREATED_SOME))
        takeBackCreated();
    if (has(DESTROYED_SOME))
        bringBackDestroyed();
    m_changes->forEachBackward([](ModelElement::Impl::Changes& record) {
        if (record.getKeptElement() && !record.isCreated())
            putBack(*record.getKeptElement(), record);
    });
    unpinElements();
    return TransactionResult::RolledBack;
}

/// Where no change that was recorded moved an element, one walk is enough. Each is held for its own
/// turn only: what was loaded without a record may live by what it gives up there.
void TransactionImpl::undoInPlace()
{
    m_changes->forEachBackward([this](ModelElement::Impl::Changes& record) {
        if (ModelElement const element(findElementOf(record)); element.getImpl())
            putBack(*element.getImpl(), record);
    });
}

void TransactionImpl::takeBackCreated()
{
    m_changes->forEachBackward([this](ModelElement::Impl::Changes& record) {
        ModelElement::Impl* const element = record.getKeptElement();
        if (!element || !record.isCreated() || record.isDestroyed())
            return;
        element->basicDisassociateAll();
        m_model->remove(element);
        element->invalidate();
    });
}

void TransactionImpl::bringBackDestroyed()
{
    m_changes->forEachBackward([this](ModelElement::Impl::Changes& record) {
        if (record.isDestroyed() && !record.isCreated())
            m_model->resurrectElement(record.getKeptElement());
    });
}
}  // namespace tarn::kiln::internal
