#include "style/write_cpp.h"

#include <gtest/gtest.h>

#include <locale>
#include <string>
#include <vector>

#include "style/error.h"

namespace vorelstyle {
namespace {

std::string writtenOf(const std::string& json) {
    return writtenAsCpp("addLook", parseStyle(json));
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
    const std::string text =
        writtenAsCpp("addLook", parseStyle(R"({"pattern": {"image": "a.png"}})"), 0, 1, onePixel);
    EXPECT_NE(text.find("// a.png as A, R, G, B\n"), std::string::npos) << text;
    EXPECT_NE(text.find("\n        40, 10, 20, 30,\n"), std::string::npos) << text;
}

TEST(WriteCppText, PatternWithTooManyPixels_IsRefused) {
    const auto large = [](const std::string&) {
        return PatternImage{257, 256, std::vector<uint8_t>(size_t{257} * 256 * 4)};
    };
    const Style style = parseStyle(R"({"pattern": {"image": "a.png"}})", "b.json");
    try {
        writtenAsCpp("addLook", style, 0, 1, large);
        FAIL() << "written out";
    } catch (const StyleError& error) {
        EXPECT_EQ(
            std::string(error.what()),
            "style 'b.json': pattern.image: has more than 65536 pixels, too many to be written as C++");
    }
}

size_t countOf(const std::string& text, const std::string& part) {
    size_t count = 0;
    for (size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1))
        ++count;
    return count;
}

TEST(WriteCppText, OneLookInItsPlace_IsOneFunction) {
    const std::string plain = writtenOf(R"({"description": "a", "color": "#000001"})");
    EXPECT_EQ(plain, R"(#include <voreleffect/voreleffect.h>

/// a.
/// For an empty set; VFEffect.h shows how a set paints a run.
void addLook(VFontEffect::VFEffect& look) {
    look.setTextOpacity(1);
    look.addText(0x000001, 1);
}
)");
    EXPECT_EQ(writtenOf(R"({"version": 2, "description": "a", "looks": [{"color": "#000001"}]})"),
              plain);
    EXPECT_EQ(writtenOf(R"({"version": 2, "looks": [{"description": "a", "color": "#000001"}]})"),
              plain);
}

TEST(WriteCppText, Stack_TellsHowItIsPaintedToTheLastBit) {
    const std::string text = writtenOf(R"({"version": 2, "looks": [{}, {}]})");
    EXPECT_NE(
        text.find("\n/// source + destination * (255 - source alpha) / 255, rounded to nearest.\n"),
        std::string::npos)
        << text;
    EXPECT_NE(text.find("in\n/// reading order"), std::string::npos) << text;
}

struct Grouped : std::numpunct<char> {
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\1"; }
};

TEST(WriteCppText, Numbers_AreThoseOfCppInAnyLocale) {
    const auto wide = [](const std::string&) {
        return PatternImage{300, 1, std::vector<uint8_t>(1200, 99)};
    };
    const std::locale before = std::locale::global(std::locale(std::locale::classic(), new Grouped));
    const std::string text =
        writtenAsCpp("addLook", parseStyle(R"({"version": 2, "looks": [{"pattern": {"image": "a.png"}},
             {}, {}, {}, {}, {}, {}, {}, {}, {"offset": {"x": 1000}}]})"),
                     {}, {}, wide);
    std::locale::global(before);
    EXPECT_NE(text.find("\n        99, 99, "), std::string::npos);
    EXPECT_NE(text.find("pattern(300, 1, pixels, 4);"), std::string::npos);
    EXPECT_NE(text.find("void addLook10("), std::string::npos);
    EXPECT_NE(text.find("{addLook10, 1000, 0, \"block\"}"), std::string::npos);
}

TEST(WriteCppText, Stack_IsAFunctionForEachLookAndTheirPlaces) {
    const std::string text = writtenOf(R"({"version": 2, "description": "all", "looks": [
        {"description": "low", "color": "#000001"},
        {"offset": {"x": 3, "y": -2}, "span": "word", "fill": false}]})");
    EXPECT_NE(text.find("/// low.\n/// For an empty set; VFEffect.h shows how a set paints a run.\n"
                        "void addLook1(VFontEffect::VFEffect& look) {\n    look.setTextOpacity(1);\n"
                        "    look.addText(0x000001, 1);\n}\n"),
              std::string::npos)
        << text;
    EXPECT_NE(text.find("void addLook2(VFontEffect::VFEffect& look) {\n    look.setTextOpacity(0);\n"
                        "    look.addText(0x000000, 0);\n}\n"),
              std::string::npos)
        << text;
    EXPECT_NE(text.find("/// all.\n/// In the order of painting."), std::string::npos) << text;
    EXPECT_NE(text.find("const AddLookLook addLookLooks[2] = {\n    {addLook1, 0, 0, \"block\"},\n"
                        "    {addLook2, 3, -2, \"word\"},\n};\n"),
              std::string::npos)
        << text;
    EXPECT_EQ(countOf(text, "void addLook"), 2U);
}

TEST(WriteCppText, MovedLookOrOneInSpans_TellsItsPlace) {
    for (const char* place : {R"("offset": {"x": 1})", R"("offset": {"y": 1})", R"("span": "line")"}) {
        const std::string text = writtenOf(std::string(R"({"version": 2, )") + place + "}");
        EXPECT_EQ(countOf(text, "AddLookLook addLookLooks[1] = {"), 1U) << text;
    }
}

TEST(WriteCppText, ChosenFill_IsThatOfTheTopmostFilledLook) {
    const std::string text = writtenAsCpp(
        "addLook", parseStyle(R"({"version": 2, "looks": [{}, {}, {"fill": false}]})"), 0xABCDEF, 0.5F);
    EXPECT_EQ(countOf(text, "addText(0xABCDEF, 0.5F)"), 1U) << text;
    EXPECT_LT(text.find("void addLook2("), text.find("0xABCDEF")) << text;
}

TEST(WriteCppText, WidthOfATile_IsWrittenAsItsScale) {
    const auto load = [](const std::string&) { return PatternImage{4, 1, std::vector<uint8_t>(16)}; };
    const std::string text = writtenAsCpp(
        "addLook", parseStyle(R"({"version": 2, "pattern": {"image": "a.png", "width": 10}})"), {}, {},
        load);
    EXPECT_NE(text.find("addPatternText(&pattern, 2.5F, 1);"), std::string::npos) << text;
}

/// The message with which the style is refused.
std::string faultOf(const std::string& json) {
    try {
        writtenAsCpp("addLook", parseStyle(json, "a.json"));
        return "";
    } catch (const StyleError& error) {
        return error.what();
    }
}

TEST(WriteCppText, LengthsThatAreNotResolved_AreRefused) {
    EXPECT_EQ(
        faultOf(R"({"version": 2, "looks": [{}, {"outerGlow": {"size": "4%", "color": "#000000"}}]})"),
        "style 'a.json': looks[1].outerGlow.size: is a share of the font's size, not in pixels");
    EXPECT_EQ(faultOf(R"({"version": 2, "looks": [{}, {"offset": {"x": 0.5}}]})"),
              "style 'a.json': looks[1].offset.x: is no whole number of pixels within 32767");
}

TEST(WriteCppText, TextFill_KeepsItsPlaceAndIsNotAddedTwice) {
    const std::string text = writtenOf(
        R"({"text": {"color": "#000000", "opacity": 0.5}, "stroke": {"size": 1, "color": "#000000", "position": "inside"}})");
    EXPECT_NE(text.find("addText(0x000000, 0.5F);\n    look.addStrokeText"), std::string::npos) << text;
    EXPECT_EQ(text.find("addText"), text.rfind("addText"));
}

}  // namespace
}  // namespace vorelstyle
