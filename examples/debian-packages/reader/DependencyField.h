/// \file
/// The value of a relation field such as `Depends`, taken apart.
#pragma once
#include "reader/Version.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace debian {

/// The versions that a relation asks for.
struct VersionBound
{
    VersionRelation relation;
    Version version;
};

/// One entry of an architecture list such as `[amd64 !i386]`.
struct ArchitectureRestriction
{
    std::string architecture;
    bool excluded;  ///< Written with `!`.
};

/// One package that a field names, with the conditions on it.
struct PackageRelation
{
    std::string package;
    std::string architecture;  ///< What follows `name:`, such as "any" or "amd64"; empty if absent.
    std::optional<VersionBound> bound;
    std::vector<ArchitectureRestriction> restrictions;  ///< In the order of the field.
};

/// Alternatives, of which the first is preferred; never empty.
using RelationGroup = std::vector<PackageRelation>;

/// Reads the value of a relation field.
///
///     field    = [group {"," group}]
///     group    = relation {"|" relation}
///     relation = name [":" architecture] ["(" operator version ")"] ["[" {["!"] architecture} "]"]
///                {"<" {["!"] profile} ">"}
///     operator = "<<" | "<=" | "=" | ">=" | ">>" | "<" | ">"
///
/// Blanks and newlines may stand between all parts, except around the colon and behind `!`. The
/// legacy operators `<` and `>` mean `<=` and `>=`, as they do for dpkg. Lists in brackets are not
/// empty. Build profiles concern nobody who has built packages at hand: they are checked and
/// dropped. An empty value has no groups; an empty group, as behind a trailing comma, is an error.
///
/// \throws SyntaxError  with the column in `value` and the reason.
std::vector<RelationGroup> parseDependencyField(std::string_view value);

}  // namespace debian
