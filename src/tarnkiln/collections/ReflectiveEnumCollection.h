/// \file
/// The collections of literals of enumerations that have no C++ type.
///
///     registry.registerType(colour, makeReflectiveEnumCollection, /*builder=*/nullptr);
#pragma once
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/PrimitiveSet.h"

#include <memory>

namespace tarn::kiln {

/// Literals in the order in which they were put there, kept as numbers.
///
/// Values of another enumeration than the property's, and numbers, are refused with
/// `CannotCastIncompatibleTypes` (qualified name of their type).
class TARNKILN_EXPORT ReflectiveEnumSequence : public PrimitiveSequence<long>
{
public:
    /// \param owner  null makes a snapshot.
    ReflectiveEnumSequence(ModelElement::Impl* owner, bool unique, meta::Property const& property);
    ~ReflectiveEnumSequence() override;

    // AbstractOwnedCollection
    meta::Type getCollectionType() const override { return getPropertyType(); }
    // AbstractPrimitiveCollection
    void genericAdd(Value const& value) override;
    void genericRemove(Value const& value) override;
    GenericPrimitiveInterface* getGenericInterface() const override;

private:
    class CheckedInterface;

    std::unique_ptr<CheckedInterface> m_checked;
};

/// Each literal once, in the order of their numbers; else the same.
class TARNKILN_EXPORT ReflectiveEnumSet : public PrimitiveSet<long>
{
public:
    /// \param owner  null makes a snapshot.
    ReflectiveEnumSet(ModelElement::Impl* owner, meta::Property const& property);
    ~ReflectiveEnumSet() override;

    // AbstractOwnedCollection
    meta::Type getCollectionType() const override { return getPropertyType(); }
    // AbstractPrimitiveCollection
    void genericAdd(Value const& value) override;
    void genericRemove(Value const& value) override;
};

/// A sequence if the property is ordered, else a set; what run-time metamodels enter in the
/// registry with their enumerations. The caller owns it.
///
/// \param owner  empty makes a snapshot.
TARNKILN_EXPORT AbstractOwnedCollection*
makeReflectiveEnumCollection(ModelElement const& owner, meta::Property const& property);
}  // namespace tarn::kiln
