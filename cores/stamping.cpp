#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "core/coverage_rows.h"
#include "voreleffect/VFECore.h"

/// Grey-scale dilation by the anti-aliased disc, stamped: every source pixel of coverage c raises
/// each pixel t of the plane under the disc to max(t, c - (255 - weight)). For a full weight that is
/// max(t, c), for an empty one no change. Maxima do not depend on the order of stamps.
/// Cost: (2R + 1)^2 steps for each source pixel that is not empty. The stroke itself, which knows that
/// the weights are those of a disc, gets the same bytes in far fewer.
namespace VFontEffect {

using namespace internal;

namespace {

using Work = VFStroke::DilationWork;

bool fitsTogether(const Work& work) {
    if (work.plane == nullptr || work.source == nullptr || work.kernel == nullptr) return false;
    const int64_t border = 2 * int64_t{work.radius};
    return work.radius >= 0 && work.sourceWidth > 0 && work.kernelSide == border + 1 &&
           work.planeWidth >= work.sourceWidth + border &&
           work.planeHeight >= work.sourceHeight + border;
}

/// Raises what lies under the disc whose corner is at (x, y) of the plane.
void stampDisc(const Work& work, unsigned char* plane, int64_t x, int64_t y, int coverage) {
    for (int64_t row = 0; row < work.kernelSide; ++row) {
        const unsigned char* const weights = work.kernel + row * work.kernelSide;
        unsigned char* const target = plane + (y + row) * work.planeWidth + x;
        for (int64_t i = 0; i < work.kernelSide; ++i) {
            const int stamped = coverage - (255 - weights[i]);
            if (stamped > target[i]) target[i] = static_cast<unsigned char>(stamped);
        }
    }
}

/// Stamps the band of rows, each byte ^ invertMask, into the plane.
int stampBand(const Work& work, unsigned char* plane, uint8_t invertMask) {
    const int64_t firstRow = std::max(work.firstRow, 0);
    const int64_t endRow = std::min(work.endRow, work.sourceHeight);
    if (firstRow >= endRow) return 0;
    for (int64_t y = firstRow; y < endRow; ++y) {
        for (int64_t x = 0; x < work.sourceWidth; ++x) {
            const int coverage = work.source[y * work.sourceWidth + x] ^ invertMask;
            // The disc's centre lies half its side further on both axes: its corner is at (x, y).
            if (coverage != 0) stampDisc(work, plane, x, y, coverage);
        }
    }
    return 1;
}

int stampWork(const void* work, bool outside, bool inside) {
    if (work == nullptr) return 0;
    const Work& w = *static_cast<const Work*>(work);
    if (!fitsTogether(w)) return 0;
    const ptrdiff_t planeBytes = static_cast<ptrdiff_t>(w.planeWidth) * w.planeHeight;
    int done = 0;
    if (outside) done = stampBand(w, w.plane, kAsIs);
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
