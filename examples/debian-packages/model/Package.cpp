#include "model/PackageImpl.h"

#include "model/Metamodel.h"
#include "model/PackageIndexImpl.h"
#include "model/ReleaseImpl.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace debian::model {

constinit Slot const Package::Impl::NAME{.index = 1, .property = propertyAt<1>};
constinit Slot const Package::Impl::INDEX{
    .index = 2, .opposite = &PackageIndex::Impl::PACKAGES, .property = propertyAt<2>};
constinit Slot const Package::Impl::RELEASES{.index = 3,
                                             .composite = true,
                                             .single = false,
                                             .keyed = true,
                                             .opposite = &Release::Impl::PACKAGE,
                                             .property = propertyAt<3>};
constinit Slot const Package::Impl::PROVIDERS{
    .index = 4, .single = false, .opposite = &Release::Impl::PROVIDES, .property = propertyAt<4>};

Package Package::cast(ModelElement const& element)
{
    return support::cast<Package>(element);
}

meta::Class const& Package::metaClass()
{
    return Metamodel::getInstance().package;
}

Package Package::create(Model const& model, UUID const& id)
{
    return support::create<Package>(model, id);
}

Package::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Package::Impl::~Impl() = default;

void Package::Impl::setName(ustring const& name)
{
    support::changeKey(
        *this, getName(), name, getIndex(), INDEX,
        [&] { support::requireFreeKey(getIndex()->getPackages(), name); },
        [&] { support::setScalar(*this, m_name, NAME, name); });
}

PackageIndex Package::Impl::getIndex() const
{
    return PackageIndex(getIndexImpl());
}

PackageIndex::Impl* Package::Impl::getIndexImpl() const
{
    return support::containerOf<PackageIndex::Impl>(*this, INDEX);
}

void Package::Impl::setIndex(PackageIndex const& index)
{
    support::setContainer(*this, INDEX, index.getImpl(),
                          [&] { support::requireFreeKey(index->getPackages(), getName()); });
}

std::unique_ptr<ElementMap<ustring, Release>> Package::Impl::makeReleases(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Release::Impl*>(member)->getLabel();
    };
    return std::make_unique<ElementMap<ustring, Release>>(owner, keyOf, RELEASES);
}

ElementMap<ustring, Release>& Package::Impl::getReleases() const
{
    return support::shownCollection(*this, m_releases, &Impl::makeReleases);
}

std::unique_ptr<ElementSequence<Release>> Package::Impl::makeProviders(Impl* owner)
{
    return std::make_unique<ElementSequence<Release>>(owner, /*unique=*/true, PROVIDERS);
}

ElementSequence<Release>& Package::Impl::getProviders() const
{
    return support::shownCollection(*this, m_providers, &Impl::makeProviders);
}
}  // namespace debian::model

template class tarn::kiln::support::Record<debian::model::Package::Impl,
                                           tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<debian::model::Package::Impl,
                                               tarn::kiln::ModelElement::Impl>;
