/// \file
/// Reads the packages of an index one after the other.
///
///     debian::ControlFile file("/var/lib/dpkg/status");
///     debian::PackageReader reader(file);
///     while (auto package = reader.next())
///         std::cout << package->package << ' ' << package->version.text() << '\n';
#pragma once
#include "reader/PackageParagraph.h"
#include "reader/Paragraph.h"

#include <cstddef>
#include <optional>

namespace debian {
class ControlFile;

/// Gives the packages of a control file, without those that dpkg knows but that are not installed.
///
/// A paragraph with a field `Status` comes from a status file of dpkg and counts only if the field
/// ends in " installed"; of the others only the number is known. A paragraph without the field
/// comes from an index of available packages and always counts. Packages are given in the order of
/// the file; that two have the same name, version and architecture is not noticed.
class PackageReader
{
public:
    /// \param file  kept by reference; must live as long as this reader.
    explicit PackageReader(ControlFile& file);

    /// The next package; nothing at the end of the file.
    /// \throws ReadError  for all reasons of `ControlFile::next` and of `PackageParagraph`.
    std::optional<PackageParagraph> next();

    /// How many paragraphs of packages that are not installed were passed over so far.
    std::size_t skippedCount() const { return m_skippedCount; }

private:
    ControlFile& m_file;
    Paragraph m_paragraph;  // kept for its capacity
    std::size_t m_skippedCount = 0;
};

}  // namespace debian
