#pragma once

#include <algorithm>
#include <cstdint>

#include "blend/clip.h"
#include "blend/job.h"
#include "core/numeric.h"
#include "cores/fill_kernels.h"
#include "cores/paint_input.h"

namespace VFontEffect::internal {

/// A gradient or pattern below this scale draws nothing. A NaN is not below it.
constexpr float kSmallestScale = 0.1F;

/// Fills the covered pixels of a box, beneath what the destination holds: `fill(job)` paints the part of
/// the box that lies on the destination, if any. Deliberate: coverage gates a pixel, it does not scale
/// its colour.
template <class Fill>
void fillCovered(const CoverageBox& box, const VFBitmap* destination, Fill fill) {
    const ColourView target = ColourView::of(destination);
    if (!target) return;
    const Clip clip = clipPlacement(saturateToInt(box.left), saturateToInt(box.top), box.width,
                                    box.height, target.width, target.height);
    if (clip.empty()) return;
    FillJob job = {jobOn(target, clip), clip.left - box.left, clip.top - box.top};
    job.blend.mask = box.row(job.top) + job.left;
    job.blend.maskStride = box.mask.width;
    fill(job);
}

/// A premultiplied colour word as the pixel in memory: R, G, B, A.
inline uint32_t pixelOf(uint32_t word) {
    return (word & 0xFF00FF00U) | (word & 0xFFU) << 16 | (word >> 16 & 0xFFU);
}

}  // namespace VFontEffect::internal
