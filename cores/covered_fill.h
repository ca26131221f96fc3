#pragma once

#include <cstdint>

#include "blend/clip.h"
#include "blend/job.h"
#include "cores/fill_kernels.h"
#include "cores/paint_input.h"

namespace VFontEffect::internal {

/// A gradient or pattern below this scale draws nothing. A NaN is not below it.
constexpr float kSmallestScale = 0.1F;

/// Fills the covered pixels of a box, beneath what the destination holds: `fill(job)` paints the part of
/// the box that lies on the destination, if any. That part starts at the box's corner, for a box lies
/// inside its mask. Deliberate: coverage gates a pixel, it does not scale its colour.
template <class Fill>
void fillCovered(const CoverageBox& box, const VFBitmap* destination, Fill fill) {
    const ColourView target = ColourView::of(destination);
    if (!target) return;
    const Clip clip = clipPlacement(static_cast<int>(box.left), static_cast<int>(box.top), box.width,
                                    box.height, target.width, target.height);
    if (clip.empty()) return;
    BlendJob job = jobOn(target, clip);
    job.mask = box.row(0);
    job.maskStride = box.mask.width;
    fill(job);
}

/// A premultiplied colour word as the pixel in memory: R, G, B, A.
inline uint32_t pixelOf(uint32_t word) {
    return (word & 0xFF00FF00U) | (word & 0xFFU) << 16 | (word >> 16 & 0xFFU);
}

}  // namespace VFontEffect::internal
