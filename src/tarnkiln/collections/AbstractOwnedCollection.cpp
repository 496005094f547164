#include "tarnkiln/collections/AbstractOwnedCollection.h"

#include "tarnkiln/kernel/internal/TransactionImpl.h"
#include "tarnkiln/meta/Extension.h"

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

void AbstractOwnedCollection::basicSetProperty(meta::Property const& property) noexcept
{
    m_property = property;
    m_feature = Feature(m_property);
}

bool AbstractOwnedCollection::isChangedInSilence() const
{
    if (!m_owner)
        return true;
    Model::Impl const* const model = m_owner->getModelImpl();
    return model && internal::isChangedInSilence(*model);
}

/// Neither an extension nor a computed property has a slot.
void AbstractOwnedCollection::modifying()
{
    if (!m_owner || !m_feature)
        return;
    if (unsigned long const index = m_feature.index())
        return m_owner->notifyModifying(index);
    if (meta::Extension const extension = meta::Extension::cast(m_property))
        return m_owner->notifyModifying(extension);
    m_owner->notifyModifying(0);
}

namespace {

Model::Impl* modelOf(ModelElement::Impl const* owner)
{
    return owner ? owner->getModelImpl() : nullptr;
}
}  // namespace

AbstractOwnedCollection::Operation::Operation(AbstractOwnedCollection& collection)
    : m_transaction(modelOf(collection.m_owner)),
      m_step(modelOf(collection.m_owner))
{}

AbstractOwnedCollection::Operation::~Operation() = default;

TransactionResult AbstractOwnedCollection::Operation::commit()
{
    m_step.close();
    return m_transaction.commit();
}
}  // namespace tarn::kiln
