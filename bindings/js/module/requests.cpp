#include "requests.h"

#include <cmath>
#include <limits>
#include <utility>
#include <vector>

#include "style/vorelstyle.h"

namespace vorelscript {
namespace {

using vorelcompose::Limits;
using vorelcompose::Request;
using vorelstyle::JsonObject;
using vorelstyle::Range;

/// As many as a request may have of what has no bound of its own.
constexpr double kMostEntries = 1000;
constexpr double kMostFloat = std::numeric_limits<float>::max();

/// The limits as they are written: 0.05, and not the nearest float.
template <typename Number>
Range rangeOf(const Limits<Number>& limits) {
    const auto written = [](Number number) { return std::round(double(number) * 1e6) / 1e6; };
    return {written(limits.low), written(limits.high)};
}

int whole(const JsonObject& given, const char* key, const Limits<int>& limits, int usual) {
    return given.integer(key, rangeOf(limits), usual);
}

std::optional<int> wholeIfAny(const JsonObject& given, const char* key, const Limits<int>& limits) {
    if (!given.has(key)) return std::nullopt;
    return given.integer(key, rangeOf(limits));
}

std::optional<float> numberIfAny(const JsonObject& given, const char* key, const Limits<float>& limits) {
    if (!given.has(key)) return std::nullopt;
    return given.number(key, rangeOf(limits));
}

template <typename Words, typename Value>
Value word(const JsonObject& given, const char* key, const Words& words, Value usual) {
    std::vector<std::string_view> names;
    int usualAt = 0;
    for (const auto& [name, meaning] : words) {
        if (meaning == usual) usualAt = static_cast<int>(names.size());
        names.emplace_back(name);
    }
    return words[static_cast<size_t>(given.choice(key, names, usualAt))].second;
}

std::vector<voreltext::FontVariation> variationsOf(const JsonObject& given) {
    std::vector<voreltext::FontVariation> variations;
    if (!given.has("variations")) return variations;
    for (const vorelstyle::JsonValue& each : given.array("variations", {0, kMostEntries})) {
        const JsonObject variation(each, "variations", {"axis", "value"});
        std::string axis = variation.string("axis");
        if (axis.size() != 4) given.fail("variations", "'" + axis + "' is no axis of four letters");
        variations.push_back({std::move(axis), variation.number("value", {-kMostFloat, kMostFloat})});
    }
    return variations;
}

voreltext::CanvasRequest canvasOf(const JsonObject& given, const voreltext::CanvasRequest& usual) {
    return {wholeIfAny(given, "width", vorelcompose::kCanvasSide),
            wholeIfAny(given, "height", vorelcompose::kCanvasSide),
            word(given, "anchor", vorelcompose::kAnchors, usual.anchor),
            whole(given, "margin", vorelcompose::kMargin, usual.margin),
            whole(given, "padding", vorelcompose::kPadding, usual.padding)};
}

/// What the looks of a style depend on.
void readColours(Request& request, const JsonObject& given) {
    request.size = whole(given, "size", vorelcompose::kFontSize, request.size);
    if (given.has("color")) request.color = given.color("color");
    request.opacity = numberIfAny(given, "opacity", vorelcompose::kOpacity);
    request.effectScale = numberIfAny(given, "effectScale", vorelcompose::kEffectScale).value_or(1.0F);
}

Request requestOf(const JsonObject& given) {
    Request request;
    request.fonts = given.strings("fonts", {1, double{vorelcompose::kMostFonts}});
    if (given.has("features")) request.features = given.strings("features", {0, kMostEntries});
    request.variations = variationsOf(given);
    readColours(request, given);
    request.align = word(given, "align", vorelcompose::kAligns, request.align);
    request.lineHeight = numberIfAny(given, "lineHeight", vorelcompose::kLineHeight).value_or(1.0F);
    const Range spacing = rangeOf(vorelcompose::kLetterSpacing);
    request.letterSpacing = given.length("letterSpacing", {spacing, spacing}, vorelstyle::Length{});
    request.canvas = canvasOf(given, request.canvas);
    request.fit = word(given, "fit", vorelcompose::kFits, request.fit);
    request.box = word(given, "box", vorelcompose::kBoxes, request.box);
    request.strict = given.boolean("strict", false);
    checkCanvas(request);
    return request;
}

std::string textOf(const JsonObject& given) {
    std::string text = given.string("text");
    if (text.size() > vorelcompose::kMaxTextBytes) {
        given.fail("text",
                   "longer than " + std::to_string(vorelcompose::kMaxTextBytes) + " bytes of UTF-8");
    }
    return text;
}

vorelcompose::Background backgroundOf(const JsonObject& given) {
    if (!given.has("background")) return {};
    const std::string name = given.string("background");
    const auto background = vorelcompose::parseBackground(name);
    if (!background) {
        given.fail("background", "'" + name + "' is none of transparent, checkerboard, #RRGGBB, #RGB");
    }
    return *background;
}

/// What `read` makes of the object that the text is.
template <typename Read>
auto readAs(std::string_view json, const std::vector<std::string_view>& keys, const Read& read) {
    try {
        const vorelstyle::JsonDocument document(json);
        return read(JsonObject(document.root(), "", keys));
    } catch (const vorelstyle::StyleError& error) {
        throw RequestError(error.what());
    }
}

}  // namespace

TextRequest textRequest(std::string_view json) {
    static const std::vector<std::string_view> kKeys{
        "text",          "markup",      "fonts",      "size",   "align",      "lineHeight",
        "letterSpacing", "features",    "color",      "width",  "variations", "premultiplied",
        "opacity",       "effectScale", "height",     "anchor", "margin",     "fit",
        "box",           "padding",     "background", "strict"};
    return readAs(json, kKeys, [](const JsonObject& given) {
        TextRequest request{requestOf(given), textOf(given), given.boolean("markup", false),
                            given.boolean("premultiplied", false), backgroundOf(given)};
        const bool hasBackground =
            request.background.kind != vorelcompose::Background::Kind::transparent;
        if (request.isPremultiplied && hasBackground)
            given.fail("premultiplied", "not beside a background");
        return request;
    });
}

SourceRequest sourceRequest(std::string_view json) {
    return readAs(json, {"name", "size", "color", "opacity", "effectScale"},
                  [](const JsonObject& given) {
                      SourceRequest source;
                      source.name = given.string("name");
                      readColours(source.request, given);
                      return source;
                  });
}

Request sizeRequest(int size, float effectScale) {
    Request request;
    const auto fail = [](const char* what, const std::string& limits) {
        throw RequestError(std::string(what) + limits);
    };
    if (!contains(vorelcompose::kFontSize, size))
        fail("size: no whole number from ", spelled(vorelcompose::kFontSize));
    if (!contains(vorelcompose::kEffectScale, effectScale))
        fail("effectScale: no number from ", spelled(vorelcompose::kEffectScale));
    request.size = size;
    request.effectScale = effectScale;
    return request;
}

}  // namespace vorelscript
