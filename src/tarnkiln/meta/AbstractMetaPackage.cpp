#include "tarnkiln/meta/AbstractMetaPackage.h"

#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/AbstractMethodInvoker.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <utility>

namespace tarn::kiln::meta {
namespace {

constexpr std::uint32_t UNBOUNDED = 0xFFFFFFFF;

/// A new element of the registry's model that `describe` has finished, in one transaction.
template <class Handle, class Describe>
Handle create(UUID const& id, ustring const& name, Describe describe)
{
    MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
    Handle const created = Handle::create(locked.getModel(), id);
    created->setName(name);
    describe(*created.getImpl());
    transaction.commit();
    return created;
}

UUID parse(string const& uuid)
{
    return boost::lexical_cast<UUID>(uuid);
}
}  // namespace

AbstractMetaPackage::AbstractMetaPackage() = default;
AbstractMetaPackage::~AbstractMetaPackage() = default;

Package AbstractMetaPackage::createPackage(ustring const& name, ustring const& uri) const
{
    return create<Package>(UUID{}, name, [&](Package::Impl& created) { created.setUri(uri); });
}

Class AbstractMetaPackage::createClass(ustring const& name, string const& vobjName, bool isAbstract,
                                       string const& uuid) const
{
    return create<Class>(parse(uuid), name, [&](Class::Impl& created) {
        created.setVobjName(vobjName);
        created.setIsAbstract(isAbstract);
    });
}

DataType AbstractMetaPackage::createDataType(ustring const& name, string const& vobjName,
                                             string const& uuid) const
{
    return create<DataType>(parse(uuid), name,
                            [&](DataType::Impl& created) { created.setVobjName(vobjName); });
}

Property AbstractMetaPackage::createProperty(ustring const& name, ValueFlags flags,
                                             bool isComposite, string const& uuid) const
{
    return create<Property>(parse(uuid), name, [&](Property::Impl& created) {
        created.setIsComposite(isComposite);
        created.setLower(flags == ValueFlags::Single ? 1 : 0);
        created.setUpper(flags <= ValueFlags::Single ? 1 : UNBOUNDED);
        created.setIsOrdered(flags == ValueFlags::Sequence);
    });
}

Enum AbstractMetaPackage::createEnum(ustring const& name, string const& uuid) const
{
    return create<Enum>(parse(uuid), name, [](Enum::Impl&) {});
}

EnumLiteral AbstractMetaPackage::createEnumLiteral(ustring const& name, int value,
                                                   string const& uuid) const
{
    return create<EnumLiteral>(parse(uuid), name,
                               [&](EnumLiteral::Impl& created) { created.setValue(value); });
}

void AbstractMetaPackage::setPropertyIndex(Property const& property, int index) const
{
    property->setPropertyIndex(index);
}

void AbstractMetaPackage::setInvoker(Operation const& operation,
                                     std::unique_ptr<AbstractMethodInvoker> invoker)
{
    operation->setInvoker(std::move(invoker));
}

void AbstractMetaPackage::registerRootPackage(Package const& package) const
{
    MetaRegistry::getInstance().registerRootPackage(package);
}

void AbstractMetaPackage::unregisterRootPackage(ustring const& uri) const
{
    MetaRegistry::getInstance().unregisterRootPackage(uri);
}

void AbstractMetaPackage::updateCollectionInstantiator(
    Type const& type, MetaRegistry::CollectionInstantiator collection) const
{
    MetaRegistry::getInstance().updateCollectionInstantiator(type, collection);
}

void AbstractMetaPackage::setVobjClassName(StructuredType const& type, char const* name) const
{
    type->setVobjName(name);
}

void AbstractMetaPackage::setVobjCompactDisplay(StructuredType const& type, bool compact) const
{
    type->setVobjCompactDisplay(compact);
}

void AbstractMetaPackage::setVobjDispCategory(Property const& property,
                                              string const& category) const
{
    property->setVobjDispCategory(category);
}

void AbstractMetaPackage::setVobjDispSkipEmpty(Property const& property) const
{
    property->setVobjDispSkipEmpty(true);
}

void AbstractMetaPackage::setDefaultVobjCategory(Package const& package,
                                                 string const& category) const
{
    package->setDefaultVobjCategory(category);
}

void AbstractMetaPackage::setOrderedVobjDispCategories(
    StructuredType const& type, std::initializer_list<string> categories) const
{
    PrimitiveSequence<string>& present = type->getVobjDispCategories();
    PrimitiveSequence<string> wanted(/*owner=*/nullptr, present.isUnique(),
                                     present.getCollectionFeature());
    for (string const& category : categories)
        wanted.push_back(category);
    present.copyContents(wanted);
}
}  // namespace tarn::kiln::meta
