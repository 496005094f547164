/// \file
/// The registry's table of types.
#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/ReflectiveBuilder.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/meta/internal/RegistryReading.h"

#include <algorithm>

namespace tarn::kiln::meta {
namespace {

/// Makes the collections of `type` that are otherwise made at their first use, which may come from
/// several threads at once and finds the model frozen.
///
/// The kind of type is told by its C++ class: while the metamodel of metamodels is being built the
/// classes have no superclasses yet.
void materialise(Type const& type)
{
    if (StructuredType const structured = StructuredType::cast(type))
    {
        structured->getOwnedAttributes();
        structured->getOwnedOperations();
    }
    if (Enum const enumeration = Enum::cast(type))
        enumeration->getLiterals();
}

/// Types, what they own and the packages that own them are asked by all threads, which would
/// contend for the counts.
void makePermanent(Type const& type)
{
    if (!type)
        return;
    auto const makeAll = [](auto const& members) {
        for (auto const& [name, member] : members)
            member.getElementImpl()->makePermanent();
    };
    type.getElementImpl()->makePermanent();
    for (Package::Impl* owner = type->getOwningPackageImpl(); owner;
         owner = owner->getParentPackageImpl())
        owner->makePermanent();
    if (StructuredType const structured = StructuredType::cast(type))
    {
        makeAll(structured->getOwnedAttributes());
        makeAll(structured->getOwnedOperations());
    }
    if (Enum const enumeration = Enum::cast(type))
        makeAll(enumeration->getLiterals());
}
}  // namespace

void MetaRegistry::publish() noexcept
{
    try
    {
        std::for_each(m_unpublished.begin(), m_unpublished.end(), makePermanent);
    }
    catch (...)
    {
        // those that are left stay counted
    }
    m_unpublished.clear();
}

void MetaRegistry::registerType(Type const& type, ustring const& name,
                                CollectionInstantiator collection, BuilderInstantiator builder)
{
    LockedModel const locked(*this);
    m_unpublished.push_back(type);
    TypeEntry const entry{builder, collection, type};
    auto const [position, inserted] = m_directory.types.emplace(name, entry);
    directoryChanged();
    if (!inserted)
    {
        // What a rolled back metamodel leaves behind must not keep it from being built again.
        if (position->second.type)
            reportException(tarnkiln::messages::DuplicateTypeInRegistry(name));
        position->second = entry;
    }
    if (m_initialised && type)
        materialise(type);
}

void MetaRegistry::registerType(Type const& type, CollectionInstantiator collection,
                                BuilderInstantiator builder)
{
    registerType(type, type->getQualifiedName(), collection, builder);
}

void MetaRegistry::registerType(Type const& type, BuilderInstantiator builder)
{
    registerType(type, /*collection=*/nullptr, builder);
}

void MetaRegistry::registerReflectiveClass(Class const& metaClass)
{
    LockedModel const locked(*this);
    registerType(metaClass, /*builder=*/nullptr);
    m_directory.types.find(metaClass->getQualifiedName())->second.isReflective = true;
}

void MetaRegistry::unregisterType(Type const& type, ustring const& name)
{
    auto const position = m_directory.types.find(name);
    if (position == m_directory.types.end() || position->second.type != type)
        return;
    m_directory.types.erase(position);
    directoryChanged();
}

void MetaRegistry::updateCollectionInstantiator(Type const& type, CollectionInstantiator collection)
{
    LockedModel const locked(*this);
    auto const position = m_directory.types.find(type->getQualifiedName());
    TARNKILN_ASSERT(position != m_directory.types.end(), "only a registered type can be updated");
    position->second.collectionInstantiator = collection;
    directoryChanged();
}

Type MetaRegistry::getType(ustring const& name) const
{
    auto const find = [&](Directory const& directory) {
        auto const position = directory.types.find(name);
        return position != directory.types.end() ? &position->second.type : nullptr;
    };
    std::optional<Type> found = Reading::find(*this, find);
    if (!found && name.starts_with(u"tarn.kiln."))
    {
        MetaPackageMeta::getInstance();
        found = Reading::find(*this, find);
    }
    if (found)
        return *found;
    // Metamodels of old spell these two names so.
    if (name == u"meta.Model")
        return Model::metaClass();
    if (name == u"meta.ModelElement")
        return ModelElement::metaClass();
    return {};
}

Class MetaRegistry::getClass(ustring const& name) const
{
    return Class::cast(getType(name));
}

PrimitiveType MetaRegistry::getPrimitiveType(ustring const& name) const
{
    return PrimitiveType::cast(getType(name));
}

std::unique_ptr<ModelElement::Builder> MetaRegistry::instantiateBuilder(Class const& metaClass,
                                                                        Model const& model) const
{
    if (!metaClass)
        return nullptr;
    BuilderInstantiator instantiator = nullptr;
    {
        Reading const directory(*this);
        TypeEntry const* const entry = directory->findEntry(metaClass);
        if (entry && entry->isReflective)
            return std::make_unique<ReflectiveBuilder>(model, metaClass);
        if (entry)
            instantiator = entry->builderInstantiator;
    }
    return instantiator ? instantiator(model) : nullptr;
}

MetaRegistry::TypeEntry const* MetaRegistry::Directory::findEntry(Type const& type) const
{
    auto const position = types.find(type->getQualifiedName());
    bool const found = position != types.end() && position->second.type == type;
    return found ? &position->second : nullptr;
}
}  // namespace tarn::kiln::meta
