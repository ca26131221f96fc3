#include "ops/tile/tile_plan.h"

#include <algorithm>
#include <cstring>

#include "core/arena.h"
#include "core/assert.h"

namespace VFontEffect::internal {
namespace {

/// A weight as the loops take it.
constexpr uint32_t kBothHalves = 0x00010001U;

}  // namespace

TilePlan::TilePlan(CpuLevel level, const ColourView& pattern, float scale, float opacity, int64_t width)
    : mLoops(tileLoops(level)),
      mPattern(pattern),
      mColumns(pattern.width, scale),
      mRows(pattern.height, scale),
      mOpacity(opacity),
      mWidth(width),
      mSampled(std::min(width, mColumns.period())),
      mLength(mSampled + kTileSlack),
      mMemory(layOut(nullptr)) {
    VOREL_ASSERT(pattern && pattern.width > 0 && pattern.height > 0);
    if (!mMemory) return;
    layOut(mMemory.data());
    listTaps();
}

/// Returns how many bytes that takes.
int64_t TilePlan::layOut(uint8_t* memory) {
    Arena arena = {memory};
    mTaps = arena.take<uint32_t>(4 * mLength);
    for (KeptRow& kept : mMixed)
        kept.mixed = {arena.take<uint32_t>(mLength), arena.take<uint32_t>(mLength)};
    mRow = arena.take<uint32_t>(mWidth + kTileSlack);
    return arena.used;
}

void TilePlan::listTaps() {
    for (int64_t x = 0; x < mLength; ++x) {
        // Pixels are looked up for the columns behind the last one too.
        const TileAxis::Tap tap = x < mSampled ? mColumns.at(x) : TileAxis::Tap{};
        mTaps[x] = static_cast<uint32_t>(tap.near);
        mTaps[mLength + x] = static_cast<uint32_t>(tap.far);
        mTaps[2 * mLength + x] = tap.nearWeight * kBothHalves;
        mTaps[3 * mLength + x] = tap.farWeight * kBothHalves;
    }
}

ColumnTaps TilePlan::taps() const {
    const auto* const columns = reinterpret_cast<const int32_t*>(mTaps);
    return {columns, columns + mLength, mTaps + 2 * mLength, mTaps + 3 * mLength};
}

const uint32_t* TilePlan::row(int64_t y) {
    VOREL_ASSERT(*this && y >= 0);
    const TileAxis::Tap rows = mRows.at(y);
    const MixedRow near = mixedRow(rows.near, rows.far);
    const MixedRow far = mixedRow(rows.far, rows.near);
    mLoops.mixRows(near, far, rows.nearWeight, rows.farWeight, mOpacity, mSampled, mRow);
    repeat();
    return mRow;
}

/// The mixed row of the pattern, in the place of whichever kept one is not `other`.
MixedRow TilePlan::mixedRow(int32_t row, int32_t other) {
    for (KeptRow& kept : mMixed) {
        if (kept.row == row) return kept.mixed;
    }
    KeptRow& replaced = mMixed[0].row == other ? mMixed[1] : mMixed[0];
    replaced.row = row;
    const auto* const words = reinterpret_cast<const uint32_t*>(mPattern.at(0, row));
    mLoops.mixColumns(words, taps(), mSampled, replaced.mixed);
    return replaced.mixed;
}

/// Copies the tile to the rest of the row, twice as much each time.
void TilePlan::repeat() {
    for (int64_t done = mSampled; done < mWidth; done *= 2) {
        const int64_t count = std::min(done, mWidth - done);
        std::memcpy(mRow + done, mRow, static_cast<size_t>(count) * sizeof(uint32_t));
    }
}

}  // namespace VFontEffect::internal
