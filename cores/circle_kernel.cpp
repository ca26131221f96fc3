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

/// The weights of the walk's row, `middle` being its cell in the disc's middle column.
void fillRow(const RimWalk& walk, int64_t reach, unsigned char* middle) {
    std::memset(middle - reach, 0, static_cast<size_t>(2 * reach + 1));
    if (walk.flatReach >= 0)
        std::memset(middle - walk.flatReach, 255, static_cast<size_t>(2 * walk.flatReach + 1));
    for (int64_t dx = walk.flatReach + 1; dx <= walk.outerReach; ++dx)
        middle[dx] = middle[-dx] = walk.weight(dx);
}

/// As makeCircleKernel.
int storeDisc(unsigned char** kernel, float radius) {
    const int64_t reach = discReach(radius);
    const int64_t side = 2 * reach + 1;
    if (side < 1 || side > std::numeric_limits<int32_t>::max() / side) return 0;
    if (kernel != nullptr && side <= kLargestSide) {
        const auto rowBytes = static_cast<size_t>(side);
        auto* const disc = static_cast<unsigned char*>(std::malloc(rowBytes * rowBytes));
        if (disc != nullptr) {
            *kernel = disc;
            for (RimWalk walk(reach, radius); !walk.done(); walk.nextRow()) {
                unsigned char* const below = disc + (reach + walk.row()) * side;
                unsigned char* const above = disc + (reach - walk.row()) * side;
                fillRow(walk, reach, below + reach);
                if (above != below) std::memcpy(above, below, rowBytes);
            }
        }
    }
    return static_cast<int>(side);
}

}  // namespace

int makeCircleKernel(unsigned char** kernel, float radius) {
    return inOwnFloatState([&] { return storeDisc(kernel, radius); });
}

}  // namespace VFontEffect
