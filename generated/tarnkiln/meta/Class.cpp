// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/ClassImpl.h"

#include "tarnkiln/meta/ClassBuilder.h"
#include "tarnkiln/meta/ClassConstrainables.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const Class::Impl::SUPERCLASS{
    .index = 9, .property = propertyOf<rows::properties::ClassSuperclass>};
constinit Slot const Class::Impl::EXTENSIONS{
    .index = 10, .composite = true, .single = false, .keyed = true,
    .opposite = &DynamicExtensions::Impl::OWNING_CLASS,
    .property = propertyOf<rows::properties::ClassExtensions>};
constinit Slot const Class::Impl::IS_ABSTRACT{
    .index = 11, .property = propertyOf<rows::properties::ClassIsAbstract>};

Class Class::cast(ModelElement const& element)
{
    return support::cast<Class>(element);
}

meta::Class const& Class::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Class);
}

Class Class::create(Model const& model, UUID const& id)
{
    return support::create<Class>(model, id);
}

Class::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Class::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Class::Impl::~Impl() = default;

void Class::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

Class Class::Impl::getSuperclass() const
{
    return Class(support::resolve(*this, m_superclass, SUPERCLASS));
}

bool Class::Impl::hasSuperclass() const
{
    return m_superclass && m_superclass.get()->isLive();
}

void Class::Impl::setSuperclass(Class const& superclass)
{
    support::setReference(*this, m_superclass, SUPERCLASS, superclass.getImpl());
}

std::unique_ptr<ElementMap<unsigned long, DynamicExtensions>>
Class::Impl::makeExtensions(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<DynamicExtensions::Impl*>(member)->getModelID();
    };
    return std::make_unique<ElementMap<unsigned long, DynamicExtensions>>(owner, keyOf, EXTENSIONS);
}

ElementMap<unsigned long, DynamicExtensions>& Class::Impl::getExtensions() const
{
    return support::shownCollection(*this, m_extensions, &Impl::makeExtensions);
}

void Class::Impl::setIsAbstract(bool abstract)
{
    support::setScalar(*this, m_isAbstract, IS_ABSTRACT, abstract);
}

Class::Builder::Builder() = default;

Class::Builder::Builder(Model const& model) : BuilderBase(model) {}

Class::Builder::~Builder() = default;

Class::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Class::metaClass(), source.second)
{}

Class::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : StructuredType::Constrainables(query, metaClass, mode),
      superclass(*this, propertyOf<rows::properties::ClassSuperclass>()),
      extensions(*this, propertyOf<rows::properties::ClassExtensions>()),
      isAbstract(*this, propertyOf<rows::properties::ClassIsAbstract>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Class::Impl, tarn::kiln::meta::StructuredType::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Class::Impl, tarn::kiln::meta::StructuredType::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Class::Impl, tarn::kiln::meta::StructuredType::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Class::Builder>;
