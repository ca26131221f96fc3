#pragma once

#include <voreleffect/VFEffect.h>

#include <cstddef>
#include <cstdint>
#include <vector>

#include "text/canvas.h"
#include "text/image.h"
#include "text/run.h"
#include "text/text_layout.h"

namespace voreltext {

/// What of a text is painted as one run, with a text box of its own: gradients, patterns and the effects
/// inside follow it. A word is what blanks separate, cut where a line ends within it; a glyph is a
/// letter with its marks, or what a font joins to one sign.
enum class Span { block, line, word, glyph };

/// The glyphs of a text by their spans, in reading order.
std::vector<std::vector<size_t>> spansOf(const TextLayout& text, Span span);

/// A part of a text whose fill has a colour of its own.
struct ColouredPart {
    size_t begin;  ///< code points of the text, half-open
    size_t end;
    uint32_t colour;  ///< 0xRRGGBB
};

/// One look of a stack. The set of effects must outlive it and is not planned by painting: it can be
/// painted again.
struct Layer {
    const VFontEffect::VFEffect* effects;
    int x = 0;  ///< how far it is moved, in pixels to the right and downwards
    int y = 0;
    Span span = Span::block;  ///< spans are painted in reading order, later ones over earlier ones

    /// In the order of the text, none over another. A span is painted once more for each colour in it,
    /// one after the other, and the glyphs of that colour are taken from there; all else stays. A glyph
    /// of several characters has the colour of the first.
    std::vector<ColouredPart> colours = {};
    float fillOpacity = 1;  ///< of these colours

    /// Whether the pictures of colour fonts are laid over what the effects make of their coverage, and
    /// at which opacity.
    bool takesPictures = false;
    float pictureOpacity = 1;
};

/// The pixels that the layers need around a text, all of them together; at least 0 on each side.
Margins marginsOf(const std::vector<Layer>& layers);

/// Paints the text in each layer, the last on top, on a transparent canvas; premultiplied. What reaches
/// beyond the canvas is cut off, and changes nothing within. Throws TextError when a picture would be
/// too large.
Image paint(const std::vector<Layer>& layers, const TextLayout& text, const Canvas& canvas);

}  // namespace voreltext
