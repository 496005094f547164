#include "tarnkiln/meta/TransactionOrigin.h"

#include <tuple>

namespace tarn::kiln::meta {

int TransactionOrigin::compareWith(TransactionOrigin const& other) const
{
    // An absent optional comes before all present ones.
    auto const mine = std::tie(m_model, m_language, m_transactionId, m_synchronizer);
    auto const theirs =
        std::tie(other.m_model, other.m_language, other.m_transactionId, other.m_synchronizer);
    return mine < theirs ? -1 : theirs < mine ? 1 : 0;
}
}  // namespace tarn::kiln::meta
