#pragma once

#include <algorithm>
#include <cstdint>

#include "cores/covered_fill.h"
#include "cores/stop_ramp.h"

namespace VFontEffect::internal {

/// The premultiplied colours of a gradient fill, entry i at position i / 256.
class GradientTable {
  public:
    /// `count` of 1 or more stops.
    GradientTable(const VFGradient* stops, int count);

    /// The colour of an index in 0..255; others are clamped to the ends.
    uint32_t at(int64_t index) const { return mColours[std::clamp<int64_t>(index, 0, kLastRead)]; }

  private:
    static constexpr int64_t kLastRead = 255;

    uint32_t mColours[kTableSize];
};

/// Whether a gradient record has what it takes to draw.
template <class Property>
bool canFill(const Property* record) {
    return record != nullptr && !(record->mScale < kSmallestScale) && record->mGradient != nullptr &&
           record->mGradientCount > 0;
}

}  // namespace VFontEffect::internal
