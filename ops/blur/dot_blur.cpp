#include "ops/blur/dot_blur.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/assert.h"
#include "core/numeric.h"

namespace VFontEffect::internal {
namespace {

/// Bytes of a row that whole vectors are written to.
int64_t strideFor(int64_t width) {
    return roundedUp(width, kWidestVector);
}

int64_t quadsOf(int64_t rows) {
    return roundedUp(rows, kQuad) / kQuad;
}

/// In multiples of four, so that what follows cells of a byte is aligned.
int64_t cellsOf(int radius) {
    return roundedUp(kCellsBefore + 2 * int64_t{radius} + 1 + kCellsBehind, 4);
}
constexpr int64_t kMostCells =
    kCellsBefore + 2 * int64_t{BlurWeights::kLongestRadius} + 1 + kCellsBehind + 3;

/// The weights from the first cell's on, and those behind the last one.
void fillString(const BlurWeights& weights, uint8_t* string) {
    std::fill_n(string, cellsOf(weights.radius) + kWeightsBehindCell, uint8_t{0});
    uint8_t* const centre = string + kCellsBefore + weights.radius;
    for (int64_t k = 0; k <= weights.radius; ++k)
        centre[k] = centre[-k] = static_cast<uint8_t>(weights.byDistance[k]);
}

}  // namespace

// --- Weights --------------------------------------------------------------------------------------

namespace {

int64_t packedBytes(const DotLoops& loops, int radius) {
    return cellsOf(radius) * (loops.cellBytes + int64_t{sizeof(uint32_t)});
}

/// The weights in the form of a level's loops, in memory of packedBytes().
PackedBlur packed(const DotLoops& loops, const BlurWeights& weights, uint8_t* memory) {
    const int64_t count = cellsOf(weights.radius);
    uint8_t string[kMostCells + kWeightsBehindCell];
    fillString(weights, string);
    loops.fillCells(string, count, memory);
    auto* const totals = reinterpret_cast<uint32_t*>(memory + count * loops.cellBytes);
    uint32_t before = 0;
    for (int64_t i = 0; i < count; before += string[i++])
        totals[i] = before;

    PackedBlur blur = {};
    blur.radius = weights.radius;
    blur.total = weights.total;
    blur.inverse = inverseAbove(weights.total);
    blur.cells = memory + kCellsBefore * loops.cellBytes;
    blur.totals = totals + kCellsBefore;
    return blur;
}

}  // namespace

// --- Working memory -------------------------------------------------------------------------------

namespace {

/// More than any quad needs, so that groups rarely move.
constexpr int64_t kSpareGroups = 16;

/// The groups that 4 * quads rows of results need of `height` rows. Group 0 begins with row `firstRow`.
/// Groups without coverage are left out, and so there is no need to store those that lie wholly above or
/// below the rows.
GroupRange neededGroups(const BlurWeights& weights, int64_t height, int64_t firstRow, int64_t quads) {
    const int64_t end = quads - 1 + tapSteps(weights.radius);
    const int64_t first = std::min(end, std::max<int64_t>(0, -firstRow) / kQuad);
    return {first, std::clamp(quadsOf(std::max<int64_t>(0, height - firstRow)), first, end)};
}

TapGroups takeGroups(const DotLoops& loops, const BlurWeights& weights, int64_t width,
                     const GroupRange& needed, Arena& arena) {
    TapGroups taps = {};
    taps.missing = needed;
    taps.steps = tapSteps(weights.radius);
    taps.capacity = std::min(taps.steps - 1 + kSpareGroups, needed.end - needed.first);
    taps.strips = (width + loops.form.vectorBytes - 1) / loops.form.vectorBytes;
    taps.groupBytes = kQuad * loops.form.vectorBytes;
    const int64_t stripBytes = taps.groupBytes * taps.capacity;
    uint8_t* const groups = arena.take<uint8_t>(stripBytes * taps.strips);
    auto* const firstCovered = arena.take<int32_t>(taps.strips);
    auto* const lastCovered = arena.take<int32_t>(taps.strips);
    taps.columns = {groups, stripBytes, needed.first, width, firstCovered, lastCovered};
    return taps;
}

}  // namespace

void TapGroups::clear() const {
    std::fill_n(columns.firstCovered, strips, 0);
    std::fill_n(columns.lastCovered, strips, -1);
}

/// Makes room behind the groups from `group` on.
void TapGroups::forgetBefore(int64_t group) {
    VOREL_ASSERT(group > columns.firstGroup && group <= missing.first);
    const int64_t skipped = (group - columns.firstGroup) * groupBytes;
    const int64_t kept = (missing.first - group) * groupBytes;
    for (int64_t strip = 0; strip < strips; ++strip) {
        uint8_t* const groups = columns.groups + strip * columns.stripStride;
        std::memmove(groups, groups + skipped, static_cast<size_t>(kept));
    }
    columns.firstGroup = group;
}

DotBlur::Layout DotBlur::Layout::of(const DotLoops& loops, const BlurInput& input, Arena& arena) {
    const BlurWeights& weights = input.weights;
    const Box& window = input.window;
    Layout layout = {};
    layout.window = window;
    layout.source = ReachedSource::of(input);
    layout.firstRow = window.top - weights.radius - layout.source.top;
    layout.stride = strideFor(window.width());
    const CoverageRows& part = layout.source.part;
    const bool acrossFirst = input.order == BlurInput::Order::acrossThenDown;
    if (acrossFirst) layout.across = arena.take<uint8_t>(layout.stride * kQuad);
    const GroupRange needed =
        neededGroups(weights, part.height, layout.firstRow, quadsOf(window.height()));
    layout.taps = takeGroups(loops, weights, acrossFirst ? window.width() : part.width, needed, arena);

    layout.intermediate = PlacedIntermediate::of(input, layout.source, loops.form.vectorBytes, arena);
    layout.out = arena.take<uint8_t>(layout.stride * kQuad);
    return layout;
}

int64_t DotBlur::memoryBytes(const DotLoops& loops, const BlurInput& input) {
    Arena arena = {nullptr};
    static_cast<void>(Layout::of(loops, input, arena));
    return arena.used;
}

// --- Passes -----------------------------------------------------------------------------------------

DotBlur::DotBlur(const DotLoops& loops, const BlurInput& largest, int64_t memoryBytes)
    : mLoops(loops),
      mFirst(largest.first),
      mSecond(largest.second),
      mMemoryBytes(memoryBytes),
      mMemory(mMemoryBytes + packedBytes(loops, largest.weights.radius)) {
    if (mMemory) mBlur = packed(loops, largest.weights, mMemory.data() + mMemoryBytes);
}

void DotBlur::begin(const BlurInput& input) {
    Arena arena = {mMemory.data()};
    mLayout = Layout::of(mLoops, input, arena);
    VOREL_ASSERT(arena.used <= mMemoryBytes);
    mLayout.taps.clear();
    clear(mLoops.form, mLayout.intermediate.rows);
}

void DotBlur::blurAcross(const PassEnding& ending, uint8_t* out) {
    const Box& window = mLayout.window;
    VOREL_ASSERT(roundedUp(window.width(), mLoops.form.vectorBytes) <= mLayout.stride);
    const int64_t left = mLayout.intermediate.left;
    mLoops.across(mBlur, mLayout.intermediate.rows, window.left - left, window.right - left,
                  {out, mLayout.stride, ending});
}

void DotBlur::feed(int64_t group) {
    const CoverageRows& part = mLayout.source.part;
    const TapColumns& columns = mLayout.taps.columns;
    const int64_t row = mLayout.firstRow + kQuad * group;
    if (mLayout.across == nullptr) return mLoops.feed(part, row, columns, group);
    mLoops.copy(part, row, mLayout.intermediate.rows);
    blurAcross(mFirst, mLayout.across);
    const CoverageRows across = {mLayout.across, mLayout.stride, mLayout.window.width(), kQuad, kAsIs};
    mLoops.feed(across, 0, columns, group);
}

BlurredRows DotBlur::rows(int64_t y) {
    VOREL_ASSERT((y - mLayout.window.top) % kQuad == 0);
    const int64_t quad = (y - mLayout.window.top) / kQuad;
    mLayout.taps.complete(quad, [&](int64_t group) { feed(group); });
    const TapColumns& columns = mLayout.taps.columns;
    if (mLayout.across != nullptr) {
        mLoops.downToBytes(mBlur, columns, quad, {mLayout.out, mLayout.stride, mSecond});
    } else {
        mLoops.down(mBlur, columns, quad, mLayout.intermediate.rows);
        fillFullColumns(mLoops.form, mLayout.intermediate.rows);
        blurAcross(mSecond, mLayout.out);
    }
    return {mLayout.out, mLayout.stride};
}

}  // namespace VFontEffect::internal
