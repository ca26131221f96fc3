#pragma once

#include "cores/paint_input.h"
#include "cores/placed_target.h"

namespace VFontEffect::internal {

/// A gradient or pattern below this scale draws nothing. A NaN is not below it.
constexpr float kSmallestScale = 0.1F;

/// Whether a gradient record has what it takes to draw.
template <class Property>
bool canFill(const Property* record) {
    return record != nullptr && !(record->mScale < kSmallestScale) && record->mGradient != nullptr &&
           record->mGradientCount > 0;
}

/// Fills the covered pixels of a box, beneath what the destination holds: `fill(job)` paints the part
/// of the box that lies on the destination, if any. That part starts at the box's corner, for a box lies
/// inside its mask. Deliberate: coverage gates a pixel, it does not scale its colour.
template <class Fill>
void fillCovered(CpuLevel level, const CoverageBox& box, const VFBitmap* destination, Fill fill) {
    const PlacedTarget target(level, destination, box.left, box.top);
    const CoverageRows coverage = box.rows();
    const Box seen = target.seen(wholeOf(coverage));
    if (!seen.empty()) fill(target.jobOn(seen, coverage.start, coverage.stride));
}

}  // namespace VFontEffect::internal
