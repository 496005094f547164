#include "model/PackageIndexImpl.h"

#include "model/Metamodel.h"
#include "model/PackageImpl.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace debian::model {

constinit Slot const PackageIndex::Impl::PACKAGES{.index = 1,
                                                  .composite = true,
                                                  .single = false,
                                                  .keyed = true,
                                                  .opposite = &Package::Impl::INDEX,
                                                  .property = propertyAt<0>};

PackageIndex PackageIndex::cast(ModelElement const& element)
{
    return support::cast<PackageIndex>(element);
}

meta::Class const& PackageIndex::metaClass()
{
    return Metamodel::getInstance().packageIndex;
}

PackageIndex PackageIndex::create(Model const& model, UUID const& id)
{
    return support::create<PackageIndex>(model, id);
}

PackageIndex::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

PackageIndex::Impl::~Impl() = default;

std::unique_ptr<ElementMap<ustring, Package>> PackageIndex::Impl::makePackages(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Package::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMap<ustring, Package>>(owner, keyOf, PACKAGES);
}

ElementMap<ustring, Package>& PackageIndex::Impl::getPackages() const
{
    return support::shownCollection(*this, m_packages, &Impl::makePackages);
}
}  // namespace debian::model

template class tarn::kiln::support::Record<debian::model::PackageIndex::Impl,
                                           tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<debian::model::PackageIndex::Impl,
                                               tarn::kiln::ModelElement::Impl>;
