#include "model/AlternativeImpl.h"

#include "model/DependencyGroupImpl.h"
#include "model/Metamodel.h"
#include "model/PackageImpl.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace debian::model {

constinit Slot const Alternative::Impl::GROUP{
    .index = 1, .opposite = &DependencyGroup::Impl::ALTERNATIVES, .property = propertyAt<19>};
constinit Slot const Alternative::Impl::RELATION{.index = 2, .property = propertyAt<20>};
constinit Slot const Alternative::Impl::BOUND{.index = 3, .property = propertyAt<21>};
constinit Slot const Alternative::Impl::TARGET{.index = 4, .property = propertyAt<22>};

Alternative Alternative::cast(ModelElement const& element)
{
    return support::cast<Alternative>(element);
}

meta::Class const& Alternative::metaClass()
{
    return Metamodel::getInstance().alternative;
}

Alternative Alternative::create(Model const& model, UUID const& id)
{
    return support::create<Alternative>(model, id);
}

Alternative::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Alternative::Impl::~Impl() = default;

DependencyGroup Alternative::Impl::getGroup() const
{
    return DependencyGroup(getGroupImpl());
}

DependencyGroup::Impl* Alternative::Impl::getGroupImpl() const
{
    return support::containerOf<DependencyGroup::Impl>(*this, GROUP);
}

void Alternative::Impl::setGroup(DependencyGroup const& group)
{
    support::setContainer(*this, GROUP, group.getImpl());
}

void Alternative::Impl::setRelation(ustring const& relation)
{
    support::setScalar(*this, m_relation, RELATION, relation);
}

void Alternative::Impl::setBound(ustring const& bound)
{
    support::setScalar(*this, m_bound, BOUND, bound);
}

Package Alternative::Impl::getTarget() const
{
    return Package(support::resolve(*this, m_target, TARGET));
}

Package::Impl* Alternative::Impl::getTargetImpl() const
{
    return m_target.get();
}

void Alternative::Impl::setTarget(Package const& target)
{
    support::setReference(*this, m_target, TARGET, target.getImpl());
}
}  // namespace debian::model

template class tarn::kiln::support::Record<debian::model::Alternative::Impl,
                                           tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<debian::model::Alternative::Impl,
                                               tarn::kiln::ModelElement::Impl>;
