#include "look_states.h"

#include <array>
#include <limits>
#include <string>
#include <unordered_map>
#include <variant>

namespace vorelscript {
namespace {

using vorelstyle::Effect;
using vorelstyle::JsonObject;
using vorelstyle::JsonValue;
using vorelstyle::LookStyle;
using vorelstyle::Range;
using vorelstyle::Stops;
using Keys = std::vector<std::string_view>;

/// In the order of the numbers that styles have for them.
constexpr std::array<std::string_view, 3> kPositions{"centre", "outside", "inside"};

/// What a look holds is in range already, or is made so by the library.
constexpr Range kAny{-double{std::numeric_limits<float>::max()}, std::numeric_limits<float>::max()};
constexpr Range kColours{0, 0xFFFFFF};
constexpr Range kStopCounts{0, 256};
constexpr Range kLookCounts{0, 1000};
constexpr Range kEffectCounts{0, 16};

int numberOf(uint32_t colour) {
    return static_cast<int>(colour);
}

uint32_t colourIn(const JsonObject& object, const char* key) {
    return static_cast<uint32_t>(object.integer(key, kColours));
}

/// Writes the members of an effect.
class EffectWriter {
  public:
    EffectWriter(JsonWriter& json, const vorelstyle::LoadImage& load, std::vector<uint8_t>& pixels)
        : mJson(json), mLoad(load), mPixels(pixels) {}

    void operator()(const vorelstyle::Shadow& e) const {
        mJson.entry("color", numberOf(e.color))
            .entry("angle", e.angle)
            .entry("distance", e.distance.value)
            .entry("size", e.size.value)
            .entry("opacity", e.opacity);
    }
    void operator()(const vorelstyle::Glow& e) const {
        mJson.entry("size", e.size.value).entry("color", numberOf(e.color)).entry("opacity", e.opacity);
        writeStops(e.gradient);
    }
    void operator()(const vorelstyle::LinearGradient& e) const {
        mJson.entry("angle", e.angle).entry("scale", e.scale).entry("opacity", e.opacity);
        writeStops(e.gradient);
    }
    void operator()(const vorelstyle::RadialGradient& e) const {
        mJson.entry("scale", e.scale).entry("opacity", e.opacity);
        writeStops(e.gradient);
    }
    void operator()(const vorelstyle::Stroke& e) const {
        mJson.entry("size", e.size.value)
            .entry("color", numberOf(e.color))
            .entry("opacity", e.opacity)
            .entry("position", kPositions[static_cast<size_t>(e.position)]);
    }
    void operator()(const vorelstyle::Pattern& e) const {
        if (!mLoad) throw vorelstyle::StyleError("pattern.image: " + e.image + " is not at hand");
        const vorelstyle::PatternImage image = mLoad(e.image);
        mJson.entry("width", image.width)
            .entry("height", image.height)
            .entry("at", mPixels.size())
            .entry("scale", patternScale(e, image, [](const std::string&) {}))
            .entry("opacity", e.opacity);
        mPixels.insert(mPixels.end(), image.pixels.begin(), image.pixels.end());
    }
    void operator()(const vorelstyle::TextFill& /*fill*/) const {}
    void operator()(const vorelstyle::Relief& /*relief*/) const {
        throw vorelstyle::StyleError("the library has no core for bevel and emboss");
    }

  private:
    void writeStops(const Stops& stops) const {
        mJson.key("stops").beginArray();
        for (const auto& stop : stops) {
            mJson.beginObject()
                .entry("color", numberOf(stop.mColor))
                .entry("place", stop.mLocation)
                .entry("opacity", stop.mOpacity)
                .endObject();
        }
        mJson.endArray();
    }

    JsonWriter& mJson;
    const vorelstyle::LoadImage& mLoad;
    std::vector<uint8_t>& mPixels;
};

float ownFillOpacityOf(const LookStyle& look) {
    for (const Effect& effect : look.effects) {
        if (const auto* fill = std::get_if<vorelstyle::TextFill>(&effect)) return fill->opacity;
    }
    return 1;
}

vorelstyle::Length pixelsIn(const JsonObject& object, const char* key) {
    return {object.number(key, kAny)};
}

Stops stopsIn(const JsonObject& object) {
    Stops stops;
    for (const JsonValue& each : object.array("stops", kStopCounts)) {
        const JsonObject stop(each, object.pathOf("stops"), {"color", "place", "opacity"});
        stops.push_back(
            {colourIn(stop, "color"), stop.number("opacity", kAny), stop.number("place", kAny)});
    }
    return stops;
}

template <typename Shadow>
Effect shadowIn(const JsonObject& object) {
    return Shadow{{object.number("angle", kAny), pixelsIn(object, "distance"), pixelsIn(object, "size"),
                   colourIn(object, "color"), object.number("opacity", kAny)}};
}

template <typename Glow>
Effect glowIn(const JsonObject& object) {
    return Glow{{pixelsIn(object, "size"), colourIn(object, "color"), object.number("opacity", kAny),
                 stopsIn(object)}};
}

Effect linearIn(const JsonObject& object) {
    return vorelstyle::LinearGradient{object.number("angle", kAny), object.number("scale", kAny),
                                      object.number("opacity", kAny), stopsIn(object)};
}

Effect radialIn(const JsonObject& object) {
    return vorelstyle::RadialGradient{object.number("scale", kAny), object.number("opacity", kAny),
                                      stopsIn(object)};
}

Effect strokeIn(const JsonObject& object) {
    const int position = object.choice("position", {kPositions.begin(), kPositions.end()});
    return vorelstyle::Stroke{pixelsIn(object, "size"), colourIn(object, "color"),
                              object.number("opacity", kAny), 0, position};
}

Effect patternIn(const JsonObject& object) {
    return vorelstyle::Pattern{
        object.string("image"), object.number("scale", kAny), object.number("opacity", kAny), {}};
}

Effect effectOf(const JsonValue& value, const std::string& path) {
    static const std::unordered_map<std::string, Effect (*)(const JsonObject&)> kinds{
        {"outerShadow", shadowIn<vorelstyle::OuterShadow>},
        {"innerShadow", shadowIn<vorelstyle::InnerShadow>},
        {"outerGlow", glowIn<vorelstyle::OuterGlow>},
        {"innerGlow", glowIn<vorelstyle::InnerGlow>},
        {"linearGradient", linearIn},
        {"radialGradient", radialIn},
        {"stroke", strokeIn},
        {"pattern", patternIn}};
    static const Keys kKeys{"kind",    "color", "angle", "distance", "size",
                            "opacity", "stops", "scale", "image",    "position"};
    const JsonObject object(value, path, kKeys);
    const auto kind = kinds.find(object.string("kind"));
    if (kind == kinds.end()) object.fail("kind", "is no effect");
    return kind->second(object);
}

LookStyle lookOf(const JsonObject& state) {
    LookStyle look;
    for (const JsonValue& each : state.array("effects", kEffectCounts))
        look.effects.push_back(effectOf(each, state.pathOf("effects")));
    look.isFilled = state.boolean("isFilled");
    if (!look.isFilled) return look;
    look.color = colourIn(state, "fill");
    look.textOpacity = state.number("textOpacity", kAny);
    const float fillOpacity = state.number("fillOpacity", kAny);
    if (fillOpacity < 1) look.effects.emplace_back(vorelstyle::TextFill{*look.color, fillOpacity});
    return look;
}

}  // namespace

void writeState(JsonWriter& json, const LookStyle& look, const vorelstyle::LoadImage& load,
                std::vector<uint8_t>& pixels) {
    json.beginObject()
        .entry("fill", numberOf(fillOf(look)))
        .entry("fillOpacity", ownFillOpacityOf(look))
        .entry("isFilled", look.isFilled)
        .entry("textOpacity", look.isFilled ? look.textOpacity.value_or(1.0F) : 1.0F);
    json.key("effects").beginArray();
    for (const Effect& effect : look.effects) {
        if (std::holds_alternative<vorelstyle::TextFill>(effect)) continue;
        json.beginObject().entry("kind", effectName(effect));
        std::visit(EffectWriter(json, load, pixels), effect);
        json.endObject();
    }
    json.endArray().endObject();
}

vorelstyle::Style styleOfStates(std::string_view json) {
    const vorelstyle::JsonDocument document("{\"looks\":" + std::string(json) + "}");
    const JsonObject root(document.root(), "", {"looks"});
    vorelstyle::Style style;
    style.version = 2;
    const std::vector<JsonValue> states = root.array("looks", kLookCounts);
    style.isList = states.size() > 1;
    if (!states.empty()) style.looks.clear();
    for (const JsonValue& each : states) {
        style.looks.push_back(lookOf(
            JsonObject(each, "looks", {"fill", "fillOpacity", "isFilled", "textOpacity", "effects"})));
    }
    return style;
}

}  // namespace vorelscript
