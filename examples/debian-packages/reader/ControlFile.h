/// \file
/// Reads a control file, such as a package index, paragraph by paragraph.
///
///     debian::ControlFile file("/var/lib/dpkg/status");
///     debian::Paragraph paragraph;
///     while (file.next(paragraph))
///         std::cout << paragraph.find("Package")->value << '\n';
#pragma once
#include "reader/Paragraph.h"

#include <cstddef>
#include <filesystem>
#include <fstream>
#include <iosfwd>
#include <string>
#include <string_view>
#include <vector>

namespace debian {

/// A stream of paragraphs. Knows lines and fields, but not what fields a package has.
///
/// | Line                           | Meaning                                          |
/// |--------------------------------|--------------------------------------------------|
/// | empty, or blanks only          | ends a paragraph; several in a row count as one  |
/// | begins with `#`                | a comment, ignored wherever it stands            |
/// | begins with a space or tab     | continues the field above                        |
/// | `Name: value`                  | begins a field; the value may be empty           |
///
/// A line ends in LF or CR LF; a CR elsewhere is text. Blanks at the ends of lines and around the
/// colon's value are dropped. Names consist of printable ASCII without space and colon, and begin
/// with neither `#` nor `-`. A file holds at least one paragraph. The last one needs no empty line
/// behind it, but its last line needs a newline: without one the file counts as cut off.
///
/// The memory in use is that of a block and the longest paragraph, never that of the file. Not
/// copyable; for one thread. After an error the file is of no further use.
class ControlFile
{
public:
    static constexpr std::size_t MAX_PARAGRAPH_BYTES = std::size_t(16) << 20;
    static constexpr std::size_t MAX_FIELDS = 256;  ///< Of one paragraph.

    /// Opens a file.
    /// \throws ReadError  if it cannot be opened.
    explicit ControlFile(std::filesystem::path const& path);

    /// Reads from a stream that somebody else owns and keeps alive, such as `std::cin`.
    /// \param name  stands for the file name in errors.
    ControlFile(std::istream& stream, std::string name);

    ControlFile(ControlFile const&) = delete;
    ControlFile& operator=(ControlFile const&) = delete;

    /// Replaces `paragraph` by the next one of the file; false, with the paragraph empty, at the
    /// end.
    ///
    /// \throws ReadError  if the file cannot be read; if a line is cut off by the end of the file,
    ///     holds a NUL byte or invalid UTF-8, has no colon, has a field name that is empty, holds a
    ///     wrong character or stands twice in its paragraph, or continues no field; if a paragraph
    ///     exceeds a limit; if the file ends and had no paragraph at all.
    bool next(Paragraph& paragraph);

    /// The name as given, for errors of those who understand the paragraphs.
    std::string const& name() const { return m_name; }
    /// How much of the file was read so far, which may be more than the paragraphs took.
    std::size_t bytesRead() const { return m_bytesRead; }

private:
    bool readLine(std::string_view& line);
    bool fillBuffer();
    void checkText(std::string_view line) const;
    void addField(Paragraph& paragraph, std::string_view line) const;
    [[noreturn]] void fail(std::string const& reason) const;

    std::ifstream m_ownFile;  // only used when the file was opened here
    std::istream& m_stream;
    std::string m_name;
    std::vector<char> m_buffer;
    std::size_t m_begin = 0;  // of the bytes in the buffer that are not yet used
    std::size_t m_end = 0;
    std::size_t m_line = 0;  // number of the line read last
    std::size_t m_bytesRead = 0;
    bool m_hadParagraph = false;
};

}  // namespace debian
