#include "Table.h"

#include <gtest/gtest.h>

#include <sstream>

namespace {

using debian::Table;

constexpr std::chrono::microseconds TIME(1500);

std::string printed(Table const& table, std::size_t maxRows = 0)
{
    std::ostringstream output;
    table.print(output, maxRows, TIME);
    return output.str();
}

Table threeRows()
{
    Table table({{"package"}, {"KiB", Table::Alignment::Right}, {"by"}});
    table.addRow({"vi", "7", "Ann"});
    table.addRow({"mawk-extra", "12345", ""});
    table.addRow({"gdb", "10", "Bob"});
    return table;
}

TEST(Table, AlignsItsColumns)
{
    EXPECT_EQ(printed(threeRows()), "  package       KiB  by\n"
                                    "  ----------  -----  ---\n"
                                    "  vi              7  Ann\n"
                                    "  mawk-extra  12345\n"
                                    "  gdb            10  Bob\n"
                                    "  3 rows in 1.500 ms\n");
}

TEST(Table, LeavesOutWhatIsBehindTheLimit)
{
    EXPECT_EQ(printed(threeRows(), 1), "  package  KiB  by\n"
                                       "  -------  ---  ---\n"
                                       "  vi         7  Ann\n"
                                       "  ... and 2 more\n"
                                       "  3 rows in 1.500 ms\n");
    EXPECT_EQ(printed(threeRows(), 3), printed(threeRows()));
    EXPECT_EQ(printed(threeRows(), 4), printed(threeRows()));
}

TEST(Table, CountsCharactersNotBytes)
{
    Table table({{"by", Table::Alignment::Right}, {"x"}});
    table.addRow({"Zoë €", "1"});
    table.addRow({"Annika", "2"});

    EXPECT_EQ(printed(table), "      by  x\n"
                              "  ------  -\n"
                              "   Zoë €  1\n"
                              "  Annika  2\n"
                              "  2 rows in 1.500 ms\n");
}

TEST(Table, SaysOneRow)
{
    Table table({{"a"}});
    table.addRow({"b"});

    EXPECT_EQ(printed(table), "  a\n  -\n  b\n  1 row in 1.500 ms\n");
}

TEST(Table, HasNoColumnsWithoutRows)
{
    EXPECT_EQ(printed(Table({{"package"}})), "  0 rows in 1.500 ms\n");
}

}  // namespace
