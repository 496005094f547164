#include "tarnkiln/kernel/DynamicValue.h"

#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <utility>

namespace tarn::kiln {

namespace {

/// Whether the value is one that only its converter can copy and free.
bool isConverted(Value const& value)
{
    return value.getType().getElementImpl() &&
           value.getType() == meta::StandardTypes::hostArrayMeta;
}
}  // namespace

ModelElement::Impl::DynamicValue::DynamicValue(Value const& value)
    : m_held(new Value(isConverted(value)
                           ? meta::MetaRegistry::getInstance().convertValueForOwnership(value)
                           : value))
{}

ModelElement::Impl::DynamicValue::DynamicValue(AbstractOwnedCollection* collection) noexcept
    : m_held(collection),
      m_isCollection(true)
{}

ModelElement::Impl::DynamicValue::~DynamicValue()
{
    if (isEmpty())
        return;
    if (!m_isCollection)
    {
        if (isConverted(getValue()))
            meta::MetaRegistry::getInstance().releaseOwnedValue(getValue());
        delete &getValue();
        return;
    }
    AbstractOwnedCollection* const collection = getCollection();
    if (m_callback)
        m_callback(nullptr, collection);
    delete collection;
}

ModelElement::Impl::DynamicValue& ModelElement::Impl::DynamicValue::operator=(Value const& value)
{
    return *this = DynamicValue(value);
}

ModelElement::Impl::DynamicValue&
ModelElement::Impl::DynamicValue::operator=(DynamicValue&& other) noexcept
{
    DynamicValue taken(std::move(other));
    swap(taken);
    return *this;
}

void ModelElement::Impl::DynamicValue::swap(DynamicValue& other) noexcept
{
    std::swap(m_held, other.m_held);
    std::swap(m_isCollection, other.m_isCollection);
}

ReferenceCollection* ModelElement::Impl::DynamicValue::getReferenceCollection() const
{
    return dynamic_cast<ReferenceCollection*>(getCollection());
}

AbstractPrimitiveCollection* ModelElement::Impl::DynamicValue::getPrimitiveCollection() const
{
    return dynamic_cast<AbstractPrimitiveCollection*>(getCollection());
}

bool ModelElement::Impl::DynamicValue::refersToElements() const
{
    if (m_isCollection)
        return getReferenceCollection() != nullptr;
    return m_held && internal::classImpl(getValue().getType());
}
}  // namespace tarn::kiln
