#include "json_writer.h"

#include <gtest/gtest.h>

namespace vorelscript {
namespace {

TEST(JsonWriter, SeparatesWhatStandsInAList) {
    JsonWriter json;
    json.beginObject()
        .entry("a", 1)
        .key("b")
        .beginArray()
        .value(true)
        .value(-2)
        .beginObject()
        .endObject();
    json.endArray().entry("c", std::vector<std::string>{"x", "y"}).endObject();
    EXPECT_EQ(json.text(), R"({"a":1,"b":[true,-2,{}],"c":["x","y"]})");
}

TEST(JsonWriter, EscapesWhatEndsATextOrALine) {
    JsonWriter json;
    json.value("\"a\\\n\x1F\xC3\xA9");
    EXPECT_EQ(json.text(), "\"\\\"a\\\\\\u000a\\u001f\xC3\xA9\"");
}

TEST(JsonWriter, WritesNumbersThatAreReadAsTheSame) {
    JsonWriter json;
    json.beginArray().value(0.1F).value(0.1).value(size_t{7}).endArray();
    EXPECT_EQ(json.text(), "[0.1,0.1,7]");
}

}  // namespace
}  // namespace vorelscript
