#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <limits>

#include "core/numeric.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// A disc beyond this takes seconds and is no text effect: it counts as one that memory cannot hold.
constexpr int64_t kLargestSide = 8192;

/// 255 inside the radius, falling to 0 over the pixel outside of it.
unsigned char discWeight(int64_t dx, int64_t dy, float radius) {
    const float distance = std::sqrt(static_cast<float>(dx * dx + dy * dy));
    const float cover = clampOrLow(1.0F - (distance - radius), 0.0F, 1.0F);
    return static_cast<unsigned char>(toInt(clampOrLow(cover * 255.0F + 0.5F, 0.0F, 255.0F)));
}

}  // namespace

int makeCircleKernel(unsigned char** kernel, float radius) {
    const int64_t reach = toInt(radius + 0.5F);
    const int64_t side = 2 * reach + 1;
    if (side < 1 || side > std::numeric_limits<int32_t>::max() / side) return 0;
    if (kernel != nullptr && side <= kLargestSide) {
        auto* const disc = static_cast<unsigned char*>(std::malloc(static_cast<size_t>(side * side)));
        if (disc != nullptr) {
            *kernel = disc;
            for (int64_t y = -reach; y <= reach; ++y) {
                for (int64_t x = -reach; x <= reach; ++x) {
                    disc[(y + reach) * side + x + reach] = discWeight(x, y, radius);
                }
            }
        }
    }
    return static_cast<int>(side);
}

}  // namespace VFontEffect
