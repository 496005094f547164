/// \file
/// The value of a property that a model added to a class.
#pragma once
#include "tarnkiln/collections/Fwd.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Value.h"

namespace tarn::kiln {

/// Owns either a value or a collection, or nothing.
///
/// A value of the type `HostArray` passes through the converter that is registered for it, when it
/// comes and when it goes. A host is told by the invalidate callback, with a null element, when a
/// collection dies.
///
/// Threads: as the element's model.
class TARNKILN_EXPORT ModelElement::Impl::DynamicValue
{
public:
    DynamicValue() = default;
    explicit DynamicValue(Value const& value);
    /// Takes the collection over.
    explicit DynamicValue(AbstractOwnedCollection* collection) noexcept;
    /// Leaves the other one with nothing.
    DynamicValue(DynamicValue&& other) noexcept { swap(other); }
    ~DynamicValue();
    DynamicValue& operator=(Value const& value);
    /// Leaves the other one with nothing.
    DynamicValue& operator=(DynamicValue&& other) noexcept;
    void swap(DynamicValue& other) noexcept;

    bool isEmpty() const { return !m_held; }
    bool isCollection() const { return m_isCollection; }
    /// Only for one that holds a value.
    Value const& getValue() const { return *static_cast<Value const*>(m_held); }
    /// Null if it holds something else; so the next two.
    AbstractOwnedCollection* getCollection() const
    {
        return m_isCollection ? static_cast<AbstractOwnedCollection*>(m_held) : nullptr;
    }
    ReferenceCollection* getReferenceCollection() const;
    AbstractPrimitiveCollection* getPrimitiveCollection() const;
    /// Whether it holds elements or collects them.
    bool refersToElements() const;

private:
    void* m_held = nullptr;  ///< Owned: a `Value`, or an `AbstractOwnedCollection`.
    bool m_isCollection = false;
};
}  // namespace tarn::kiln
