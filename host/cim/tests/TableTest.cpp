#include "cim/Table.h"

#include <gtest/gtest.h>

using cimhost::cim::table;

namespace {

TEST(Table, alignsItsColumns)
{
    EXPECT_EQ(table({"Name", "Health", "Id"}, {{"Front panel", "OK", "1"}, {"x", "Degraded/Warning", "22"}}),
              "Name         Health            Id\n"
              "-----------  ----------------  --\n"
              "Front panel  OK                1\n"
              "x            Degraded/Warning  22\n");
}

TEST(Table, countsColumnsOfTheTerminalNotBytes)
{
    EXPECT_EQ(table({"Name", "Id"}, {{"L\u00fcfter", "1"}, {"\u98a8\u6247", "2"}}), "Name    Id\n"
                                                                                    "------  --\n"
                                                                                    "L\u00fcfter  1\n"
                                                                                    "\u98a8\u6247    2\n");
}

TEST(Table, doesNotLetACellDriveTheTerminal)
{
    EXPECT_EQ(table({"N\n"}, {{"a\x1b[2J\nb\xff"}}), "N\\n\n"
                                                     "--------------\n"
                                                     "a\\x001B[2J\\nb\uFFFD\n");
}

TEST(Table, fillsAndCutsRows)
{
    EXPECT_EQ(table({"A", "B"}, {{"1"}, {"1", "2", "3"}, {}}), "A  B\n"
                                                               "-  -\n"
                                                               "1\n"
                                                               "1  2\n"
                                                               "\n");
}

TEST(Table, hasItsHeadingAlsoWithoutRows)
{
    EXPECT_EQ(table({"A", "Bc"}, {}), "A  Bc\n-  --\n");
}

} // namespace
