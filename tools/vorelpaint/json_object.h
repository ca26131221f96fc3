#pragma once

#include <cstdint>
#include <initializer_list>
#include <nlohmann/json.hpp>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace vorelpaint {

using Json = nlohmann::ordered_json;

struct Range {
    double low;
    double high;
};

/// Parses `text`. Throws StyleError with the line of a syntax error, or with the path of a key that
/// stands twice in one object.
Json parseJson(std::string_view text);

/// The value as JSON, in ASCII and short enough for a message.
std::string quoted(const Json& value);

/// One object of a style file or of a batch, read key by key. Every fault throws a StyleError that
/// begins with the path of the key and says what may stand there. A reader without a fallback refuses a
/// missing key.
class JsonObject {
  public:
    /// Refuses a value that is not an object, and keys other than `known`.
    JsonObject(const Json& value, std::string path, const std::vector<std::string_view>& known);

    bool has(std::string_view key) const { return mObject.contains(key); }
    float number(std::string_view key, Range range, std::optional<float> fallback = {}) const;
    int integer(std::string_view key, Range range, std::optional<int> fallback = {}) const;
    uint32_t color(std::string_view key, std::optional<uint32_t> fallback = {}) const;
    std::string string(std::string_view key) const;
    std::string numeral(std::string_view key) const;  ///< a number as JSON spells it

    /// The position of the key's value, a string, among `names`.
    int choice(std::string_view key, std::initializer_list<std::string_view> names) const;

    /// An array of `sizes` elements.
    const Json& array(std::string_view key, Range sizes) const;

    std::string pathOf(std::string_view key) const;
    [[noreturn]] void fail(std::string_view key, const std::string& fault) const;

  private:
    /// A test of a value's type, such as &Json::is_number.
    using TypeTest = bool (Json::*)() const noexcept;

    /// The key's value, of the tested type; null when it is missing and may be.
    const Json* find(std::string_view key, bool optional, TypeTest hasType,
                     const std::string& expected) const;

    const Json& mObject;
    std::string mPath;
};

}  // namespace vorelpaint
