/// \file
/// The fields of a package that name other packages.
#pragma once
#include <array>
#include <cstddef>
#include <string_view>

namespace debian {

/// The relation fields other than `Provides`. Their values index arrays.
enum class DependencyKind : unsigned char
{
    PreDepends,
    Depends,
    Recommends,
    Suggests,
    Conflicts,
    Breaks,
    Replaces,
    Enhances,
};

/// All kinds, in the order of their values.
inline constexpr std::array DEPENDENCY_KINDS = {
    DependencyKind::PreDepends, DependencyKind::Depends,   DependencyKind::Recommends,
    DependencyKind::Suggests,   DependencyKind::Conflicts, DependencyKind::Breaks,
    DependencyKind::Replaces,   DependencyKind::Enhances,
};

/// The name of the field, such as "Pre-Depends".
std::string_view fieldName(DependencyKind kind);

/// False for the kinds that concern every package named: conflicts, breaks and replacements.
bool allowsAlternatives(DependencyKind kind);

}  // namespace debian
