#include "reader/ControlFile.h"

#include "reader/Ascii.h"
#include "reader/ReadError.h"
#include "reader/Utf8.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <istream>
#include <system_error>
#include <utility>

namespace debian {
namespace {

constexpr std::size_t BLOCK_BYTES = std::size_t(256) << 10;

std::string_view withoutTrailingBlanks(std::string_view text)
{
    while (!text.empty() && ascii::isBlank(text.back()))
        text.remove_suffix(1);
    return text;
}

std::string_view withoutLeadingBlanks(std::string_view text)
{
    while (!text.empty() && ascii::isBlank(text.front()))
        text.remove_prefix(1);
    return text;
}

bool mayStandInFieldName(char c)
{
    return c > ' ' && c <= '~' && c != ':';
}

}  // namespace

ControlFile::ControlFile(std::filesystem::path const& path)
    : m_stream(m_ownFile),
      m_name(path.string()),
      m_buffer(BLOCK_BYTES)
{
    errno = 0;
    m_ownFile.open(path, std::ios::binary);
    if (!m_ownFile)
    {
        std::string const cause = errno == 0 ? "" : ": " + std::generic_category().message(errno);
        fail("cannot be opened" + cause);
    }
}

ControlFile::ControlFile(std::istream& stream, std::string name)
    : m_stream(stream),
      m_name(std::move(name)),
      m_buffer(BLOCK_BYTES)
{}

bool ControlFile::next(Paragraph& paragraph)
{
    paragraph.clear();
    std::string_view line;
    while (readLine(line))
    {
        checkText(line);
        if (line.starts_with('#'))
            continue;
        line = withoutTrailingBlanks(line);
        if (line.empty())
        {
            if (!paragraph.isEmpty())
                break;
            continue;
        }
        if (paragraph.byteCount() + line.size() > MAX_PARAGRAPH_BYTES)
            fail("paragraph is longer than " + std::to_string(MAX_PARAGRAPH_BYTES) + " bytes");

        if (!ascii::isBlank(line.front()))
            addField(paragraph, line);
        else if (!paragraph.isEmpty())
            paragraph.continueField(line);
        else
            fail("continuation line before any field");
    }

    if (!paragraph.isEmpty())
        m_hadParagraph = true;
    else if (!m_hadParagraph)
        throw ReadError(m_name, 0, "file has no paragraph");
    return !paragraph.isEmpty();
}

void ControlFile::checkText(std::string_view line) const
{
    std::size_t const nul = line.find('\0');
    if (nul != std::string_view::npos)
        fail("NUL byte at column " + std::to_string(nul + 1));
    std::size_t const invalid = findInvalidUtf8(line);
    if (invalid != std::string_view::npos)
        fail("invalid UTF-8 at column " + std::to_string(invalid + 1));
}

void ControlFile::addField(Paragraph& paragraph, std::string_view line) const
{
    std::size_t const colon = line.find(':');
    if (colon == std::string_view::npos)
        fail("line has no colon after a field name");

    std::string_view const name = line.substr(0, colon);
    if (name.empty())
        fail("field name is empty");
    auto const wrong = std::find_if_not(name.begin(), name.end(), mayStandInFieldName);
    if (wrong != name.end() || name.front() == '-')
    {
        auto const column = wrong == name.end() ? 1 : wrong - name.begin() + 1;
        fail("character not allowed in a field name at column " + std::to_string(column));
    }
    if (paragraph.find(name))
        fail("field \"" + std::string(name) + "\" stands twice in its paragraph");
    if (paragraph.fieldCount() == MAX_FIELDS)
        fail("paragraph has more than " + std::to_string(MAX_FIELDS) + " fields");

    paragraph.addField(name, withoutLeadingBlanks(line.substr(colon + 1)), m_line);
}

/// Finds the next line, without its end. The view dies with the next call.
bool ControlFile::readLine(std::string_view& line)
{
    std::size_t searched = 0;
    for (;;)
    {
        std::string_view const rest(m_buffer.data() + m_begin, m_end - m_begin);
        std::size_t const newline = rest.find('\n', searched);
        if (newline != std::string_view::npos)
        {
            line = rest.substr(0, newline);
            if (line.ends_with('\r'))
                line.remove_suffix(1);
            m_begin += newline + 1;
            ++m_line;
            return true;
        }
        searched = rest.size();
        if (!fillBuffer())
        {
            if (rest.empty())
                return false;
            ++m_line;
            fail("file ends inside this line; it may be cut off");
        }
    }
}

/// Reads on behind the unfinished line, which moves to the front; false at the end of the file.
bool ControlFile::fillBuffer()
{
    std::memmove(m_buffer.data(), m_buffer.data() + m_begin, m_end - m_begin);
    m_end -= m_begin;
    m_begin = 0;
    if (m_end == m_buffer.size())
    {
        if (m_end > MAX_PARAGRAPH_BYTES)
        {
            ++m_line;
            fail("line is longer than " + std::to_string(MAX_PARAGRAPH_BYTES) + " bytes");
        }
        m_buffer.resize(2 * m_buffer.size());
    }

    m_stream.read(m_buffer.data() + m_end, static_cast<std::streamsize>(m_buffer.size() - m_end));
    if (m_stream.bad())
        fail("cannot be read");
    auto const count = static_cast<std::size_t>(m_stream.gcount());
    m_end += count;
    m_bytesRead += count;
    return count != 0;
}

void ControlFile::fail(std::string const& reason) const
{
    throw ReadError(m_name, m_line, reason);
}

}  // namespace debian
