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
    const auto movesOn = [&](int entry) { return end < positions.of[entry] && next < count; };
    for (int first = 1; first < kTableLast;) {
        if (movesOn(first)) {
            const VFGradient& stop = stops[next++];
            segment = {segment.upper, stop.mColor, end, stop.mLocation - end};
            end = stop.mLocation;
        }
        int behind = first + 1;
        while (behind < kTableLast && !movesOn(behind))
            ++behind;
        loops.mixStops(segment, positions.of + first, behind - first, table + first);
        first = behind;
    }
}

GradientTable::GradientTable(const RampLoops& loops, const VFGradient* stops, int count) {
    std::fill_n(mPixels, kTableLast, stops[0].mColor);
    if (count > 1) fillBetweenStops(loops, stops, count, stops[0].mLocation, TablePositions(), mPixels);
    loops.premultiplied(mPixels, kTableLast, mPixels);
}

}  // namespace VFontEffect::internal
