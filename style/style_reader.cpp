#include <algorithm>
#include <array>
#include <utility>

#include "style/error.h"
#include "style/json_object.h"
#include "style/message.h"
#include "style/style.h"

namespace vorelstyle {
namespace {

constexpr Range kUnit{0, 1};
constexpr Range kAngle{-360, 360};
constexpr Range kAltitude{0, 90};
constexpr Range kPixels{0, 100};
constexpr Range kStopCount{1, 256};
constexpr Range kCode{0, 255};
// The library draws nothing below a scale of 0.1.
constexpr Range kGradientScale{0.1, 2};
constexpr Range kPatternScale{0.1, 10};
constexpr Range kDepth{0, 10};
constexpr Range kSoften{0, 16};

Stops readStops(const JsonObject& effect) {
    constexpr std::string_view kKey = "gradient";
    Stops stops;
    std::string spelledBefore;
    for (const JsonValue element : effect.array(kKey, kStopCount)) {
        const std::string path = effect.pathOf(kKey) + "[" + std::to_string(stops.size()) + "]";
        const JsonObject stop(element, path, {"color", "opacity", "location"});
        const float location = stop.number("location", kUnit);
        if (!stops.empty() && location < stops.back().mLocation) {
            stop.fail("location", stop.value("location").quoted() + " lies before " + spelledBefore +
                                      ", the location of the stop that precedes it");
        }
        spelledBefore = stop.value("location").quoted();
        stops.push_back({stop.color("color"), stop.number("opacity", kUnit, 1.0F), location});
    }
    return stops;
}

Shadow readShadow(JsonValue value, const char* name) {
    const JsonObject effect(value, name, {"angle", "distance", "size", "color", "opacity"});
    return {effect.number("angle", kAngle), effect.number("distance", kPixels),
            effect.number("size", kPixels), effect.color("color"),
            effect.number("opacity", kUnit, 1.0F)};
}

/// A glow takes its colours from the stops where there are any, else from `color`.
Glow readGlow(JsonValue value, const char* name) {
    const JsonObject effect(value, name, {"size", "color", "opacity", "gradient"});
    const bool hasStops = effect.has("gradient");
    const std::optional<uint32_t> unused = hasStops ? std::optional<uint32_t>(0) : std::nullopt;
    return {effect.number("size", kPixels), effect.color("color", unused),
            effect.number("opacity", kUnit, 1.0F), hasStops ? readStops(effect) : Stops{}};
}

Relief readRelief(JsonValue value, const char* name) {
    const JsonObject effect(
        value, name,
        {"style", "size", "depth", "technique", "direction", "soften", "opacity", "angle", "altitude",
         "highlightColor", "highlightOpacity", "shadowColor", "shadowOpacity"});
    return {effect.integer("style", kCode, 0),
            effect.number("size", kPixels),
            effect.number("depth", kDepth, 1.0F),
            effect.integer("technique", kCode, 0),
            effect.integer("direction", kCode, 0),
            effect.integer("soften", kSoften, 0),
            effect.number("opacity", kUnit, 1.0F),
            effect.number("angle", kAngle),
            effect.number("altitude", kAltitude),
            effect.color("highlightColor"),
            effect.number("highlightOpacity", kUnit, 1.0F),
            effect.color("shadowColor"),
            effect.number("shadowOpacity", kUnit, 1.0F)};
}

Effect readLinearGradient(JsonValue value, const char* name) {
    const JsonObject effect(value, name, {"angle", "scale", "opacity", "gradient"});
    return LinearGradient{effect.number("angle", kAngle), effect.number("scale", kGradientScale, 1.0F),
                          effect.number("opacity", kUnit, 1.0F), readStops(effect)};
}

Effect readRadialGradient(JsonValue value, const char* name) {
    const JsonObject effect(value, name, {"scale", "opacity", "gradient"});
    return RadialGradient{effect.number("scale", kGradientScale, 1.0F),
                          effect.number("opacity", kUnit, 1.0F), readStops(effect)};
}

Effect readStroke(JsonValue value, const char* name) {
    const JsonObject effect(value, name, {"size", "color", "opacity", "strokeStyle", "position"});
    return Stroke{effect.number("size", kPixels), effect.color("color"),
                  effect.number("opacity", kUnit, 1.0F), effect.integer("strokeStyle", kCode, 0),
                  effect.choice("position", {"center", "outside", "inside"})};
}

Effect readPattern(JsonValue value, const char* name) {
    const JsonObject effect(value, name, {"image", "scale", "opacity"});
    const std::string image = effect.string("image");
    if (image.empty()) effect.fail("image", "must name a PNG file");
    if (image.find('\0') != std::string::npos) effect.fail("image", "has a NUL character in its name");
    return Pattern{image, effect.number("scale", kPatternScale, 1.0F),
                   effect.number("opacity", kUnit, 1.0F)};
}

Effect readTextFill(JsonValue value, const char* name) {
    const JsonObject effect(value, name, {"color", "opacity"});
    return TextFill{effect.color("color"), effect.number("opacity", kUnit, 1.0F)};
}

template <typename Kind, auto kRead>
Effect readAs(JsonValue value, const char* name) {
    return Kind{kRead(value, name)};
}

struct EffectKind {
    const char* name;
    int type;
    Effect (*read)(JsonValue value, const char* name);
};

/// The keys of a style file in the order of the alternatives of Effect.
constexpr std::array<EffectKind, std::variant_size_v<Effect>> kEffectKinds{{
    {"outerShadow", 1, readAs<OuterShadow, readShadow>},
    {"innerShadow", 2, readAs<InnerShadow, readShadow>},
    {"outerGlow", 3, readAs<OuterGlow, readGlow>},
    {"innerGlow", 4, readAs<InnerGlow, readGlow>},
    {"bevel", 5, readAs<Bevel, readRelief>},
    {"emboss", 6, readAs<Emboss, readRelief>},
    {"linearGradient", 7, readLinearGradient},
    {"radialGradient", 8, readRadialGradient},
    {"stroke", kStrokeType, readStroke},
    {"pattern", kPatternType, readPattern},
    {"text", kTextType, readTextFill},
}};

std::vector<std::string_view> knownKeys() {
    std::vector<std::string_view> keys{"$schema", "description", "color", "textOpacity"};
    for (const EffectKind& kind : kEffectKinds)
        keys.emplace_back(kind.name);
    return keys;
}

void refuseSecondFill(const Style& style) {
    if (style.color && hasTextFill(style)) {
        throw StyleError("color: the fill has its colour in text.color already");
    }
}

}  // namespace

std::string_view effectName(const Effect& effect) {
    return kEffectKinds[effect.index()].name;
}

int effectType(const Effect& effect) {
    return kEffectKinds[effect.index()].type;
}

std::string_view effectName(int type) {
    const auto* kind = std::find_if(kEffectKinds.begin(), kEffectKinds.end(),
                                    [=](const EffectKind& each) { return each.type == type; });
    return kind == kEffectKinds.end() ? "" : kind->name;
}

bool hasTextFill(const Style& style) {
    return std::any_of(style.effects.begin(), style.effects.end(),
                       [](const Effect& effect) { return std::holds_alternative<TextFill>(effect); });
}

uint32_t fillOf(const Style& style) {
    for (const Effect& effect : style.effects) {
        if (const auto* text = std::get_if<TextFill>(&effect)) return text->color;
    }
    return style.color.value_or(0);
}

float opacityOf(const Style& style) {
    return style.textOpacity.value_or(1.0F);
}

Style parseStyle(std::string_view json, std::string_view name) {
    try {
        Style style = readStyle(JsonDocument(json).root());
        style.name = name;
        return style;
    } catch (const StyleError& error) {
        throw StyleError(faultPrefix(name) + error.what());
    }
}

Style readStyle(JsonValue json) {
    const JsonObject file(json, "", knownKeys());
    Style style;
    if (file.has("$schema")) file.string("$schema");  // for editors
    if (file.has("description")) style.description = file.string("description");
    if (file.has("color")) style.color = file.color("color");
    if (file.has("textOpacity")) style.textOpacity = file.number("textOpacity", kUnit);
    for (const std::string_view key : file.keys()) {
        for (const EffectKind& kind : kEffectKinds) {
            if (key == kind.name) style.effects.push_back(kind.read(file.value(key), kind.name));
        }
    }
    refuseSecondFill(style);
    return style;
}

}  // namespace vorelstyle
