#include "model/ReleaseImpl.h"

#include "model/DependencyGroupImpl.h"
#include "model/Metamodel.h"
#include "model/PackageImpl.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace debian::model {

constinit Slot const Release::Impl::LABEL{.index = 1, .property = propertyAt<5>};
constinit Slot const Release::Impl::PACKAGE{
    .index = 2, .opposite = &Package::Impl::RELEASES, .property = propertyAt<6>};
constinit Slot const Release::Impl::VERSION{.index = 3, .property = propertyAt<7>};
constinit Slot const Release::Impl::ARCHITECTURE{.index = 4, .property = propertyAt<8>};
constinit Slot const Release::Impl::SECTION{.index = 5, .property = propertyAt<9>};
constinit Slot const Release::Impl::MAINTAINER{.index = 6, .property = propertyAt<10>};
constinit Slot const Release::Impl::SUMMARY{.index = 7, .property = propertyAt<11>};
constinit Slot const Release::Impl::INSTALLED_SIZE{.index = 8, .property = propertyAt<12>};
constinit Slot const Release::Impl::ESSENTIAL{.index = 9, .property = propertyAt<13>};
constinit Slot const Release::Impl::GROUPS{.index = 10,
                                           .composite = true,
                                           .single = false,
                                           .opposite = &DependencyGroup::Impl::RELEASE,
                                           .property = propertyAt<14>};
constinit Slot const Release::Impl::PROVIDES{.index = 11,
                                             .single = false,
                                             .opposite = &Package::Impl::PROVIDERS,
                                             .property = propertyAt<15>};

Release Release::cast(ModelElement const& element)
{
    return support::cast<Release>(element);
}

meta::Class const& Release::metaClass()
{
    return Metamodel::getInstance().release;
}

Release Release::create(Model const& model, UUID const& id)
{
    return support::create<Release>(model, id);
}

Release::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Release::Impl::~Impl() = default;

void Release::Impl::setLabel(ustring const& label)
{
    support::changeKey(
        *this, getLabel(), label, getPackage(), PACKAGE,
        [&] { support::requireFreeKey(getPackage()->getReleases(), label); },
        [&] { support::setScalar(*this, m_label, LABEL, label); });
}

Package Release::Impl::getPackage() const
{
    return Package(getPackageImpl());
}

Package::Impl* Release::Impl::getPackageImpl() const
{
    return support::containerOf<Package::Impl>(*this, PACKAGE);
}

void Release::Impl::setPackage(Package const& package)
{
    support::setContainer(*this, PACKAGE, package.getImpl(),
                          [&] { support::requireFreeKey(package->getReleases(), getLabel()); });
}

void Release::Impl::setVersion(ustring const& version)
{
    support::setScalar(*this, m_version, VERSION, version);
}

void Release::Impl::setArchitecture(ustring const& architecture)
{
    support::setScalar(*this, m_architecture, ARCHITECTURE, architecture);
}

void Release::Impl::setSection(ustring const& section)
{
    support::setScalar(*this, m_section, SECTION, section);
}

void Release::Impl::setMaintainer(ustring const& maintainer)
{
    support::setScalar(*this, m_maintainer, MAINTAINER, maintainer);
}

void Release::Impl::setSummary(ustring const& summary)
{
    support::setScalar(*this, m_summary, SUMMARY, summary);
}

void Release::Impl::setInstalledSize(boost::optional<long> const& installedSize)
{
    support::setScalar(*this, m_installedSize, INSTALLED_SIZE, installedSize);
}

void Release::Impl::setIsEssential(bool essential)
{
    support::setScalar(*this, m_essential, ESSENTIAL, essential);
}

std::unique_ptr<ElementSequence<DependencyGroup>> Release::Impl::makeGroups(Impl* owner)
{
    return std::make_unique<ElementSequence<DependencyGroup>>(owner, /*unique=*/true, GROUPS);
}

ElementSequence<DependencyGroup>& Release::Impl::getGroups() const
{
    return support::shownCollection(*this, m_groups, &Impl::makeGroups);
}

std::unique_ptr<ElementSequence<Package>> Release::Impl::makeProvides(Impl* owner)
{
    return std::make_unique<ElementSequence<Package>>(owner, /*unique=*/true, PROVIDES);
}

ElementSequence<Package>& Release::Impl::getProvides() const
{
    return support::shownCollection(*this, m_provides, &Impl::makeProvides);
}
}  // namespace debian::model

template class tarn::kiln::support::Record<debian::model::Release::Impl,
                                           tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<debian::model::Release::Impl,
                                               tarn::kiln::ModelElement::Impl>;
