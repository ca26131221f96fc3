#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "core/numeric.h"
#include "core/pixel_buffer.h"
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
    Tap at(int64_t coordinate) const {
        const float position = static_cast<float>(coordinate % mTileSize) / mScale;
        const float whole = std::floor(position);
        const auto farWeight =
            static_cast<uint32_t>(std::clamp(toInt((position - whole) * 255.0F), 0, 255));
        const int64_t near = std::clamp<int64_t>(toInt(whole), 0, mPatternSize - 1);
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

    explicit operator bool() const { return mTaps && mMixed[0].planes && mMixed[1].planes && mRow; }

    /// Row y: R, G, B, A, premultiplied. It stays until the next call.
    const uint32_t* row(int64_t y);

  private:
    static constexpr int32_t kNoRow = -1;

    /// A pattern row mixed along its columns.
    struct KeptRow {
        explicit KeptRow(int64_t width);
        MixedRow mixed() { return {planes.data(), planes.data() + length}; }

        PixelBuffer<uint32_t> planes;
        int64_t length;
        int32_t row = kNoRow;
    };

    void listTaps();
    ColumnTaps taps();
    MixedRow mixedRow(int32_t row, int32_t other);
    void repeat();

    const TileLoops& mLoops;
    ColourView mPattern;
    TileAxis mColumns;
    TileAxis mRows;
    float mOpacity;
    int64_t mWidth;
    int64_t mSampled;
    PixelBuffer<uint32_t> mTaps;
    KeptRow mMixed[2];
    PixelBuffer<uint32_t> mRow;
};

}  // namespace VFontEffect::internal
