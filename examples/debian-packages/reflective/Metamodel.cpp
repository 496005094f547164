#include "reflective/Metamodel.h"

#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <tuple>
#include <utility>

namespace debian::reflective {

using meta::ClassDefinition;
using meta::PropertyDefinition;
using meta::StandardTypes;

namespace {

/// Both ends of an association.
std::pair<meta::Property, meta::Property> ends(PropertyDefinition one, PropertyDefinition other)
{
    return {one, other};
}

/// The ends of an association that is single at the other end, which gets the name.
std::pair<meta::Property, meta::Property> ends(PropertyDefinition one, char16_t const* other)
{
    return ends(one, one.opposite(other));
}

}  // namespace

Metamodel const& Metamodel::getInstance()
{
    static Metamodel const metamodel;
    return metamodel;
}

Metamodel::Metamodel()
{
    meta::Type const& text = StandardTypes::stringMeta;
    meta::PackageDefinition definition(u"debianAtRunTime",
                                       u"http://example.org/debian-packages/at-run-time");
    ClassDefinition index = definition.defineClass(u"PackageIndex");
    ClassDefinition named = definition.defineClass(u"Package");
    ClassDefinition released = definition.defineClass(u"Release");
    ClassDefinition needed = definition.defineClass(u"DependencyGroup");
    ClassDefinition offered = definition.defineClass(u"Alternative");

    package.name = named.attribute(u"name", text);
    std::tie(packageIndex.packages, package.index) =
        ends(index.contents(u"packages", named).keyedBy(package.name), u"index");

    release.label = released.attribute(u"label", text);
    std::tie(package.releases, release.package) =
        ends(named.contents(u"releases", released).keyedBy(release.label), u"package");
    release.version = released.attribute(u"version", text);
    release.architecture = released.attribute(u"architecture", text);
    release.section = released.attribute(u"section", text);
    release.maintainer = released.attribute(u"maintainer", text);
    release.summary = released.attribute(u"summary", text);
    release.installedSize =
        released.attribute(u"installedSize", StandardTypes::integer64Meta).optional();
    release.isEssential = released.attribute(u"isEssential", StandardTypes::booleanMeta);
    PropertyDefinition provides = released.reference(u"provides", named).sequence().unique();
    std::tie(release.provides, package.providers) =
        ends(provides, provides.opposite(u"providers").sequence().unique());

    dependencyGroup.kind = needed.attribute(u"kind", text);
    std::tie(release.groups, dependencyGroup.release) =
        ends(released.contents(u"groups", needed).sequence().unique(), u"release");

    std::tie(dependencyGroup.alternatives, alternative.group) =
        ends(needed.contents(u"alternatives", offered).sequence().unique(), u"group");
    alternative.relation = offered.attribute(u"relation", text);
    alternative.bound = offered.attribute(u"bound", text);
    alternative.target = offered.reference(u"target", named);
    definition.finish();

    packageIndex.metaClass = index;
    package.metaClass = named;
    release.metaClass = released;
    dependencyGroup.metaClass = needed;
    alternative.metaClass = offered;
}
}  // namespace debian::reflective
