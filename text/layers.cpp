#include "text/layers.h"

#include <algorithm>
#include <map>
#include <utility>

#include "text/layer_painter.h"
#include "text/overlay.h"

namespace voreltext {
namespace {

using VFontEffect::VFEffect;

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
        for (const std::vector<size_t>& glyphs : spansOf(text, layer.span)) {
            const LayerPart part = painter.part(text, glyphs);
            Image picture = painter.paint(part);
            painter.colour(picture, part);
            painter.lay(picture, part, image, canvas);
            painter.layPictures(part, image, canvas);
        }
    }
    return image;
}

}  // namespace voreltext
