#pragma once

#include <voreleffect/VFEffect.h>

#include <cstdint>
#include <string>
#include <vector>

#include "image.h"
#include "style.h"
#include "text_layout.h"

namespace vorelpaint {

struct Margins {
    int left;
    int top;
    int right;
    int bottom;
};

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

    static constexpr int64_t kMaxPixels = int64_t{1} << 25;

  private:
    VFontEffect::VFEffect mEffects;
    std::string mKey;
    std::vector<std::string> mUnpainted;
};

}  // namespace vorelpaint
