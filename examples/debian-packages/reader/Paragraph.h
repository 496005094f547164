/// \file
/// One paragraph of a control file: an ordered list of named fields.
#pragma once
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace debian {

/// The fields of one paragraph, in the order of the file.
///
/// All text lies in one buffer that keeps its capacity over `clear()`, so that reading a file
/// paragraph by paragraph into the same object hardly allocates. Names are compared without regard
/// to case and are unique; `ControlFile` sees to that.
class Paragraph
{
public:
    /// A field; the views die with the next change of the paragraph.
    struct Field
    {
        std::string_view name;   ///< Spelled as in the file.
        std::string_view value;  ///< Lines are joined by a newline and keep their leading blank.
        std::size_t line;        ///< Where the field begins; counts from 1.
    };

    bool isEmpty() const { return m_fields.empty(); }
    std::size_t fieldCount() const { return m_fields.size(); }
    std::size_t byteCount() const { return m_text.size(); }  ///< Of all names and values.

    /// \param index  counts from 0, less than `fieldCount()`.
    Field fieldAt(std::size_t index) const;
    /// The field of that name in any case; nothing if the paragraph has none.
    std::optional<Field> find(std::string_view name) const;
    /// Where the first field begins; 0 for the empty paragraph.
    std::size_t line() const { return m_fields.empty() ? 0 : m_fields.front().line; }

    void clear();
    /// Appends a field. The caller has checked that its name is new.
    void addField(std::string_view name, std::string_view value, std::size_t line);
    /// Appends a line, leading blank included, to the last field. There must be one.
    void continueField(std::string_view line);

private:
    /// Offsets into `m_text`, which moves when it grows.
    struct Place
    {
        std::size_t nameBegin;
        std::size_t valueBegin;  // also the end of the name
        std::size_t valueEnd;
        std::size_t line;
    };

    std::string_view nameOf(Place const& place) const;

    std::string m_text;
    std::vector<Place> m_fields;
};

}  // namespace debian
