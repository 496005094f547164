#include "reader/PackageParagraph.h"

#include "reader/Ascii.h"
#include "reader/PackageName.h"
#include "reader/Paragraph.h"
#include "reader/ReadError.h"
#include "reader/SyntaxError.h"

#include <charconv>
#include <string_view>
#include <type_traits>
#include <utility>

namespace debian {
namespace {

std::string quoted(std::string_view text)
{
    // Appended: GCC 12 warns of overlaps in sums of literals and strings that are inlined.
    std::string result(1, '"');
    return result.append(text).append(1, '"');
}

/// Reads fields of one paragraph and turns what is wrong with them into `ReadError`.
class FieldReader
{
public:
    FieldReader(Paragraph const& paragraph, std::string const& file)
        : m_paragraph(paragraph),
          m_file(file)
    {}

    std::string readText(std::string_view name) const
    {
        auto const field = m_paragraph.find(name);
        return field ? std::string(field->value) : std::string();
    }

    std::string readFirstLine(std::string_view name) const
    {
        auto const field = m_paragraph.find(name);
        return field ? std::string(field->value.substr(0, field->value.find('\n'))) : std::string();
    }

    std::string readName(std::string_view name, bool (*isValid)(std::string_view)) const
    {
        Paragraph::Field const field = findMandatory(name);
        if (!isValid(field.value))
            fail(field, quoted(field.value) + " is not allowed");
        return std::string(field.value);
    }

    Version readVersion(std::string_view name) const
    {
        Paragraph::Field const field = findMandatory(name);
        return translateErrors(field, [&] { return Version(std::string(field.value)); });
    }

    bool readBoolean(std::string_view name) const
    {
        auto const field = m_paragraph.find(name);
        if (!field || ascii::equalsIgnoringCase(field->value, "no"))
            return false;
        if (ascii::equalsIgnoringCase(field->value, "yes"))
            return true;
        fail(*field, quoted(field->value) + " is neither \"yes\" nor \"no\"");
    }

    std::optional<std::uint64_t> readNumber(std::string_view name) const
    {
        auto const field = m_paragraph.find(name);
        if (!field)
            return std::nullopt;
        std::uint64_t number = 0;
        char const* const end = field->value.data() + field->value.size();
        auto const result = std::from_chars(field->value.data(), end, number);
        if (result.ec != std::errc() || result.ptr != end)
            fail(*field, quoted(field->value) + " is not a number of 64 bits");
        return number;
    }

    MultiArch readMultiArch(std::string_view name) const
    {
        auto const field = m_paragraph.find(name);
        if (!field || field->value == "no")
            return MultiArch::No;
        if (field->value == "same")
            return MultiArch::Same;
        if (field->value == "foreign")
            return MultiArch::Foreign;
        if (field->value == "allowed")
            return MultiArch::Allowed;
        fail(*field,
             quoted(field->value) + " is none of \"no\", \"same\", \"foreign\" and \"allowed\"");
    }

    std::vector<RelationGroup> readRelations(std::string_view name, bool allowAlternatives) const
    {
        auto const field = m_paragraph.find(name);
        if (!field)
            return {};
        auto groups = translateErrors(*field, [&] { return parseDependencyField(field->value); });
        for (RelationGroup const& group : groups)
        {
            if (!allowAlternatives && group.size() > 1)
                fail(*field, "alternatives to \"" + group.front().package + "\" are not allowed");
        }
        return groups;
    }

    std::vector<PackageRelation> readProvides(std::string_view name) const
    {
        std::vector<PackageRelation> provides;
        for (RelationGroup& group : readRelations(name, /*allowAlternatives=*/false))
        {
            PackageRelation& provided = group.front();
            if (provided.bound && provided.bound->relation != VersionRelation::Equal)
                fail(*m_paragraph.find(name),
                     quoted(provided.package) + " has another relation than \"=\"");
            provides.push_back(std::move(provided));
        }
        return provides;
    }

private:
    Paragraph::Field findMandatory(std::string_view name) const
    {
        auto const field = m_paragraph.find(name);
        if (!field || field->value.empty())
            throw ReadError(m_file, m_paragraph.line(),
                            "paragraph has no field \"" + std::string(name) +
                                "\"; the file may be cut off or no package index");
        return *field;
    }

    template <class Read>
    std::invoke_result_t<Read const&> translateErrors(Paragraph::Field const& field,
                                                      Read const& read) const
    {
        try
        {
            return read();
        }
        catch (SyntaxError const& error)
        {
            fail(field, error.what());
        }
    }

    [[noreturn]] void fail(Paragraph::Field const& field, std::string const& reason) const
    {
        throw ReadError(m_file, field.line, "field \"" + std::string(field.name) + "\": " + reason);
    }

    Paragraph const& m_paragraph;
    std::string const& m_file;
};

}  // namespace

PackageParagraph::PackageParagraph(Paragraph const& paragraph, std::string const& file)
    : line(paragraph.line()),
      package(FieldReader(paragraph, file).readName("Package", isPackageName)),
      version(FieldReader(paragraph, file).readVersion("Version")),
      architecture(FieldReader(paragraph, file).readName("Architecture", isArchitecture))
{
    FieldReader const fields(paragraph, file);
    status = fields.readText("Status");
    essential = fields.readBoolean("Essential");
    priority = fields.readText("Priority");
    section = fields.readText("Section");
    maintainer = fields.readText("Maintainer");
    installedSize = fields.readNumber("Installed-Size");
    description = fields.readFirstLine("Description");
    multiArch = fields.readMultiArch("Multi-Arch");
    for (DependencyKind const kind : DEPENDENCY_KINDS)
    {
        dependencies[static_cast<std::size_t>(kind)] =
            fields.readRelations(fieldName(kind), allowsAlternatives(kind));
    }
    provides = fields.readProvides("Provides");
}

}  // namespace debian
