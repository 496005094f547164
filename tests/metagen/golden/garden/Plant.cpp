// Made from garden.json by `metagen.py`; do not edit.
#include "acme/garden/PlantImpl.h"

#include "acme/garden/BedImpl.h"
#include "acme/garden/GardenMetaPackage.h"
#include "acme/garden/PlantBuilder.h"
#include "acme/garden/PlantConstrainables.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace acme::garden {

constinit Slot const Plant::Impl::NAME{
    .index = 1, .property = propertyOf<rows::properties::PlantName>};
constinit Slot const Plant::Impl::BED{
    .index = 2, .opposite = &Bed::Impl::PLANTS, .property = propertyOf<rows::properties::PlantBed>};
constinit Slot const Plant::Impl::SOWN{
    .index = 3, .property = propertyOf<rows::properties::PlantSown>};
constinit Slot const Plant::Impl::HEIGHT{
    .index = 4, .property = propertyOf<rows::properties::PlantHeight>};
constinit Slot const Plant::Impl::IS_HARDY{
    .index = 5, .property = propertyOf<rows::properties::PlantIsHardy>};
constinit Slot const Plant::Impl::NOTES{
    .index = 6, .single = false, .property = propertyOf<rows::properties::PlantNotes>};

Plant Plant::cast(ModelElement const& element)
{
    return support::cast<Plant>(element);
}

meta::Class const& Plant::metaClass()
{
    return GardenMetaPackage::getInstance().getClass(rows::classes::Plant);
}

Plant::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Plant::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values.getBuilder(), id)
{
    values.construct(*this);
}

Plant::Impl::~Impl() = default;

void Plant::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void Plant::Impl::setName(ustring const& name)
{
    auto const requireFree = [&] {
        support::requireFreeKey(getBed()->getPlants(), name);
    };
    auto const store = [&] { support::setScalar(*this, m_name, NAME, name); };
    support::changeKey(*this, getName(), name, getBed(), BED, requireFree, store);
}

Bed Plant::Impl::getBed() const
{
    return Bed(getBedImpl());
}

Bed::Impl* Plant::Impl::getBedImpl() const
{
    return support::containerOf<Bed::Impl>(*this, BED);
}

bool Plant::Impl::hasBed() const
{
    return getBedImpl() && getBedImpl()->isLive();
}

void Plant::Impl::setBed(Bed const& bed)
{
    auto const requireFree = [&] {
        support::requireFreeKey(bed->getPlants(), getName());
    };
    support::setContainer(*this, BED, bed.getImpl(), requireFree);
}

void Plant::Impl::setSown(Season sown)
{
    support::setScalar(*this, m_sown, SOWN, sown);
}

void Plant::Impl::setHeight(boost::optional<int> const& height)
{
    support::setScalar(*this, m_height, HEIGHT, height);
}

void Plant::Impl::setIsHardy(bool hardy)
{
    support::setScalar(*this, m_isHardy, IS_HARDY, hardy);
}

std::unique_ptr<PrimitiveSequence<ustring>> Plant::Impl::makeNotes(Impl* owner)
{
    return std::make_unique<PrimitiveSequence<ustring>>(owner, /*unique=*/false, NOTES);
}

PrimitiveSequence<ustring>& Plant::Impl::getNotes() const
{
    return support::shownCollection(*this, m_notes, &Impl::makeNotes);
}

Plant::Builder::Builder() = default;

Plant::Builder::Builder(Model const& model) : BuilderBase(model) {}

Plant::Builder::~Builder() = default;

Plant::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Plant::metaClass(), source.second)
{}

Plant::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : ModelElement::Constrainables(query, metaClass, mode),
      name(*this, propertyOf<rows::properties::PlantName>()),
      bed(*this, propertyOf<rows::properties::PlantBed>()),
      sown(*this, propertyOf<rows::properties::PlantSown>()),
      height(*this, propertyOf<rows::properties::PlantHeight>()),
      isHardy(*this, propertyOf<rows::properties::PlantIsHardy>()),
      notes(*this, propertyOf<rows::properties::PlantNotes>())
{}
}  // namespace acme::garden

template class tarn::kiln::support::Record<
    acme::garden::Plant::Impl, tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    acme::garden::Plant::Impl, tarn::kiln::ModelElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    acme::garden::Plant::Impl, tarn::kiln::support::BuilderRoot>;
template class tarn::kiln::support::BuilderTop<acme::garden::Plant::Builder>;
