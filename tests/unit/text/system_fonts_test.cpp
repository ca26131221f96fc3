#include "text/system_fonts.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "text/error.h"

namespace voreltext {
namespace {

TEST(SystemFonts, Family_IsFoundWithItsStyle) {
    const SystemFonts fonts;
    EXPECT_EQ(std::filesystem::path(fonts.find("DejaVu Sans").path).filename(), "DejaVuSans.ttf");
    EXPECT_EQ(std::filesystem::path(fonts.find("dejavu sans:bold").path).filename(),
              "DejaVuSans-Bold.ttf");
}

TEST(SystemFonts, GenericFamily_IsWhateverTheSystemPrefers) {
    EXPECT_TRUE(std::filesystem::is_regular_file(SystemFonts().find("sans-serif").path));
}

TEST(SystemFonts, FamilyThatIsNotInstalled_IsNotReplacedByTheNearest) {
    try {
        SystemFonts().find("No Such Family:bold");
        FAIL() << "found";
    } catch (const TextError& error) {
        EXPECT_STREQ(error.what(), "no font file or family 'No Such Family:bold'");
    }
}

}  // namespace
}  // namespace voreltext
