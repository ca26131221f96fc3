#include "text/layer_painter.h"

#include <algorithm>
#include <cstdint>
#include <iterator>
#include <set>

#include "text/overlay.h"

namespace voreltext {
namespace {

using VFontEffect::VFEffect;

Image paintRun(VFEffect& effects, const LayerPart& part) {
    Run run(effects, part.frame);
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
std::vector<uint32_t> fillsShown(const LayerPart& part, const std::vector<uint32_t>& fills) {
    const Frame& frame = part.frame;
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

}  // namespace

LayerPainter::LayerPainter(const Layer& layer) : mLayer(layer), mEffects(*layer.effects) {}

LayerPart LayerPainter::part(const TextLayout& text, const std::vector<size_t>& glyphs) {
    LayerPart part{{}, {}, {{}, marginsOf(mEffects), faintEndOf(mEffects)}};
    for (const size_t i : glyphs) {
        part.masks.push_back(text.rasterise(i));
        part.clusters.push_back(text.glyph(i).cluster);
        part.frame.ink.grow(text.glyph(i).box);
    }
    return part;
}

Image LayerPainter::paint(const LayerPart& part) {
    return paintRun(mEffects, part);
}

/// One colour after the other: a text may have thousands.
void LayerPainter::colour(Image& picture, const LayerPart& part) const {
    std::vector<uint32_t> fills;
    fills.reserve(part.clusters.size());
    for (const size_t cluster : part.clusters)
        fills.push_back(fillAt(mLayer, cluster));
    std::set<uint32_t> colours(fills.begin(), fills.end());
    colours.erase(kOwnFill);
    if (colours.empty()) return;
    const std::vector<uint32_t> shown = fillsShown(part, fills);
    for (const uint32_t colour : colours) {
        const Image coloured = paintedIn(colour, part);
        for (size_t i = 0; i < shown.size(); ++i) {
            if (shown[i] == colour) std::copy_n(&coloured.pixels[i * 4], 4, &picture.pixels[i * 4]);
        }
    }
}

void LayerPainter::lay(const Image& picture, const LayerPart& part, Image& canvas,
                       const Canvas& place) const {
    layOver(canvas, picture, originX(place) - part.frame.shiftX(), originY(place) - part.frame.shiftY());
}

void LayerPainter::layPictures(const LayerPart& part, Image& canvas, const Canvas& place) const {
    if (!mLayer.takesPictures) return;
    for (const GlyphMask& mask : part.masks) {
        if (mask.pixels.empty()) continue;
        Image picture{mask.box.width(), mask.box.height(), mask.pixels};
        fade(picture, mLayer.pictureOpacity);
        layOver(canvas, picture, mask.box.left + originX(place), mask.box.top + originY(place));
    }
}

Image LayerPainter::paintedIn(uint32_t colour, const LayerPart& part) const {
    VFEffect effects(*mLayer.effects);
    effects.addText(colour, mLayer.fillOpacity);
    return paintRun(effects, part);
}

int LayerPainter::originX(const Canvas& place) const {
    return notTooFar(int64_t{place.x} + mLayer.x);
}

int LayerPainter::originY(const Canvas& place) const {
    return notTooFar(int64_t{place.y} + mLayer.y);
}

}  // namespace voreltext
