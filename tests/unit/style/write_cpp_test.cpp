#include "style/write_cpp.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>

#include "style/error.h"

namespace vorelstyle {
namespace {

std::string writtenOf(const std::string& json) {
    std::ostringstream out;
    writeCpp(out, "addLook", parseStyle(json), 0, 1);
    return out.str();
}

TEST(WriteCppText, FunctionNames_AreTheLooksWords) {
    EXPECT_EQ(functionName("gold"), "addGold");
    EXPECT_EQ(functionName("paper-cut"), "addPaperCut");
    EXPECT_EQ(functionName("My look.2"), "addMyLook2");
    EXPECT_EQ(functionName(""), "addLook");
    EXPECT_EQ(functionName("\xC3\xA9"), "addLook");
}

TEST(WriteCppText, Fractions_AreShortestFloats) {
    EXPECT_NE(writtenOf(R"({"outerGlow": {"size": 0.1, "color": "#000000", "opacity": 1e-7}})")
                  .find("addOuterGlowText(0.1F, 0x000000, 1e-07F, 0, nullptr);"),
              std::string::npos);
}

TEST(WriteCppText, Description_StaysInItsComment) {
    const std::string text = writtenOf(R"({"description": "a\nint evil;\\"})");
    EXPECT_NE(text.find("/// a int evil;\\.\n"), std::string::npos) << text;
}

TEST(WriteCppText, Description_CannotReorderTheSource) {
    const std::string text = writtenOf(R"({"description": "a \u202e} \u2066b\u0085c\u2028int evil;"})");
    EXPECT_NE(text.find("/// a <U+202E>} <U+2066>b<U+0085>c<U+2028>int evil;.\n"), std::string::npos)
        << text;
}

TEST(WriteCppText, Pattern_IsWrittenWithItsPixels) {
    const auto onePixel = [](const std::string&) { return PatternImage{1, 1, {10, 20, 30, 40}}; };
    std::ostringstream out;
    writeCpp(out, "addLook", parseStyle(R"({"pattern": {"image": "a.png"}})"), 0, 1, onePixel);
    EXPECT_NE(out.str().find("// a.png as A, R, G, B\n"), std::string::npos) << out.str();
    EXPECT_NE(out.str().find("\n        40, 10, 20, 30,\n"), std::string::npos) << out.str();
}

TEST(WriteCppText, PatternWithTooManyPixels_IsRefused) {
    const auto large = [](const std::string&) {
        return PatternImage{257, 256, std::vector<uint8_t>(size_t{257} * 256 * 4)};
    };
    const Style style = parseStyle(R"({"pattern": {"image": "a.png"}})", "b.json");
    std::ostringstream out;
    try {
        writeCpp(out, "addLook", style, 0, 1, large);
        FAIL() << "written out";
    } catch (const StyleError& error) {
        EXPECT_EQ(
            std::string(error.what()),
            "style 'b.json': pattern.image: has more than 65536 pixels, too many to be written as C++");
    }
}

TEST(WriteCppText, TextFill_KeepsItsPlaceAndIsNotAddedTwice) {
    const std::string text = writtenOf(
        R"({"text": {"color": "#000000", "opacity": 0.5}, "stroke": {"size": 1, "color": "#000000", "position": "inside"}})");
    EXPECT_NE(text.find("addText(0x000000, 0.5F);\n    look.addStrokeText"), std::string::npos) << text;
    EXPECT_EQ(text.find("addText"), text.rfind("addText"));
}

}  // namespace
}  // namespace vorelstyle
