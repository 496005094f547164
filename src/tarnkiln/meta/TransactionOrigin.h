/// \file
/// Where a transaction comes from.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Language.h"

#include <boost/optional.hpp>

namespace tarn::kiln::meta {

/// Who began a transaction; carried unchanged into every report of it. A plain value.
class TARNKILN_EXPORT TransactionOrigin
{
public:
    TransactionOrigin() = default;

    UUID const& getModel() const { return m_model; }
    Language getLanguage() const { return m_language; }
    UUID const& getTransactionId() const { return m_transactionId; }
    boost::optional<UUID> const& getSynchronizer() const { return m_synchronizer; }

    void setModel(UUID const& model) { m_model = model; }
    void setLanguage(Language language) { m_language = language; }
    void setTransactionId(UUID const& id) { m_transactionId = id; }
    void setSynchronizer(boost::optional<UUID> const& synchronizer)
    {
        m_synchronizer = synchronizer;
    }

    /// Negative, 0 or positive; fields in declaration order, an absent synchronizer first.
    int compareWith(TransactionOrigin const& other) const;
    bool operator==(TransactionOrigin const& other) const { return compareWith(other) == 0; }
    bool operator<(TransactionOrigin const& other) const { return compareWith(other) < 0; }

private:
    UUID m_model{};
    Language m_language = Language::Unknown;
    UUID m_transactionId{};
    boost::optional<UUID> m_synchronizer;
};
}  // namespace tarn::kiln::meta
