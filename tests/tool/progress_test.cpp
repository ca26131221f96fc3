#include "progress.h"

#include <gtest/gtest.h>

namespace vorelpaint {
namespace {

TEST(Progress, Bar_FillsWithTheWork) {
    EXPECT_EQ(Progress::line(0, 2, "jobs"), "[--------------------------------] 0 of 2 jobs");
    EXPECT_EQ(Progress::line(1, 2, "jobs"), "[################----------------] 1 of 2 jobs");
    EXPECT_EQ(Progress::line(2, 2, "jobs"), "[################################] 2 of 2 jobs");
}

TEST(Progress, MoreThanTheTotal_StaysWithinTheBar) {
    EXPECT_EQ(Progress::line(3, 2, "jobs"), "[################################] 3 of 2 jobs");
}

TEST(Progress, UnknownTotal_IsACount) {
    EXPECT_EQ(Progress::line(7, 0, "jobs"), "7 jobs");
}

}  // namespace
}  // namespace vorelpaint
