#include "model/DependencyGroupImpl.h"

#include "model/AlternativeImpl.h"
#include "model/Metamodel.h"
#include "model/ReleaseImpl.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace debian::model {

constinit Slot const DependencyGroup::Impl::KIND{.index = 1, .property = propertyAt<16>};
constinit Slot const DependencyGroup::Impl::RELEASE{
    .index = 2, .opposite = &Release::Impl::GROUPS, .property = propertyAt<17>};
constinit Slot const DependencyGroup::Impl::ALTERNATIVES{.index = 3,
                                                         .composite = true,
                                                         .single = false,
                                                         .opposite = &Alternative::Impl::GROUP,
                                                         .property = propertyAt<18>};

DependencyGroup DependencyGroup::cast(ModelElement const& element)
{
    return support::cast<DependencyGroup>(element);
}

meta::Class const& DependencyGroup::metaClass()
{
    return Metamodel::getInstance().dependencyGroup;
}

DependencyGroup DependencyGroup::create(Model const& model, UUID const& id)
{
    return support::create<DependencyGroup>(model, id);
}

DependencyGroup::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

DependencyGroup::Impl::~Impl() = default;

void DependencyGroup::Impl::setKind(ustring const& kind)
{
    support::setScalar(*this, m_kind, KIND, kind);
}

Release DependencyGroup::Impl::getRelease() const
{
    return Release(getReleaseImpl());
}

Release::Impl* DependencyGroup::Impl::getReleaseImpl() const
{
    return support::containerOf<Release::Impl>(*this, RELEASE);
}

void DependencyGroup::Impl::setRelease(Release const& release)
{
    support::setContainer(*this, RELEASE, release.getImpl());
}

std::unique_ptr<ElementSequence<Alternative>> DependencyGroup::Impl::makeAlternatives(Impl* owner)
{
    return std::make_unique<ElementSequence<Alternative>>(owner, /*unique=*/true, ALTERNATIVES);
}

ElementSequence<Alternative>& DependencyGroup::Impl::getAlternatives() const
{
    return support::shownCollection(*this, m_alternatives, &Impl::makeAlternatives);
}
}  // namespace debian::model

template class tarn::kiln::support::Record<debian::model::DependencyGroup::Impl,
                                           tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<debian::model::DependencyGroup::Impl,
                                               tarn::kiln::ModelElement::Impl>;
