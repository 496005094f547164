#include "tarnkiln/meta/TransactionOriginDatatypeSerializer.h"

namespace tarn::kiln::meta {

using Origin = TransactionOrigin;

TransactionOriginDatatypeSerializer::TransactionOriginDatatypeSerializer(DataType const& type)
    : DefaultDatatypeSerializer(
          type, {field<&Origin::getModel, &Origin::setModel>(u"model"),
                 field<&Origin::getLanguage, &Origin::setLanguage>(u"language"),
                 field<&Origin::getTransactionId, &Origin::setTransactionId>(u"transactionId"),
                 field<&Origin::getSynchronizer, &Origin::setSynchronizer>(u"synchronizer")})
{}

TransactionOriginDatatypeSerializer::~TransactionOriginDatatypeSerializer() = default;
}  // namespace tarn::kiln::meta
