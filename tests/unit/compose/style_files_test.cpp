#include "compose/system/style_files.h"

#include <gtest/gtest.h>

#include <string>

#include "compose/error.h"
#include "tests/tool/temp_dir.h"

namespace vorelcompose {
namespace {

using vorelstyle::Stack;
using vorelstyle::Style;
using vorelstyle::StyleError;

/// A style whose file lies among the presets, with this image for its pattern.
Style patternStyle(const std::string& image) {
    return vorelstyle::parseStyle(R"({"pattern": {"image": ")" + image + R"("}})",
                                  VOREL_PRESETS "/a.json");
}

TEST(StyleFiles, Faults_NameTheFile) {
    const vorel_test::TempDir dir;
    const std::string path = dir.write("bad.json", R"({"color": 1})");
    try {
        loadStyle(path);
        FAIL() << "read";
    } catch (const StyleError& error) {
        EXPECT_EQ(std::string(error.what()).rfind("style '" + path + "': color: ", 0), 0U)
            << error.what();
    }
}

TEST(StyleFiles, FileThatCannotBeRead_IsAComposeError) {
    EXPECT_THROW(loadStyle("no/such.json"), ComposeError);
}

TEST(StyleFiles, Images_LieBesideTheFile) {
    const Style style = patternStyle("tiles.png");
    const vorelstyle::PatternImage image = imagesOf(style)("tiles.png");
    EXPECT_GT(image.width, 0);
    EXPECT_EQ(image.pixels.size(), static_cast<size_t>(image.width * image.height * 4));
    EXPECT_EQ(Stack(style, {}, {}, imagesOf(style)).looks().front().look.added().front(),
              vorelstyle::kPatternType);
}

TEST(StyleFiles, PatternFaults_NameTheStyleFile) {
    try {
        const Style style =
            vorelstyle::parseStyle(R"({"pattern": {"image": "none.png"}})", "looks/a.json");
        const Stack stack(style, {}, {}, imagesOf(style));
        FAIL() << "painted without its pattern";
    } catch (const StyleError& error) {
        EXPECT_EQ(std::string(error.what()).rfind("style 'looks/a.json': pattern.image: ", 0), 0U);
    }
}

TEST(StyleFiles, PatternThatCannotBeRead_IsAStyleError) {
    for (const char* image : {"none.png", ".", "gold.json"}) {
        const Style style = patternStyle(image);
        EXPECT_THROW(Stack(style, {}, {}, imagesOf(style)), StyleError) << image;
    }
}

}  // namespace
}  // namespace vorelcompose
