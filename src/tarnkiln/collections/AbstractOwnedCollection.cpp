#include "tarnkiln/collections/AbstractOwnedCollection.h"

#include "tarnkiln/kernel/ModelImpl.h"

namespace tarn::kiln {

AbstractOwnedCollection::AbstractOwnedCollection(ModelElement::Impl* owner, Feature const& feature)
    : m_owner(owner),
      m_feature(feature),
      m_property(feature.slot() ? meta::Property() : feature.property())
{}

AbstractOwnedCollection::~AbstractOwnedCollection() = default;

meta::Property const& AbstractOwnedCollection::getCollectionProperty() const
{
    Slot const* const slot = m_feature.slot();
    if (slot && slot->property)
        return slot->property();
    return m_property;
}

void AbstractOwnedCollection::modifying()
{
    if (m_owner && m_feature)
        m_owner->notifyModifying(m_feature.index());
}

AbstractOwnedCollection::Operation::Operation(AbstractOwnedCollection& collection)
{
    Model::Impl* const model = collection.m_owner ? collection.m_owner->getModelImpl() : nullptr;
    if (model && !model->getCurrentTransaction())
        m_transaction = model->beginTransaction(/*revertible=*/false);
}

AbstractOwnedCollection::Operation::~Operation() = default;

TransactionResult AbstractOwnedCollection::Operation::commit()
{
    return m_transaction ? m_transaction.commit() : TransactionResult::NotCompleted;
}
}  // namespace tarn::kiln
