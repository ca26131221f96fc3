#include "style/resolved_style.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "style/error.h"

namespace vorelstyle {
namespace {

Style read(const std::string& json) {
    return parseStyle(json);
}

Style scaled(const Style& style, float factor) {
    return resolvedStyle(style, 96, factor);
}

/// A style of version 2 whose one effect is a stroke of this size, as JSON spells it.
Style strokeOf(const std::string& size, const std::string& opacity = "1") {
    return read(R"({"version": 2, "stroke": {"color": "#000000", "position": "outside", "size": )" +
                size + R"(, "opacity": )" + opacity + "}}");
}

template <typename Kind>
Kind only(const Style& style) {
    return std::get<Kind>(style.looks.at(0).effects.at(0));
}

Stroke resolvedStroke(const std::string& size, int fontSizePx, float scale = 1) {
    return only<Stroke>(resolvedStyle(strokeOf(size), fontSizePx, scale));
}

OuterShadow resolvedShadow(const std::string& distance, const std::string& size, int fontSizePx) {
    const std::string shadow = R"({"angle": 0, "color": "#000000", "opacity": 0.5, "distance": )" +
                               distance + R"(, "size": )" + size + "}";
    return only<OuterShadow>(
        resolvedStyle(read(R"({"version": 2, "outerShadow": )" + shadow + "}"), fontSizePx, 1));
}

std::vector<std::string> notesOf(const Style& style, int fontSizePx, float scale) {
    std::vector<std::string> notes;
    resolvedStyle(style, fontSizePx, scale, [&](const std::string& line) { notes.push_back(line); });
    return notes;
}

TEST(ResolvedStyle, Pixels_AreMultipliedAndRounded) {
    const Style style = scaled(
        read(
            R"({"outerShadow": {"angle": 45, "distance": 5, "size": 9, "color": "#000000", "opacity": 1},
                 "stroke": {"size": 4, "color": "#000000", "opacity": 1, "position": "outside"}})"),
        0.5F);
    const auto& shadow = std::get<OuterShadow>(style.looks[0].effects[0]);
    EXPECT_EQ(shadow.distance, Length{3});  // 2.5 rounds away from zero
    EXPECT_EQ(shadow.size, Length{5});      // 4.5 likewise
    EXPECT_EQ(shadow.angle, 45.0F);
    EXPECT_EQ(std::get<Stroke>(style.looks[0].effects[1]).size, Length{2});
}

TEST(ResolvedStyle, Pixels_NeverVanishNorLeaveTheRange) {
    const char* json = R"({"outerGlow": {"size": 2, "color": "#000000", "opacity": 1},
                           "innerShadow": {"angle": 0, "distance": 0, "size": 60, "color": "#000000",
                                           "opacity": 1}})";
    const auto glow = only<OuterGlow>(scaled(read(json), 0.1F));
    EXPECT_EQ(glow.size, Length{1});
    EXPECT_EQ(glow.opacity, 1.0F) << "only shares fade";
    const Style large = scaled(read(json), 4.0F);
    EXPECT_EQ(std::get<InnerShadow>(large.looks[0].effects[1]).size, Length{100});
    EXPECT_EQ(std::get<InnerShadow>(large.looks[0].effects[1]).distance, Length{0});
}

TEST(ResolvedStyle, PixelsAtFactorOne_StayAsTheyAre) {
    Style style = read(R"({"outerShadow": {"angle": 0, "distance": 0.4, "size": 2.7, "color": "#000000"},
                           "pattern": {"image": "a.png", "scale": 0.15}})");
    style = scaled(style, 1.0F);
    const auto& shadow = std::get<OuterShadow>(style.looks[0].effects[0]);
    EXPECT_EQ(shadow.size, Length{2.7F});
    EXPECT_EQ(shadow.distance, Length{0.4F});
    EXPECT_EQ(shadow.opacity, 1.0F);
    EXPECT_EQ(std::get<Pattern>(style.looks[0].effects[1]).scale, 0.15F);
    EXPECT_EQ(only<Stroke>(scaled(strokeOf("\"2.7px\""), 1)).size, Length{2.7F});
}

TEST(ResolvedStyle, Pixels_DoNotFollowTheFont) {
    EXPECT_EQ(resolvedStroke("4", 12).size, Length{4});
    EXPECT_EQ(resolvedStroke("\"4px\"", 1000).size, Length{4});
}

TEST(ResolvedStyle, Shares_FollowTheFontAndTheScale) {
    EXPECT_EQ(resolvedStroke("\"4%\"", 100).size, Length{4});
    EXPECT_EQ(resolvedStroke("\"4%\"", 96).size, Length{4});    // 3.84
    EXPECT_EQ(resolvedStroke("\"4%\"", 310).size, Length{12});  // 12.4
    EXPECT_EQ(resolvedStroke("\"4%\"", 200, 2.5F).size, Length{20});
    EXPECT_EQ(resolvedStroke("\"4%\"", 200, 0.5F).size, Length{4});
    EXPECT_EQ(resolvedStroke("\"0%\"", 200, 0.5F).size, Length{0});
}

TEST(ResolvedStyle, HalvesOfAPixel_RoundAwayFromZero) {
    EXPECT_EQ(resolvedStroke("\"0.7%\"", 500).size, Length{4});      // 3.5
    EXPECT_EQ(resolvedStroke("\"3.333%\"", 105).size, Length{3});    // 3.49965
    EXPECT_EQ(resolvedStroke("\"10%\"", 50, 0.7F).size, Length{4});  // 3.5, though 0.7F is less than 0.7
    const Style style =
        resolvedStyle(read(R"({"version": 2, "offset": {"x": "0.7%", "y": "-0.7%"}})"), 500, 1);
    EXPECT_EQ(style.looks[0].offsetX, Length{4});
    EXPECT_EQ(style.looks[0].offsetY, Length{-4});
}

TEST(ResolvedStyle, EveryShare_IsTheNearestWholePixel) {
    for (int thousandths = 0; thousandths <= 100000; thousandths += 37) {
        for (const int font : {1, 7, 12, 96, 100, 333, 999}) {
            // In integers: the share is thousandths * font hundred-thousandths of a pixel.
            const int64_t share = int64_t{thousandths} * font;
            if (share < 100000) continue;  // a hairline
            const int64_t nearest = std::min<int64_t>(100, (2 * share + 100000) / 200000);
            Style style = strokeOf("1");
            std::get<Stroke>(style.looks[0].effects[0]).size = {static_cast<float>(thousandths) / 1000,
                                                                Length::Unit::percent};
            ASSERT_EQ(only<Stroke>(resolvedStyle(style, font, 1)).size,
                      Length{static_cast<float>(nearest)})
                << thousandths << " of " << font;
        }
    }
}

TEST(ResolvedStyle, Hairlines_AreOnePixelAndFade) {
    const Style style = strokeOf("\"0.3%\"", "0.5");
    const auto stroke = only<Stroke>(resolvedStyle(style, 100, 1));
    EXPECT_EQ(stroke.size, Length{1});
    EXPECT_NEAR(stroke.opacity, 0.15F, 1e-4);  // 0.3 pixels at half of the opacity
    const auto glow =
        only<InnerGlow>(resolvedStyle(read(R"({"version": 2, "innerGlow": {"size": "1%", "opacity": 0.8,
                 "gradient": [{"color": "#000000", "opacity": 0.6, "location": 0}]}})"),
                                      50, 0.5F));
    EXPECT_EQ(glow.size, Length{1});
    EXPECT_NEAR(glow.opacity, 0.2F, 1e-4);  // a quarter of a pixel
    EXPECT_EQ(glow.gradient[0].mOpacity, 0.6F) << "the library multiplies it by the effect's";
}

TEST(ResolvedStyle, Hairlines_GrowIntoLinesWithoutAJump) {
    // Down to a hundredth of the font's percent around 1 pixel: the opacity nears that of the line.
    EXPECT_NEAR(resolvedStroke("\"0.999%\"", 100).opacity, 0.999F, 1e-4);
    EXPECT_EQ(resolvedStroke("\"1%\"", 100).opacity, 1.0F);
    EXPECT_EQ(resolvedStroke("\"1.001%\"", 100).opacity, 1.0F);
    for (const char* size : {"\"0.999%\"", "\"1%\"", "\"1.001%\""})
        EXPECT_EQ(resolvedStroke(size, 100).size, Length{1}) << size;
    float before = 0;
    for (int font = 1; font <= 150; ++font) {
        const Stroke stroke = resolvedStroke("\"1%\"", font);
        EXPECT_EQ(stroke.size, Length{static_cast<float>(font < 150 ? 1 : 2)}) << font;
        EXPECT_NEAR(stroke.opacity, std::min(1.0F, static_cast<float>(font) / 100), 1e-4) << font;
        EXPECT_GE(stroke.opacity, before) << font;
        before = stroke.opacity;
    }
}

TEST(ResolvedStyle, HairlineDistancesOfShadows_FadeAndBlursVanish) {
    const OuterShadow shadow = resolvedShadow("\"0.6%\"", "\"0.4%\"", 100);
    EXPECT_EQ(shadow.distance, Length{1});
    EXPECT_EQ(shadow.size, Length{0});
    EXPECT_NEAR(shadow.opacity, 0.3F, 1e-4);
    EXPECT_EQ(resolvedShadow("\"3%\"", "\"0.5%\"", 100).size, Length{1});
    EXPECT_EQ(resolvedShadow("\"3%\"", "\"0.4%\"", 100).opacity, 0.5F) << "its blur alone is fine";
}

TEST(ResolvedStyle, ShadowsWithoutDistance_KeepTheirOpacity) {
    for (const char* nothing : {"0", "\"0px\"", "\"0%\""}) {
        const OuterShadow shadow = resolvedShadow(nothing, "\"5%\"", 40);
        EXPECT_EQ(shadow.distance, Length{0});
        EXPECT_EQ(shadow.size, Length{2});
        EXPECT_EQ(shadow.opacity, 0.5F);
    }
}

TEST(ResolvedStyle, Relief_ResolvesItsSize) {
    const auto bevel = only<Bevel>(
        resolvedStyle(read(R"({"version": 2, "bevel": {"size": "5%", "angle": 0, "altitude": 0,
                 "highlightColor": "#000000", "shadowColor": "#000000"}})"),
                      60, 1));
    EXPECT_EQ(bevel.size, Length{3});
}

TEST(ResolvedStyle, LengthsBeyondTheLibrary_AreCutAndNoted) {
    const char* shadow = R"({"angle": 0, "distance": "34%", "size": 60, "color": "#000000"})";
    const std::string look = std::string(R"("outerShadow": )") + shadow;
    const Style alone = read(R"({"version": 2, )" + look + "}");
    EXPECT_EQ(only<OuterShadow>(resolvedStyle(alone, 400, 1)).distance, Length{100});
    const std::string told =
        "outerShadow.distance: 136 pixels are more than the library's 100; painted with 100";
    EXPECT_EQ(notesOf(alone, 400, 1), std::vector<std::string>{told});
    EXPECT_TRUE(notesOf(alone, 294, 1).empty()) << "99.96 pixels";

    const Style listed = read(R"({"version": 2, "looks": [{}, {)" + look + "}]}");
    EXPECT_EQ(notesOf(listed, 400, 1), std::vector<std::string>{"looks[1]." + told});
    EXPECT_EQ(
        notesOf(listed, 10, 2),
        std::vector<std::string>{
            "looks[1].outerShadow.size: 120 pixels are more than the library's 100; painted with 100"});
    const Style one = read(R"({"version": 2, "looks": [{)" + look + "}]}");
    EXPECT_EQ(notesOf(one, 400, 1), std::vector<std::string>{"looks[0]." + told});
}

TEST(ResolvedStyle, PatternScales_AreMultipliedAndCut) {
    const Style style = read(R"({"pattern": {"image": "a.png", "scale": 1.5, "opacity": 1}})");
    EXPECT_EQ(only<Pattern>(scaled(style, 2.0F)).scale, 3.0F);
    EXPECT_EQ(only<Pattern>(scaled(style, 0.05F)).scale, 0.1F);
    EXPECT_EQ(
        notesOf(style, 96, 8),
        std::vector<std::string>{"pattern.scale: 12 is more than the library's 10; painted with 10"});
    EXPECT_EQ(notesOf(style, 96, 0.0625F),
              std::vector<std::string>{
                  "pattern.scale: 0.09375 is less than the library's 0.1; painted with 0.1"});
    EXPECT_TRUE(notesOf(style, 96, 2).empty());
}

TEST(ResolvedStyle, TileWidths_AreWholePixelsAboveZero) {
    const auto widthOf = [](const std::string& width, int font, float scale) {
        const Style style =
            read(R"({"version": 2, "pattern": {"image": "a.png", "width": )" + width + "}}");
        return only<Pattern>(resolvedStyle(style, font, scale)).width;
    };
    EXPECT_EQ(widthOf("\"25%\"", 97, 1), Length{24});  // 24.25
    EXPECT_EQ(widthOf("\"25%\"", 97, 2), Length{49});  // 48.5
    EXPECT_EQ(widthOf("\"1%\"", 10, 1), Length{1});
    EXPECT_EQ(widthOf("12", 97, 1), Length{12});
    EXPECT_EQ(widthOf("12", 97, 1.5F), Length{18});
    EXPECT_EQ(widthOf("1", 97, 0.1F), Length{1});
    EXPECT_EQ(widthOf("\"1000%\"", 1000, 1), Length{10000}) << "no 100 pixels for tiles";
}

TEST(ResolvedStyle, Offsets_AreRoundedInEitherUnit) {
    const auto offsetOf = [](const std::string& x, int font, float scale) {
        const Style style = read(R"({"version": 2, "offset": {"x": )" + x + "}}");
        const Style resolved = resolvedStyle(style, font, scale);
        EXPECT_EQ(resolved.looks[0].offsetY, Length{0});
        return resolved.looks[0].offsetX;
    };
    EXPECT_EQ(offsetOf("2.4", 96, 1), Length{2});
    EXPECT_EQ(offsetOf("-2.5", 96, 1), Length{-3});
    EXPECT_EQ(offsetOf("\"-0.4px\"", 96, 1), Length{0}) << "no hairline";
    EXPECT_EQ(offsetOf("3", 96, 0.5F), Length{2});
    EXPECT_EQ(offsetOf("\"-50%\"", 33, 2), Length{-33});
    EXPECT_EQ(offsetOf("1000", 96, 20), Length{20000});
    EXPECT_EQ(offsetOf("\"83.7%\"", 500, 1), Length{419}) << "418.5, though 83.7F is less than 83.7";
}

TEST(ResolvedStyle, OffsetsPastTheFarthest_AreCutAndNoted) {
    const Style style = read(R"({"version": 2, "looks": [{"offset": {"x": -1000, "y": "100%"}}]})");
    const Style resolved = resolvedStyle(style, 40000, 40);
    EXPECT_EQ(resolved.looks[0].offsetX, Length{-32767});
    EXPECT_EQ(resolved.looks[0].offsetY, Length{32767});
    EXPECT_EQ(notesOf(style, 40000, 40),
              (std::vector<std::string>{
                  "looks[0].offset.x: -40000 pixels are farther than 32767; moved by -32767",
                  "looks[0].offset.y: 1600000 pixels are farther than 32767; moved by 32767"}));
}

TEST(ResolvedStyle, ResolvedStyles_StayAsTheyAre) {
    const Style once = resolvedStyle(strokeOf("\"0.3%\""), 100, 1);
    const auto twice = only<Stroke>(resolvedStyle(once, 777, 1));
    EXPECT_EQ(twice.size, Length{1});
    EXPECT_EQ(twice.opacity, only<Stroke>(once).opacity);
}

/// The message with which the look of a style of version 2 is refused that is not resolved.
std::string refusalOf(const std::string& effect) {
    try {
        requireResolved(read(R"({"version": 2, )" + effect + "}").looks[0]);
        return "";
    } catch (const StyleError& error) {
        return error.what();
    }
}

TEST(ResolvedStyle, Shares_AreRefusedByName) {
    const std::string is = ": is a share of the font's size, not in pixels";
    const std::string colour = R"(, "color": "#000000")";
    EXPECT_EQ(refusalOf(R"("outerShadow": {"angle": 0, "distance": "1%", "size": 0)" + colour + "}"),
              "outerShadow.distance" + is);
    EXPECT_EQ(refusalOf(R"("innerShadow": {"angle": 0, "distance": 1, "size": "0%")" + colour + "}"),
              "innerShadow.size" + is);
    EXPECT_EQ(refusalOf(R"("outerGlow": {"size": "1%")" + colour + "}"), "outerGlow.size" + is);
    EXPECT_EQ(refusalOf(R"("stroke": {"position": "inside", "size": "1%")" + colour + "}"),
              "stroke.size" + is);
    EXPECT_EQ(refusalOf(R"("pattern": {"image": "a.png", "width": "1%"})"), "pattern.width" + is);
    EXPECT_EQ(refusalOf(R"("emboss": {"size": "1%", "angle": 0, "altitude": 0,
                           "highlightColor": "#000000", "shadowColor": "#000000"})"),
              "emboss.size" + is);
    EXPECT_EQ(refusalOf(R"("stroke": {"position": "inside", "size": "1px")" + colour + "}"), "");
}

}  // namespace
}  // namespace vorelstyle
