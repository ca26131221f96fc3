#pragma once

#include <voreleffect/VFEffect.h>

#include <cstddef>
#include <cstdint>
#include <vector>

#include "text/canvas.h"
#include "text/glyph_mask.h"
#include "text/image.h"
#include "text/layers.h"
#include "text/run.h"
#include "text/text_layout.h"

namespace voreltext {

/// A span of a text: what one run of a layer paints.
struct LayerPart {
    std::vector<GlyphMask> masks;
    std::vector<size_t> clusters;  ///< of each mask: where its characters begin in the text
    Frame frame;                   ///< of the run's picture, with room for the faint end of a glow
};

/// The steps by which `paint` paints a layer: of each span its part, the picture of its run, that with
/// the colours of the layer, then both kinds of pictures laid on the canvas.
class LayerPainter {
  public:
    /// The layer must outlive it.
    explicit LayerPainter(const Layer& layer);

    LayerPart part(const TextLayout& text, const std::vector<size_t>& glyphs);

    /// One run in the layer's own fill; premultiplied, of the size of the part's frame. Throws TextError
    /// when the picture would be too large.
    Image paint(const LayerPart& part);

    /// Replaces the pixels of the glyphs that have a colour of their own. `picture` is the run's.
    void colour(Image& picture, const LayerPart& part) const;

    /// Lays the run's picture on the canvas where the layer has it.
    void lay(const Image& picture, const LayerPart& part, Image& canvas, const Canvas& place) const;

    /// Lays the pictures of colour fonts on the canvas, where the layer takes them.
    void layPictures(const LayerPart& part, Image& canvas, const Canvas& place) const;

  private:
    Image paintedIn(uint32_t colour, const LayerPart& part) const;
    int originX(const Canvas& place) const;
    int originY(const Canvas& place) const;

    const Layer& mLayer;
    /// Painting plans a set, and a planned one may paint in another order once its effects are changed:
    /// that of the layer is copied.
    VFontEffect::VFEffect mEffects;
};

}  // namespace voreltext
