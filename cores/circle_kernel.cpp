#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <limits>

#include "core/float_state.h"
#include "ops/dilate/disc_shape.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// A disc beyond this takes seconds and is no text effect: it counts as one that memory cannot hold.
constexpr int64_t kLargestSide = 8192;

/// A disc of zeros becomes that disc.
void fillDisc(unsigned char* disc, int64_t reach, float radius) {
    const int64_t side = 2 * reach + 1;
    const auto middleOf = [&](int64_t y) { return disc + (reach + y) * side + reach; };
    const auto setCell = [&](int64_t x, int64_t y, uint8_t weight) {
        middleOf(y)[x] = middleOf(y)[-x] = weight;
    };
    walkRim(reach, radius, setCell, [&](int64_t y, int64_t flatReach, int64_t) {
        if (flatReach >= 0)
            std::memset(middleOf(y) - flatReach, 255, static_cast<size_t>(2 * flatReach + 1));
        if (y != 0) std::memcpy(middleOf(-y) - reach, middleOf(y) - reach, static_cast<size_t>(side));
    });
}

/// As makeCircleKernel.
int storeDisc(unsigned char** kernel, float radius) {
    const int64_t reach = discReach(radius);
    const int64_t side = 2 * reach + 1;
    if (side < 1 || side > std::numeric_limits<int32_t>::max() / side) return 0;
    if (kernel != nullptr && side <= kLargestSide) {
        const auto rowBytes = static_cast<size_t>(side);
        auto* const disc = static_cast<unsigned char*>(std::calloc(rowBytes, rowBytes));
        if (disc != nullptr) {
            *kernel = disc;
            fillDisc(disc, reach, radius);
        }
    }
    return static_cast<int>(side);
}

}  // namespace

int makeCircleKernel(unsigned char** kernel, float radius) {
    return inOwnFloatState([&] { return storeDisc(kernel, radius); });
}

}  // namespace VFontEffect
