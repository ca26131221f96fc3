#pragma once

#include <voreleffect/VFBitmap.h>
#include <voreleffect/VFEffect.h>

#include <cstdint>

#include "text/image.h"
#include "text/text_layout.h"

namespace voreltext {

struct Margins {
    int left;
    int top;
    int right;
    int bottom;
};

/// The pixels that a set of effects needs around a text.
Margins marginsOf(VFontEffect::VFEffect& effects);

/// Where a text stands in its picture: around its ink the room that the effects need, around that the
/// padding.
struct Frame {
    Box ink;
    Margins margins;
    int padding;  ///< at most TextLayout::kMaxSide

    int width() const { return ink.width() + margins.left + margins.right + 2 * padding; }
    int height() const { return ink.height() + margins.top + margins.bottom + 2 * padding; }

    /// What is added to a place in the text for the place in the picture.
    int shiftX() const { return margins.left + padding - ink.left; }
    int shiftY() const { return margins.top + padding - ink.top; }
};

/// Throws TextError for a picture beyond TextLayout::kMaxSide or kMaxPixels, or of a negative size.
void checkSize(int width, int height);
constexpr int64_t kMaxPixels = int64_t{1} << 25;

/// A picture in the making: one run of a set of effects, from planning to merging its layers.
class Run {
  public:
    /// The set must outlive the run. Throws TextError when the picture would be too large.
    Run(VFontEffect::VFEffect& effects, const Frame& frame);

    void begin();                       ///< plans the run; the set has its layers and destination then
    void draw(const GlyphMask& glyph);  ///< once per glyph; the effects' own painting follows
    void merge();                       ///< merges the layers, which ends the run
    Image picture() const;              ///< premultiplied

  private:
    VFontEffect::VFEffect& mEffects;
    Frame mFrame;
    VFontEffect::VFBitmap mPicture;
};

/// Paints the text on a transparent picture, premultiplied, of the size of the text's ink with the
/// margins of the effects and `padding` around it. Throws TextError when the picture would be too large.
Image paint(VFontEffect::VFEffect& effects, const TextLayout& text, int padding);

}  // namespace voreltext
