// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/NamedElementImpl.h"

#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/NamedElementBuilder.h"
#include "tarnkiln/meta/NamedElementConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const NamedElement::Impl::NAME{
    .index = 1, .property = propertyOf<rows::properties::NamedElementName>};

NamedElement NamedElement::cast(ModelElement const& element)
{
    return support::cast<NamedElement>(element);
}

meta::Class const& NamedElement::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::NamedElement);
}

NamedElement NamedElement::create(Model const& model, UUID const& id)
{
    return support::create<NamedElement>(model, id);
}

NamedElement::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

NamedElement::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values.getBuilder(), id)
{
    values.construct(*this);
}

NamedElement::Impl::~Impl() = default;

void NamedElement::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void NamedElement::Impl::setName(ustring const& name)
{
    support::setScalar(*this, m_name, NAME, name);
}

NamedElement::Builder::Builder() = default;

NamedElement::Builder::Builder(Model const& model) : BuilderBase(model) {}

NamedElement::Builder::~Builder() = default;

NamedElement::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, NamedElement::metaClass(), source.second)
{}

NamedElement::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : ModelElement::Constrainables(query, metaClass, mode),
      name(*this, propertyOf<rows::properties::NamedElementName>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::NamedElement::Impl, tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::NamedElement::Impl, tarn::kiln::ModelElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::NamedElement::Impl, tarn::kiln::support::BuilderRoot>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::NamedElement::Builder>;
