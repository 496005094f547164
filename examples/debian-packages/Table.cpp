#include "Table.h"

#include "Figures.h"

#include <algorithm>
#include <ostream>

namespace debian {
namespace {

/// The number of characters in a text of UTF-8: of its bytes that continue none.
std::size_t widthOf(std::string const& text)
{
    auto const isFirst = [](char byte) { return (static_cast<unsigned char>(byte) >> 6) != 2; };
    return static_cast<std::size_t>(std::count_if(text.begin(), text.end(), isFirst));
}

}  // namespace

void Table::print(std::ostream& output, std::size_t maxRows,
                  std::chrono::duration<double> time) const
{
    std::size_t const shown = maxRows == 0 ? m_rows.size() : std::min(maxRows, m_rows.size());
    if (shown != 0)
        printRows(output, shown);
    if (shown < m_rows.size())
        output << "  ... and " << m_rows.size() - shown << " more\n";
    output << "  " << m_rows.size() << (m_rows.size() == 1 ? " row" : " rows") << " in "
           << inMilliseconds(time) << '\n';
}

void Table::printRows(std::ostream& output, std::size_t count) const
{
    auto const end = m_rows.begin() + static_cast<std::ptrdiff_t>(count);
    Row names;
    Row rules;
    for (std::size_t at = 0; at < m_columns.size(); ++at)
    {
        std::size_t width = widthOf(m_columns[at].name);
        for (auto row = m_rows.begin(); row != end; ++row)
            width = std::max(width, widthOf((*row)[at]));
        names.push_back(m_columns[at].name);
        rules.emplace_back(width, '-');
    }
    printLine(output, names, rules);
    printLine(output, rules, rules);
    for (auto row = m_rows.begin(); row != end; ++row)
        printLine(output, *row, rules);
}

void Table::printLine(std::ostream& output, Row const& row, Row const& rules) const
{
    std::string line;
    for (std::size_t at = 0; at < row.size(); ++at)
    {
        std::string const padding(rules[at].size() - widthOf(row[at]), ' ');
        bool const isRight = m_columns[at].alignment == Alignment::Right;
        line += "  " + (isRight ? padding + row[at] : row[at] + padding);
    }
    line.erase(line.find_last_not_of(' ') + 1);
    output << line << '\n';
}

}  // namespace debian
