#include "core/assert.h"

#include <gtest/gtest.h>

#include "tests/support/plans.h"

namespace {

#if defined(VOREL_ASSERTIONS)

TEST(Assert, BrokenContract_EndsTheProcessAndNamesIt) {
    EXPECT_DEATH(vorel_test::askForRowsOutOfOrder(),
                 "dilation_plan.cpp:[0-9]+: contract broken: .*y == ");
}

#else

TEST(Assert, WithoutAssertions_AsksNothing) {
    int asked = 0;
    VOREL_ASSERT(++asked > 1);
    EXPECT_EQ(asked, 0);
}

#endif

}  // namespace
