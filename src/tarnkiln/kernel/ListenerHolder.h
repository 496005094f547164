/// \file
/// How a client's listener class is put on a model's list.
///
/// A listener derives from `Listener` and has the methods that it needs, none of them virtual:
///
///     class Watcher : public Listener
///     {
///     public:
///         void transactionPreparing(ReportData& report);  // may still change the model
///         bool transactionValidating(ReportData& report); // false refuses the transaction
///         void transactionCommitted(ReportData& report);
///         void transactionRolledBack(ReportData& report); // what has just been taken back
///     };
///     model->addListener(&watcher);
///
/// A shallow listener, which needs no old values and so leaves transactions cheap, names the class
/// of the elements that it cares for as `ElementType` and takes a
/// `ShallowChangeReport<ElementType>&` instead.
#pragma once
#include "tarnkiln/kernel/Listener.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ReportData.h"
#include "tarnkiln/kernel/ShallowChangeReport.h"

#include <type_traits>
#include <utility>

namespace tarn::kiln {

namespace internal {

/// The report that a listener class takes.
template <class L, bool Shallow> struct ReportOf
{
    using Type = ReportData;
    static Type& from(ReportData& data) { return data; }
};

template <class L> struct ReportOf<L, true>
{
    using Type = ShallowChangeReport<typename L::ElementType>;
    static Type from(ReportData& data) { return Type(data); }
};

template <class L, class Report>
concept Preparing = requires(L listener, Report& report)
{
    listener.transactionPreparing(report);
};
template <class L, class Report>
concept Validating = requires(L listener, Report& report)
{
    {
        listener.transactionValidating(report)
        } -> std::convertible_to<bool>;
};
template <class L, class Report>
concept Committed = requires(L listener, Report& report)
{
    listener.transactionCommitted(report);
};
template <class L, class Report>
concept RolledBack = requires(L listener, Report& report)
{
    listener.transactionRolledBack(report);
};
}  // namespace internal

/// Stands on a model's list for a listener of class `L` and keeps the latest report.
template <class L, bool Shallow> class ListenerHolder final : public ListenerHolderBase
{
    using Reports = internal::ReportOf<L, Shallow>;
    using Report = typename Reports::Type;

public:
    ListenerHolder(L* listener, bool wantsPrepare, bool wantsValidate, bool wantsNotify, bool owned)
        : ListenerHolderBase(listener, Shallow, wantsPrepare, wantsValidate, wantsNotify, owned),
          m_typed(listener)
    {}

    /// A holder that wants what `listener` has methods for.
    static std::unique_ptr<ListenerHolder> forMethodsOf(L* listener, bool owned)
    {
        return std::make_unique<ListenerHolder>(
            listener, internal::Preparing<L, Report>, internal::Validating<L, Report>,
            internal::Committed<L, Report> || internal::RolledBack<L, Report>, owned);
    }

    void prepare(std::shared_ptr<ReportData> const& report) override
    {
        m_report = report;
        if constexpr (internal::Preparing<L, Report>)
        {
            decltype(auto) typed = Reports::from(*report);
            m_typed->transactionPreparing(typed);
        }
    }
    bool validate(std::shared_ptr<ReportData> const& report) override
    {
        m_report = report;
        if constexpr (internal::Validating<L, Report>)
        {
            decltype(auto) typed = Reports::from(*report);
            return m_typed->transactionValidating(typed);
        }
        else
        {
            return true;
        }
    }
    void committed(std::shared_ptr<ReportData> const& report) override
    {
        m_report = report;
        if constexpr (internal::Committed<L, Report>)
        {
            decltype(auto) typed = Reports::from(*report);
            m_typed->transactionCommitted(typed);
        }
    }
    void rolledBack(bool, std::shared_ptr<ReportData> const& report) override
    {
        m_report = report;
        if constexpr (internal::RolledBack<L, Report>)
        {
            decltype(auto) typed = Reports::from(*report);
            m_typed->transactionRolledBack(typed);
        }
    }

private:
    L* m_typed;
    std::shared_ptr<ReportData> m_report;
};

template <class L> void Model::Impl::addShallowListener(L* listener)
{
    if (!isListening(listener))
        addListenerHolder(std::make_unique<ListenerHolder<L, true>>(
            listener, /*wantsPrepare=*/false, /*wantsValidate=*/false, /*wantsNotify=*/true,
            /*owned=*/false));
}

template <class L> void Model::Impl::addListener(L* listener)
{
    if (!isListening(listener))
        addListenerHolder(ListenerHolder<L, false>::forMethodsOf(listener, /*owned=*/false));
}

template <class L> void Model::Impl::addOwnedListener(std::unique_ptr<L> listener)
{
    auto holder = ListenerHolder<L, false>::forMethodsOf(listener.get(), /*owned=*/true);
    static_cast<void>(listener.release());
    addListenerHolder(std::move(holder));
}
}  // namespace tarn::kiln
