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

namespace {

Model::Impl* modelOf(ModelElement::Impl const* owner)
{
    return owner ? owner->getModelImpl() : nullptr;
}

Transaction beginUnlessOpen(Model::Impl* model)
{
    return model && !model->getCurrentTransaction() ? model->beginTransaction(/*revertible=*/false)
                                                    : Transaction();
}
}  // namespace

AbstractOwnedCollection::Operation::Operation(AbstractOwnedCollection& collection)
    : m_transaction(beginUnlessOpen(modelOf(collection.m_owner))),
      m_step(modelOf(collection.m_owner))
{}

AbstractOwnedCollection::Operation::~Operation() = default;

TransactionResult AbstractOwnedCollection::Operation::commit()
{
    m_step.close();
    return m_transaction ? m_transaction.commit() : TransactionResult::NotCompleted;
}
}  // namespace tarn::kiln
