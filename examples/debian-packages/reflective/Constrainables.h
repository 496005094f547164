/// \file
/// What a query may ask of elements whose classes are defined at run time.
///
/// The members of generated search instances serve any property that is known when the program
/// runs. So the classes here are used like generated ones.
#pragma once
#include "reflective/Elements.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"
#include "tarnkiln/query/ModelElementConstrainables.h"

#include <utility>

namespace debian::reflective {

/// The query that a search instance is added to, and which elements suit.
using SearchSource = std::pair<query::AbstractQuery&, query::SearchClassMatchMode const>;

class Package::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = Package;
    explicit Constrainables(SearchSource const& source);

    query::ConstrainableValue<ustring, true> name;
    query::ConstrainableReference<PackageIndex> index;
    query::ConstrainableReference<Release> releases;
    query::ConstrainableReference<Release> providers;
};

class Release::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = Release;
    explicit Constrainables(SearchSource const& source);

    query::ConstrainableValue<ustring, true> label;
    query::ConstrainableReference<Package> package;
    query::ConstrainableValue<ustring, true> version;
    query::ConstrainableValue<ustring, true> architecture;
    query::ConstrainableValue<ustring, true> section;
    query::ConstrainableValue<ustring, true> maintainer;
    query::ConstrainableValue<ustring, true> summary;
    query::ConstrainableValue<long> installedSize;
    query::ConstrainableValue<bool> isEssential;
    query::ConstrainableReference<DependencyGroup> groups;
    query::ConstrainableReference<Package> provides;
};

class DependencyGroup::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = DependencyGroup;
    explicit Constrainables(SearchSource const& source);

    query::ConstrainableValue<ustring, true> kind;
    query::ConstrainableReference<Release> release;
    query::ConstrainableReference<Alternative> alternatives;
};

class Alternative::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = Alternative;
    explicit Constrainables(SearchSource const& source);

    query::ConstrainableReference<DependencyGroup> group;
    query::ConstrainableValue<ustring, true> relation;
    query::ConstrainableValue<ustring, true> bound;
    query::ConstrainableReference<Package> target;
};
}  // namespace debian::reflective
