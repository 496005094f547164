/// \file
/// The metamodel of package indexes, defined while the program runs.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Property.h"

namespace debian::reflective {

namespace meta = tarn::kiln::meta;

/// The classes and properties that `model/debian.json` describes, under the same names, in a
/// package of their own.
///
/// Threads: may be asked for on any thread.
class Metamodel
{
public:
    /// Defined and registered when first asked for.
    static Metamodel const& getInstance();

    struct PackageIndex
    {
        meta::Class metaClass;
        meta::Property packages;
    };
    struct Package
    {
        meta::Class metaClass;
        meta::Property name, index, releases, providers;
    };
    struct Release
    {
        meta::Class metaClass;
        meta::Property label, package, version, architecture, section, maintainer, summary,
            installedSize, isEssential, groups, provides;
    };
    struct DependencyGroup
    {
        meta::Class metaClass;
        meta::Property kind, release, alternatives;
    };
    struct Alternative
    {
        meta::Class metaClass;
        meta::Property group, relation, bound, target;
    };

    PackageIndex packageIndex;
    Package package;
    Release release;
    DependencyGroup dependencyGroup;
    Alternative alternative;

private:
    Metamodel();
};
}  // namespace debian::reflective
