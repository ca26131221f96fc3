#include "ops/tile/tile_plan.h"

#include <algorithm>
#include <cstring>

#include "core/assert.h"

namespace VFontEffect::internal {
namespace {

/// A weight as the loops take it.
constexpr uint32_t kBothHalves = 0x00010001U;

}  // namespace

TilePlan::KeptRow::KeptRow(int64_t width)
    : planes(PixelBuffer<uint32_t>::uninitialised(width + kTileSlack, 2)), length(width + kTileSlack) {}

TilePlan::TilePlan(CpuLevel level, const ColourView& pattern, float scale, float opacity, int64_t width)
    : mLoops(tileLoops(level)),
      mPattern(pattern),
      mColumns(pattern.width, scale),
      mRows(pattern.height, scale),
      mOpacity(opacity),
      mWidth(width),
      mSampled(std::min(width, mColumns.period())),
      mTaps(PixelBuffer<uint32_t>::uninitialised(mSampled + kTileSlack, 4)),
      mMixed{KeptRow(mSampled), KeptRow(mSampled)},
      mRow(PixelBuffer<uint32_t>::uninitialised(width + kTileSlack)) {
    VOREL_ASSERT(pattern && pattern.width > 0 && pattern.height > 0);
    if (mTaps) listTaps();
}

/// Four planes of words, as ColumnTaps names them.
void TilePlan::listTaps() {
    const int64_t length = mSampled + kTileSlack;
    uint32_t* const words = mTaps.data();
    for (int64_t x = 0; x < length; ++x) {
        // Pixels are looked up for the columns behind the last one too.
        const TileAxis::Tap tap = x < mSampled ? mColumns.at(x) : TileAxis::Tap{};
        words[x] = static_cast<uint32_t>(tap.near);
        words[length + x] = static_cast<uint32_t>(tap.far);
        words[2 * length + x] = tap.nearWeight * kBothHalves;
        words[3 * length + x] = tap.farWeight * kBothHalves;
    }
}

ColumnTaps TilePlan::taps() {
    const int64_t length = mSampled + kTileSlack;
    const uint32_t* const words = mTaps.data();
    const auto* const columns = reinterpret_cast<const int32_t*>(words);
    return {columns, columns + length, words + 2 * length, words + 3 * length};
}

const uint32_t* TilePlan::row(int64_t y) {
    VOREL_ASSERT(*this && y >= 0);
    const TileAxis::Tap rows = mRows.at(y);
    const MixedRow near = mixedRow(rows.near, rows.far);
    const MixedRow far = mixedRow(rows.far, rows.near);
    mLoops.mixRows(near, far, rows.nearWeight, rows.farWeight, mOpacity, mSampled, mRow.data());
    repeat();
    return mRow.data();
}

/// The mixed row of the pattern, in the place of whichever kept one is not `other`.
MixedRow TilePlan::mixedRow(int32_t row, int32_t other) {
    for (KeptRow& kept : mMixed) {
        if (kept.row == row) return kept.mixed();
    }
    KeptRow& replaced = mMixed[0].row == other ? mMixed[1] : mMixed[0];
    replaced.row = row;
    const auto* const words = reinterpret_cast<const uint32_t*>(mPattern.at(0, row));
    mLoops.mixColumns(words, taps(), mSampled, replaced.mixed());
    return replaced.mixed();
}

/// Copies the tile to the rest of the row, twice as much each time.
void TilePlan::repeat() {
    for (int64_t done = mSampled; done < mWidth; done *= 2) {
        const int64_t count = std::min(done, mWidth - done);
        std::memcpy(mRow.data() + done, mRow.data(), static_cast<size_t>(count) * sizeof(uint32_t));
    }
}

}  // namespace VFontEffect::internal
