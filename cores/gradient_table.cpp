#include "cores/gradient_table.h"

#include <algorithm>

#include "core/fixed_point.h"

namespace VFontEffect::internal {

GradientTable::GradientTable(const VFGradient* stops, int count) {
    std::fill_n(mPixels, kTableLast, stops[0].mColor);
    if (count > 1) {
        StopRamp ramp(stops, count, stops[0].mLocation);
        for (int i = 1; i < kTableLast; ++i)
            mPixels[i] = ramp.colourAt(tablePosition(i));
    }
    std::transform(mPixels, mPixels + kTableLast, mPixels,
                   [](uint32_t color) { return pixelOf(premultiply(color)); });
}

}  // namespace VFontEffect::internal
