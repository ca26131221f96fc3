#include "ops/ramp/stop_ramp.h"

#include <algorithm>

#include "core/assert.h"

namespace VFontEffect::internal {

void fillBetweenStops(const RampLoops& loops, const VFGradient* stops, int count, float start,
                      const TablePositions& positions, uint32_t* table) {
    VOREL_ASSERT(count > 1);
    float end = stops[1].mLocation;
    RampSegment segment = {stops[0].mColor, stops[1].mColor, start, end - start};
    int next = 2;
    for (int first = 1; first < kTableLast;) {
        if (end < positions.of[first] && next < count) {
            const VFGradient& stop = stops[next++];
            segment = {segment.upper, stop.mColor, end, stop.mLocation - end};
            end = stop.mLocation;
        }
        const float* const place = positions.of + first;
        const float* const last = positions.of + kTableLast;
        const float* const behind = next < count ? std::upper_bound(place + 1, last, end) : last;
        loops.mixStops(segment, place, behind - place, table + first);
        first += static_cast<int>(behind - place);
    }
}

GradientTable::GradientTable(const RampLoops& loops, const VFGradient* stops, int count) {
    mPixels[0] = stops[0].mColor;
    if (count > 1) {
        fillBetweenStops(loops, stops, count, stops[0].mLocation, TablePositions(), mPixels);
    } else {
        std::fill_n(mPixels, kTableLast, stops[0].mColor);
    }
    loops.premultiplied(mPixels, kTableLast, mPixels);
}

}  // namespace VFontEffect::internal
