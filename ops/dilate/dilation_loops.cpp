#include "ops/dilate/dilation_loops.h"

#include "ops/dilate/cells.h"
#include "ops/dilate/spreading.h"
#include "ops/dilate/squares.h"
#include "ops/dilate/tiles.h"

namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

void keepMin(uint8_t* first, const uint8_t* second, int64_t count) {
    for (int64_t x = 0; x < count; x += kBytes)
        store(first + x, min(load<U8s>(first + x), load<U8s>(second + x)));
}

}  // namespace

extern const DilationLoops kDilationLoops = {
    {kCells<0>, kCells<1>, kCells<2>}, kSpreading, kTiles, kSquares, kLongestSpreadReach, keepMin,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
