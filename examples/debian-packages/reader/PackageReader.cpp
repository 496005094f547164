#include "reader/PackageReader.h"

#include "reader/ControlFile.h"

namespace debian {
namespace {

bool isInstalledOrAvailable(Paragraph const& paragraph)
{
    auto const status = paragraph.find("Status");
    // The blank matters: "half-installed" and "not-installed" are not installed.
    return !status || status->value.ends_with(" installed");
}

}  // namespace

PackageReader::PackageReader(ControlFile& file) : m_file(file) {}

std::optional<PackageParagraph> PackageReader::next()
{
    while (m_file.next(m_paragraph))
    {
        if (isInstalledOrAvailable(m_paragraph))
            return PackageParagraph(m_paragraph, m_file.name());
        ++m_skippedCount;
    }
    return std::nullopt;
}

}  // namespace debian
