#pragma once

#include <voreleffect/VFEffect.h>

#include <cstdint>
#include <string>
#include <vector>

#include "image.h"
#include "run.h"
#include "style.h"
#include "text_layout.h"

namespace vorelpaint {

/// The pixels of a pattern in the library's order: A, R, G, B. Throws StyleError when its file cannot be
/// read.
Image patternImage(const Style& style, const Pattern& pattern);

/// A style turned into a set of effects, ready to paint runs of text.
class Look {
  public:
    /// `fill` is 0xRRGGBB; it and `textOpacity` are what the style's text takes. Throws ToolError
    /// when a pattern image cannot be read.
    Look(const Style& style, uint32_t fill, float textOpacity);

    /// The library's cache key of the look: bytes, mostly beyond ASCII.
    const std::string& key() const { return mKey; }

    /// Pixels that the effects need around the text.
    Margins margins();

    /// Effects of the style that this library has no core for; they are not painted.
    const std::vector<std::string>& unpainted() const { return mUnpainted; }

    /// Paints the text on a transparent picture, premultiplied, of the size of the text's ink with
    /// the margins and `padding` around it. Throws ToolError when the picture would be too large.
    Image paint(const TextLayout& text, int padding);

    /// The set itself, for a caller that drives it step by step. Not planned before the first picture.
    const VFontEffect::VFEffect& effects() const { return mEffects; }

    /// The types of its effects (VFEffect.h) in the order in which they were added.
    const std::vector<int>& added() const { return mAdded; }

  private:
    VFontEffect::VFEffect mEffects;
    std::vector<int> mAdded;
    std::string mKey;
    std::vector<std::string> mUnpainted;
};

}  // namespace vorelpaint
