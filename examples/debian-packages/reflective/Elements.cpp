#include "reflective/Elements.h"

#include "reflective/Metamodel.h"

namespace debian::reflective {
namespace {

Metamodel const& metamodel()
{
    return Metamodel::getInstance();
}

}  // namespace

meta::Class const& PackageIndex::metaClass()
{
    return metamodel().packageIndex.metaClass;
}

MapView<Package> PackageIndex::getPackages() const
{
    return getCollection<MapView<Package>>(metamodel().packageIndex.packages);
}

meta::Class const& Package::metaClass()
{
    return metamodel().package.metaClass;
}

ustring Package::getName() const
{
    return get<ustring>(metamodel().package.name);
}

void Package::setName(ustring const& name) const
{
    set(metamodel().package.name, name);
}

PackageIndex Package::getIndex() const
{
    return getElement<PackageIndex>(metamodel().package.index);
}

void Package::setIndex(PackageIndex const& index) const
{
    setElement(metamodel().package.index, index);
}

MapView<Release> Package::getReleases() const
{
    return getCollection<MapView<Release>>(metamodel().package.releases);
}

bool Package::hasReleases() const
{
    return has(metamodel().package.releases);
}

SequenceView<Release> Package::getProviders() const
{
    return getCollection<SequenceView<Release>>(metamodel().package.providers);
}

bool Package::hasProviders() const
{
    return has(metamodel().package.providers);
}

meta::Class const& Release::metaClass()
{
    return metamodel().release.metaClass;
}

ustring Release::getLabel() const
{
    return get<ustring>(metamodel().release.label);
}

void Release::setLabel(ustring const& label) const
{
    set(metamodel().release.label, label);
}

Package Release::getPackage() const
{
    return getElement<Package>(metamodel().release.package);
}

void Release::setPackage(Package const& package) const
{
    setElement(metamodel().release.package, package);
}

ustring Release::getVersion() const
{
    return get<ustring>(metamodel().release.version);
}

void Release::setVersion(ustring const& version) const
{
    set(metamodel().release.version, version);
}

ustring Release::getArchitecture() const
{
    return get<ustring>(metamodel().release.architecture);
}

void Release::setArchitecture(ustring const& architecture) const
{
    set(metamodel().release.architecture, architecture);
}

ustring Release::getSection() const
{
    return get<ustring>(metamodel().release.section);
}

void Release::setSection(ustring const& section) const
{
    set(metamodel().release.section, section);
}

ustring Release::getMaintainer() const
{
    return get<ustring>(metamodel().release.maintainer);
}

void Release::setMaintainer(ustring const& maintainer) const
{
    set(metamodel().release.maintainer, maintainer);
}

ustring Release::getSummary() const
{
    return get<ustring>(metamodel().release.summary);
}

void Release::setSummary(ustring const& summary) const
{
    set(metamodel().release.summary, summary);
}

boost::optional<long> Release::getInstalledSize() const
{
    return get<boost::optional<long>>(metamodel().release.installedSize);
}

void Release::setInstalledSize(boost::optional<long> const& installedSize) const
{
    set(metamodel().release.installedSize, installedSize);
}

bool Release::isEssential() const
{
    return get<bool>(metamodel().release.isEssential);
}

void Release::setIsEssential(bool essential) const
{
    set(metamodel().release.isEssential, essential);
}

SequenceView<DependencyGroup> Release::getGroups() const
{
    return getCollection<SequenceView<DependencyGroup>>(metamodel().release.groups);
}

bool Release::hasGroups() const
{
    return has(metamodel().release.groups);
}

SequenceView<Package> Release::getProvides() const
{
    return getCollection<SequenceView<Package>>(metamodel().release.provides);
}

meta::Class const& DependencyGroup::metaClass()
{
    return metamodel().dependencyGroup.metaClass;
}

ustring DependencyGroup::getKind() const
{
    return get<ustring>(metamodel().dependencyGroup.kind);
}

void DependencyGroup::setKind(ustring const& kind) const
{
    set(metamodel().dependencyGroup.kind, kind);
}

Release DependencyGroup::getRelease() const
{
    return getElement<Release>(metamodel().dependencyGroup.release);
}

void DependencyGroup::setRelease(Release const& release) const
{
    setElement(metamodel().dependencyGroup.release, release);
}

SequenceView<Alternative> DependencyGroup::getAlternatives() const
{
    return getCollection<SequenceView<Alternative>>(metamodel().dependencyGroup.alternatives);
}

bool DependencyGroup::hasAlternatives() const
{
    return has(metamodel().dependencyGroup.alternatives);
}

meta::Class const& Alternative::metaClass()
{
    return metamodel().alternative.metaClass;
}

DependencyGroup Alternative::getGroup() const
{
    return getElement<DependencyGroup>(metamodel().alternative.group);
}

void Alternative::setGroup(DependencyGroup const& group) const
{
    setElement(metamodel().alternative.group, group);
}

ustring Alternative::getRelation() const
{
    return get<ustring>(metamodel().alternative.relation);
}

void Alternative::setRelation(ustring const& relation) const
{
    set(metamodel().alternative.relation, relation);
}

ustring Alternative::getBound() const
{
    return get<ustring>(metamodel().alternative.bound);
}

void Alternative::setBound(ustring const& bound) const
{
    set(metamodel().alternative.bound, bound);
}

Package Alternative::getTarget() const
{
    return getElement<Package>(metamodel().alternative.target);
}

ModelElement::Impl* Alternative::getTargetImpl() const
{
    return peekElement(metamodel().alternative.target);
}

void Alternative::setTarget(Package const& target) const
{
    setElement(metamodel().alternative.target, target);
}

}  // namespace debian::reflective
