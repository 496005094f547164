#include "tarnkiln/kernel/DynamicValue.h"

#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/ReferenceCollection.h"

namespace tarn::kiln {

ModelElement::Impl::DynamicValue::DynamicValue(Value const& value)
    : m_value(std::make_unique<Value>(value))
{
}

ModelElement::Impl::DynamicValue::DynamicValue(AbstractOwnedCollection* collection)
    : m_collection(collection)
{
}

ModelElement::Impl::DynamicValue::DynamicValue(DynamicValue&& other) noexcept = default;

ModelElement::Impl::DynamicValue::~DynamicValue()
{
    if (m_collection && m_callback)
        m_callback(nullptr, m_collection.get());
}

ModelElement::Impl::DynamicValue& ModelElement::Impl::DynamicValue::operator=(Value const& value)
{
    *m_value = value;
    return *this;
}

ReferenceCollection* ModelElement::Impl::DynamicValue::getReferenceCollection() const
{
    return dynamic_cast<ReferenceCollection*>(m_collection.get());
}

AbstractPrimitiveCollection* ModelElement::Impl::DynamicValue::getPrimitiveCollection() const
{
    return dynamic_cast<AbstractPrimitiveCollection*>(m_collection.get());
}
} // namespace tarn::kiln
