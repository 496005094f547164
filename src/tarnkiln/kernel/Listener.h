/// \file
/// Who is told about transactions, and how the model keeps it.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"

#include <memory>

namespace tarn::kiln {

/// The base of all listeners of a model. See ListenerHolder.h for what a listener may implement.
class TARNKILN_EXPORT Listener
{
public:
    virtual ~Listener();
    /// Called when the listener has been taken off its model, or the model dies.
    virtual void listenerRemoved();
};

/// What stands on a model's list of listeners: who, and which phases it wants.
class TARNKILN_EXPORT ListenerHolderBase
{
public:
    /// \param shallow        needs no old values; one holder that does makes transactions deep.
    /// \param wantsPrepare   is asked first and may still change the model.
    /// \param wantsValidate  may refuse the transaction; changes are prohibited.
    /// \param wantsNotify    is told of the commit, or of the rollback.
    /// \param owned          the holder deletes the listener when it goes.
    ListenerHolderBase(Listener* listener, bool shallow, bool wantsPrepare, bool wantsValidate,
                       bool wantsNotify, bool owned);
    ListenerHolderBase(ListenerHolderBase const&) = delete;
    ListenerHolderBase& operator=(ListenerHolderBase const&) = delete;
    /// Tells the listener that it is removed, and deletes it if owned.
    virtual ~ListenerHolderBase();

    virtual void prepare(std::shared_ptr<ReportData> const& report) = 0;
    virtual bool validate(std::shared_ptr<ReportData> const& report) = 0;
    virtual void committed(std::shared_ptr<ReportData> const& report) = 0;
    virtual void rolledBack(bool deep, std::shared_ptr<ReportData> const& report) = 0;

    Listener* getListener() const { return m_listener; }
    bool isShallow() const { return m_shallow; }
    bool wantsPrepare() const { return m_wantsPrepare; }
    bool wantsValidate() const { return m_wantsValidate; }
    bool wantsNotify() const { return m_wantsNotify; }

private:
    Listener* m_listener;
    bool m_shallow;
    bool m_wantsPrepare;
    bool m_wantsValidate;
    bool m_wantsNotify;
    bool m_owned;
};
}  // namespace tarn::kiln
