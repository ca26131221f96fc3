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
    const JsonDocument document(R"({"a": 1.50, "b": 3})");
    const JsonObject object(document.root(), "", {"a", "b"});
    EXPECT_EQ(object.numeral("a"), "1.5");
    EXPECT_EQ(object.numeral("b"), "3");
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

}  // namespace
}  // namespace vorelstyle
