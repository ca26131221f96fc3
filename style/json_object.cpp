#include "style/json_object.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <nlohmann/json.hpp>
#include <set>
#include <utility>

#include "style/colour.h"
#include "style/error.h"
#include "style/message.h"
#include "style/nearest.h"
#include "unicode/decimal.h"

namespace vorelstyle {
namespace {

using Json = nlohmann::ordered_json;

/// A test of a value's type, such as &Json::is_number.
using TypeTest = bool (Json::*)() const noexcept;

constexpr size_t kMaxQuoted = 40;
constexpr size_t kMaxPath = 120;

/// Cut so that it fits into a message.
std::string shortened(std::string text, size_t maxSize) {
    if (text.size() > maxSize) text.replace(maxSize, std::string::npos, "...");
    return text;
}

/// As JSON, in ASCII and short enough for a message.
std::string quoted(const Json& value) {
    return shortened(value.dump(-1, ' ', true), kMaxQuoted);
}

/// A key from a file as it may stand in a message: like a quoted value, without the quotes unless
/// nothing stands between them.
std::string escaped(const std::string& key) {
    if (key.empty()) return "\"\"";
    const std::string text = Json(key).dump(-1, ' ', true);
    return text.substr(1, std::min(text.size() - 2, kMaxQuoted));
}

std::string under(const std::string& path, std::string_view key) {
    return path + (path.empty() ? "" : ".") + std::string(key);
}

std::string withArticle(const Json& value) {
    std::string type = value.type_name();
    if (type == "null") return type;
    return (type == "object" || type == "array" ? "an " : "a ") + type;
}

std::string wrongType(const std::string& expected, const Json& value) {
    return "must be " + expected + ", not " + withArticle(value);
}

/// "a number from 0 to 100" of the noun "a number from".
std::string between(const char* noun, Range range) {
    return noun + (' ' + vorelunicode::decimal(range.low)) + " to " + vorelunicode::decimal(range.high);
}

std::string withUnit(double value, const char* unit) {
    return vorelunicode::decimal(value) + unit;
}

/// 'a length from 0 to 100 pixels, as 4 or "4px", or from 0% to 100% of the font's size, as "4%"'.
std::string lengthBetween(const LengthRange& range) {
    return between("a length from", range.pixels) + " pixels, as 4 or \"4px\", or from " +
           withUnit(range.percent.low, "%") + " to " + withUnit(range.percent.high, "%") +
           " of the font's size, as \"4%\"";
}

std::string outOfRange(const Json& value, Range range) {
    return quoted(value) + between(" is out of range,", range);
}

bool contains(Range range, double value) {
    return value >= range.low && value <= range.high;
}

/// Follows the parser. Refuses a second key of the same name: the later one would silently replace the
/// earlier.
class ParserGuard {
  public:
    bool operator()(int depth, Json::parse_event_t event, const Json& parsed) {
        const auto level = static_cast<size_t>(depth);
        switch (event) {
            case Json::parse_event_t::object_start:
            case Json::parse_event_t::array_start:
                countElement(level);
                mLevels.resize(std::max(mLevels.size(), level + 2));
                mLevels[level + 1] = {};
                mLevel = level + 1;
                break;
            case Json::parse_event_t::object_end:
            case Json::parse_event_t::array_end:
                mLevel = level;
                break;
            case Json::parse_event_t::value:
                countElement(level);
                break;
            case Json::parse_event_t::key:
                addKey(level, parsed.get<std::string>());
                break;
            default:
                break;
        }
        return true;
    }

    /// The path of the value that comes next.
    std::string nextPath() const {
        if (mLevel == 0) return "";
        const Level& level = mLevels[mLevel];
        const std::string path = pathTo(mLevel);
        return shortened(level.keys.empty() ? path + "[" + std::to_string(level.elements) + "]"
                                            : under(path, escaped(level.key)),
                         kMaxPath);
    }

  private:
    /// An object or array that is being read.
    struct Level {
        std::set<std::string> keys;
        std::string key;      ///< the last one; arrays have none
        size_t elements = 0;  ///< values begun so far
    };

    void countElement(size_t level) { ++mLevels[level].elements; }

    void addKey(size_t level, const std::string& key) {
        if (!mLevels[level].keys.insert(key).second) {
            throw StyleError(shortened(under(pathTo(level), escaped(key)), kMaxPath) +
                             ": key given twice");
        }
        mLevels[level].key = key;
    }

    /// The path of the object at this depth; the root, at depth 1, has none.
    std::string pathTo(size_t level) const {
        std::string path;
        for (size_t i = 1; i < level && path.size() <= kMaxPath; ++i) {
            const Level& around = mLevels[i];
            if (around.keys.empty()) {
                path.append("[").append(std::to_string(around.elements - 1)).append("]");
            } else {
                path = under(path, escaped(around.key));
            }
        }
        return path;
    }

    std::vector<Level> mLevels = std::vector<Level>(1);  ///< by depth; the first holds the root
    size_t mLevel = 0;                                   ///< the innermost that is open
};

/// "[json.exception.parse_error.101] parse error at line 3, column 5: fault" without its preface.
std::string withoutPreface(const std::string& message, const char* preface) {
    const size_t at = message.find(preface);
    return at == std::string::npos ? message : message.substr(at);
}

Json parse(std::string_view text) {
    ParserGuard guard;
    try {
        return Json::parse(text.begin(), text.end(), std::ref(guard));
    } catch (const Json::parse_error& error) {
        throw StyleError("no valid JSON: " + withoutPreface(error.what(), "line "));
    } catch (const Json::out_of_range& error) {  // of a number, without its place
        const std::string path = guard.nextPath();
        throw StyleError((path.empty() ? "" : path + ": ") + withoutPreface(error.what(), "number "));
    }
}

const Json& nodeAt(const void* node) {
    return *static_cast<const Json*>(node);
}

/// The key's value in the node of `object`, of the tested type; null when it is missing and may be.
const Json* find(const JsonObject& object, const Json& node, std::string_view key, bool optional,
                 TypeTest hasType, const std::string& expected) {
    const auto found = node.find(key);
    if (found == node.end()) {
        if (!optional) object.fail(key, "missing; " + expected);
        return nullptr;
    }
    const Json& value = *found;
    if (!(value.*hasType)()) object.fail(key, wrongType(expected, value));
    return &value;
}

}  // namespace

struct JsonDocument::Tree {
    Json root;
};

JsonDocument::JsonDocument(std::string_view text) : mTree(new Tree{parse(text)}) {}

JsonDocument::~JsonDocument() = default;

JsonValue JsonDocument::root() const {
    return JsonValue(&mTree->root);
}

bool JsonValue::isObject() const {
    return nodeAt(mNode).is_object();
}

bool JsonValue::isString() const {
    return nodeAt(mNode).is_string();
}

bool JsonValue::isArray() const {
    return nodeAt(mNode).is_array();
}

bool JsonValue::isNumber() const {
    return nodeAt(mNode).is_number();
}

std::string JsonValue::quoted() const {
    return vorelstyle::quoted(nodeAt(mNode));
}

JsonObject::JsonObject(JsonValue value, std::string path, const std::vector<std::string_view>& known)
    : mObject(value), mPath(std::move(path)) {
    const Json& node = nodeAt(value.mNode);
    if (!node.is_object()) {
        throw StyleError((mPath.empty() ? "" : mPath + ": ") + wrongType("an object", node));
    }
    for (const auto& item : node.items()) {
        if (std::find(known.begin(), known.end(), item.key()) != known.end()) continue;
        throw StyleError(pathOf(escaped(item.key())) + ": unknown key" +
                         choices(item.key(), known, "known are"));
    }
}

std::vector<std::string_view> JsonObject::keys() const {
    std::vector<std::string_view> keys;
    for (const auto& item : nodeAt(mObject.mNode).items())
        keys.emplace_back(item.key());
    return keys;
}

bool JsonObject::has(std::string_view key) const {
    return nodeAt(mObject.mNode).contains(key);
}

JsonValue JsonObject::value(std::string_view key) const {
    return JsonValue(&*nodeAt(mObject.mNode).find(key));
}

std::string JsonObject::pathOf(std::string_view key) const {
    return under(mPath, key);
}

void JsonObject::fail(std::string_view key, const std::string& fault) const {
    throw StyleError(pathOf(key) + ": " + fault);
}

float JsonObject::number(std::string_view key, Range range, std::optional<float> fallback) const {
    const Json* value = find(*this, nodeAt(mObject.mNode), key, fallback.has_value(), &Json::is_number,
                             between("a number from", range));
    if (value == nullptr) return *fallback;
    if (!contains(range, value->get<double>())) fail(key, outOfRange(*value, range));
    return value->get<float>();
}

int JsonObject::integer(std::string_view key, Range range, std::optional<int> fallback) const {
    const std::string expected = between("a whole number from", range);
    const Json* value =
        find(*this, nodeAt(mObject.mNode), key, fallback.has_value(), &Json::is_number, expected);
    if (value == nullptr) return *fallback;
    const auto number = value->get<double>();
    if (!contains(range, number)) fail(key, outOfRange(*value, range));
    // JSON knows one kind of number: 1.0 is as whole as 1.
    if (number != std::trunc(number)) fail(key, "must be " + expected + ", not " + quoted(*value));
    return static_cast<int>(number);
}

uint32_t JsonObject::color(std::string_view key, std::optional<uint32_t> fallback) const {
    const Json* value = find(*this, nodeAt(mObject.mNode), key, fallback.has_value(), &Json::is_string,
                             "a colour \"#RRGGBB\"");
    if (value == nullptr) return *fallback;
    const std::optional<uint32_t> colour = parseColour(value->get_ref<const std::string&>());
    if (!colour) fail(key, quoted(*value) + " is no colour; write \"#RRGGBB\" or \"#RGB\"");
    return *colour;
}

bool JsonObject::boolean(std::string_view key, std::optional<bool> fallback) const {
    const Json* value = find(*this, nodeAt(mObject.mNode), key, fallback.has_value(), &Json::is_boolean,
                             "true or false");
    return value == nullptr ? *fallback : value->get<bool>();
}

Length JsonObject::length(std::string_view key, const LengthRange& range,
                          std::optional<Length> fallback) const {
    if (!has(key) && fallback) return *fallback;
    const std::string expected = lengthBetween(range);
    if (!has(key)) fail(key, "missing; " + expected);
    const Json& value = *nodeAt(mObject.mNode).find(key);
    if (value.is_number()) return {number(key, range.pixels)};
    if (!value.is_string()) fail(key, wrongType(expected, value));
    const auto& text = value.get_ref<const std::string&>();
    const std::optional<Length> length = parseLength(text);
    const bool hasWrongSign = range.pixels.low >= 0 && text.find('-') == 0;
    if (!length || hasWrongSign) fail(key, "must be " + expected + ", not " + quoted(value));
    const bool isShare = length->unit == Length::Unit::percent;
    const Range allowed = isShare ? range.percent : range.pixels;
    if (contains(allowed, static_cast<double>(length->value))) return *length;
    const char* unit = isShare ? "%" : "px";
    fail(key, quoted(value) + " is out of range, " + withUnit(allowed.low, unit) + " to " +
                  withUnit(allowed.high, unit));
}

std::string JsonObject::string(std::string_view key) const {
    return find(*this, nodeAt(mObject.mNode), key, false, &Json::is_string, "a string")
        ->get<std::string>();
}

std::string JsonObject::numeral(std::string_view key) const {
    const Json* value = find(*this, nodeAt(mObject.mNode), key, false, &Json::is_number, "a number");
    // JSON knows one kind of number: 96.0 is as whole as 96.
    constexpr double kMostWhole = 1e15;
    const auto number = value->get<double>();
    const bool isWhole = number == std::trunc(number) && std::abs(number) <= kMostWhole;
    return isWhole ? std::to_string(static_cast<int64_t>(number)) : value->dump();
}

int JsonObject::choice(std::string_view key, const std::vector<std::string_view>& names,
                       std::optional<int> fallback) const {
    const Json* value = find(*this, nodeAt(mObject.mNode), key, fallback.has_value(), &Json::is_string,
                             "one of " + joined(names));
    if (value == nullptr) return *fallback;
    const auto& given = value->get_ref<const std::string&>();
    const auto found = std::find(names.begin(), names.end(), given);
    if (found == names.end()) fail(key, quoted(*value) + " is " + noneOf(given, names));
    return static_cast<int>(found - names.begin());
}

std::vector<std::string> JsonObject::strings(std::string_view key, Range sizes) const {
    std::vector<std::string> strings;
    for (const JsonValue element : array(key, sizes)) {
        const Json& node = nodeAt(element.mNode);
        if (!node.is_string()) {
            fail(std::string(key) + "[" + std::to_string(strings.size()) + "]",
                 wrongType("a string", node));
        }
        strings.push_back(node.get<std::string>());
    }
    return strings;
}

std::vector<JsonValue> JsonObject::array(std::string_view key, Range sizes) const {
    const Json* value = find(*this, nodeAt(mObject.mNode), key, false, &Json::is_array,
                             between("an array of", sizes) + " elements");
    if (!contains(sizes, static_cast<double>(value->size()))) {
        fail(key, "has " + std::to_string(value->size()) + " elements" + between(",", sizes) +
                      " are allowed");
    }
    std::vector<JsonValue> elements;
    elements.reserve(value->size());
    for (const Json& element : *value)
        elements.push_back(JsonValue(&element));
    return elements;
}

}  // namespace vorelstyle
