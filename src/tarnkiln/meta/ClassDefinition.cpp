#include "tarnkiln/meta/ClassDefinition.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/internal/defineProperty.h"

namespace tarn::kiln::meta {

ClassDefinition::ClassDefinition(Class const& defined) : m_class(defined) {}

ClassDefinition& ClassDefinition::extends(Class const& superclass)
{
    m_class->setSuperclass(superclass);
    return *this;
}

ClassDefinition& ClassDefinition::makeAbstract()
{
    m_class->setIsAbstract(true);
    return *this;
}

PropertyDefinition ClassDefinition::attribute(ustring const& name, Type const& type)
{
    return PropertyDefinition(internal::defineProperty(m_class, name, type)).required();
}

PropertyDefinition ClassDefinition::reference(ustring const& name, Class const& target)
{
    return PropertyDefinition(internal::defineProperty(m_class, name, target)).optional();
}

PropertyDefinition ClassDefinition::contents(ustring const& name, Class const& target)
{
    Property const made = internal::defineProperty(m_class, name, target);
    made->setIsComposite(true);
    return PropertyDefinition(made).optional();
}
}  // namespace tarn::kiln::meta
