#include "ops/dilate/disc_shape.h"

#include <algorithm>
#include <cmath>

#include "core/numeric.h"

namespace VFontEffect::internal {

int64_t discReach(float radius) {
    return toInt(radius + 0.5F);
}

uint8_t discWeight(int64_t dx, int64_t dy, float radius) {
    const float distance = std::sqrt(static_cast<float>(dx * dx + dy * dy));
    const float cover = clampOrLow(1.0F - (distance - radius), 0.0F, 1.0F);
    return static_cast<uint8_t>(toInt(clampOrLow(cover * 255.0F + 0.5F, 0.0F, 255.0F)));
}

DiscShape::DiscShape(float radius) : reach(-1) {
    const int64_t wanted = discReach(radius);
    if (wanted < 0 || wanted > kLongestReach) return;
    reach = static_cast<int>(wanted);
    int16_t start = 0;
    int16_t cells = 0;
    const auto addCell = [&](int64_t, int64_t, uint8_t weight) {
        rimDeficit[cells++] = static_cast<uint8_t>(255 - weight);
    };
    walkRim(reach, radius, addCell, [&](int64_t row, int64_t flat, int64_t outer) {
        flatReach[row] = static_cast<int16_t>(flat);
        outerReach[row] = static_cast<int16_t>(outer);
        rimStart[row] = start;
        std::reverse(rimDeficit + start, rimDeficit + cells);
        start = cells;
    });
}

}  // namespace VFontEffect::internal
