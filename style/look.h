#pragma once

#include <voreleffect/VFEffect.h>

#include <cstdint>
#include <string>
#include <vector>

#include "style/pattern_image.h"
#include "style/style.h"

namespace vorelstyle {

/// A look turned into a set of effects, ready to paint runs of text.
class Look {
  public:
    /// The lengths of `look` are resolved (resolvedStyle). `fill` is 0xRRGGBB; it and `textOpacity` are
    /// what the text takes. `load` is called, before this returns, for a look with a pattern only.
    /// Throws StyleError when the pattern has no picture, or a length is still a share of the font's
    /// size.
    Look(const LookStyle& look, uint32_t fill, float textOpacity, const LoadImage& load = {});

    /// The library's cache key of the look: bytes, mostly beyond ASCII.
    const std::string& key() const { return mKey; }

    /// Effects of the look that this library has no core for; they are not painted.
    const std::vector<std::string>& unpainted() const { return mUnpainted; }

    /// What is painted otherwise than the look asks for, a line each: "pattern.width: ...".
    const std::vector<std::string>& notes() const { return mNotes; }

    /// The set itself, to paint with. Not planned before the first picture.
    VFontEffect::VFEffect& effects() { return mEffects; }
    const VFontEffect::VFEffect& effects() const { return mEffects; }

    /// The opacity of the text's fill: that of the text, multiplied with that of the effect `text`.
    float fillOpacity() const { return mFillOpacity; }

    /// The types of its effects (VFEffect.h) in the order in which they were added.
    const std::vector<int>& added() const { return mAdded; }

  private:
    VFontEffect::VFEffect mEffects;
    std::vector<int> mAdded;
    float mFillOpacity;
    std::string mKey;
    std::vector<std::string> mUnpainted;
    std::vector<std::string> mNotes;
};

}  // namespace vorelstyle
