#include "film_rate.h"

#include <gtest/gtest.h>

namespace vorelpaint {
namespace {

TEST(FrameRate, WholeNumbersAndFractions_AreRead) {
    EXPECT_EQ(parseFrameRate("30")->text(), "30/1");
    EXPECT_EQ(parseFrameRate("24000/1001")->text(), "24000/1001");
    EXPECT_EQ(parseFrameRate("1")->text(), "1/1");
    EXPECT_EQ(parseFrameRate("240")->text(), "240/1");
}

TEST(FrameRate, AnythingElse_IsRefused) {
    for (const char* text : {"", "0", "-30", "29.97", "30/", "/1", "30/0", "1/2", "241", "240001/1000",
                             "30 ", "30/1/1", "2000000/1000001", "99999999999999999999"}) {
        EXPECT_FALSE(parseFrameRate(text)) << text;
    }
}

TEST(FrameRate, FramesBefore_CountsThoseThatBeginBefore) {
    const FrameRate ten{10, 1};
    EXPECT_EQ(ten.framesBefore(0), 0);
    EXPECT_EQ(ten.framesBefore(1), 1);
    EXPECT_EQ(ten.framesBefore(100), 1);
    EXPECT_EQ(ten.framesBefore(101), 2);
    // Frame 24 begins at 1.001 seconds.
    const FrameRate film{24000, 1001};
    EXPECT_EQ(film.framesBefore(1001), 24);
    EXPECT_EQ(film.framesBefore(1002), 25);
    EXPECT_DOUBLE_EQ(film.startMs(24), 1001.0);
    // A day at the largest parts: 86400 * 1000000 / 4167, rounded up.
    EXPECT_EQ((FrameRate{1000000, 4167}.framesBefore(86400000)), 20734342);
}

}  // namespace
}  // namespace vorelpaint
