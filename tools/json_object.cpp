#include "json_object.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <sstream>

#include "colour.h"
#include "style.h"

namespace vorelpaint {
namespace {

constexpr size_t kMaxQuoted = 40;

/// The value as JSON, in ASCII and short enough for a message.
std::string quoted(const Json& value) {
    std::string text = value.dump(-1, ' ', true);
    if (text.size() > kMaxQuoted) text.replace(kMaxQuoted, std::string::npos, "...");
    return text;
}

/// A key from a file as it may stand in a message: like a quoted value, without the quotes.
std::string escaped(const std::string& key) {
    const std::string text = Json(key).dump(-1, ' ', true);
    return text.substr(1, std::min(text.size() - 2, kMaxQuoted));
}

template <typename Names>
std::string joined(const Names& names) {
    std::string text;
    for (const std::string_view name : names)
        text.append(text.empty() ? "" : ", ").append(name);
    return text;
}

std::string withArticle(const Json& value) {
    std::string type = value.type_name();
    if (type == "null") return type;
    return (type == "object" || type == "array" ? "an " : "a ") + type;
}

std::string wrongType(const char* expected, const Json& value) {
    return std::string("must be ") + expected + ", not " + withArticle(value);
}

std::string outOfRange(const Json& value, Range range) {
    std::ostringstream text;
    text << quoted(value) << " is out of range, " << range.low << " to " << range.high;
    return text.str();
}

bool contains(Range range, double value) {
    return value >= range.low && value <= range.high;
}

/// Refuses a second key of the same name: the later one would silently replace the earlier.
class DuplicateKeys {
  public:
    bool operator()(int depth, Json::parse_event_t event, const Json& parsed) {
        const auto level = static_cast<size_t>(depth);
        if (event == Json::parse_event_t::object_start) {
            mKeys.resize(std::max(mKeys.size(), level + 2));
            mKeys[level + 1].clear();
        } else if (event == Json::parse_event_t::key) {
            const auto key = parsed.get<std::string>();
            if (!mKeys[level].insert(key).second) throw StyleError(quoted(parsed) + ": key given twice");
        }
        return true;
    }

  private:
    std::vector<std::set<std::string>> mKeys;  ///< by depth, of the object being read there
};

/// "[json.exception.parse_error.101] parse error at line 3, column 5: fault" without its preface.
std::string syntaxFault(const std::string& message) {
    const size_t line = message.find("line ");
    if (line != std::string::npos) return message.substr(line);
    const size_t bracket = message.find("] ");
    return bracket == std::string::npos ? message : message.substr(bracket + 2);
}

}  // namespace

Json parseJson(std::string_view text) {
    try {
        return Json::parse(text.begin(), text.end(), DuplicateKeys());
    } catch (const Json::exception& error) {
        throw StyleError("no valid JSON: " + syntaxFault(error.what()));
    }
}

JsonObject::JsonObject(const Json& value, std::string path, const std::vector<std::string_view>& known)
    : mObject(value), mPath(std::move(path)) {
    if (!value.is_object()) {
        throw StyleError((mPath.empty() ? "style" : mPath) + ": " + wrongType("an object", value));
    }
    for (const auto& item : value.items()) {
        if (std::find(known.begin(), known.end(), item.key()) != known.end()) continue;
        throw StyleError(pathOf(escaped(item.key())) + ": unknown key; known are " + joined(known));
    }
}

std::string JsonObject::pathOf(std::string_view key) const {
    return mPath + (mPath.empty() ? "" : ".") + std::string(key);
}

void JsonObject::fail(std::string_view key, const std::string& fault) const {
    throw StyleError(pathOf(key) + ": " + fault);
}

const Json* JsonObject::find(std::string_view key, bool optional) const {
    const auto found = mObject.find(key);
    if (found != mObject.end()) return &*found;
    if (!optional) fail(key, "missing");
    return nullptr;
}

float JsonObject::number(std::string_view key, Range range, std::optional<float> fallback) const {
    const Json* value = find(key, fallback.has_value());
    if (value == nullptr) return *fallback;
    if (!value->is_number()) fail(key, wrongType("a number", *value));
    if (!contains(range, value->get<double>())) fail(key, outOfRange(*value, range));
    return value->get<float>();
}

int JsonObject::integer(std::string_view key, Range range, std::optional<int> fallback) const {
    const Json* value = find(key, fallback.has_value());
    if (value == nullptr) return *fallback;
    if (!value->is_number()) fail(key, wrongType("a whole number", *value));
    if (!contains(range, value->get<double>())) fail(key, outOfRange(*value, range));
    if (!value->is_number_integer()) fail(key, quoted(*value) + " is no whole number");
    return value->get<int>();
}

uint32_t JsonObject::color(std::string_view key, std::optional<uint32_t> fallback) const {
    const Json* value = find(key, fallback.has_value());
    if (value == nullptr) return *fallback;
    if (!value->is_string()) fail(key, wrongType("a colour \"#RRGGBB\"", *value));
    const std::optional<uint32_t> colour = parseColour(value->get_ref<const std::string&>());
    if (!colour) fail(key, quoted(*value) + " is no colour; write \"#RRGGBB\"");
    return *colour;
}

std::string JsonObject::string(std::string_view key) const {
    const Json* value = find(key, false);
    if (!value->is_string()) fail(key, wrongType("a string", *value));
    return value->get<std::string>();
}

int JsonObject::choice(std::string_view key, std::initializer_list<std::string_view> names) const {
    const Json* value = find(key, false);
    if (!value->is_string()) fail(key, wrongType("a string", *value));
    const auto* found = std::find(names.begin(), names.end(), value->get_ref<const std::string&>());
    if (found == names.end()) fail(key, quoted(*value) + " is none of " + joined(names));
    return static_cast<int>(found - names.begin());
}

const Json& JsonObject::array(std::string_view key, Range sizes) const {
    const Json* value = find(key, false);
    if (!value->is_array()) fail(key, wrongType("an array", *value));
    if (!contains(sizes, static_cast<double>(value->size()))) {
        std::ostringstream fault;
        fault << "has " << value->size() << " elements, " << sizes.low << " to " << sizes.high
              << " are allowed";
        fail(key, fault.str());
    }
    return *value;
}

}  // namespace vorelpaint
