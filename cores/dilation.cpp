#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "voreleffect/VFECore.h"

/// Grey-scale dilation by the anti-aliased disc, stamped: every source pixel of coverage c raises
/// each pixel t of the plane under the disc to max(t, c - (255 - weight)). For a full weight that is
/// max(t, c), for an empty one no change. Maxima do not depend on the order of stamps.
/// Cost: (2R + 1)^2 steps for each source pixel that is not empty.
namespace VFontEffect {
namespace {

using Work = VFStroke::DilationWork;

bool fitsTogether(const Work& work) {
    if (work.plane == nullptr || work.source == nullptr || work.kernel == nullptr) return false;
    const int64_t border = 2 * int64_t{work.radius};
    return work.radius >= 0 && work.sourceWidth > 0 && work.kernelSide == border + 1 &&
           work.planeWidth >= work.sourceWidth + border &&
           work.planeHeight >= work.sourceHeight + border;
}

void stampRow(const uint8_t* weights, int side, int coverage, uint8_t* target) {
    for (int x = 0; x < side; ++x) {
        const int raised = coverage - (255 - weights[x]);
        target[x] = static_cast<uint8_t>(std::max<int>(target[x], raised));
    }
}

/// Stamps the band of rows into the plane. `flip` 0xFF takes the inverse of the coverage.
int stampBand(const Work& work, unsigned char* plane, uint8_t flip) {
    const int64_t firstRow = std::max(work.firstRow, 0);
    const int64_t endRow = std::min(work.endRow, work.sourceHeight);
    if (firstRow >= endRow) return 0;
    const int64_t stride = work.planeWidth;
    const int64_t side = work.kernelSide;
    for (int64_t y = firstRow; y < endRow; ++y) {
        const uint8_t* const source = work.source + y * work.sourceWidth;
        for (int64_t x = 0; x < work.sourceWidth; ++x) {
            const int coverage = source[x] ^ flip;
            if (coverage == 0) continue;
            // The disc's centre lies `radius` further on both axes: its corner is at (x, y).
            for (int64_t row = 0; row < side; ++row) {
                stampRow(work.kernel + row * side, work.kernelSide, coverage,
                         plane + (y + row) * stride + x);
            }
        }
    }
    return 1;
}

constexpr uint8_t kCoverage = 0;
constexpr uint8_t kInverse = 0xFF;

int stampWork(const void* work, bool outside, bool inside) {
    if (work == nullptr) return 0;
    const Work& w = *static_cast<const Work*>(work);
    if (!fitsTogether(w)) return 0;
    const ptrdiff_t planeBytes = static_cast<ptrdiff_t>(w.planeWidth) * w.planeHeight;
    int done = 0;
    if (outside) done = stampBand(w, w.plane, kCoverage);
    if (inside) done = stampBand(w, outside ? w.plane + planeBytes : w.plane, kInverse);
    return done;
}

}  // namespace

int VFStroke::partalDTStrokeCenter(void* work) {
    return stampWork(work, true, true);
}
int VFStroke::partalDTStrokeOutside(void* work) {
    return stampWork(work, true, false);
}
int VFStroke::partalDTStrokeInside(void* work) {
    return stampWork(work, false, true);
}

}  // namespace VFontEffect
