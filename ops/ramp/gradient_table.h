#pragma once

#include <cstdint>

#include "cores/covered_fill.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/ramp/stop_ramp.h"

namespace VFontEffect::internal {

/// The premultiplied colours of a gradient fill, entry i at position i / 256.
class GradientTable {
  public:
    /// `count` of 1 or more stops.
    GradientTable(const VFGradient* stops, int count);

    RampPixels pixels() const { return mPixels; }

  private:
    uint32_t mPixels[kTableLast];
};

/// Whether a gradient record has what it takes to draw.
template <class Property>
bool canFill(const Property* record) {
    return record != nullptr && !(record->mScale < kSmallestScale) && record->mGradient != nullptr &&
           record->mGradientCount > 0;
}

}  // namespace VFontEffect::internal
