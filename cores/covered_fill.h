#pragma once

#include <cstdint>

#include "core/blend_modes.h"
#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "cores/paint_input.h"
#include "voreleffect/VFBlender.h"

namespace VFontEffect::internal {

/// A gradient or pattern below this scale draws nothing. A NaN is not below it.
constexpr float kSmallestScale = 0.1F;

/// Fills the covered pixels of a box and blends them beneath what the destination holds.
/// `shaderOf(y)` gives the shader of a row, `shader(x)` the premultiplied colour word of a pixel, both
/// counted from the box's corner. Deliberate: coverage gates a pixel, it does not scale its colour.
template <class ShaderOf>
void fillCovered(const CoverageBox& box, const VFBitmap* destination, ShaderOf shaderOf) {
    auto image = PixelBuffer<unsigned int>::zeroed(box.width, box.height);
    if (!image) return;
    for (int64_t y = 0; y < box.height; ++y) {
        const unsigned char* const coverage = box.row(y);
        unsigned int* const row = image.data() + y * box.width;
        const auto shader = shaderOf(y);
        for (int64_t x = 0; x < box.width; ++x) {
            if (coverage[x] != 0) row[x] = shader(x);
        }
    }
    const int width = saturateToInt(box.width);
    VFBlender().drawBitmapBlend32(saturateToInt(box.left), saturateToInt(box.top), destination,
                                  image.data(), width, saturateToInt(box.height), width, kModeDstOver);
}

}  // namespace VFontEffect::internal
