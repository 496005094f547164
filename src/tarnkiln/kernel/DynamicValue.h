/// \file
/// The value of a property that a model added to a class.
#pragma once
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Value.h"

#include <memory>

namespace tarn::kiln {

/// Owns either a value or a collection.
///
/// A host is told by the invalidate callback, with a null element, when the collection dies.
class TARNKILN_EXPORT ModelElement::Impl::DynamicValue
{
public:
    explicit DynamicValue(Value const& value);
    /// Takes the collection over.
    explicit DynamicValue(AbstractOwnedCollection* collection);
    DynamicValue(DynamicValue&& other) noexcept;
    ~DynamicValue();
    /// Only for one that holds a value.
    DynamicValue& operator=(Value const& value);

    bool isCollection() const { return m_collection != nullptr; }
    Value const& getValue() const { return *m_value; }
    AbstractOwnedCollection* getCollection() const { return m_collection.get(); }
    /// Null if it holds something else.
    ReferenceCollection* getReferenceCollection() const;
    AbstractPrimitiveCollection* getPrimitiveCollection() const;

private:
    std::unique_ptr<Value> m_value;
    std::unique_ptr<AbstractOwnedCollection> m_collection;
};
} // namespace tarn::kiln
