#include "text/fonts.h"

#include <gtest/gtest.h>

#include "unit/text/made_font.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

using vorel_test::letters;
using vorel_test::openMade;

TEST(Fonts, FirstOne_IsTheMainOne) {
    Fonts fonts{openMade(letters(), 20)};
    fonts.add(openMade(letters(), 30));
    EXPECT_EQ(fonts.count(), 2U);
    EXPECT_EQ(fonts.main().sizePx(), 20);
    EXPECT_EQ(fonts[1].sizePx(), 30);
    EXPECT_EQ(fonts.added(), (std::vector<size_t>{0, 1}));
}

TEST(Fonts, Fallback_IsOpenedOnceAtTheSizeOfTheMainFont) {
    Fonts fonts{openMade(letters(), 20)};
    EXPECT_FALSE(fonts.fallbackFor({'1'})) << "there is none";
    fonts.setFallback([](const Cluster&) { return FontFile{VOREL_TEST_FONT}; });
    EXPECT_EQ(fonts.fallbackFor({'1'}), 1U);
    EXPECT_EQ(fonts.fallbackFor({'2'}), 1U);
    EXPECT_EQ(fonts.count(), 2U);
    EXPECT_EQ(fonts[1].sizePx(), 20);
    EXPECT_EQ(fonts.added(), std::vector<size_t>{0});
}

TEST(Fonts, FallbackThatHasNotTheCluster_IsNone) {
    Fonts fonts{openMade(letters())};
    fonts.setFallback([](const Cluster&) { return FontFile{VOREL_TEST_FONT}; });
    EXPECT_FALSE(fonts.fallbackFor({0x13080}));
    EXPECT_TRUE(fonts.fallbackFor({'1', 0x200D, 0xFE0F})) << "marks that show nothing do not count";
}

TEST(Fonts, FallbackThatCannotBeOpened_IsAskedOnce) {
    Fonts fonts{openMade(letters())};
    fonts.setFallback([](const Cluster& cluster) -> std::optional<FontFile> {
        if (cluster == Cluster{'0'}) return std::nullopt;
        return FontFile{"no/such.ttf"};
    });
    EXPECT_FALSE(fonts.fallbackFor({'0'}));
    EXPECT_FALSE(fonts.fallbackFor({'1'}));
    EXPECT_FALSE(fonts.fallbackFor({'1'}));
    EXPECT_EQ(fonts.count(), 1U);
}

TEST(Fonts, Fallbacks_AreBounded) {
    Fonts fonts{openMade(letters())};
    long asked = 0;
    fonts.setFallback([&](const Cluster&) { return FontFile{"no/such.ttf", asked++}; });
    for (size_t i = 0; i < Fonts::kMostFallbacks; ++i)
        EXPECT_FALSE(fonts.fallbackFor({'1'}));
    fonts.setFallback([](const Cluster&) { return FontFile{VOREL_TEST_FONT}; });
    EXPECT_FALSE(fonts.fallbackFor({'1'})) << "one too many";
}

TEST(Fonts, FontThatIsAddedLater_StandsBehindTheOthers) {
    Fonts fonts{openMade(letters())};
    fonts.setFallback([](const Cluster&) { return FontFile{VOREL_TEST_FONT}; });
    fonts.fallbackFor({'1'});
    fonts.add(openMade(letters()));
    EXPECT_EQ(fonts.added(), (std::vector<size_t>{0, 2}));
}

}  // namespace
}  // namespace voreltext
