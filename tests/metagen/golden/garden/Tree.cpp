// Made from garden.json by `metagen.py`; do not edit.
#include "acme/garden/TreeImpl.h"

#include "acme/garden/BedImpl.h"
#include "acme/garden/GardenMetaPackage.h"
#include "acme/garden/TreeBuilder.h"
#include "acme/garden/TreeConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace acme::garden {

constinit Slot const Tree::Impl::PLANTED{
    .index = 7, .property = propertyOf<rows::properties::TreePlanted>};
constinit Slot const Tree::Impl::GRAFT{
    .index = 8, .opposite = &Tree::Impl::STOCK,
    .property = propertyOf<rows::properties::TreeGraft>};
constinit Slot const Tree::Impl::STOCK{
    .index = 9, .opposite = &Tree::Impl::GRAFT,
    .property = propertyOf<rows::properties::TreeStock>};

Tree Tree::cast(ModelElement const& element)
{
    return support::cast<Tree>(element);
}

meta::Class const& Tree::metaClass()
{
    return GardenMetaPackage::getInstance().getClass(rows::classes::Tree);
}

Tree Tree::create(Model const& model, UUID const& id)
{
    return support::create<Tree>(model, id);
}

Tree::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Tree::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Tree::Impl::~Impl() = default;

void Tree::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void Tree::Impl::setPlanted(boost::posix_time::ptime const& planted)
{
    support::refuseSecondValue(*this, m_planted, u"planted");
    support::setScalar(*this, m_planted, PLANTED, planted);
}

Tree Tree::Impl::getGraft() const
{
    return Tree(support::resolve(*this, m_graft, GRAFT));
}

bool Tree::Impl::hasGraft() const
{
    return m_graft && m_graft.get()->isLive();
}

void Tree::Impl::setGraft(Tree const& graft)
{
    support::setReference(*this, m_graft, GRAFT, graft.getImpl());
}

Tree Tree::Impl::getStock() const
{
    return Tree(support::resolve(*this, m_stock, STOCK));
}

bool Tree::Impl::hasStock() const
{
    return m_stock && m_stock.get()->isLive();
}

void Tree::Impl::setStock(Tree const& stock)
{
    support::setReference(*this, m_stock, STOCK, stock.getImpl());
}

Tree::Builder::Builder() = default;

Tree::Builder::Builder(Model const& model) : BuilderBase(model) {}

Tree::Builder::~Builder() = default;

Tree::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Tree::metaClass(), source.second)
{}

Tree::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Plant::Constrainables(query, metaClass, mode),
      planted(*this, propertyOf<rows::properties::TreePlanted>()),
      graft(*this, propertyOf<rows::properties::TreeGraft>()),
      stock(*this, propertyOf<rows::properties::TreeStock>())
{}
}  // namespace acme::garden

template class tarn::kiln::support::Record<
    acme::garden::Tree::Impl, acme::garden::Plant::Impl::Storage>;
template class tarn::kiln::support::Dispatched<acme::garden::Tree::Impl, acme::garden::Plant::Impl>;
template class tarn::kiln::support::BuilderValues<
    acme::garden::Tree::Impl, acme::garden::Plant::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<acme::garden::Tree::Builder>;
