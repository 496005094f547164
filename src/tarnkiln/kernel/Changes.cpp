#include "tarnkiln/kernel/Changes.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
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
