/// \file
/// What can be asked of an index.
///
///     Questions<Generated> const questions(loaded.index, MissingNames(loaded.missing));
///     questions.largestPackages("^lib").print(std::cout, 10, {});
#pragma once
#include "Forms.h"
#include "MissingNames.h"
#include "Table.h"
#include "tarnkiln/kernel/Model.h"

#include <string>

namespace debian {

/// The kinds of dependencies without which a release does not work, as a regular expression.
inline constexpr char16_t const* STRICT_KINDS = u"^(Pre-)?Depends$";
/// The kind of dependencies that most users want to be satisfied.
inline constexpr char16_t const* RECOMMENDED_KIND = u"^Recommends$";

/// Questions to an index, answered by queries. Each call runs them anew.
///
/// What is searched are the elements of the model of the index. Rows that are alike are one row;
/// unless something else is said, they are in the order of their texts.
///
/// Threads: as the model.
template <ElementForm Form> class Questions
{
public:
    /// \param missing  the names that became proxies while the index was loaded.
    Questions(PackageIndex<Form> const& index, MissingNames missing);

    /// The dependencies of some kinds that no release of the index satisfies: package, release,
    /// dependency. What satisfies one is told by `satisfiersOf`.
    ///
    /// \param kinds  a regular expression.
    Table unmetDependencies(tarn::kiln::ustring const& kinds) const;

    /// The pairs of packages of which one strictly depends on the other by name, where releases of
    /// both have the same maintainer: package, package depended on, maintainer. Versions do not
    /// matter.
    Table dependenciesOfSameMaintainer() const;

    /// The releases of the packages whose names match, the largest first: package, release, size in
    /// units of 1024 bytes. Those whose size is not known are not among them.
    ///
    /// \param pattern  a regular expression that is searched in the names.
    /// \throws std::runtime_error  if it is no regular expression.
    Table largestPackages(std::string const& pattern) const;

    /// The dependencies of any kind that name a package, which may be a virtual or a missing one:
    /// package, release, dependency.
    ///
    /// \throws std::runtime_error  if no package of the index is called so, and none is missing.
    Table reverseDependencies(std::string const& name) const;

    /// The package of the index that most alternatives name, the first one by name if there are
    /// several; empty if they name none.
    std::string mostNamedPackage() const;

private:
    PackageIndex<Form> m_index;
    tarn::kiln::Model m_model;
    MissingNames m_missing;
};

}  // namespace debian
