#include "ops/dilate/dilation_plan.h"

#include <algorithm>

#include "core/assert.h"

namespace VFontEffect::internal {
namespace {

/// Rows that are dilated at once: few enough to stay in the cache with what is blended with them.
constexpr int64_t kBandRows = 32;

/// The source with its border, as far as it is in reach of a window.
Box reachedSource(const DilationInput& input, const Box& window) {
    const Box whole = expanded(wholeOf(input.source), kDilationBorder);
    return intersection(expanded(window, input.disc.reach), whole);
}

Dilation dilationOf(const DilationInput& input, const Box& window) {
    const Box part = reachedSource(input, window);
    VOREL_ASSERT(!window.empty() && !part.empty());
    const Box box = intersection(part, wholeOf(input.source));
    const int64_t corner = box.empty() ? 0 : box.top * input.source.stride + box.left;
    return {{input.source.start + corner, input.source.stride, box.width(), box.height(),
             input.source.invertMask},
            box.left - part.left,
            box.top - part.top,
            &input.disc,
            part.width(),
            part.height(),
            window.left - part.left,
            window.right - part.left,
            window.top - part.top,
            std::min(kBandRows, window.height())};
}

/// That of a window that is as large as any and has as much of the source around it.
Dilation largestDilation(const DilationInput& input, const Windows& windows) {
    Dilation largest = dilationOf(input, windows.part);
    const int64_t reach = input.disc.reach;
    if (windows.areCutAcross()) {
        largest.left = reach;
        largest.right = reach + windows.width;
        largest.width = largest.right + reach;
    }
    if (windows.areCutDown()) {
        largest.height = windows.height + 2 * reach;
        largest.bandRows = std::min(kBandRows, windows.height);
    }
    return largest;
}

const DilationStrategy& strategyFor(const DilationLoops& loops, int reach) {
    VOREL_ASSERT(reach >= 0);
    if (reach <= kLongestCellReach) return loops.cells[reach];
    return reach <= loops.longestSpreadReach ? loops.spreading : loops.tiles;
}

}  // namespace

int64_t DilationPlan::memoryBytes(CpuLevel level, const DilationInput& input, const Windows& windows) {
    const DilationLoops& loops = dilationLoops(level);
    const int64_t bytes = memoryBytesOfTiles(level, input, windows);
    if (&strategyFor(loops, input.disc.reach) != &loops.tiles) return bytes;
    return std::max(bytes, loops.squares.memoryBytes(largestDilation(input, windows)));
}

int64_t DilationPlan::memoryBytesOfTiles(CpuLevel level, const DilationInput& input,
                                         const Windows& windows) {
    return strategyFor(dilationLoops(level), input.disc.reach)
        .memoryBytes(largestDilation(input, windows));
}

DilationPlan::DilationPlan(CpuLevel level, const DilationInput& input, uint8_t* memory,
                           int64_t memoryBytes)
    : mInput(input),
      mLoops(dilationLoops(level)),
      mStrategy(&strategyFor(mLoops, input.disc.reach)),
      mMemory(memory),
      mMemoryBytes(memoryBytes) {}

bool DilationPlan::begin(const Box& window) {
    mDilation = dilationOf(mInput, window);
    mFirstRow = window.top - mDilation.top;
    mNextRow = window.top;
    // All other strategies have memory for every window.
    if (mStrategy == &mLoops.squares && !hasMemory()) return false;
    VOREL_ASSERT(hasMemory());
    mStrategy->begin(mDilation, mMemory);
    return true;
}

void DilationPlan::giveUpTiles() {
    if (mStrategy == &mLoops.tiles) mStrategy = &mLoops.squares;
}

CoverageRows DilationPlan::rows(int64_t y, int64_t count) {
    return asRows(nextRows(y, count), count);
}

CoverageRows DilationPlan::minRows(DilationPlan& other, int64_t y, int64_t count) {
    VOREL_ASSERT(mDilation.left == other.mDilation.left && mDilation.right == other.mDilation.right);
    uint8_t* const values = nextRows(y, count);
    if (values == nullptr) return {};
    const uint8_t* const others = other.nextRows(y, count);
    if (others == nullptr) return {};
    mLoops.keepMin(values, others, dilatedStride(mDilation) * count);
    return asRows(values, count);
}

uint8_t* DilationPlan::nextRows(int64_t y, int64_t count) {
    VOREL_ASSERT(y == mNextRow && count > 0 && count <= bandRows());
    mNextRow += count;
    uint8_t* const rows = mStrategy->rows(mDilation, mMemory, y - mFirstRow, count);
    if (rows != nullptr) return rows;
    // Here and in the windows that follow, which hold more of the same.
    giveUpTiles();
    if (!hasMemory()) return nullptr;
    mDilation.top = y - mFirstRow;
    mStrategy->begin(mDilation, mMemory);
    return mStrategy->rows(mDilation, mMemory, mDilation.top, count);
}

CoverageRows DilationPlan::asRows(const uint8_t* values, int64_t count) const {
    return {values, dilatedStride(mDilation), mDilation.right - mDilation.left, count, kAsIs};
}

}  // namespace VFontEffect::internal
