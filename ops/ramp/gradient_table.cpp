#include "ops/ramp/gradient_table.h"

#include <algorithm>

namespace VFontEffect::internal {

GradientTable::GradientTable(const RampLoops& loops, const VFGradient* stops, int count) {
    std::fill_n(mPixels, kTableLast, stops[0].mColor);
    if (count > 1) fillBetweenStops(loops, stops, count, stops[0].mLocation, TablePositions(), mPixels);
    loops.premultiplied(mPixels, kTableLast, mPixels);
}

}  // namespace VFontEffect::internal
