#include "numbered_name.h"

#include <gtest/gtest.h>

#include <string>

namespace vorelpaint {
namespace {

std::string named(const char* path, int64_t number) {
    const std::optional<NumberedName> name = NumberedName::parse(path);
    return name ? name->with(number) : "none";
}

TEST(NumberedName, Number_HasItsDigitsAtLeast) {
    EXPECT_EQ(named("frame_%05d.png", 7), "frame_00007.png");
    EXPECT_EQ(named("frame_%05d.png", 1234567), "frame_1234567.png");
    EXPECT_EQ(named("%d", 0), "0");
    EXPECT_EQ(named("a%09db.png", 1), "a000000001b.png");
}

TEST(NumberedName, DirectoryAndDoubledSigns_StandForThemselves) {
    EXPECT_EQ(named("50%/%d/f%d.png", 3), "50%/%d/f3.png");
    EXPECT_EQ(named("100%%_%d%%.png", 3), "100%_3%.png");
}

TEST(NumberedName, NoNumberOrAnotherForm_IsNone) {
    for (const char* path : {"", "a.png", "%d/a.png", "%%d.png", "%d%d.png", "%5d.png", "%0d.png",
                             "%010d.png", "%s.png", "%", "a%", "%0", "%05", "%x%d"}) {
        EXPECT_EQ(named(path, 1), "none") << path;
    }
}

}  // namespace
}  // namespace vorelpaint
