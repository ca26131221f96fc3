#include "style/resolved_style.h"

#include <gtest/gtest.h>

namespace vorelstyle {
namespace {

Style read(const char* json) {
    return parseStyle(json);
}

Style scaled(const Style& style, float factor) {
    return resolvedStyle(style, 96, factor);
}

TEST(ResolvedStyle, Lengths_AreMultipliedAndRounded) {
    const Style style = scaled(
        read(
            R"({"outerShadow": {"angle": 45, "distance": 5, "size": 9, "color": "#000000", "opacity": 1},
                 "stroke": {"size": 4, "color": "#000000", "opacity": 1, "position": "outside"}})"),
        0.5F);
    const auto& shadow = std::get<OuterShadow>(style.looks[0].effects[0]);
    EXPECT_EQ(shadow.distance, Length{3.0F});  // 2.5 rounds away from zero
    EXPECT_EQ(shadow.size, Length{5.0F});      // 4.5 likewise
    EXPECT_EQ(shadow.angle, 45.0F);
    EXPECT_EQ(std::get<Stroke>(style.looks[0].effects[1]).size, Length{2.0F});
}

TEST(ResolvedStyle, Lengths_NeverVanishNorLeaveTheRange) {
    const char* json = R"({"outerGlow": {"size": 2, "color": "#000000", "opacity": 1},
                           "innerShadow": {"angle": 0, "distance": 0, "size": 60, "color": "#000000",
                                           "opacity": 1}})";
    EXPECT_EQ(std::get<OuterGlow>(scaled(read(json), 0.1F).looks[0].effects[0]).size, Length{1.0F});
    const Style large = scaled(read(json), 4.0F);
    EXPECT_EQ(std::get<InnerShadow>(large.looks[0].effects[1]).size, Length{100.0F});
    EXPECT_EQ(std::get<InnerShadow>(large.looks[0].effects[1]).distance, Length{0.0F});
}

TEST(ResolvedStyle, FactorOne_ChangesNothing) {
    Style style = read(R"({"outerShadow": {"angle": 0, "distance": 0.4, "size": 2.7, "color": "#000000"},
                           "pattern": {"image": "a.png", "scale": 0.15}})");
    style = scaled(style, 1.0F);
    const auto& shadow = std::get<OuterShadow>(style.looks[0].effects[0]);
    EXPECT_EQ(shadow.size, Length{2.7F});
    EXPECT_EQ(shadow.distance, Length{0.4F});
    EXPECT_EQ(std::get<Pattern>(style.looks[0].effects[1]).scale, 0.15F);
}

TEST(ResolvedStyle, Patterns_ScaleAlong) {
    const char* json = R"({"pattern": {"image": "a.png", "scale": 1.5, "opacity": 1}})";
    EXPECT_EQ(std::get<Pattern>(scaled(read(json), 2.0F).looks[0].effects[0]).scale, 3.0F);
    EXPECT_EQ(std::get<Pattern>(scaled(read(json), 0.05F).looks[0].effects[0]).scale, 0.1F);
}

}  // namespace
}  // namespace vorelstyle
