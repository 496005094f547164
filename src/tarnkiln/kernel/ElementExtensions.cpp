/// \file
/// How elements hold values of the properties that their model has added to their classes.
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/internal/ChangedExtensions.h"
#include "tarnkiln/kernel/internal/DeclaredExtensions.h"
#include "tarnkiln/kernel/internal/ExtensionValues.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/support/JoiningTransaction.h"

#include <algorithm>
#include <utility>

namespace tarn::kiln {

using internal::ChangedExtensions;
using internal::ExtensionValues;
namespace messages = tarnkiln::messages;

namespace {

[[noreturn]] void reportNoSuchExtension(ModelElement::Impl const& element, ustring const& name)
{
    reportException(
        messages::NoSuchExtension(name, internal::qualifiedName(element.getMetaClass())));
}

bool hasEntries(ModelElement::Impl::DynamicValue const& value)
{
    if (auto const* const references = value.getReferenceCollection())
        return references->getGenericInterface()->genericSize() != 0;
    auto const* const values = value.getPrimitiveCollection();
    return values && values->size() != 0;
}

bool isSingle(meta::Extension const& extension)
{
    return extension->getUpper() == 1;
}

/// A collection of the extension's values; an empty owner makes a snapshot. Null if the type has no
/// collections.
std::unique_ptr<AbstractOwnedCollection> makeCollection(ModelElement const& owner,
                                                        meta::Extension const& extension)
{
    return std::unique_ptr<AbstractOwnedCollection>(
        meta::MetaRegistry::getInstance().instantiateDynamicCollection(owner, extension));
}
}  // namespace

// ---------------------------------------------------------------------------- where values lie

ExtensionValues& ModelElement::Impl::makeExtensionValues() const
{
    if (ExtensionValues* const present = extensionValues())
        return *present;
    auto made = std::make_unique<ExtensionValues>();
    made->anchor = anchorImpl();
    m_extensionValues = made.release();
    m_aside = Aside::Extensions;
    return *m_extensionValues;
}

void ModelElement::Impl::destroyExtensionValues()
{
    delete extensionValues();
}

/// The extension of that name that the class of this element has; empty if there is none.
meta::Extension ModelElement::Impl::findExtension(ustring const& name) const
{
    Model::Impl const* const model = getModelImpl();
    return model ? model->getExtension(getMetaClass(), name) : meta::Extension();
}

/// The value of the extension, or null; lets go of values of others of that name.
ModelElement::Impl::DynamicValue*
ModelElement::Impl::findExtensionValue(ustring const& name, meta::Extension const& extension) const
{
    ExtensionValues* const values = extensionValues();
    if (!values)
        return nullptr;
    DynamicValue* const found = extension ? values->find(extension) : nullptr;
    if (!found)
        values->eraseNamesakes(name, extension);
    return found;
}

bool ModelElement::Impl::isExtensionOfClass(meta::Extension const& extension) const
{
    meta::Class const extended = extension->getExtendedMetaclass();
    return extended && getMetaClass() && getMetaClass()->isA(extended);
}

AbstractOwnedCollection*
ModelElement::Impl::makeExtensionCollection(meta::Extension const& extension) const
{
    if (isProxy())
        reportException(messages::CannotModifyProxy());
    auto made = makeCollection(ModelElement(const_cast<Impl*>(this)), extension);
    if (!made)
        reportNoSuchExtension(*this, extension->getName());
    ExtensionValues& values = makeExtensionValues();
    values.reserve(extension);
    AbstractOwnedCollection* const collection = made.get();
    values.put(extension, DynamicValue(made.release()));
    return collection;
}

// ---------------------------------------------------------------------------- reading

Value ModelElement::Impl::getExtension(ustring const& name) const
{
    meta::Extension const extension = findExtension(name);
    DynamicValue const* const held = findExtensionValue(name, extension);
    if (!extension)
        reportNoSuchExtension(*this, name);
    if (held ? held->isCollection() : !isSingle(extension))
        return Value::createCollectionValue(extension, held ? held->getCollection()
                                                            : makeExtensionCollection(extension));
    return held ? held->getValue() : getModelImpl()->getExtensionDefault(getMetaClass(), name);
}

bool ModelElement::Impl::hasNonDefaultExtension(ustring const& name) const
{
    if (!extensionValues())
        return false;
    meta::Extension const extension = findExtension(name);
    DynamicValue const* const held = extension ? extensionValues()->find(extension) : nullptr;
    return held && (!held->isCollection() || hasEntries(*held));
}

std::vector<ustring> ModelElement::Impl::_extensionNames() const
{
    std::vector<ustring> result;
    if (ExtensionValues const* const values = extensionValues())
    {
        for (ExtensionValues::Entry const& entry : values->entries())
        {
            if (!entry.value.isEmpty())
                result.push_back(entry.extension->getName());
        }
    }
    std::sort(result.begin(), result.end());
    return result;
}

// ---------------------------------------------------------------------------- setting

void ModelElement::Impl::setExtension(ustring const& name, Value const& value)
{
    if (!isLive())
        return;
    meta::Extension const extension = findExtension(name);
    if (!extension || !isSingle(extension))
        reportNoSuchExtension(*this, name);
    setExtension(extension, value);
}

void ModelElement::Impl::setExtension(meta::Extension const& extension, Value const& value)
{
    if (!isLive())
        return;
    if (isProxy())
        reportException(messages::CannotModifyProxy());
    support::JoiningTransaction transaction(*this);
    value.checkCompatibleWithProperty(extension);
    DynamicValue wanted(value);
    ustring const name = extension->getName();
    DynamicValue const* const present = findExtensionValue(name, extension);
    auto const* const declared = m_model->findExtensionRecord(getMetaClass(), name);
    if (!declared || declared->extension != extension || !declared->defaultValue)
        reportNoSuchExtension(*this, name);

    if (value == *declared->defaultValue)
    {
        if (present)
        {
            notifyModifying(extension);
            extensionValues()->reset(extension);
        }
    }
    else if (!present || present->isCollection() || !(present->getValue() == wanted.getValue()))
    {
        makeExtensionValues().reserve(extension);
        notifyModifying(extension);
        extensionValues()->put(extension, std::move(wanted));
    }
    transaction.commit();
}

// ---------------------------------------------------------------------------- records

void ModelElement::Impl::copyValue(Storage* storage, meta::Extension const& extension) const
{
    ChangedExtensions const* const changed = storage->changedExtensions();
    ChangedExtensions::Entry const* const known = changed ? changed->find(extension) : nullptr;
    if (known && !known->old.isEmpty())
        return;
    ExtensionValues* const values = extensionValues();
    DynamicValue const* const present = values ? values->find(extension) : nullptr;
    ChangedExtensions::Entry entry;
    entry.extension = extension;
    entry.wasSet = present != nullptr;
    if (present ? !present->isCollection() : isSingle(extension))
    {
        entry.old = DynamicValue(
            present ? present->getValue()
                    : m_model->getExtensionDefault(getMetaClass(), extension->getName()));
    }
    else
    {
        auto snapshot = makeCollection(ModelElement(), extension);
        if (!snapshot)
            reportNoSuchExtension(*this, extension->getName());
        if (present)
            snapshot->copyContents(*present->getCollection());
        if (m_callback)  // the collection dies with the element
            entry.spare = makeCollection(ModelElement(const_cast<Impl*>(this)), extension);
        entry.old = DynamicValue(snapshot.release());
    }
    storage->makeChangedExtensions().keep(std::move(entry));
}

void ModelElement::Impl::restoreExtensions(Storage& storage)
{
    ChangedExtensions* const changed = storage.changedExtensions();
    ExtensionValues* const values = extensionValues();
    if (changed && values)  // what was never made has not changed
        changed->swapWith(*values);
}

// ---------------------------------------------------------------------------- the end

/// Announces what `dropEndingExtensions` is going to drop, so that a rollback brings it back.
void ModelElement::Impl::recordEndingExtensions()
{
    ExtensionValues* const values = extensionValues();
    for (std::size_t i = 0; values && i < values->entries().size(); ++i)
    {
        ExtensionValues::Entry const& entry = values->entries()[i];
        bool const ends = !entry.value.isEmpty() && (m_callback || entry.value.refersToElements());
        if (!ends || !entry.extension)
            continue;
        meta::Extension const extension = entry.extension;
        notifyModifying(extension);
    }
}

/// A dead element refers to no others, which it could keep in memory for ever. A host sees the
/// collections go with the element.
void ModelElement::Impl::dropEndingExtensions()
{
    ExtensionValues* const values = extensionValues();
    if (!values)
        return;
    if (m_callback)
        values->resetAll();
    else
        values->dropReferences();
}

// ---------------------------------------------------------------------------- moving

void ModelElement::Impl::updateDynamicValuesOnMoveToAnotherModel(
    std::unordered_map<meta::Extension, meta::Extension> const& mapping)
{
    ExtensionValues* const values = extensionValues();
    if (!values)
        return;
    for (auto const& [before, after] : mapping)
        values->replaceExtension(before, after);
}
}  // namespace tarn::kiln
