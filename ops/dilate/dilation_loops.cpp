#include "ops/dilate/cells.h"
#include "ops/dilate/spreading.h"
#include "ops/dilate/tiles.h"

namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

enum class Strategy { cells, spread, tiles };

Strategy strategyOf(const Dilation& dilation) {
    const int reach = dilation.disc->reach;
    return reach <= kLongestCellReach     ? Strategy::cells
           : reach <= kLongestSpreadReach ? Strategy::spread
                                          : Strategy::tiles;
}

int64_t memoryBytes(const Dilation& dilation) {
    switch (strategyOf(dilation)) {
        case Strategy::cells:
            return cellPlanes(dilation).bytes;
        case Strategy::spread:
            return spreadPlanes(dilation).bytes;
        default:
            return tilePlanes(dilation).bytes;
    }
}

void begin(Dilation& dilation) {
    const Strategy way = strategyOf(dilation);
    if (way == Strategy::spread) listDeficits(dilation);
    if (way == Strategy::tiles) beginTiles(dilation);
}

uint8_t* dilateRows(const Dilation& dilation, int64_t y, int64_t count) {
    if (dilation.disc->reach == 0) return dilateRowsByCells<CentreCell>(dilation, y, count);
    if (dilation.disc->reach == 1) return dilateRowsByCells<NearCells>(dilation, y, count);
    if (dilation.disc->reach == 2) return dilateRowsByCells<FarCells>(dilation, y, count);
    if (strategyOf(dilation) == Strategy::spread) return dilateRowsBySpreading(dilation, y, count);
    return dilateRowsByTiles(dilation, y, count);
}

void keepSmaller(uint8_t* first, const uint8_t* second, int64_t count) {
    for (int64_t x = 0; x < count; x += kBytes)
        store(first + x, min(load<U8s>(first + x), load<U8s>(second + x)));
}

/// target = max(target, coverage - deficit), a row of the disc at a time.
VOREL_INLINE void stampRow(const uint8_t* weights, uint8_t coverage, uint8_t* target, int64_t count) {
    const auto raise = [=](int64_t x) {
        const U8s deficits = ~load<U8s>(weights + x);
        const U8s stamped = subSaturated(splat<U8s>(coverage), deficits);
        store(target + x, max(load<U8s>(target + x), stamped));
    };
    int64_t x = 0;
    for (; x + kBytes <= count; x += kBytes)
        raise(x);
    // The last vector may lie over its predecessor: raising twice changes nothing.
    if (x < count && count >= kBytes) return raise(count - kBytes);
    for (; x < count; ++x) {
        const int raised = coverage - (255 - weights[x]);
        target[x] = static_cast<uint8_t>(max<int>(target[x], raised));
    }
}

void stamp(const Stamping& stamping) {
    for (int64_t y = stamping.firstRow; y < stamping.endRow; ++y) {
        const uint8_t* const source = stamping.source + y * stamping.sourceWidth;
        for (int64_t x = 0; x < stamping.sourceWidth; ++x) {
            const auto coverage = static_cast<uint8_t>(source[x] ^ stamping.invertMask);
            if (coverage == 0) continue;
            // The disc's centre lies half its side further on both axes: its corner is at (x, y).
            for (int64_t row = 0; row < stamping.side; ++row) {
                stampRow(stamping.weights + row * stamping.side, coverage,
                         stamping.plane + (y + row) * stamping.planeWidth + x, stamping.side);
            }
        }
    }
}

}  // namespace

extern const DilationLoops kDilationLoops = {memoryBytes, begin, dilateRows, keepSmaller, stamp};

}  // namespace VFontEffect::internal::VOREL_LEVEL
