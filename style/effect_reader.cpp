#include "style/effect_reader.h"

#include <algorithm>
#include <array>
#include <utility>

namespace vorelstyle {
namespace {

constexpr Range kUnit{0, 1};
constexpr Range kAngle{-360, 360};
constexpr Range kAltitude{0, 90};
constexpr LengthRange kPixels{{0, 100}, {0, 100}};
constexpr LengthRange kTileWidth{{0.001, 1000}, {0.001, 1000}};
constexpr Range kStopCount{1, 256};
constexpr Range kCode{0, 255};
// The library draws nothing below a scale of 0.1.
constexpr Range kGradientScale{0.1, 2};
constexpr Range kPatternScale{0.1, 10};
constexpr Range kDepth{0, 10};
constexpr Range kSoften{0, 16};

/// One effect of a document, which the version of the format tells how to read.
struct Source {
    JsonValue value;
    std::string path;
    int version;
};

/// A length, which is a number of pixels in the first version.
Length readLength(const JsonObject& effect, std::string_view key, const LengthRange& range,
                  int version) {
    if (version > 1) return effect.length(key, range);
    if (effect.has(key) && effect.value(key).isString() && parseLength(effect.string(key))) {
        requireVersion2(effect, key, version);
    }
    return {effect.number(key, range.pixels)};
}

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

Shadow readShadow(const Source& source) {
    const JsonObject effect(source.value, source.path,
                            {"angle", "distance", "size", "color", "opacity"});
    return {effect.number("angle", kAngle), readLength(effect, "distance", kPixels, source.version),
            readLength(effect, "size", kPixels, source.version), effect.color("color"),
            effect.number("opacity", kUnit, 1.0F)};
}

/// A glow takes its colours from the stops where there are any, else from `color`.
Glow readGlow(const Source& source) {
    const JsonObject effect(source.value, source.path, {"size", "color", "opacity", "gradient"});
    const bool hasStops = effect.has("gradient");
    const std::optional<uint32_t> unused = hasStops ? std::optional<uint32_t>(0) : std::nullopt;
    return {readLength(effect, "size", kPixels, source.version), effect.color("color", unused),
            effect.number("opacity", kUnit, 1.0F), hasStops ? readStops(effect) : Stops{}};
}

Relief readRelief(const Source& source) {
    const JsonObject effect(
        source.value, source.path,
        {"style", "size", "depth", "technique", "direction", "soften", "opacity", "angle", "altitude",
         "highlightColor", "highlightOpacity", "shadowColor", "shadowOpacity"});
    return {effect.integer("style", kCode, 0),
            readLength(effect, "size", kPixels, source.version),
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

Effect readLinearGradient(const Source& source) {
    const JsonObject effect(source.value, source.path, {"angle", "scale", "opacity", "gradient"});
    return LinearGradient{effect.number("angle", kAngle), effect.number("scale", kGradientScale, 1.0F),
                          effect.number("opacity", kUnit, 1.0F), readStops(effect)};
}

Effect readRadialGradient(const Source& source) {
    const JsonObject effect(source.value, source.path, {"scale", "opacity", "gradient"});
    return RadialGradient{effect.number("scale", kGradientScale, 1.0F),
                          effect.number("opacity", kUnit, 1.0F), readStops(effect)};
}

Effect readStroke(const Source& source) {
    const JsonObject effect(source.value, source.path,
                            {"size", "color", "opacity", "strokeStyle", "position"});
    return Stroke{readLength(effect, "size", kPixels, source.version), effect.color("color"),
                  effect.number("opacity", kUnit, 1.0F), effect.integer("strokeStyle", kCode, 0),
                  effect.choice("position", {"center", "outside", "inside"})};
}

/// The width of a tile where the pattern has one instead of a scale.
std::optional<Length> readTileWidth(const JsonObject& effect, int version) {
    constexpr std::string_view kKey = "width";
    if (!effect.has(kKey)) return std::nullopt;
    requireVersion2(effect, kKey, version);
    if (effect.has("scale")) effect.fail(kKey, "not beside scale, which it stands for");
    return effect.length(kKey, kTileWidth);
}

Effect readPattern(const Source& source) {
    const JsonObject effect(source.value, source.path, {"image", "scale", "opacity", "width"});
    const std::string image = effect.string("image");
    if (image.empty()) effect.fail("image", "must name a PNG file");
    if (image.find('\0') != std::string::npos) effect.fail("image", "has a NUL character in its name");
    return Pattern{image, effect.number("scale", kPatternScale, 1.0F),
                   effect.number("opacity", kUnit, 1.0F), readTileWidth(effect, source.version)};
}

Effect readTextFill(const Source& source) {
    const JsonObject effect(source.value, source.path, {"color", "opacity"});
    return TextFill{effect.color("color"), effect.number("opacity", kUnit, 1.0F)};
}

template <typename Kind, auto kRead>
Effect readAs(const Source& source) {
    return Kind{kRead(source)};
}

struct EffectKind {
    const char* name;
    int type;
    Effect (*read)(const Source& source);
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

auto kindNamed(std::string_view name) {
    return std::find_if(kEffectKinds.begin(), kEffectKinds.end(),
                        [=](const EffectKind& each) { return each.name == name; });
}

}  // namespace

void requireVersion2(const JsonObject& object, std::string_view key, int version) {
    if (version < 2 && object.has(key)) object.fail(key, "needs \"version\": 2");
}

std::string_view effectName(const Effect& effect) {
    return kEffectKinds[effect.index()].name;
}

int effectType(const Effect& effect) {
    return kEffectKinds[effect.index()].type;
}

std::string_view effectName(int type) {
    const auto kind = std::find_if(kEffectKinds.begin(), kEffectKinds.end(),
                                   [=](const EffectKind& each) { return each.type == type; });
    return kind == kEffectKinds.end() ? "" : kind->name;
}

std::vector<std::string_view> effectNames() {
    std::vector<std::string_view> names;
    names.reserve(kEffectKinds.size());
    for (const EffectKind& kind : kEffectKinds)
        names.emplace_back(kind.name);
    return names;
}

bool isEffect(std::string_view name) {
    return kindNamed(name) != kEffectKinds.end();
}

Effect readEffect(const JsonObject& look, std::string_view name, int version) {
    return kindNamed(name)->read({look.value(name), look.pathOf(name), version});
}

}  // namespace vorelstyle
