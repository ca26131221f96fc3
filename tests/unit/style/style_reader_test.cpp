#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "style/error.h"
#include "style/json_object.h"
#include "style/style.h"

namespace vorelstyle {
namespace {

/// The message with which `json` is refused; empty when it is read.
std::string faultOf(const std::string& json) {
    try {
        parseStyle(json);
        return "";
    } catch (const StyleError& error) {
        return error.what();
    }
}

LookStyle onlyLook(const std::string& json) {
    const Style style = parseStyle(json);
    EXPECT_EQ(style.looks.size(), 1U);
    return style.looks.at(0);
}

template <typename Kind>
Kind only(const std::string& json) {
    const LookStyle look = onlyLook(json);
    EXPECT_EQ(look.effects.size(), 1U);
    return std::get<Kind>(look.effects.at(0));
}

TEST(StyleReader, EmptyObject_IsTextWithoutEffects) {
    const Style style = parseStyle("{}");
    ASSERT_EQ(style.looks.size(), 1U);
    EXPECT_TRUE(style.looks[0].effects.empty());
    EXPECT_FALSE(style.looks[0].color);
    EXPECT_FALSE(style.looks[0].textOpacity);
    EXPECT_TRUE(style.name.empty());
}

TEST(StyleReader, Name_StandsBeforeEveryFaultAndStaysWithTheStyle) {
    EXPECT_EQ(parseStyle("{}", "looks/a.json").name, "looks/a.json");
    for (const char* json : {"{", R"({"color": 1})", R"({"stroke": {"size": 1}})"}) {
        try {
            parseStyle(json, "looks/a.json");
            FAIL() << json << " was read";
        } catch (const StyleError& error) {
            EXPECT_EQ(error.what(), "style 'looks/a.json': " + faultOf(json));
        }
    }
}

TEST(StyleReader, StyleInsideADocument_IsReadFromItsValue) {
    const JsonDocument document(R"({"look": {"outerGlow": {"size": 3, "color": "#0000FF"}}})");
    const JsonObject around(document.root(), "", {"look"});
    const Style style = readStyle(around.value("look"));
    ASSERT_EQ(style.looks.at(0).effects.size(), 1U);
    EXPECT_EQ(std::get<OuterGlow>(style.looks[0].effects[0]).size, Length{3});
}

TEST(StyleReader, FillAndOpacity_AreTheTextsOwnElseTheStylesElseBlackAndOpaque) {
    EXPECT_EQ(fillOf(onlyLook("{}")), 0U);
    EXPECT_EQ(opacityOf(onlyLook("{}")), 1.0F);
    EXPECT_EQ(fillOf(onlyLook(R"({"color": "#010203"})")), 0x010203U);
    EXPECT_EQ(fillOf(onlyLook(R"({"text": {"color": "#040506"}})")), 0x040506U);
    EXPECT_EQ(opacityOf(onlyLook(R"({"textOpacity": 0.5})")), 0.5F);
}

TEST(StyleReader, TopLevelKeys_AreTheTextsDefaults) {
    const Style style = parseStyle(R"({"description": "d", "color": "#0A0b0C", "textOpacity": 0.25})");
    EXPECT_EQ(style.description, "d");
    EXPECT_EQ(style.looks[0].color, 0x0A0B0CU);
    EXPECT_EQ(style.looks[0].textOpacity, 0.25F);
}

TEST(StyleReader, Effects_KeepTheOrderOfTheFile) {
    const LookStyle look = onlyLook(R"({
        "text": {"color": "#000000"},
        "stroke": {"size": 1, "color": "#000000", "position": "center"},
        "bevel": {"size": 1, "angle": 0, "altitude": 0,
                  "highlightColor": "#000000", "shadowColor": "#000000"},
        "outerShadow": {"angle": 0, "distance": 0, "size": 0, "color": "#000000"}})");
    ASSERT_EQ(look.effects.size(), 4U);
    EXPECT_EQ(effectName(look.effects[0]), "text");
    EXPECT_EQ(effectName(look.effects[1]), "stroke");
    EXPECT_EQ(effectName(look.effects[2]), "bevel");
    EXPECT_EQ(effectName(look.effects[3]), "outerShadow");
}

TEST(StyleReader, OuterShadow_ReadsEveryArgument) {
    const auto shadow = only<OuterShadow>(
        R"({"outerShadow": {"angle": -45.5, "distance": 7, "size": 3, "color": "#123456", "opacity": 0.5}})");
    EXPECT_EQ(shadow.angle, -45.5F);
    EXPECT_EQ(shadow.distance, Length{7});
    EXPECT_EQ(shadow.size, Length{3});
    EXPECT_EQ(shadow.color, 0x123456U);
    EXPECT_EQ(shadow.opacity, 0.5F);
}

TEST(StyleReader, InnerShadow_WithoutOpacityIsOpaque) {
    const auto shadow = only<InnerShadow>(
        R"({"innerShadow": {"angle": 90, "distance": 100, "size": 0, "color": "#FFFFFF"}})");
    EXPECT_EQ(shadow.distance, Length{100});
    EXPECT_EQ(shadow.opacity, 1.0F);
}

TEST(StyleReader, GlowWithoutStops_HasItsColour) {
    const auto glow = only<OuterGlow>(R"({"outerGlow": {"size": 9, "color": "#FF0000"}})");
    EXPECT_EQ(glow.color, 0xFF0000U);
    EXPECT_TRUE(glow.gradient.empty());
}

TEST(StyleReader, GlowWithStops_NeedsNoColour) {
    const auto glow = only<InnerGlow>(
        R"({"innerGlow": {"size": 9, "gradient": [{"color": "#FF0000", "location": 0},
                                                  {"color": "#00FF00", "opacity": 0.5, "location": 1}]}})");
    ASSERT_EQ(glow.gradient.size(), 2U);
    EXPECT_EQ(glow.gradient[0].mColor, 0xFF0000U);
    EXPECT_EQ(glow.gradient[0].mOpacity, 1.0F);
    EXPECT_EQ(glow.gradient[1].mColor, 0x00FF00U);
    EXPECT_EQ(glow.gradient[1].mOpacity, 0.5F);
    EXPECT_EQ(glow.gradient[1].mLocation, 1.0F);
}

TEST(StyleReader, GlowWithNeither_IsRefused) {
    EXPECT_EQ(faultOf(R"({"outerGlow": {"size": 9}})"),
              "outerGlow.color: missing; a colour \"#RRGGBB\"");
}

TEST(StyleReader, Gradients_ReadAngleAndScale) {
    const auto linear = only<LinearGradient>(
        R"({"linearGradient": {"angle": 30, "scale": 0.5, "gradient": [{"color": "#010203", "location": 0.5}]}})");
    EXPECT_EQ(linear.angle, 30.0F);
    EXPECT_EQ(linear.scale, 0.5F);
    const auto radial = only<RadialGradient>(
        R"({"radialGradient": {"scale": 2, "gradient": [{"color": "#010203", "location": 0}]}})");
    EXPECT_EQ(radial.scale, 2.0F);
    EXPECT_EQ(radial.gradient.at(0).mColor, 0x010203U);
}

TEST(StyleReader, StrokePositions_BecomeTheLibrarysNumbers) {
    const auto positionOf = [](const std::string& name) {
        return only<Stroke>(R"({"stroke": {"size": 2, "color": "#000000", "position": ")" + name +
                            R"("}})")
            .position;
    };
    EXPECT_EQ(positionOf("center"), 0);
    EXPECT_EQ(positionOf("outside"), 1);
    EXPECT_EQ(positionOf("inside"), 2);
}

TEST(StyleReader, Pattern_KeepsItsPathUnopened) {
    const auto pattern = only<Pattern>(R"({"pattern": {"image": "no/such.png", "scale": 10}})");
    EXPECT_EQ(pattern.image, "no/such.png");
    EXPECT_EQ(pattern.scale, 10.0F);
}

TEST(StyleReader, PatternWithoutAUsableName_IsRefused) {
    EXPECT_EQ(faultOf(R"({"pattern": {"image": ""}})"), "pattern.image: must name a PNG file");
    EXPECT_EQ(faultOf(R"({"pattern": {"image": "a\u0000b.png"}})"),
              "pattern.image: has a NUL character in its name");
}

TEST(StyleReader, Relief_ReadsEveryArgument) {
    const auto emboss = only<Emboss>(
        R"({"emboss": {"style": 1, "size": 2, "depth": 3, "technique": 4, "direction": 5, "soften": 6,
                       "opacity": 0.1, "angle": 7, "altitude": 8, "highlightColor": "#000009",
                       "highlightOpacity": 0.2, "shadowColor": "#00000A", "shadowOpacity": 0.3}})");
    EXPECT_EQ(emboss.style, 1);
    EXPECT_EQ(emboss.size, Length{2});
    EXPECT_EQ(emboss.depth, 3.0F);
    EXPECT_EQ(emboss.technique, 4);
    EXPECT_EQ(emboss.direction, 5);
    EXPECT_EQ(emboss.soften, 6);
    EXPECT_EQ(emboss.opacity, 0.1F);
    EXPECT_EQ(emboss.angle, 7.0F);
    EXPECT_EQ(emboss.altitude, 8.0F);
    EXPECT_EQ(emboss.highlightColor, 9U);
    EXPECT_EQ(emboss.highlightOpacity, 0.2F);
    EXPECT_EQ(emboss.shadowColor, 10U);
    EXPECT_EQ(emboss.shadowOpacity, 0.3F);
}

TEST(StyleReader, UnknownEffect_IsNamed) {
    EXPECT_EQ(faultOf(R"({"outershadow": {}})")
                  .rfind("outershadow: unknown key; did you mean outerShadow? Known are ", 0),
              0U);
}

TEST(StyleReader, UnknownKeyBeyondAscii_IsEscaped) {
    EXPECT_EQ(faultOf("{\"\xC3\xA9\\n\": 1}").rfind("\\u00e9\\n: unknown key", 0), 0U);
}

TEST(StyleReader, EmptyKey_IsShownInItsQuotes) {
    EXPECT_EQ(faultOf(R"({"": 1})").rfind("\"\": unknown key; ", 0), 0U);
    EXPECT_EQ(faultOf(R"({"text": {"": 1}})").rfind("text.\"\": unknown key; ", 0), 0U);
}

TEST(StyleReader, UnknownArgument_IsNamedBeforeAMissingOne) {
    EXPECT_EQ(faultOf(R"({"text": {"colour": "#000000"}})"),
              "text.colour: unknown key; did you mean color? Known are color, opacity");
}

TEST(StyleReader, UnknownKeyOfAStop_IsNamedWithItsPlace) {
    const std::string fault = faultOf(
        R"({"radialGradient": {"gradient": [{"color": "#000000", "location": 0},
                                            {"color": "#000000", "position": 1}]}})");
    EXPECT_EQ(fault,
              "radialGradient.gradient[1].position: unknown key; known are color, opacity, location");
}

TEST(StyleReader, MissingArgument_IsNamed) {
    EXPECT_EQ(faultOf(R"({"outerShadow": {"angle": 1, "distance": 1, "color": "#000000"}})"),
              "outerShadow.size: missing; a number from 0 to 100");
    EXPECT_EQ(faultOf(R"({"linearGradient": {"angle": 1}})"),
              "linearGradient.gradient: missing; an array of 1 to 256 elements");
    EXPECT_EQ(faultOf(R"({"stroke": {"size": 1, "color": "#000000"}})"),
              "stroke.position: missing; one of center, outside, inside");
}

TEST(StyleReader, WrongTypes_AreNamed) {
    EXPECT_EQ(faultOf("[]"), "must be an object, not an array");
    EXPECT_EQ(faultOf("null"), "must be an object, not null");
    EXPECT_EQ(faultOf(R"({"stroke": 3})"), "stroke: must be an object, not a number");
    EXPECT_EQ(faultOf(R"({"textOpacity": "1"})"),
              "textOpacity: must be a number from 0 to 1, not a string");
    EXPECT_EQ(faultOf(R"({"description": 1})"), "description: must be a string, not a number");
    EXPECT_EQ(faultOf(R"({"color": 255})"), "color: must be a colour \"#RRGGBB\", not a number");
    EXPECT_EQ(faultOf(R"({"outerGlow": {"size": 1, "gradient": {}}})"),
              "outerGlow.gradient: must be an array of 1 to 256 elements, not an object");
    EXPECT_EQ(faultOf(R"({"outerGlow": {"size": true, "color": "#000000"}})"),
              "outerGlow.size: must be a number from 0 to 100, not a boolean");
    EXPECT_EQ(faultOf(R"({"pattern": {"image": null}})"), "pattern.image: must be a string, not null");
    EXPECT_EQ(faultOf(R"({"stroke": {"size": 1, "color": "#000000", "position": 1}})"),
              "stroke.position: must be one of center, outside, inside, not a number");
    EXPECT_EQ(faultOf(R"({"stroke": {"size": 1, "color": "#000000", "strokeStyle": []}})"),
              "stroke.strokeStyle: must be a whole number from 0 to 255, not an array");
}

TEST(StyleReader, NumbersOutOfRange_AreNamedWithTheRange) {
    EXPECT_EQ(faultOf(R"({"textOpacity": 1.5})"), "textOpacity: 1.5 is out of range, 0 to 1");
    EXPECT_EQ(faultOf(R"({"outerGlow": {"size": 101, "color": "#000000"}})"),
              "outerGlow.size: 101 is out of range, 0 to 100");
    EXPECT_EQ(
        faultOf(R"({"outerShadow": {"angle": 361, "distance": 0, "size": 0, "color": "#000000"}})"),
        "outerShadow.angle: 361 is out of range, -360 to 360");
    EXPECT_EQ(faultOf(R"({"pattern": {"image": "a", "scale": 0.05}})"),
              "pattern.scale: 0.05 is out of range, 0.1 to 10");
    EXPECT_EQ(faultOf(R"({"radialGradient": {"scale": 2.5, "gradient": []}})"),
              "radialGradient.scale: 2.5 is out of range, 0.1 to 2");
}

TEST(StyleReader, WholeNumbers_MayBeSpelledWithAPoint) {
    const auto stroke = only<Stroke>(
        R"({"stroke": {"size": 1, "color": "#000000", "strokeStyle": 7.0, "position": "inside"}})");
    EXPECT_EQ(stroke.strokeStyle, 7);
}

TEST(StyleReader, SchemaForEditors_IsReadPast) {
    EXPECT_EQ(faultOf(R"({"$schema": "vorelpaint-style.schema.json"})"), "");
    EXPECT_EQ(faultOf(R"({"$schema": 1})"), "$schema: must be a string, not a number");
}

TEST(StyleReader, WholeNumbers_RefuseFractions) {
    EXPECT_EQ(faultOf(R"({"stroke": {"size": 1, "color": "#000000", "strokeStyle": 1.5}})"),
              "stroke.strokeStyle: must be a whole number from 0 to 255, not 1.5");
    EXPECT_EQ(faultOf(R"({"stroke": {"size": 1, "color": "#000000", "strokeStyle": 1e30}})"),
              "stroke.strokeStyle: 1e+30 is out of range, 0 to 255");
}

TEST(StyleReader, StopCount_HasItsRange) {
    EXPECT_EQ(faultOf(R"({"radialGradient": {"gradient": []}})"),
              "radialGradient.gradient: has 0 elements, 1 to 256 are allowed");
    std::string stops;
    for (int i = 0; i < 257; ++i)
        stops += R"({"color": "#000000", "location": 1},)";
    stops.pop_back();
    EXPECT_EQ(faultOf(R"({"radialGradient": {"gradient": [)" + stops + "]}}"),
              "radialGradient.gradient: has 257 elements, 1 to 256 are allowed");
}

TEST(StyleReader, StopsThatStepBack_AreRefused) {
    EXPECT_EQ(faultOf(R"({"radialGradient": {"gradient": [{"color": "#000000", "location": 0.5},
                                                          {"color": "#000000", "location": 0.4}]}})"),
              "radialGradient.gradient[1].location: 0.4 lies before 0.5, the location of the stop that "
              "precedes it");
}

TEST(StyleReader, ShortColours_AreRead) {
    EXPECT_EQ(onlyLook(R"({"color": "#F80"})").color, 0xFF8800U);
}

TEST(StyleReader, BadColours_AreQuoted) {
    for (const char* colour :
         {"red", "#12", "#1234", "#12345", "#1234567", "#12345G", "123456", "#+12345", "# 12345", ""}) {
        EXPECT_EQ(faultOf(std::string(R"({"color": ")") + colour + R"("})"),
                  std::string("color: \"") + colour + "\" is no colour; write \"#RRGGBB\" or \"#RGB\"");
    }
}

TEST(StyleReader, LongValues_AreCutInMessages) {
    const std::string fault = faultOf(R"({"color": ")" + std::string(5000, 'x') + R"("})");
    EXPECT_LT(fault.size(), 120U);
    EXPECT_NE(fault.find("xxx..."), std::string::npos);
    EXPECT_LT(faultOf("{\"" + std::string(5000, 'x') + "\": 1}").size(), 300U);
}

TEST(StyleReader, BadPosition_ListsThePositions) {
    EXPECT_EQ(faultOf(R"({"stroke": {"size": 1, "color": "#000000", "position": "outer"}})"),
              "stroke.position: \"outer\" is none of center, outside, inside");
}

TEST(StyleReader, SyntaxError_NamesItsLine) {
    const std::string fault = faultOf("{\n  \"color\": \"#000000\",\n  oops\n}");
    EXPECT_EQ(fault.rfind("no valid JSON: line 3, column 3:", 0), 0U) << fault;
    EXPECT_EQ(faultOf("").rfind("no valid JSON: line 1, column 1:", 0), 0U);
}

TEST(StyleReader, InvalidUtf8AndHugeNumbers_AreNoValidJson) {
    EXPECT_EQ(faultOf("{\"color\": \"\xFF\"}").rfind("no valid JSON: ", 0), 0U);
}

TEST(StyleReader, KeyGivenTwice_IsRefused) {
    EXPECT_EQ(faultOf(R"({"color": "#000000", "color": "#FFFFFF"})"), "color: key given twice");
    EXPECT_EQ(faultOf(R"({"text": {"color": "#000000", "color": "#000000"}})"),
              "text.color: key given twice");
    EXPECT_EQ(faultOf(R"({"color": "#000000", "outerGlow": {"gradient": [{"location": 0}, 3, [{}],
                          {"color": "#000000", "location": 0, "color": "#FFFFFF"}]}})"),
              "outerGlow.gradient[3].color: key given twice");
    const std::string deep = std::string(50000, '[') + R"({"a": 1, "a": 2})";
    EXPECT_LT(faultOf(deep).size(), 200U);
}

TEST(StyleReader, SameKeyInTwoEffects_IsFine) {
    EXPECT_EQ(faultOf(R"({"outerGlow": {"size": 1, "color": "#000000"},
                          "innerGlow": {"size": 1, "color": "#000000"}})"),
              "");
}

TEST(StyleReader, ColourBesideATextFill_IsRefused) {
    EXPECT_EQ(faultOf(R"({"color": "#000000", "text": {"color": "#000000"}})"),
              "color: the fill has its colour in text.color already");
}

TEST(StyleReader, Version_IsTheFirstWhereNoneIsSaid) {
    EXPECT_EQ(parseStyle("{}").version, 1);
    EXPECT_EQ(parseStyle(R"({"version": 1})").version, 1);
    EXPECT_EQ(parseStyle(R"({"version": 2.0})").version, 2);
    EXPECT_EQ(faultOf(R"({"version": 0})"), "version: 0 is out of range, 1 to 2");
}

TEST(StyleReader, BadStyles_AreRefusedInOneLineWithTheirPath) {
    std::ifstream file(VOREL_REFUSED_STYLES);
    const std::string text((std::istreambuf_iterator<char>(file)), {});
    const JsonDocument document("{\"styles\": " + text + "}");
    const auto cases = JsonObject(document.root(), "", {"styles"}).array("styles", {1, 1000});
    EXPECT_GT(cases.size(), 30U);
    for (const JsonValue value : cases) {
        const JsonObject bad(value, "", {"refused", "style"});
        const std::string refused = bad.string("refused");
        try {
            readStyle(bad.value("style"));
            ADD_FAILURE() << "read, not refused: " << refused;
        } catch (const StyleError& error) {
            EXPECT_EQ(std::string(error.what()).substr(0, refused.size()), refused);
            EXPECT_EQ(std::string(error.what()).find('\n'), std::string::npos);
        }
    }
}

TEST(StyleReader, Looks_KeepTheOrderOfTheFile) {
    const Style style = parseStyle(R"({"version": 2, "$schema": "s", "description": "both", "looks": [
        {"description": "low", "color": "#000001"},
        {"textOpacity": 0.5, "outerGlow": {"size": "3%", "color": "#000000"}}]})");
    EXPECT_TRUE(style.isList);
    EXPECT_EQ(style.description, "both");
    ASSERT_EQ(style.looks.size(), 2U);
    EXPECT_EQ(style.looks[0].description, "low");
    EXPECT_EQ(style.looks[0].color, 1U);
    EXPECT_EQ(style.looks[1].description, "");
    EXPECT_EQ(style.looks[1].textOpacity, 0.5F);
    EXPECT_EQ(std::get<OuterGlow>(style.looks[1].effects.at(0)).size,
              (Length{3, Length::Unit::percent}));
}

TEST(StyleReader, LookOfAFileWithoutAList_LeavesTheDescriptionToTheFile) {
    const Style style = parseStyle(R"({"version": 2, "description": "d"})");
    EXPECT_FALSE(style.isList);
    EXPECT_EQ(style.description, "d");
    EXPECT_EQ(style.looks.at(0).description, "");
}

TEST(StyleReader, ThirtyTwoLooks_AreTheMost) {
    const auto withLooks = [](int count) {
        std::string looks = "{}";
        for (int i = 1; i < count; ++i)
            looks += ", {}";
        return R"({"version": 2, "looks": [)" + looks + "]}";
    };
    EXPECT_EQ(parseStyle(withLooks(32)).looks.size(), 32U);
    EXPECT_EQ(faultOf(withLooks(33)), "looks: has 33 elements, 1 to 32 are allowed");
    EXPECT_EQ(faultOf(withLooks(1000)), "looks: has 1000 elements, 1 to 32 are allowed");
}

TEST(StyleReader, LookKeys_HaveTheirDefaults) {
    for (const char* json : {R"({"version": 2})", R"({"version": 2, "offset": {}})",
                             R"({"version": 2, "looks": [{"fill": true, "span": "block"}]})"}) {
        const LookStyle look = onlyLook(json);
        EXPECT_TRUE(look.isFilled);
        EXPECT_EQ(look.offsetX, Length{});
        EXPECT_EQ(look.offsetY, Length{});
        EXPECT_EQ(look.span, Span::block);
    }
}

TEST(StyleReader, LookKeys_AreRead) {
    const LookStyle look = onlyLook(
        R"({"version": 2, "fill": false, "span": "word", "offset": {"x": -1000, "y": "-12.5%"}})");
    EXPECT_FALSE(look.isFilled);
    EXPECT_EQ(look.offsetX, Length{-1000});
    EXPECT_EQ(look.offsetY, (Length{-12.5F, Length::Unit::percent}));
    EXPECT_EQ(look.span, Span::word);
    EXPECT_EQ(onlyLook(R"({"version": 2, "span": "line"})").span, Span::line);
    EXPECT_EQ(onlyLook(R"({"version": 2, "span": "glyph"})").span, Span::glyph);
}

TEST(StyleReader, LookWithoutFill_IsInvisibleText) {
    EXPECT_EQ(opacityOf(onlyLook(R"({"version": 2, "fill": false})")), 0.0F);
    EXPECT_EQ(opacityOf(onlyLook(R"({"version": 2, "fill": true, "textOpacity": 0.5})")), 0.5F);
}

TEST(StyleReader, TopFill_IsThatOfTheLastFilledLook) {
    const auto topOf = [](const std::string& looks) {
        return topFill(parseStyle(R"({"version": 2, "looks": [)" + looks + "]}"));
    };
    EXPECT_EQ(topOf("{}, {}"), 1U);
    EXPECT_EQ(topOf(R"({}, {}, {"fill": false})"), 1U);
    EXPECT_EQ(topOf(R"({}, {"textOpacity": 0})"), 1U) << "a caller may choose another opacity";
    EXPECT_EQ(topOf(R"({"fill": false})"), std::nullopt);
}

TEST(StyleReader, LengthsOfVersion2_AreNumbersOrStrings) {
    const auto sizeOf = [](const std::string& size) {
        return only<OuterGlow>(R"({"version": 2, "outerGlow": {"color": "#000000", "size": )" + size +
                               "}}")
            .size;
    };
    EXPECT_EQ(sizeOf("4"), Length{4});
    EXPECT_EQ(sizeOf("\"4px\""), Length{4});
    EXPECT_EQ(sizeOf("\"4%\""), (Length{4, Length::Unit::percent}));
    const auto shadow = only<InnerShadow>(
        R"({"version": 2, "innerShadow": {"angle": 0, "distance": "1%", "size": "2%", "color": "#000000"}})");
    EXPECT_EQ(shadow.distance, (Length{1, Length::Unit::percent}));
    EXPECT_EQ(shadow.size, (Length{2, Length::Unit::percent}));
    const auto stroke = only<Stroke>(
        R"({"version": 2, "stroke": {"size": "100%", "color": "#000000", "position": "inside"}})");
    EXPECT_EQ(stroke.size, (Length{100, Length::Unit::percent}));
}

TEST(StyleReader, LengthsOfVersion1_AreNumbers) {
    const auto faultOfSize = [](const std::string& size) {
        return faultOf(R"({"outerGlow": {"color": "#000000", "size": )" + size + "}}");
    };
    EXPECT_EQ(faultOfSize("\"4px\""), "outerGlow.size: needs \"version\": 2");
    EXPECT_EQ(faultOfSize("\"x\""), "outerGlow.size: must be a number from 0 to 100, not a string");
    EXPECT_EQ(faultOf(R"({"outerGlow": {"color": "#000000"}})"),
              "outerGlow.size: missing; a number from 0 to 100");
}

TEST(StyleReader, WidthOfATile_StandsInsteadOfTheScale) {
    const auto pattern =
        only<Pattern>(R"({"version": 2, "pattern": {"image": "a.png", "width": "12.5%"}})");
    EXPECT_EQ(pattern.width, (Length{12.5F, Length::Unit::percent}));
    EXPECT_FALSE(only<Pattern>(R"({"version": 2, "pattern": {"image": "a.png"}})").width);
}

TEST(StyleReader, DeepNesting_IsRefusedWithoutHarm) {
    const std::string deep = "{\"text\": " + std::string(50000, '[') + std::string(50000, ']') + "}";
    EXPECT_EQ(faultOf(deep), "text: must be an object, not an array");
}

}  // namespace
}  // namespace vorelstyle
