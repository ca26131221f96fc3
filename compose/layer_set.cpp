#include "compose/layer_set.h"

#include <algorithm>
#include <optional>
#include <string>
#include <utility>
#include <variant>

namespace vorelcompose {
namespace {

using vorelstyle::ColourRange;
using vorelstyle::Effect;
using vorelstyle::LookStyle;
using vorelstyle::Stack;
using vorelstyle::StackedLook;
using vorelstyle::Style;
using voreltext::Layer;

/// The rooms of styles and of text do not know each other; they count their spans alike.
voreltext::Span spanOf(vorelstyle::Span span) {
    switch (span) {
        case vorelstyle::Span::line:
            return voreltext::Span::line;
        case vorelstyle::Span::word:
            return voreltext::Span::word;
        case vorelstyle::Span::glyph:
            return voreltext::Span::glyph;
        default:
            return voreltext::Span::block;
    }
}

Layer layerOf(const StackedLook& stacked) {
    Layer layer{&stacked.look.effects()};
    layer.x = stacked.place.offsetX;
    layer.y = stacked.place.offsetY;
    layer.span = spanOf(stacked.place.span);
    return layer;
}

/// Whether an effect may leave nothing to be seen of the fill.
struct CoversFill {
    static bool isOpaque(float opacity, const vorelstyle::Stops& stops) {
        return opacity >= 1.0F && std::all_of(stops.begin(), stops.end(),
                                              [](const auto& stop) { return stop.mOpacity >= 1.0F; });
    }
    bool operator()(const vorelstyle::LinearGradient& e) const {
        return isOpaque(e.opacity, e.gradient);
    }
    bool operator()(const vorelstyle::RadialGradient& e) const {
        return isOpaque(e.opacity, e.gradient);
    }
    bool operator()(const vorelstyle::Pattern& e) const { return e.opacity >= 1.0F; }
    template <typename Other>
    bool operator()(const Other& /*effect*/) const {
        return false;
    }
};

/// Adds what the pictures hold that are loaded.
vorelstyle::LoadImage weighed(vorelstyle::LoadImage load, size_t& bytes) {
    return [load = std::move(load), &bytes](const std::string& name) {
        vorelstyle::PatternImage image = load(name);
        bytes += image.pixels.size();
        return image;
    };
}

/// The first effect of a look that covers its fill; empty when there is none.
std::string coverOf(const LookStyle& look) {
    const auto cover = std::find_if(look.effects.begin(), look.effects.end(), [](const Effect& effect) {
        return std::visit(CoversFill(), effect);
    });
    return cover == look.effects.end() ? "" : std::string(effectName(*cover));
}

}  // namespace

LayerSet::LayerSet(const Request& request, const Style& style, const vorelstyle::LoadImage& load,
                   int size, const std::vector<ColourRange>& colours, const Note& note)
    : mStyle(resolvedStyle(style, size, request.effectScale, note)),
      mStack(std::make_unique<Stack>(mStyle, request.color, request.opacity,
                                     weighed(load, mPictureBytes))) {
    for (const std::string& line : mStack->notes())
        note(line);
    for (const std::string& effect : mStack->unpainted())
        note("the library has no core for " + effect + "; it is not painted");
    for (const StackedLook& stacked : mStack->looks())
        mLayers.push_back(layerOf(stacked));
    addColours(request, colours, note);
}

/// The topmost filled look takes the colours of the markup, and the pictures of colour fonts lie on it;
/// where no look is filled, the pictures lie on the top.
void LayerSet::addColours(const Request& request, const std::vector<ColourRange>& colours,
                          const Note& note) {
    const std::optional<size_t> top = mStack->topFill();
    Layer& layer = top ? mLayers[*top] : mLayers.back();
    layer.takesPictures = true;
    if (!top) {
        if (!colours.empty()) note("no look is filled: the colours of the markup do not show");
        return;
    }
    const LookStyle& look = mStyle.looks[*top];
    layer.pictureOpacity = textPaintOf(mStyle, *top, request.color, request.opacity).opacity;
    if (!colours.empty() && !coverOf(look).empty()) {
        note("the look's " + coverOf(look) + " covers the colours of the markup");
    }
    layer.fillOpacity = mStack->looks()[*top].look.fillOpacity();
    for (const ColourRange& range : colours)
        layer.colours.push_back({range.begin, range.end, range.colour});
}

}  // namespace vorelcompose
