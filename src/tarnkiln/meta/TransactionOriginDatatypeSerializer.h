/// \file
/// The fields of the origins of transactions.
#pragma once
#include "tarnkiln/meta/DefaultDatatypeSerializer.h"
#include "tarnkiln/meta/TransactionOrigin.h"

namespace tarn::kiln::meta {

/// Takes a `TransactionOrigin` apart and puts it together.
class TARNKILN_EXPORT TransactionOriginDatatypeSerializer final
    : public DefaultDatatypeSerializer<TransactionOrigin>
{
public:
    /// \param type  the data type of the catalogue.
    explicit TransactionOriginDatatypeSerializer(DataType const& type);
    ~TransactionOriginDatatypeSerializer() override;
};
}  // namespace tarn::kiln::meta
