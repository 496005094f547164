#include "reflective/Constrainables.h"

#include "reflective/Metamodel.h"

namespace debian::reflective {
namespace {

Metamodel const& metamodel()
{
    return Metamodel::getInstance();
}

}  // namespace

Package::Constrainables::Constrainables(SearchSource const& source)
    : ModelElement::Constrainables(source.first, Package::metaClass(), source.second),
      name(*this, metamodel().package.name),
      index(*this, metamodel().package.index),
      releases(*this, metamodel().package.releases),
      providers(*this, metamodel().package.providers)
{}

Release::Constrainables::Constrainables(SearchSource const& source)
    : ModelElement::Constrainables(source.first, Release::metaClass(), source.second),
      label(*this, metamodel().release.label),
      package(*this, metamodel().release.package),
      version(*this, metamodel().release.version),
      architecture(*this, metamodel().release.architecture),
      section(*this, metamodel().release.section),
      maintainer(*this, metamodel().release.maintainer),
      summary(*this, metamodel().release.summary),
      installedSize(*this, metamodel().release.installedSize),
      isEssential(*this, metamodel().release.isEssential),
      groups(*this, metamodel().release.groups),
      provides(*this, metamodel().release.provides)
{}

DependencyGroup::Constrainables::Constrainables(SearchSource const& source)
    : ModelElement::Constrainables(source.first, DependencyGroup::metaClass(), source.second),
      kind(*this, metamodel().dependencyGroup.kind),
      release(*this, metamodel().dependencyGroup.release),
      alternatives(*this, metamodel().dependencyGroup.alternatives)
{}

Alternative::Constrainables::Constrainables(SearchSource const& source)
    : ModelElement::Constrainables(source.first, Alternative::metaClass(), source.second),
      group(*this, metamodel().alternative.group),
      relation(*this, metamodel().alternative.relation),
      bound(*this, metamodel().alternative.bound),
      target(*this, metamodel().alternative.target)
{}
}  // namespace debian::reflective
