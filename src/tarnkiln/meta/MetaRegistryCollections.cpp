/// \file
/// The collections that the registry makes.
#include "tarnkiln/collections/ReflectiveDataTypeCollection.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/meta/internal/RegistryReading.h"

namespace tarn::kiln::meta {
namespace {

/// What a collection of structured values is made of.
struct Associative
{
    DataType const& dataType;
    Property const& keyProperty;
    ModelElement const& owner;
    Property const& property;
    bool uniqueKeys;

    template <class K> AbstractOwnedCollection* make() const
    {
        return new ReflectiveDataTypeAssociative<K>(dataType, keyProperty, owner, property,
                                                    uniqueKeys);
    }
};

struct KeyRow
{
    PrimitiveType& type;
    AbstractOwnedCollection* (Associative::*make)() const;
};

KeyRow const keyRows[] = {
    {StandardTypes::integerMeta, &Associative::make<int>},
    {StandardTypes::integer8Meta, &Associative::make<signed char>},
    {StandardTypes::integer16Meta, &Associative::make<short>},
    {StandardTypes::integer64Meta, &Associative::make<long>},
    {StandardTypes::unlimitedNaturalMeta, &Associative::make<unsigned int>},
    {StandardTypes::uinteger8Meta, &Associative::make<unsigned char>},
    {StandardTypes::uinteger16Meta, &Associative::make<unsigned short>},
    {StandardTypes::uinteger64Meta, &Associative::make<unsigned long>},
    {StandardTypes::stringMeta, &Associative::make<ustring>},
    {StandardTypes::stdstringMeta, &Associative::make<string>},
    {StandardTypes::uuidMeta, &Associative::make<UUID>},
};

/// Whether values of the property can be keys at all.
bool isUsableKey(Property const& qualifier)
{
    Type const type = qualifier->getType();
    return qualifier->getUpper() < 2 && type && !Class::cast(type);
}
}  // namespace

AbstractOwnedCollection* MetaRegistry::instantiateDynamicCollection(ModelElement const& owner,
                                                                    Property const& property) const
{
    Type const type = property->getType();
    if (!type)
        return nullptr;
    // Tells the kind of type by its C++ class, which works while metamodels are being built.
    DataType const dataType = DataType::cast(type);
    Property const qualifier = property->getQualifiedBy();
    if (dataType && qualifier)
        return isUsableKey(qualifier)
                   ? createReflectiveDataTypeAssociative(dataType, qualifier, owner, property,
                                                         property->isQualificationUnique())
                   : nullptr;
    if (dataType && type->getModelImpl() != m_model.getImpl())
        return new ReflectiveDataTypeSequence(dataType, owner, property);
    CollectionInstantiator instantiator = nullptr;
    {
        Reading const directory(*this);
        if (TypeEntry const* const entry = directory->findEntry(type))
            instantiator = entry->collectionInstantiator;
    }
    return instantiator ? instantiator(owner, property) : nullptr;
}

AbstractOwnedCollection* MetaRegistry::createReflectiveDataTypeAssociative(
    DataType const& dataType, Property const& keyProperty, ModelElement const& owner,
    Property const& property, bool uniqueKeys) const
{
    Associative const parts = {dataType, keyProperty, owner, property, uniqueKeys};
    Type const keyType = keyProperty->getType();
    for (KeyRow const& row : keyRows)
    {
        if (keyType == row.type)
            return (parts.*row.make)();
    }
    if (internal::isEnumType(keyType))
        return parts.make<int>();
    reportException(tarnkiln::messages::UnsupportedQualification(
        keyType ? keyType->getQualifiedName() : ustring()));
}
}  // namespace tarn::kiln::meta
