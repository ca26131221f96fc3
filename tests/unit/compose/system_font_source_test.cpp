#include "compose/system/system_font_source.h"

#include <gtest/gtest.h>

#include "compose/error.h"

namespace vorelcompose {
namespace {

TEST(SystemFontSource, FileOrFamily_IsFound) {
    SystemFontSource fonts;
    const FontSource::Found file = fonts.find(VOREL_TEST_FONT);
    EXPECT_EQ(file.file.path, VOREL_TEST_FONT);
    EXPECT_EQ(fonts.find("DejaVu Sans").file.path, VOREL_TEST_FONT);
    EXPECT_TRUE(fonts.find("DejaVu Sans").mark == file.mark);
}

TEST(SystemFontSource, WhatIsNotThere_IsRefused) {
    SystemFontSource fonts;
    EXPECT_THROW(fonts.find("/no/such.ttf"), ComposeError);
    EXPECT_THROW(fonts.find("No Such Family"), voreltext::TextError);
}

TEST(SystemFontSource, InstalledFonts_AreReadOnceAndNotForFiles) {
    int loads = 0;
    SystemFontSource fonts([&loads] {
        ++loads;
        return std::make_unique<voreltext::SystemFonts>();
    });
    fonts.find(VOREL_TEST_FONT);
    EXPECT_EQ(loads, 0);
    fonts.load();
    fonts.find("DejaVu Sans");
    EXPECT_EQ(loads, 1);
}

}  // namespace
}  // namespace vorelcompose
