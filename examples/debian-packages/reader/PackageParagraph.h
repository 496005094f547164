/// \file
/// One package of an index, with the type of each field.
#pragma once
#include "reader/DependencyField.h"
#include "reader/DependencyKind.h"
#include "reader/Version.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace debian {
class Paragraph;

/// Whether a package of one architecture serves packages of another.
enum class MultiArch
{
    No,
    Same,
    Foreign,
    Allowed,
};

/// What a paragraph says about its package. Owns all its texts, so it outlives the paragraph.
struct PackageParagraph
{
    /// Takes the paragraph apart. Fields that have no member here are ignored.
    ///
    /// \param file  the name of the file, for errors.
    /// \throws ReadError  with the line of the field that is malformed; with the first line of the
    ///     paragraph if `Package`, `Version` or `Architecture` is absent or empty.
    PackageParagraph(Paragraph const& paragraph, std::string const& file);

    std::vector<RelationGroup> const& dependenciesOf(DependencyKind kind) const
    {
        return dependencies[static_cast<std::size_t>(kind)];
    }

    std::size_t line;  ///< Where the paragraph begins in its file; counts from 1.
    std::string package;
    Version version;
    std::string architecture;
    std::string status;  ///< Such as "install ok installed"; empty if the index has none.
    bool essential;      ///< False if absent.
    std::string priority;
    std::string section;
    std::string maintainer;
    std::optional<std::uint64_t> installedSize;  ///< In units of 1024 bytes.
    std::string description;                     ///< The first line only.
    MultiArch multiArch;                         ///< `No` if absent.
    /// Indexed by `DependencyKind`. In conflicts, breaks and replacements each group has one
    /// member.
    std::array<std::vector<RelationGroup>, DEPENDENCY_KINDS.size()> dependencies;
    std::vector<PackageRelation> provides;  ///< If there is a bound its relation is `Equal`.
};

}  // namespace debian
