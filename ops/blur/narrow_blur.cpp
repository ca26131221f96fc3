#include "ops/blur/narrow_blur.h"

#include <cstdint>
#include <cstring>

#include "core/assert.h"
#include "core/numeric.h"

namespace VFontEffect::internal {
namespace {

/// Quads of rows with the taps of one quad of results, at most.
constexpr int64_t kKeptQuads = (kMostTapRows + kQuad - 1) / kQuad;

NarrowWeights narrowed(const BlurWeights& weights) {
    VOREL_ASSERT(NarrowBlur::suits(weights));
    const uint32_t scale = weights.total < 128 ? 2 : 1;
    NarrowWeights narrow = {};
    for (int k = 0; k <= weights.radius; ++k)
        narrow.byDistance[k] = static_cast<uint8_t>(weights.byDistance[k] * scale);
    narrow.total = static_cast<uint16_t>(weights.total * scale);
    VOREL_ASSERT(narrow.total >= 128);
    narrow.division = narrowDivision(narrow.total);
    return narrow;
}

}  // namespace

bool NarrowBlur::suits(const BlurWeights& weights) {
    return weights.radius >= 1 && weights.radius <= kLargestNarrowRadius && weights.total <= 0xFF;
}

// --- Working memory -------------------------------------------------------------------------------

NarrowBlur::Layout NarrowBlur::Layout::of(const NarrowLoops& loops, const BlurInput& input,
                                          Arena& arena) {
    Layout layout = {};
    layout.window = input.window;
    layout.source = ReachedSource::of(input);
    layout.isAcrossFirst = input.order == BlurInput::Order::acrossThenDown;
    layout.firstRow = input.window.top - input.weights.radius - layout.source.top;
    layout.stride = roundedUp(input.window.width(), kWidestVector);
    const int64_t vectorBytes = loops.form.vectorBytes;
    layout.intermediate = PlacedIntermediate::of(input, layout.source, vectorBytes, arena);
    const CoverageRows& part = layout.source.part;
    layout.keepsRows = layout.isAcrossFirst || part.invertMask != kAsIs || part.width < vectorBytes;
    IntermediateRows& kept = layout.kept;
    kept.columns = roundedUp(layout.isAcrossFirst ? input.window.width() : part.width, vectorBytes);
    kept.strideBytes = kept.columns;
    kept.start = arena.take<uint8_t>(kept.strideBytes * kQuad * kKeptQuads);
    kept.covered = arena.take<uint8_t>(kept.columns / vectorBytes);
    layout.out = arena.take<uint8_t>(layout.stride * kQuad);
    return layout;
}

int64_t NarrowBlur::memoryBytes(const NarrowLoops& loops, const BlurInput& input) {
    Arena arena = {nullptr};
    static_cast<void>(Layout::of(loops, input, arena));
    return arena.used;
}

// --- Passes -----------------------------------------------------------------------------------------

NarrowBlur::NarrowBlur(const NarrowLoops& loops, const BlurInput& largest, int64_t memoryBytes)
    : mLoops(loops),
      mPasses(loops.ofRadius[largest.weights.radius - 1]),
      mRadius(largest.weights.radius),
      mWeights(narrowed(largest.weights)),
      mFirst(largest.first),
      mSecond(largest.second),
      mMemoryBytes(memoryBytes),
      mMemory(mMemoryBytes) {}

void NarrowBlur::begin(const BlurInput& input) {
    Arena arena = {mMemory.data()};
    mLayout = Layout::of(mLoops, input, arena);
    VOREL_ASSERT(arena.used <= mMemoryBytes);
    mKeptQuads = 0;
    if (!mLayout.keepsRows)
        std::memset(mLayout.kept.start, 0, static_cast<size_t>(mLayout.kept.strideBytes));
    clear(mLoops.form, mLayout.intermediate.rows);
}

void NarrowBlur::blurDown(int64_t quad) {
    const IntermediateRows& rows = mLayout.intermediate.rows;
    const auto& [vectorBytes, tapBias] = mLoops.form;
    const int64_t vectors = roundedUp(rows.columns, vectorBytes) / vectorBytes;
    std::memset(rows.covered, 0, static_cast<size_t>(vectors));
    const PassEnding ending = {mFirst.roundsUp, tapBias};
    mPasses.down(mWeights, tapsOf(quad), {rows.start + rows.coveredColumn, rows.strideBytes, ending},
                 rows.covered + rows.coveredColumn / vectorBytes);
    fillFullColumns(mLoops.form, rows);
}

void NarrowBlur::blurAcross(const PassEnding& ending, uint8_t* out, int64_t stride) {
    const Box& window = mLayout.window;
    const int64_t left = mLayout.intermediate.left;
    mPasses.across(mWeights, mLayout.intermediate.rows, window.left - left, window.right - left,
                   {out, stride, ending});
}

/// Tap rows are counted from those of the uppermost taps on.
uint8_t* NarrowBlur::keptRow(int64_t tapRow) const {
    return mLayout.kept.start + tapRow % (kKeptQuads * kQuad) * mLayout.kept.strideBytes;
}

void NarrowBlur::keep(int64_t quad) {
    const CoverageRows& part = mLayout.source.part;
    const int64_t row = mLayout.firstRow + kQuad * quad;
    uint8_t* const to = keptRow(kQuad * quad);
    if (mLayout.isAcrossFirst) {
        mLoops.copy(part, row, mLoops.form.tapBias, mLayout.intermediate.rows);
        blurAcross(mFirst, to, mLayout.kept.strideBytes);
    } else {
        IntermediateRows kept = mLayout.kept;
        kept.start = to;
        mLoops.copy(part, row, kAsIs, kept);
    }
}

TapRows NarrowBlur::tapsOf(int64_t quad) const {
    const CoverageRows& part = mLayout.source.part;
    TapRows taps = {};
    taps.width = mLayout.keepsRows ? mLayout.kept.columns : part.width;
    for (int64_t i = 0; i < kQuad + 2 * int64_t{mRadius}; ++i) {
        const int64_t tapRow = kQuad * quad + i;
        const int64_t y = mLayout.firstRow + tapRow;
        if (mLayout.keepsRows) {
            taps.rows[i] = keptRow(tapRow);
        } else {
            taps.rows[i] = y >= 0 && y < part.height ? part.start + y * part.stride : mLayout.kept.start;
        }
    }
    return taps;
}

BlurredRows NarrowBlur::rows(int64_t y) {
    VOREL_ASSERT((y - mLayout.window.top) % kQuad == 0);
    const int64_t quad = (y - mLayout.window.top) / kQuad;
    if (mLayout.keepsRows) {
        const int64_t lastTapRow = kQuad * (quad + 1) + 2 * int64_t{mRadius} - 1;
        for (; mKeptQuads <= lastTapRow / kQuad; ++mKeptQuads)
            keep(mKeptQuads);
    }
    if (mLayout.isAcrossFirst) {
        mPasses.down(mWeights, tapsOf(quad), {mLayout.out, mLayout.stride, mSecond},
                     mLayout.kept.covered);
    } else {
        blurDown(quad);
        blurAcross(mSecond, mLayout.out, mLayout.stride);
    }
    return {mLayout.out, mLayout.stride};
}

}  // namespace VFontEffect::internal
