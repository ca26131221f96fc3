#include "cores/gradient_table.h"

#include <algorithm>

#include "core/fixed_point.h"

namespace VFontEffect::internal {

GradientTable::GradientTable(const VFGradient* stops, int count) {
    std::fill_n(mPixels, kTableSize, stops[count - 1].mColor);
    if (count > 1) {
        StopRamp ramp(stops, count, stops[0].mLocation);
        mPixels[0] = stops[0].mColor;
        for (int i = 1; i < kTableLast; ++i)
            mPixels[i] = ramp.colourAt(tablePosition(i));
    }
    std::transform(mPixels, mPixels + kTableSize, mPixels,
                   [](uint32_t color) { return pixelOf(premultiply(color)); });
}

}  // namespace VFontEffect::internal
