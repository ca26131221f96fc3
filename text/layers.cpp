#include "text/layers.h"

#include <algorithm>
#include <iterator>
#include <map>
#include <set>
#include <utility>

#include "text/overlay.h"

namespace voreltext {
namespace {

using VFontEffect::VFEffect;

/// What one run paints.
struct Part {
    std::vector<GlyphMask> masks;
    std::vector<size_t> clusters;  ///< of each mask: where its characters begin in the text
    Box ink;
};

/// The place of a span in reading order: its line, and what the span counts within it.
std::pair<size_t, size_t> placeOf(const Glyph& glyph, Span span) {
    switch (span) {
        case Span::line:
            return {glyph.line, 0};
        case Span::word:
            return {glyph.line, glyph.word};
        case Span::glyph:
            return {glyph.line, glyph.cluster};
        default:
            return {0, 0};
    }
}

Part partOf(const TextLayout& text, const std::vector<size_t>& glyphs) {
    Part part;
    for (const size_t i : glyphs) {
        part.masks.push_back(text.rasterise(i));
        part.clusters.push_back(text.glyph(i).cluster);
        part.ink.grow(text.glyph(i).box);
    }
    return part;
}

Image paintRun(VFEffect& effects, const Part& part, const Frame& frame) {
    Run run(effects, frame);
    run.begin();
    for (const GlyphMask& mask : part.masks)
        run.draw(mask);
    effects.doEffectPostProcessing();
    run.merge();
    return run.picture();
}

/// An outer glow ends twice its pad, which is its size + 1, from the glyphs: its faint end lies beyond
/// the margins.
int faintEndOf(VFEffect& effects) {
    constexpr int kOuterGlowType = 3;
    VFontEffect::VFECore* const glow = effects.getEffect(kOuterGlowType);
    return glow == nullptr ? 0 : glow->getOffset() + 2;
}

constexpr uint32_t kOwnFill = 0xFFFFFFFF;  ///< that of the layer; no colour 0xRRGGBB

/// The colour of the fill of the characters at this place of the text.
uint32_t fillAt(const Layer& layer, size_t cluster) {
    const auto next = std::upper_bound(
        layer.colours.begin(), layer.colours.end(), cluster,
        [](size_t place, const ColouredPart& coloured) { return place < coloured.begin; });
    if (next == layer.colours.begin()) return kOwnFill;
    const ColouredPart& coloured = *std::prev(next);
    return cluster < coloured.end ? coloured.colour & 0xFFFFFF : kOwnFill;
}

/// For each pixel of a run's picture the fill of the last glyph that covers it.
std::vector<uint32_t> fillsShown(const Part& part, const std::vector<uint32_t>& fills,
                                 const Frame& frame) {
    const auto width = static_cast<size_t>(frame.width());
    std::vector<uint32_t> shown(width * static_cast<size_t>(frame.height()), kOwnFill);
    for (size_t i = 0; i < part.masks.size(); ++i) {
        const Box& box = part.masks[i].box;
        const uint8_t* coverage = part.masks[i].coverage.data();
        for (int y = box.top; y < box.bottom; ++y) {
            uint32_t* pixel = &shown[static_cast<size_t>(y + frame.shiftY()) * width +
                                     static_cast<size_t>(box.left + frame.shiftX())];
            for (int x = box.left; x < box.right; ++x, ++coverage, ++pixel) {
                if (*coverage != 0) *pixel = fills[i];
            }
        }
    }
    return shown;
}

/// Paints parts of the text in one layer.
class LayerPainter {
  public:
    explicit LayerPainter(const Layer& layer) : mLayer(layer), mEffects(*layer.effects) {}

    void paint(Image& canvas, const Canvas& place, const Part& part) {
        const Frame frame{part.ink, marginsOf(mEffects), faintEndOf(mEffects)};
        Image picture = paintRun(mEffects, part, frame);
        colour(picture, part, frame);
        const int x = notTooFar(int64_t{place.x} + mLayer.x);
        const int y = notTooFar(int64_t{place.y} + mLayer.y);
        layOver(canvas, picture, x - frame.shiftX(), y - frame.shiftY());
        if (!mLayer.takesPictures) return;
        for (const GlyphMask& mask : part.masks)
            layPicture(canvas, mask, x, y);
    }

  private:
    /// One colour after the other: a text may have thousands.
    void colour(Image& picture, const Part& part, const Frame& frame) const {
        std::vector<uint32_t> fills;
        fills.reserve(part.clusters.size());
        for (const size_t cluster : part.clusters)
            fills.push_back(fillAt(mLayer, cluster));
        std::set<uint32_t> colours(fills.begin(), fills.end());
        colours.erase(kOwnFill);
        if (colours.empty()) return;
        const std::vector<uint32_t> shown = fillsShown(part, fills, frame);
        for (const uint32_t colour : colours) {
            const Image coloured = paintedIn(colour, part, frame);
            for (size_t i = 0; i < shown.size(); ++i) {
                if (shown[i] == colour) std::copy_n(&coloured.pixels[i * 4], 4, &picture.pixels[i * 4]);
            }
        }
    }

    Image paintedIn(uint32_t colour, const Part& part, const Frame& frame) const {
        VFEffect effects(*mLayer.effects);
        effects.addText(colour, mLayer.fillOpacity);
        return paintRun(effects, part, frame);
    }

    void layPicture(Image& canvas, const GlyphMask& mask, int x, int y) const {
        if (mask.pixels.empty()) return;
        Image picture{mask.box.width(), mask.box.height(), mask.pixels};
        fade(picture, mLayer.pictureOpacity);
        layOver(canvas, picture, mask.box.left + x, mask.box.top + y);
    }

    const Layer& mLayer;
    /// Painting plans a set, and a planned one may paint in another order once its effects are changed:
    /// that of the layer is copied.
    VFEffect mEffects;
};

}  // namespace

std::vector<std::vector<size_t>> spansOf(const TextLayout& text, Span span) {
    std::map<std::pair<size_t, size_t>, std::vector<size_t>> places;
    for (size_t i = 0; i < text.glyphCount(); ++i)
        places[placeOf(text.glyph(i), span)].push_back(i);
    std::vector<std::vector<size_t>> spans;
    spans.reserve(places.size());
    for (auto& [place, glyphs] : places)
        spans.push_back(std::move(glyphs));
    return spans;
}

Margins marginsOf(const std::vector<Layer>& layers) {
    Margins most{0, 0, 0, 0};
    for (const Layer& layer : layers) {
        VFEffect effects(*layer.effects);
        const Margins own = marginsOf(effects);
        const int64_t x = layer.x;
        const int64_t y = layer.y;
        most = {std::max(most.left, notTooFar(own.left - x)), std::max(most.top, notTooFar(own.top - y)),
                std::max(most.right, notTooFar(own.right + x)),
                std::max(most.bottom, notTooFar(own.bottom + y))};
    }
    return most;
}

Image paint(const std::vector<Layer>& layers, const TextLayout& text, const Canvas& canvas) {
    Image image = transparentImage(canvas.width, canvas.height);
    for (const Layer& layer : layers) {
        LayerPainter painter(layer);
        for (const std::vector<size_t>& glyphs : spansOf(text, layer.span))
            painter.paint(image, canvas, partOf(text, glyphs));
    }
    return image;
}

}  // namespace voreltext
