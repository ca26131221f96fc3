#include "sheet.h"

#include <gtest/gtest.h>

namespace vorelpaint {
namespace {

TEST(SheetColumns, SquareCells_MakeASquare) {
    EXPECT_EQ(sheetColumns(1, 10, 10), 1);
    EXPECT_EQ(sheetColumns(9, 10, 10), 3);
    EXPECT_EQ(sheetColumns(10, 10, 10), 4);
}

TEST(SheetColumns, WideCells_StandInFewColumns) {
    EXPECT_EQ(sheetColumns(18, 1000, 10), 1);
    EXPECT_EQ(sheetColumns(18, 10, 1000), 18);
}

}  // namespace
}  // namespace vorelpaint
