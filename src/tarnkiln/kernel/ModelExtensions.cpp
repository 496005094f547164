/// \file
/// How a model declares extensions of classes. The values of extensions belong to the elements.
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/kernel/ExtensionListener.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/DeclaredExtensions.h"
#include "tarnkiln/kernel/internal/ExtensionGroups.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"

#include <memory>
#include <unordered_set>
#include <utility>

namespace tarn::kiln {

namespace messages = tarnkiln::messages;
using internal::DeclaredExtensions;
using internal::qualifiedName;
using meta::MetaRegistry;

namespace {

/// Fails unless `extended` is a live class of the registry's model.
void requireExtensible(meta::Class const& extended, Model const& registryModel)
{
    if (!extended || extended->getModelImpl() != registryModel.getImpl())
        reportException(messages::CannotCreateWithoutModel());
}

/// Fails if one of `namesakes` extends a class above or below `extended`.
void requireUnrelated(std::vector<meta::Extension> const& namesakes, meta::Class const& extended)
{
    for (meta::Extension const& namesake : namesakes)
    {
        meta::Class const other = namesake->getExtendedMetaclass();
        if (other && (other->isA(extended) || extended->isA(other)))
            reportException(messages::ExtensionNameMustBeUnique());
    }
}

/// Fails unless the registry can make the collections of a many-valued extension.
void requireCollection(meta::Extension const& extension)
{
    std::unique_ptr<AbstractOwnedCollection> const trial(
        MetaRegistry::getInstance().instantiateDynamicCollection(ModelElement(), extension));
    if (!trial)
        reportException(messages::CannotInstantiateCollection(qualifiedName(extension->getType())));
}

meta::Extension makeExtension(meta::DynamicExtensions const& owner, meta::Type const& type,
                              meta::ExtensionPrototype const& prototype)
{
    auto const extension = meta::Extension::create(owner->getModel());
    extension->setName(prototype.getName());
    extension->setType(type);
    extension->setOwner(owner);
    extension->setLower(prototype.getLower());
    extension->setUpper(prototype.getUpper());
    extension->setIsUnique(prototype.isUnique());
    extension->setIsOrdered(prototype.isOrdered());
    extension->setIsPublicAccessor(true);
    extension->setIsPublicMutator(true);
    return extension;
}

/// The record of an extension, entered until the end of the block or for good.
class EnteredRecord
{
public:
    using Records = internal::DeclaredExtensions;

    EnteredRecord(Records& records, ustring const& name, Records::Record const& record)
        : m_records(records),
          m_name(name),
          m_extension(record.extension)
    {
        m_records.add(name, record);
    }
    EnteredRecord(EnteredRecord const&) = delete;
    EnteredRecord& operator=(EnteredRecord const&) = delete;
    ~EnteredRecord()
    {
        if (!m_isKept)
            m_records.remove(m_name, m_extension);
    }

    void keep() { m_isKept = true; }

private:
    Records& m_records;
    ustring const m_name;
    meta::Extension const m_extension;
    bool m_isKept = false;
};
}  // namespace

void Model::Impl::extendMetaclass(meta::Class const& extended,
                                  meta::ExtensionPrototype const& prototype,
                                  boost::optional<Value> const& defaultValue)
{
    MetaRegistry& registry = MetaRegistry::getInstance();
    MetaRegistry::LockedModel const locked(registry);
    requireExtensible(extended, locked.getModel());
    meta::Type const type = registry.getType(prototype.getTypeName());
    if (!type)
        reportException(messages::NoSuchType(prototype.getTypeName()));
    bool const isSingle = prototype.getUpper() == 1;
    bool const isReference = internal::classImpl(type) != nullptr;
    ustring const name = prototype.getName();
    if (name.empty())
        reportException(messages::ExtensionMustHaveName());
    requireUnrelated(m_extensions->named(name), extended);
    if (isSingle && !isReference && !defaultValue)
        reportException(messages::ExtensionMustHaveDefaultValue());

    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
    meta::Extension const extension =
        makeExtension(internal::requireExtensionGroup(extended, m_modelCounter), type, prototype);
    if (defaultValue)
        defaultValue->checkCompatibleWithProperty(extension);
    if (!isSingle)
        requireCollection(extension);
    // A reference is never stored as a default: it could keep an element of another model.
    bool const isEmptyByDefault = isSingle && isReference;
    EnteredRecord entered(*m_extensions, name,
                          {extension,
                           isEmptyByDefault ? Value::createEmptyValue(type, true) : defaultValue,
                           extended});
    // Another transaction is open and may end as it likes.
    if (transaction.commit() != TransactionResult::Committed)
    {
        m_extensions->markIncomplete();
        reportException(messages::NoOpenTransaction());
    }
    entered.keep();
    notifyExtensionAdded(extension);
}

void Model::Impl::unextendMetaclass(meta::Class const& extended, ustring const& name)
{
    MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
    requireExtensible(extended, locked.getModel());
    meta::Extension const extension = getDeclaredExtension(extended, name);
    if (!extension)
        reportException(messages::NoSuchExtension(name, qualifiedName(extended)));
    ustring const declaredName = name;

    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
    tellExtensionListeners(
        [&](ExtensionListener& listener) { listener.extensionRemoved(getModel(), extension); });
    meta::DynamicExtensions const group = extension->getOwner();
    extension->destroy();
    internal::dropEmptyExtensionGroup(group);
    if (transaction.commit() != TransactionResult::Committed)
        reportException(messages::NoOpenTransaction());
    m_extensions->remove(declaredName, extension);
}

meta::Extension Model::Impl::getDeclaredExtension(meta::Class const& extended,
                                                  ustring const& name) const
{
    MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
    meta::DynamicExtensions const group =
        extended ? extended->getExtensions().find(m_modelCounter) : meta::DynamicExtensions();
    meta::Extension const found = group ? group->getExtensions().find(name) : meta::Extension();
    return found ? found : meta::Extension();
}

internal::DeclaredExtensionRecord const*
Model::Impl::findExtensionRecord(meta::Class const& metaClass, ustring const& name) const
{
    if (m_extensions->isComplete())
        return m_extensions->findFor(metaClass, name);
    meta::Extension const extension = findExtensionInRegistry(metaClass, name);
    return extension ? m_extensions->find(name, extension) : nullptr;
}

/// What this model extends is in its own table; others may have declared more in its name.
meta::Extension Model::Impl::getExtension(meta::Class const& metaClass, ustring const& name) const
{
    DeclaredExtensions::Record const* const known = findExtensionRecord(metaClass, name);
    return known ? known->extension : findExtensionInRegistry(metaClass, name);
}

meta::Extension Model::Impl::findExtensionInRegistry(meta::Class const& metaClass,
                                                     ustring const& name) const
{
    MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
    // A description may close the superclasses to a ring.
    std::unordered_set<meta::Class::Impl const*> seen;
    for (meta::Class at = metaClass; at && seen.insert(at.getImpl()).second;
         at = at->getSuperclass())
    {
        if (meta::Extension const found = getDeclaredExtension(at, name))
            return found;
    }
    return meta::Extension();
}

Value Model::Impl::getExtensionDefault(meta::Class const& metaClass, ustring const& name) const
{
    DeclaredExtensions::Record const* const record = findExtensionRecord(metaClass, name);
    if (!record || !record->defaultValue)
        reportException(messages::NoSuchExtension(name, qualifiedName(metaClass)));
    return *record->defaultValue;
}

void Model::Impl::notifyExtensionAdded(meta::Extension const& extension)
{
    tellExtensionListeners(
        [&](ExtensionListener& listener) { listener.extensionAdded(getModel(), extension); });
}

void Model::Impl::addExtensionListener(ExtensionListener* listener)
{
    m_extensionListeners.insert(listener);
}

void Model::Impl::removeExtensionListener(ExtensionListener* listener)
{
    m_extensionListeners.erase(listener);
}

/// A listener may remove itself and others meanwhile; those are not told any more.
void Model::Impl::tellExtensionListeners(std::function<void(ExtensionListener&)> const& tell)
{
    std::vector<ExtensionListener*> const listeners(m_extensionListeners.begin(),
                                                    m_extensionListeners.end());
    for (ExtensionListener* const listener : listeners)
    {
        if (m_extensionListeners.contains(listener))
            tell(*listener);
    }
}

/// The declarations go with the model that made them.
void Model::Impl::destroyExtensions()
{
    if (m_extensions->isEmpty())
        return;
    MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
    if (locked.getModel().getImpl() != this)
    {
        Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
        for (meta::Extension const& extension : m_extensions->all())
        {
            if (meta::DynamicExtensions const group =
                    extension ? extension->getOwner() : meta::DynamicExtensions())
                group->destroy();
        }
        transaction.commit();
    }
    m_extensions->clear();
}
}  // namespace tarn::kiln
