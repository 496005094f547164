// Made from garden.json by `metagen.py`; do not edit.
#include "acme/garden/BedImpl.h"

#include "acme/garden/BedBuilder.h"
#include "acme/garden/BedConstrainables.h"
#include "acme/garden/GardenMetaPackage.h"
#include "acme/garden/PlantImpl.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace acme::garden {

constinit Slot const Bed::Impl::PLANTS{
    .index = 1, .composite = true, .single = false, .keyed = true, .opposite = &Plant::Impl::BED,
    .property = propertyOf<rows::properties::BedPlants>};
constinit Slot const Bed::Impl::SIZE{.index = 2, .property = propertyOf<rows::properties::BedSize>};
constinit Slot const Bed::Impl::NEIGHBOURS{
    .index = 3, .single = false, .property = propertyOf<rows::properties::BedNeighbours>};

Bed Bed::cast(ModelElement const& element)
{
    return support::cast<Bed>(element);
}

meta::Class const& Bed::metaClass()
{
    return GardenMetaPackage::getInstance().getClass(rows::classes::Bed);
}

Bed Bed::create(Model const& model, UUID const& id)
{
    return support::create<Bed>(model, id);
}

Bed::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Bed::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values.getBuilder(), id)
{
    values.construct(*this);
}

Bed::Impl::~Impl() = default;

void Bed::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

std::unique_ptr<ElementMap<ustring, Plant>> Bed::Impl::makePlants(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Plant::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMap<ustring, Plant>>(owner, keyOf, PLANTS);
}

ElementMap<ustring, Plant>& Bed::Impl::getPlants() const
{
    return support::shownCollection(*this, m_plants, &Impl::makePlants);
}

void Bed::Impl::setSize(Size const& size)
{
    support::setScalar(*this, m_size, SIZE, size);
}

std::unique_ptr<UnorderedElementSet<Bed>> Bed::Impl::makeNeighbours(Impl* owner)
{
    return std::make_unique<UnorderedElementSet<Bed>>(owner, NEIGHBOURS);
}

UnorderedElementSet<Bed>& Bed::Impl::getNeighbours() const
{
    return support::shownCollection(*this, m_neighbours, &Impl::makeNeighbours);
}

Bed::Builder::Builder() = default;

Bed::Builder::Builder(Model const& model) : BuilderBase(model) {}

Bed::Builder::~Builder() = default;

Bed::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Bed::metaClass(), source.second)
{}

Bed::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : ModelElement::Constrainables(query, metaClass, mode),
      plants(*this, propertyOf<rows::properties::BedPlants>()),
      size(*this, propertyOf<rows::properties::BedSize>()),
      neighbours(*this, propertyOf<rows::properties::BedNeighbours>()),
      area(*this, propertyOf<rows::properties::BedArea>())
{}
}  // namespace acme::garden

template class tarn::kiln::support::Record<
    acme::garden::Bed::Impl, tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    acme::garden::Bed::Impl, tarn::kiln::ModelElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    acme::garden::Bed::Impl, tarn::kiln::support::BuilderRoot>;
template class tarn::kiln::support::BuilderTop<acme::garden::Bed::Builder>;
