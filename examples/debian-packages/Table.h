/// \file
/// The answer to a question, as people read it.
#pragma once
#include <chrono>
#include <cstddef>
#include <iosfwd>
#include <string>
#include <utility>
#include <vector>

namespace debian {

/// Rows of texts under the names of their columns.
class Table
{
public:
    enum class Alignment
    {
        Left,
        Right
    };
    struct Column
    {
        std::string name;
        Alignment alignment = Alignment::Left;
    };
    using Row = std::vector<std::string>;  ///< A text in UTF-8 for each column.

    explicit Table(std::vector<Column> columns) : m_columns(std::move(columns)) {}

    void addRow(Row row) { m_rows.push_back(std::move(row)); }
    std::vector<Row> const& rows() const { return m_rows; }

    /// Writes the first rows, columns below each other, and how many there are in all.
    ///
    /// A character counts as one place, whatever its width. Without rows there are no names of
    /// columns either.
    /// \param maxRows  the number of rows to write; 0 for all.
    /// \param time  what it took to find them.
    void print(std::ostream& output, std::size_t maxRows, std::chrono::duration<double> time) const;

private:
    /// \param count  the number of rows, under the names of the columns.
    void printRows(std::ostream& output, std::size_t count) const;
    /// \param rules  texts as wide as the columns.
    void printLine(std::ostream& output, Row const& row, Row const& rules) const;

    std::vector<Column> m_columns;
    std::vector<Row> m_rows;
};

}  // namespace debian
