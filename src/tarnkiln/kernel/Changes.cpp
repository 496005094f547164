#include "tarnkiln/kernel/Changes.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/ChangedExtensions.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StructuredType.h"

#include <algorithm>

namespace tarn::kiln {

namespace {

/// A bit for each slot and two more. The bit of slot 0, which no property has, tells of creation
/// and must be there also when the class has no property at all.
unsigned long sizeFor(unsigned long count)
{
    return std::max(count, 1UL) + 2;
}
}  // namespace

ModelElement::Impl::Changes::Changes(UUID const& id, Model const& model,
                                     meta::Class const& metaClass, unsigned long count)
    : m_id(id),
      m_model(model.getImpl()),
      m_metaClass(metaClass),
      m_modified(sizeFor(count))
{}

ModelElement::Impl::Changes::Changes(ModelElement::Impl const& element, unsigned long count)
    : m_id(element.getUuid()),
      m_model(element.getModelImpl()),
      m_metaClass(element.getMetaClass()),
      m_modified(sizeFor(count))
{}

ModelElement::Impl::Changes::~Changes()
{
    releaseElement();
}

void ModelElement::Impl::Changes::keepElement(ModelElement::Impl* element) noexcept
{
    element->addRef();
    releaseElement();
    m_element = element;
    m_keepsElement = 1;
}

void ModelElement::Impl::Changes::releaseElement() noexcept
{
    if (!m_keepsElement)
        return;
    m_keepsElement = 0;
    m_element->removeRef();
}

Model ModelElement::Impl::Changes::getModel() const
{
    return Model(m_model);
}

bool ModelElement::Impl::Changes::revertUnchanged(ModelElement::Impl*)
{
    return true;
}

bool ModelElement::Impl::Changes::setModified(unsigned long index)
{
    if (index == 0 || index >= slots())
        return true;
    bool const before = m_modified.test(index);
    m_modified.set(index);
    return before;
}

bool ModelElement::Impl::Changes::isChanged(meta::Property const& property) const
{
    return property && m_metaClass && m_metaClass->isATypeOf(property) &&
           isSlotChanged(static_cast<unsigned long>(property->getPropertyIndex()));
}

std::vector<meta::Property> ModelElement::Impl::Changes::getChangedProperties() const
{
    std::vector<meta::Property> result;
    result.reserve(slots());
    for (meta::Class type = m_metaClass; type; type = type->getSuperclass())
    {
        for (auto const& [name, property] : type->getOwnedAttributes())
        {
            if (property && isSlotChanged(static_cast<unsigned long>(property->getPropertyIndex())))
                result.push_back(property);
        }
    }
    return result;
}

bool ModelElement::Impl::Changes::anyChanged() const
{
    return m_modified.any() || (m_changedExtensions && !m_changedExtensions->entries().empty());
}

bool ModelElement::Impl::Changes::setModified(meta::Extension const& extension)
{
    if (m_changedExtensions && m_changedExtensions->find(extension))
        return true;
    internal::ChangedExtensions::Entry entry;
    entry.extension = extension;
    makeChangedExtensions().keep(std::move(entry));
    return false;
}

bool ModelElement::Impl::Changes::isExtensionChanged(ustring const& name) const
{
    if (!m_changedExtensions)
        return false;
    meta::Extension const extension = findExtension(name);
    return extension && m_changedExtensions->find(extension);
}

std::vector<meta::Extension> ModelElement::Impl::Changes::getChangedExtensions() const
{
    std::vector<meta::Extension> result;
    if (!m_changedExtensions)
        return result;
    for (auto const& entry : m_changedExtensions->entries())
    {
        if (entry.extension)
            result.push_back(entry.extension);
    }
    return result;
}

internal::ChangedExtensions& ModelElement::Impl::Changes::makeChangedExtensions()
{
    if (!m_changedExtensions)
        m_changedExtensions = std::make_unique<internal::ChangedExtensions>();
    return *m_changedExtensions;
}

meta::Extension ModelElement::Impl::Changes::findExtension(ustring const& name) const
{
    return m_model->getExtension(m_metaClass, name);
}

Value ModelElement::Impl::Storage::getExtensionOldValue(ustring const& name) const
{
    meta::Extension const extension = changedExtensions() ? findExtension(name) : meta::Extension();
    auto const* const changed = extension ? changedExtensions()->find(extension) : nullptr;
    if (!changed)
        reportException(
            tarnkiln::messages::NoSuchProperty(name, internal::qualifiedName(getMetaClass())));
    if (changed->old.isCollection())
        return Value::createCollectionValue(extension, changed->old.getCollection());
    // A rollback takes away what it puts in again.
    return changed->old.isEmpty() ? getModel()->getExtensionDefault(getMetaClass(), name)
                                  : changed->old.getValue();
}

void ModelElement::Impl::Storage::setOldContainer(ModelElement const& container,
                                                  Feature const& feature)
{
    if (isContainerChanged())
        return;
    m_oldValues.keep(LINK, OldLink{container, feature.property(), feature});
    setContainerChanged(true);
}

void ModelElement::Impl::Storage::setOldContainer(ModelElement const& container,
                                                  meta::Property const& property)
{
    setOldContainer(container, Feature(property));
}

bool ModelElement::Impl::Storage::revertUnchanged(ModelElement::Impl* element)
{
    if (isContainerChanged() && element->basicContainer() == getOldContainer().getImpl() &&
        element->getContainment() == getOldContainment())
        setContainerChanged(false);
    return anyChanged();
}

ModelElement ModelElement::Impl::Storage::getOldContainer() const
{
    OldLink const* const link = m_oldValues.find<OldLink>(LINK);
    return link ? link->container : ModelElement();
}

meta::Property ModelElement::Impl::Storage::getOldContainmentProperty() const
{
    OldLink const* const link = m_oldValues.find<OldLink>(LINK);
    return link ? link->property : meta::Property();
}

Feature ModelElement::Impl::Storage::getOldContainment() const
{
    OldLink const* const link = m_oldValues.find<OldLink>(LINK);
    return link ? link->feature : Feature();
}

Value ModelElement::Impl::Storage::getOldValue(meta::Property const& property,
                                               ReflectionPrivateTag const&) const
{
    reportException(tarnkiln::messages::NoSuchProperty(property ? property->getName() : ustring(),
                                                       internal::qualifiedName(getMetaClass())));
}
}  // namespace tarn::kiln
