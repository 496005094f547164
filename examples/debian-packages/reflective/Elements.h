/// \file
/// The elements of an index as the program sees them if their classes are defined at run time.
#pragma once
#include "reflective/CollectionView.h"
#include "reflective/ElementView.h"

#include <boost/optional.hpp>

namespace debian::reflective {
class Alternative;
class DependencyGroup;
class Package;
class PackageIndex;
class Release;

// What the properties mean is told in model/debian.json.

class PackageIndex : public ElementView<PackageIndex>
{
public:
    using ElementView::ElementView;
    static meta::Class const& metaClass();

    MapView<Package> getPackages() const;
};

class Package : public ElementView<Package>
{
public:
    class Constrainables;  // Constrainables.h

    using ElementView::ElementView;
    static meta::Class const& metaClass();

    ustring getName() const;
    void setName(ustring const& name) const;
    PackageIndex getIndex() const;
    void setIndex(PackageIndex const& index) const;
    MapView<Release> getReleases() const;
    bool hasReleases() const;
    SequenceView<Release> getProviders() const;
    bool hasProviders() const;
};

class Release : public ElementView<Release>
{
public:
    class Constrainables;  // Constrainables.h

    using ElementView::ElementView;
    static meta::Class const& metaClass();

    ustring getLabel() const;
    void setLabel(ustring const& label) const;
    Package getPackage() const;
    void setPackage(Package const& package) const;
    ustring getVersion() const;
    void setVersion(ustring const& version) const;
    ustring getArchitecture() const;
    void setArchitecture(ustring const& architecture) const;
    ustring getSection() const;
    void setSection(ustring const& section) const;
    ustring getMaintainer() const;
    void setMaintainer(ustring const& maintainer) const;
    ustring getSummary() const;
    void setSummary(ustring const& summary) const;
    boost::optional<long> getInstalledSize() const;
    void setInstalledSize(boost::optional<long> const& installedSize) const;
    bool isEssential() const;
    void setIsEssential(bool essential) const;
    SequenceView<DependencyGroup> getGroups() const;
    bool hasGroups() const;
    SequenceView<Package> getProvides() const;
};

class DependencyGroup : public ElementView<DependencyGroup>
{
public:
    class Constrainables;  // Constrainables.h

    using ElementView::ElementView;
    static meta::Class const& metaClass();

    ustring getKind() const;
    void setKind(ustring const& kind) const;
    Release getRelease() const;
    void setRelease(Release const& release) const;
    SequenceView<Alternative> getAlternatives() const;
    bool hasAlternatives() const;
};

class Alternative : public ElementView<Alternative>
{
public:
    class Constrainables;  // Constrainables.h

    using ElementView::ElementView;
    static meta::Class const& metaClass();

    DependencyGroup getGroup() const;
    void setGroup(DependencyGroup const& group) const;
    ustring getRelation() const;
    void setRelation(ustring const& relation) const;
    ustring getBound() const;
    void setBound(ustring const& bound) const;
    Package getTarget() const;
    Impl* getTargetImpl() const;
    void setTarget(Package const& target) const;
};
}  // namespace debian::reflective
