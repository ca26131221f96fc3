#pragma once

#include <cstdint>

#include "ops/ramp/ramp_loops.h"
#include "ops/ramp/stop_ramp.h"

namespace VFontEffect::internal {

/// The premultiplied colours of a gradient fill, entry i at position i / 256.
class GradientTable {
  public:
    /// `count` of 1 or more stops.
    GradientTable(const RampLoops& loops, const VFGradient* stops, int count);

    RampPixels pixels() const { return mPixels; }

  private:
    uint32_t mPixels[kTableLast];
};

}  // namespace VFontEffect::internal
