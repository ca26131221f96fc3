#include "text/layers.h"

#include <algorithm>
#include <map>
#include <memory>
#include <new>
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

/// An outer glow ends twice its pad, which is its size + 1, from the glyphs: its faint end lies beyond the
/// margins.
int faintEndOf(VFEffect& effects) {
    constexpr int kOuterGlowType = 3;
    VFontEffect::VFECore* const glow = effects.getEffect(kOuterGlowType);
    return glow == nullptr ? 0 : glow->getOffset() + 2;
}

/// The effects that paint the characters at this place of the text.
const VFEffect* effectsAt(const Layer& layer, size_t cluster) {
    for (const Exchange& exchange : layer.exchanges) {
        if (cluster >= exchange.begin && cluster < exchange.end) return exchange.effects;
    }
    return layer.effects;
}

/// Takes the pixels that a glyph covers from another picture of the same frame.
void takeGlyph(Image& picture, const Image& other, const GlyphMask& mask, const Frame& frame) {
    const uint8_t* coverage = mask.coverage.data();
    for (int y = mask.box.top; y < mask.box.bottom; ++y) {
        for (int x = mask.box.left; x < mask.box.right; ++x, ++coverage) {
            if (*coverage == 0) continue;
            const size_t at = offsetOf(picture, x + frame.shiftX(), y + frame.shiftY());
            std::copy_n(&other.pixels[at], 4, &picture.pixels[at]);
        }
    }
}

/// Paints parts of the text in one layer.
class LayerPainter {
  public:
    explicit LayerPainter(const Layer& layer) : mLayer(layer) {
        copyOf(layer.effects);
        for (const Exchange& exchange : layer.exchanges)
            copyOf(exchange.effects);
    }

    void paint(Image& canvas, const Canvas& place, const Part& part) {
        VFEffect& effects = copyOf(mLayer.effects);
        const Frame frame{part.ink, marginsOf(effects), faintEndOf(effects)};
        Image picture = paintRun(effects, part, frame);
        exchangeGlyphs(picture, part, frame);
        const int x = place.x + mLayer.x;
        const int y = place.y + mLayer.y;
        layOver(canvas, picture, x - frame.shiftX(), y - frame.shiftY());
        if (!mLayer.takesPictures) return;
        for (const GlyphMask& mask : part.masks)
            layPicture(canvas, mask, x, y);
    }

  private:
    /// A set to paint with: painting plans a set, and a planned one may paint in another order once its
    /// effects are changed.
    VFEffect& copyOf(const VFEffect* effects) {
        return mCopies.try_emplace(effects, *effects).first->second;
    }

    /// Glyphs may overlap: every one is taken, in their order, from the picture that is its own.
    void exchangeGlyphs(Image& picture, const Part& part, const Frame& frame) {
        std::map<const VFEffect*, Image> pictures;
        for (const size_t cluster : part.clusters) {
            const VFEffect* effects = effectsAt(mLayer, cluster);
            if (effects == mLayer.effects || pictures.count(effects) != 0) continue;
            pictures[effects] = paintRun(copyOf(effects), part, frame);
        }
        if (pictures.empty()) return;
        const Image own = picture;
        for (size_t i = 0; i < part.masks.size(); ++i) {
            const auto found = pictures.find(effectsAt(mLayer, part.clusters[i]));
            takeGlyph(picture, found == pictures.end() ? own : found->second, part.masks[i], frame);
        }
    }

    void layPicture(Image& canvas, const GlyphMask& mask, int x, int y) const {
        if (mask.pixels.empty()) return;
        Image picture{mask.box.width(), mask.box.height(), mask.pixels};
        fade(picture, mLayer.pictureOpacity);
        layOver(canvas, picture, mask.box.left + x, mask.box.top + y);
    }

    const Layer& mLayer;
    std::map<const VFEffect*, VFEffect> mCopies;
};

}  // namespace

std::vector<std::vector<size_t>> spansOf(const TextLayout& text, Span span) {
    std::map<std::pair<size_t, size_t>, std::vector<size_t>> places;
    for (size_t i = 0; i < text.glyphCount(); ++i)
        places[placeOf(text.glyph(i), span)].push_back(i);
    std::vector<std::vector<size_t>> spans;
    for (auto& [place, glyphs] : places)
        spans.push_back(std::move(glyphs));
    return spans;
}

Margins marginsOf(const std::vector<Layer>& layers) {
    Margins most{0, 0, 0, 0};
    for (const Layer& layer : layers) {
        VFEffect effects(*layer.effects);
        const Margins own = marginsOf(effects);
        most = {std::max(most.left, own.left - layer.x), std::max(most.top, own.top - layer.y),
                std::max(most.right, own.right + layer.x), std::max(most.bottom, own.bottom + layer.y)};
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
