#include "style/style_scale.h"

#include <gtest/gtest.h>

namespace vorelstyle {
namespace {

Style read(const char* json) {
    return parseStyle(json);
}

TEST(StyleScale, Lengths_AreMultipliedAndRounded) {
    const Style style = scaledStyle(
        read(
            R"({"outerShadow": {"angle": 45, "distance": 5, "size": 9, "color": "#000000", "opacity": 1},
                 "stroke": {"size": 4, "color": "#000000", "opacity": 1, "position": "outside"}})"),
        0.5F);
    const auto& shadow = std::get<OuterShadow>(style.effects[0]);
    EXPECT_EQ(shadow.distance, 3.0F);  // 2.5 rounds away from zero
    EXPECT_EQ(shadow.size, 5.0F);      // 4.5 likewise
    EXPECT_EQ(shadow.angle, 45.0F);
    EXPECT_EQ(std::get<Stroke>(style.effects[1]).size, 2.0F);
}

TEST(StyleScale, Lengths_NeverVanishNorLeaveTheRange) {
    const char* json = R"({"outerGlow": {"size": 2, "color": "#000000", "opacity": 1},
                           "innerShadow": {"angle": 0, "distance": 0, "size": 60, "color": "#000000",
                                           "opacity": 1}})";
    EXPECT_EQ(std::get<OuterGlow>(scaledStyle(read(json), 0.1F).effects[0]).size, 1.0F);
    const Style large = scaledStyle(read(json), 4.0F);
    EXPECT_EQ(std::get<InnerShadow>(large.effects[1]).size, 100.0F);
    EXPECT_EQ(std::get<InnerShadow>(large.effects[1]).distance, 0.0F);
}

TEST(StyleScale, FactorOne_ChangesNothing) {
    Style style = read(R"({"outerShadow": {"angle": 0, "distance": 0.4, "size": 2.7, "color": "#000000"},
                           "pattern": {"image": "a.png", "scale": 0.15}})");
    style = scaledStyle(style, 1.0F);
    const auto& shadow = std::get<OuterShadow>(style.effects[0]);
    EXPECT_EQ(shadow.size, 2.7F);
    EXPECT_EQ(shadow.distance, 0.4F);
    EXPECT_EQ(std::get<Pattern>(style.effects[1]).scale, 0.15F);
}

TEST(StyleScale, Patterns_ScaleAlong) {
    const char* json = R"({"pattern": {"image": "a.png", "scale": 1.5, "opacity": 1}})";
    EXPECT_EQ(std::get<Pattern>(scaledStyle(read(json), 2.0F).effects[0]).scale, 3.0F);
    EXPECT_EQ(std::get<Pattern>(scaledStyle(read(json), 0.05F).effects[0]).scale, 0.1F);
}

}  // namespace
}  // namespace vorelstyle
