#pragma once

#include <cstdint>

#include "cores/paint_input.h"
#include "cores/placed_target.h"

namespace VFontEffect::internal {

/// A gradient or pattern below this scale draws nothing. A NaN is not below it.
constexpr float kSmallestScale = 0.1F;

/// Fills the covered pixels of a box, beneath what the destination holds: `fill(job)` paints the part of
/// the box that lies on the destination, if any. That part starts at the box's corner, for a box lies
/// inside its mask. Deliberate: coverage gates a pixel, it does not scale its colour.
template <class Fill>
void fillCovered(const CoverageBox& box, const VFBitmap* destination, Fill fill) {
    const PlacedTarget target(destination, box.left, box.top);
    const Box seen = target.seen(wholeOf(box));
    if (!seen.empty()) fill(target.jobOn(seen, box.row(0), box.mask.width));
}

}  // namespace VFontEffect::internal
