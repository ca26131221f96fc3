#include "style/json_object.h"

#include <gtest/gtest.h>

#include <string>

#include "style/error.h"

namespace vorelstyle {
namespace {

TEST(JsonObject, Keys_KeepTheOrderOfTheText) {
    const JsonDocument document(R"({"b": 1, "a": {"c": 2}})");
    const JsonObject object(document.root(), "", {"a", "b"});
    EXPECT_EQ(object.keys(), (std::vector<std::string_view>{"b", "a"}));
    EXPECT_TRUE(object.value("a").isObject());
    EXPECT_FALSE(object.value("b").isObject());
}

TEST(JsonObject, Numeral_IsSpelledShortest) {
    const JsonDocument document(R"({"a": 1.50, "b": 3, "c": -96.0, "d": 1e3, "e": 1e300})");
    const JsonObject object(document.root(), "", {"a", "b", "c", "d", "e"});
    EXPECT_EQ(object.numeral("a"), "1.5");
    EXPECT_EQ(object.numeral("b"), "3");
    EXPECT_EQ(object.numeral("c"), "-96");
    EXPECT_EQ(object.numeral("d"), "1000");
    EXPECT_EQ(object.numeral("e"), "1e+300");
}

/// The message with which a text is refused.
std::string faultOfText(const std::string& text) {
    try {
        const JsonDocument document(text);
        return "";
    } catch (const StyleError& error) {
        return error.what();
    }
}

TEST(JsonDocument, NumberTooLarge_IsRefusedWithItsPath) {
    const std::string fault = "number overflow parsing '1e999'";
    EXPECT_EQ(faultOfText("1e999"), fault);
    EXPECT_EQ(faultOfText(R"({"a": 1e999})"), "a: " + fault);
    EXPECT_EQ(faultOfText(R"([1, {}, 1e999])"), "[2]: " + fault);
    EXPECT_EQ(faultOfText(R"({"a": {"b": [0]}, "c": [{"d": [[], 5, 1e999]}]})"), "c[0].d[2]: " + fault);
}

TEST(JsonObject, Array_GivesItsElements) {
    const JsonDocument document(R"({"a": [1, "x", {}]})");
    const JsonObject object(document.root(), "", {"a"});
    const std::vector<JsonValue> elements = object.array("a", {1, 3});
    ASSERT_EQ(elements.size(), 3U);
    EXPECT_EQ(elements[1].quoted(), "\"x\"");
    EXPECT_TRUE(elements[2].isObject());
    EXPECT_THROW(object.array("a", {1, 2}), StyleError);
}

TEST(JsonObject, Boolean_IsTrueOrFalse) {
    const JsonDocument document(R"({"a": true, "b": false, "c": 1})");
    const JsonObject object(document.root(), "", {"a", "b", "c"});
    EXPECT_TRUE(object.boolean("a"));
    EXPECT_FALSE(object.boolean("b", true));
    EXPECT_TRUE(object.boolean("d", true));
    EXPECT_THROW(object.boolean("c"), StyleError);
    EXPECT_THROW(object.boolean("d"), StyleError);
}

TEST(JsonObject, Choice_HasAFallback) {
    const JsonDocument document(R"({"a": "x"})");
    const JsonObject object(document.root(), "", {"a"});
    EXPECT_EQ(object.choice("a", {"w", "x"}, 0), 1);
    EXPECT_EQ(object.choice("b", {"w", "x"}, 0), 0);
    EXPECT_THROW(object.choice("b", {"w", "x"}), StyleError);
}

constexpr LengthRange kSizes{{0, 100}, {0, 50}};
constexpr LengthRange kOffsets{{-100, 100}, {-50, 50}};

/// The message with which the value, spelled as JSON, is refused as a length.
std::string faultOf(const std::string& value, const LengthRange& range) {
    const JsonDocument document("{\"a\": " + value + "}");
    try {
        JsonObject(document.root(), "b", {"a"}).length("a", range);
        return "";
    } catch (const StyleError& error) {
        return error.what();
    }
}

TEST(JsonObject, Length_IsANumberOrAString) {
    const JsonDocument document(R"({"a": 2.5, "b": "2.5px", "c": "-2.5%"})");
    const JsonObject object(document.root(), "", {"a", "b", "c"});
    EXPECT_EQ(object.length("a", kSizes), Length{2.5F});
    EXPECT_EQ(object.length("b", kSizes), Length{2.5F});
    EXPECT_EQ(object.length("c", kOffsets), (Length{-2.5F, Length::Unit::percent}));
    EXPECT_EQ(object.length("d", kSizes, Length{7}), Length{7});
}

TEST(JsonObject, LengthOutOfRange_IsRefusedInItsUnit) {
    EXPECT_EQ(faultOf("101", kSizes), "b.a: 101 is out of range, 0 to 100");
    EXPECT_EQ(faultOf("\"101px\"", kSizes), "b.a: \"101px\" is out of range, 0px to 100px");
    EXPECT_EQ(faultOf("\"51%\"", kSizes), "b.a: \"51%\" is out of range, 0% to 50%");
    EXPECT_EQ(faultOf("\"-51%\"", kOffsets), "b.a: \"-51%\" is out of range, -50% to 50%");
    EXPECT_EQ(faultOf("\"100px\"", kSizes), "");
    EXPECT_EQ(faultOf("\"-50%\"", kOffsets), "");
}

TEST(JsonObject, WrongLength_IsToldWhatMayStandThere) {
    const std::string sizes =
        "a length from 0 to 100 pixels, as 4 or \"4px\", or from 0% to 50% of the font's size, as "
        "\"4%\"";
    EXPECT_EQ(faultOf("true", kSizes), "b.a: must be " + sizes + ", not a boolean");
    EXPECT_EQ(faultOf("\"4em\"", kSizes), "b.a: must be " + sizes + ", not \"4em\"");
    EXPECT_EQ(faultOf("\"\"", kSizes), "b.a: must be " + sizes + ", not \"\"");
    EXPECT_EQ(faultOf("\"-0px\"", kSizes), "b.a: must be " + sizes + ", not \"-0px\"");
    const JsonDocument document("{}");
    try {
        JsonObject(document.root(), "", {}).length("a", kSizes);
        FAIL() << "read";
    } catch (const StyleError& error) {
        EXPECT_EQ(error.what(), "a: missing; " + sizes);
    }
}

}  // namespace
}  // namespace vorelstyle
