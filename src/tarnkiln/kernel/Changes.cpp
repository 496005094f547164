#include "tarnkiln/kernel/Changes.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StructuredType.h"

namespace tarn::kiln {

ModelElement::Impl::Changes::Changes(UUID const& id, Model const& model,
                                     meta::Class const& metaClass, unsigned long count)
    : m_id(id)
    , m_model(model.getImpl())
    , m_metaClass(metaClass)
    , m_count(count)
    , m_modified(count + 2)
{
}

ModelElement::Impl::Changes::~Changes() = default;

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
    if (index == 0 || index >= m_count)
        return true;
    bool const before = m_modified.test(index);
    m_modified.set(index);
    return before;
}

bool ModelElement::Impl::Changes::isChanged(meta::Property const& property) const
{
    return property && m_metaClass && m_metaClass->isATypeOf(property)
           && isSlotChanged(static_cast<unsigned long>(property->getPropertyIndex()));
}

std::vector<meta::Property> ModelElement::Impl::Changes::getChangedProperties() const
{
    std::vector<meta::Property> result;
    result.reserve(m_count);
    for (meta::Class type = m_metaClass; type; type = type->getSuperclass()) {
        for (auto const& [name, property] : type->getOwnedAttributes()) {
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
    m_oldContainer = container;
    m_oldContainment = feature;
    m_oldContainmentProperty = feature.property();
    setContainerChanged(true);
}

void ModelElement::Impl::Storage::setOldContainer(ModelElement const& container,
                                                  meta::Property const& property)
{
    setOldContainer(container, Feature(property));
}

bool ModelElement::Impl::Storage::revertUnchanged(ModelElement::Impl* element)
{
    if (isContainerChanged() && element->basicContainer() == m_oldContainer.getImpl()
        && element->getContainment() == m_oldContainment)
        setContainerChanged(false);
    return anyChanged();
}

Value ModelElement::Impl::Storage::getOldValue(meta::Property const& property,
                                               ReflectionPrivateTag const&) const
{
    reportException(tarnkiln::messages::NoSuchProperty(
        property ? property->getName() : ustring(), internal::qualifiedName(getMetaClass())));
}
} // namespace tarn::kiln
