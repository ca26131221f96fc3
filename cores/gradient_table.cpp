#include "cores/gradient_table.h"

#include <algorithm>

#include "core/fixed_point.h"

namespace VFontEffect::internal {

GradientTable::GradientTable(const VFGradient* stops, int count) {
    std::fill_n(mColours, kTableSize, stops[count - 1].mColor);
    if (count > 1) {
        StopRamp ramp(stops, count, stops[0].mLocation);
        mColours[0] = stops[0].mColor;
        for (int i = 1; i < kTableLast; ++i)
            mColours[i] = ramp.colourAt(tablePosition(i));
    }
    std::transform(mColours, mColours + kTableSize, mColours, premultiply);
}

}  // namespace VFontEffect::internal
