#pragma once

#include <cstdint>

#include "core/strict_math.h"
#include "ops/ramp/ramp_loops.h"
#include "voreleffect/VFBitmap.h"

namespace VFontEffect::internal {

/// Tables of colours along a ramp have 257 entries; entry i stands at position i / 256.
constexpr int kTableSize = 257;
constexpr int kTableLast = kTableSize - 1;

/// The places on a ramp of a table's entries, which ascend, and of some more.
struct TablePositions {
    static constexpr int kCount = kTableLast + static_cast<int>(kRampSlack);
    float of[kCount];

    TablePositions() {
        for (int i = 0; i < kCount; ++i)
            of[i] = static_cast<float>(i) * 0.00390625F;
    }
};

/// Gives the entries 1 to 255 of a table the straight colours along `count` stops, 2 or more. The first
/// segment runs from `start` to the position of stop 1.
///
/// Deliberate: an entry moves on by one segment at most, even when it has passed several stops, so stops
/// closer together than a table entry take effect one entry late. When no stop is left the last segment
/// stays.
void fillBetweenStops(const RampLoops& loops, const VFGradient* stops, int count, float start,
                      const TablePositions& positions, uint32_t* table);

/// The premultiplied colours along stops, entry i at position i / 256.
class GradientTable {
  public:
    /// `count` of 1 or more stops.
    GradientTable(const RampLoops& loops, const VFGradient* stops, int count);

    RampPixels pixels() const { return mPixels; }

  private:
    uint32_t mPixels[kTableLast];
};

}  // namespace VFontEffect::internal
