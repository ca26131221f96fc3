#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "style/length.h"

namespace vorelstyle {

struct Range {
    double low;
    double high;
};

/// What a length may be in either unit.
struct LengthRange {
    Range pixels;
    Range percent;
};

/// A value in a JsonDocument, which must outlive it.
class JsonValue {
  public:
    bool isObject() const;
    bool isArray() const;
    bool isNumber() const;
    bool isString() const;
    std::string quoted() const;  ///< as JSON, in ASCII and short enough for a message

  private:
    friend class JsonDocument;
    friend class JsonObject;
    explicit JsonValue(const void* node) : mNode(node) {}

    const void* mNode;  ///< of a type that json_object.cpp alone knows: its header is slow to compile
};

/// A JSON text, parsed.
class JsonDocument {
  public:
    /// Throws StyleError with the line of a syntax error, or with the path of a key that stands twice in
    /// one object or of a number that is larger than any can be.
    explicit JsonDocument(std::string_view text);
    ~JsonDocument();
    JsonDocument(const JsonDocument&) = delete;
    JsonDocument& operator=(const JsonDocument&) = delete;

    JsonValue root() const;

  private:
    struct Tree;
    std::unique_ptr<const Tree> mTree;
};

/// One object of a document, read key by key. Every fault throws a StyleError that begins with the path
/// of the key and says what may stand there. A reader without a fallback refuses a missing key.
class JsonObject {
  public:
    /// Refuses a value that is not an object, and keys other than `known`.
    JsonObject(JsonValue value, std::string path, const std::vector<std::string_view>& known);

    std::vector<std::string_view> keys() const;  ///< in the order of the text
    bool has(std::string_view key) const;
    JsonValue value(std::string_view key) const;  ///< of a key that it has

    float number(std::string_view key, Range range, std::optional<float> fallback = {}) const;
    int integer(std::string_view key, Range range, std::optional<int> fallback = {}) const;
    uint32_t color(std::string_view key, std::optional<uint32_t> fallback = {}) const;
    bool boolean(std::string_view key, std::optional<bool> fallback = {}) const;
    std::string string(std::string_view key) const;

    /// A number of pixels, or a string that parseLength reads; a minus sign may stand in it only where
    /// the range goes below 0.
    Length length(std::string_view key, const LengthRange& range,
                  std::optional<Length> fallback = {}) const;

    /// A number as JSON spells it, a whole one without a fraction.
    std::string numeral(std::string_view key) const;

    /// The position of the key's value, a string, among `names`.
    int choice(std::string_view key, const std::vector<std::string_view>& names,
               std::optional<int> fallback = {}) const;

    /// The elements of an array of strings; their number lies within `sizes`.
    std::vector<std::string> strings(std::string_view key, Range sizes) const;

    /// The elements of an array; their number lies within `sizes`.
    std::vector<JsonValue> array(std::string_view key, Range sizes) const;

    std::string pathOf(std::string_view key) const;
    [[noreturn]] void fail(std::string_view key, const std::string& fault) const;

  private:
    JsonValue mObject;
    std::string mPath;
};

}  // namespace vorelstyle
