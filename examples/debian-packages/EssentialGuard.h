/// \file
/// Keeps transactions from taking away what the system needs.
#pragma once
#include "Forms.h"
#include "tarnkiln/kernel/ListenerHolder.h"

#include <set>
#include <string>

namespace debian {

/// Refuses each transaction that destroys an essential release, or after which an essential release
/// lacks what it did not lack before.
///
///     EssentialGuard<Form> guard(index);
///     model->addListener(&guard);
///
/// What is lacking when the guard is made, as in an index that is but a part, is never refused.
///
/// Threads: as the model.
template <ElementForm Form> class EssentialGuard : public tarn::kiln::Listener
{
public:
    /// \param index  the index of the model that the guard is added to.
    explicit EssentialGuard(PackageIndex<Form> const& index);

    bool transactionValidating(tarn::kiln::ReportData& report);

    /// Why the last transaction was refused; empty if it was not.
    std::string const& reason() const { return m_reason; }

private:
    PackageIndex<Form> m_index;
    std::set<tarn::kiln::UUID> m_lackingBefore;  // of dependency groups
    std::string m_reason;
};

}  // namespace debian
