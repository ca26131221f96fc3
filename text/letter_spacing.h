#pragma once

#include <cstdint>
#include <vector>

#include "text/shaper.h"

namespace voreltext {

/// Adds `spacing`, in 64ths of a pixel, between clusters that stand beside each other; `codes` are the
/// characters that the clusters are indices into. Nothing is added at clusters that show nothing, nor
/// between two of scripts whose letters are joined: Arabic, Syriac, Mongolian, N'Ko and others.
void addLetterSpacing(std::vector<ShapedGlyph>& glyphs, const std::vector<uint32_t>& codes,
                      int64_t spacing);

}  // namespace voreltext
