#pragma once

#include <algorithm>
#include <cstdint>

#include "core/inline.h"
#include "core/line_buffer.h"
#include "core/numeric.h"
#include "core/views.h"
#include "ops/tile/tile_loops.h"

namespace VFontEffect::internal {

/// One axis of a tiling: from an output coordinate to the pattern pixels that it is mixed from.
class TileAxis {
  public:
    // A tile smaller than a pixel counts as one pixel.
    TileAxis(int64_t patternSize, float scale)
        : mPatternSize(patternSize),
          mScale(scale),
          mTileSize(std::max(1, toInt(scale * static_cast<float>(patternSize)))) {}

    /// Two neighbouring pattern pixels and their weights, which add up to 255.
    struct Tap {
        int32_t near;
        int32_t far;
        uint32_t nearWeight;
        uint32_t farWeight;
    };
    VOREL_INLINE Tap at(int64_t coordinate) const {
        const int64_t inTile = coordinate < mTileSize ? coordinate : coordinate % mTileSize;
        const float position = static_cast<float>(inTile) / mScale;
        const int32_t whole = toInt(position);
        const auto fraction = position - static_cast<float>(whole);
        const auto farWeight = static_cast<uint32_t>(std::clamp(toInt(fraction * 255.0F), 0, 255));
        const int64_t near = std::clamp<int64_t>(whole, 0, mPatternSize - 1);
        const int64_t far = near + 1 < mPatternSize ? near + 1 : 0;
        return {static_cast<int32_t>(near), static_cast<int32_t>(far), 255 - farWeight, farWeight};
    }

    /// Output pixels after which the taps repeat.
    int64_t period() const { return mTileSize; }

  private:
    int64_t mPatternSize;
    float mScale;
    int64_t mTileSize;
};

/// A pattern laid from a corner on, row by row: its sampling, planned once. It is ready, or empty when
/// memory ran out. Of what repeats along a row, one tile is sampled.
///
/// A pixel is the sum of four pattern pixels times both their weights. No step of it is rounded, so it
/// may be mixed along the columns first, once for each row of the pattern, and the output rows between
/// two pattern rows share these.
class TilePlan {
  public:
    /// Rows of `width` pixels. The pattern, in memory A, R, G, B, is not empty and must outlive the
    /// plan.
    TilePlan(CpuLevel level, const ColourView& pattern, float scale, float opacity, int64_t width);

    explicit operator bool() const { return static_cast<bool>(mMemory); }

    /// Row y: R, G, B, A, premultiplied. It stays until the next call.
    const uint32_t* row(int64_t y);

  private:
    static constexpr int32_t kNoRow = -1;

    /// A pattern row mixed along its columns.
    struct KeptRow {
        MixedRow mixed = {};
        int32_t row = kNoRow;
    };

    int64_t layOut(uint8_t* memory);
    void listTaps();
    ColumnTaps taps() const;
    MixedRow mixedRow(int32_t row, int32_t other);
    void repeat();

    const TileLoops& mLoops;
    ColourView mPattern;
    TileAxis mColumns;
    TileAxis mRows;
    float mOpacity;
    int64_t mWidth;
    int64_t mSampled;
    int64_t mLength;            ///< of what is kept for each sampled column
    uint32_t* mTaps = nullptr;  ///< four planes of words, as ColumnTaps names them
    KeptRow mMixed[2];
    uint32_t* mRow = nullptr;
    LineBuffer mMemory;
};

}  // namespace VFontEffect::internal
