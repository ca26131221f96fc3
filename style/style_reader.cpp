#include <algorithm>

#include "style/effect_reader.h"
#include "style/error.h"
#include "style/json_object.h"
#include "style/message.h"
#include "style/style.h"

namespace vorelstyle {
namespace {

constexpr Range kUnit{0, 1};
constexpr Range kVersions{1, 2};
constexpr Range kLookCount{1, 32};
constexpr LengthRange kOffset{{-1000, 1000}, {-100, 100}};

/// The keys of a look that the first version of the format has not.
constexpr std::array<std::string_view, 3> kNewLookKeys{"fill", "offset", "span"};

std::vector<std::string_view> lookKeys() {
    std::vector<std::string_view> keys{"description", "color", "textOpacity"};
    keys.insert(keys.end(), kNewLookKeys.begin(), kNewLookKeys.end());
    const std::vector<std::string_view> effects = effectNames();
    keys.insert(keys.end(), effects.begin(), effects.end());
    return keys;
}

std::vector<std::string_view> fileKeys() {
    std::vector<std::string_view> keys{"$schema", "version", "looks"};
    const std::vector<std::string_view> others = lookKeys();
    keys.insert(keys.end(), others.begin(), others.end());
    return keys;
}

void readFill(const JsonObject& object, LookStyle& look) {
    look.isFilled = object.boolean("fill", true);
    for (const std::string_view key : {"color", "textOpacity", "text"}) {
        if (!look.isFilled && object.has(key)) object.fail(key, "not beside \"fill\": false");
    }
    if (object.has("color")) look.color = object.color("color");
    if (object.has("textOpacity")) look.textOpacity = object.number("textOpacity", kUnit);
}

void readOffset(const JsonObject& object, LookStyle& look) {
    if (!object.has("offset")) return;
    const JsonObject offset(object.value("offset"), object.pathOf("offset"), {"x", "y"});
    look.offsetX = offset.length("x", kOffset, Length{});
    look.offsetY = offset.length("y", kOffset, Length{});
}

Span readSpan(const JsonObject& object) {
    return static_cast<Span>(object.choice("span", {kSpanNames.begin(), kSpanNames.end()}, 0));
}

/// Reads what makes a look out of an object, which may have other keys, too.
LookStyle readLook(const JsonObject& object, int version) {
    for (const std::string_view key : kNewLookKeys)
        requireVersion2(object, key, version);
    LookStyle look;
    readFill(object, look);
    readOffset(object, look);
    look.span = readSpan(object);
    for (const std::string_view key : object.keys()) {
        if (isEffect(key)) look.effects.push_back(readEffect(object, key, version));
    }
    if (look.color && hasTextFill(look)) {
        object.fail("color", "the fill has its colour in " + object.pathOf("text") + ".color already");
    }
    return look;
}

std::vector<LookStyle> readLooks(const JsonObject& file, int version) {
    constexpr std::string_view kKey = "looks";
    requireVersion2(file, kKey, version);
    for (const std::string_view key : lookKeys()) {
        const bool isForeign = key != "description" && file.has(key);
        if (isForeign) file.fail(key, "not beside looks; it belongs into one of them");
    }
    std::vector<LookStyle> looks;
    for (const JsonValue element : file.array(kKey, kLookCount)) {
        const JsonObject object(element, file.pathOf(kKey) + "[" + std::to_string(looks.size()) + "]",
                                lookKeys());
        looks.push_back(readLook(object, version));
        if (object.has("description")) looks.back().description = object.string("description");
    }
    return looks;
}

}  // namespace

bool hasTextFill(const LookStyle& look) {
    return std::any_of(look.effects.begin(), look.effects.end(),
                       [](const Effect& effect) { return std::holds_alternative<TextFill>(effect); });
}

uint32_t fillOf(const LookStyle& look) {
    for (const Effect& effect : look.effects) {
        if (const auto* text = std::get_if<TextFill>(&effect)) return text->color;
    }
    return look.color.value_or(0);
}

float opacityOf(const LookStyle& look) {
    return look.isFilled ? look.textOpacity.value_or(1.0F) : 0.0F;
}

std::optional<size_t> topFill(const Style& style) {
    for (size_t i = style.looks.size(); i-- > 0;) {
        if (style.looks[i].isFilled) return i;
    }
    return std::nullopt;
}

std::string lookPath(const Style& style, size_t position) {
    const bool isOne = !style.isList && style.looks.size() == 1;
    return isOne ? "" : "looks[" + std::to_string(position) + "].";
}

Style parseStyle(std::string_view json, std::string_view name) {
    return withFaultsUnder(faultPrefix(name), [&] {
        Style style = readStyle(JsonDocument(json).root());
        style.name = name;
        return style;
    });
}

Style readStyle(JsonValue json) {
    const JsonObject file(json, "", fileKeys());
    Style style;
    style.version = file.integer("version", kVersions, 1);
    if (file.has("$schema")) file.string("$schema");  // for editors
    if (file.has("description")) style.description = file.string("description");
    style.isList = file.has("looks");
    if (style.isList) {
        style.looks = readLooks(file, style.version);
    } else {
        style.looks.front() = readLook(file, style.version);
    }
    return style;
}

}  // namespace vorelstyle
