#include "write_cpp.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>

#include "error.h"

namespace vorelpaint {
namespace {

std::string writtenOf(const std::string& json) {
    std::ostringstream out;
    writeCpp(out, "addLook", parseStyle(json, VORELPAINT_PRESETS), 0, 1);
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

TEST(WriteCppText, TextFill_KeepsItsPlaceAndIsNotAddedTwice) {
    const std::string text = writtenOf(
        R"({"text": {"color": "#000000", "opacity": 0.5}, "stroke": {"size": 1, "color": "#000000", "position": "inside"}})");
    EXPECT_NE(text.find("addText(0x000000, 0.5F);\n    look.addStrokeText"), std::string::npos) << text;
    EXPECT_EQ(text.find("addText"), text.rfind("addText"));
}

}  // namespace
}  // namespace vorelpaint
