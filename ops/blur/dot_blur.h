#pragma once

#include <algorithm>
#include <cstdint>
#include <optional>

#include "core/assert.h"
#include "core/line_buffer.h"
#include "core/pixel_buffer.h"
#include "ops/blur/blur_input.h"
#include "ops/blur/dot_loops.h"

namespace VFontEffect::internal {

/// Weights in the form of a level's loops.
class PackedWeights {
  public:
    PackedWeights(const DotLoops& loops, const BlurWeights& weights);

    explicit operator bool() const { return static_cast<bool>(mMemory); }
    const PackedBlur& operator*() const { return mBlur; }
    const PackedBlur* operator->() const { return &mBlur; }

    /// Bytes of a pixel in a row between the passes.
    int64_t pixelBytes() const { return mBlur.isNarrow ? kNarrowPixelBytes : 1; }

  private:
    PixelBuffer<uint8_t> mMemory;
    PackedBlur mBlur;
};

/// Groups of four rows.
struct GroupRange {
    int64_t first;
    int64_t end;

    /// The groups that 4 * quads rows of results need of `height` rows. Group 0 begins with row
    /// `firstRow`.
    static GroupRange needed(const PackedWeights& weights, int64_t height, int64_t firstRow,
                             int64_t quads);
};

/// The rows in reach of the pass down, which come in groups of four while the results go by.
class TapGroups {
  public:
    /// For the groups of GroupRange::needed, of rows of `width` bytes.
    TapGroups(const DotLoops& loops, const PackedWeights& weights, int64_t width, int64_t height,
              int64_t firstRow, int64_t quads);

    explicit operator bool() const { return mMemory && mCovered; }
    const TapColumns& columns() const { return mColumns; }

    /// Calls feed(group) for each group that is still missing for a quad of results.
    template <class Feed>
    void complete(int64_t quad, Feed feed) {
        const int64_t end = std::min(quad + mSteps, mMissing.end);
        for (; mMissing.first < end; ++mMissing.first) {
            if (mMissing.first == mColumns.firstGroup + mCapacity) forgetBefore(quad);
            VOREL_ASSERT(mMissing.first - mColumns.firstGroup < mCapacity);
            feed(mMissing.first);
        }
    }

  private:
    void forgetBefore(int64_t group);

    /// More than any quad needs, so that groups rarely move.
    static constexpr int64_t kSpareGroups = 16;

    int64_t mSteps;
    GroupRange mMissing;
    int64_t mCapacity;
    int64_t mStrips;
    int64_t mGroupBytes;
    LineBuffer mMemory;
    PixelBuffer<int32_t> mCovered;
    TapColumns mColumns = {};
};

/// Four rows that are blurred across.
class IntermediateBuffer {
  public:
    IntermediateBuffer(const DotLoops& loops, const PackedWeights& weights, int64_t coveredColumn,
                       int64_t columns, const FullColumns& full);

    explicit operator bool() const { return mPixels && mCovered; }
    const IntermediateRows& rows() const { return mRows; }

  private:
    int64_t mStrideBytes;
    LineBuffer mPixels;
    PixelBuffer<uint8_t> mCovered;
    IntermediateRows mRows = {};
};

/// A blur by dot products, of any radius, four rows at a time: the two orders of the passes differ in
/// which one feeds the groups of taps.
class DotBlur {
  public:
    DotBlur(const DotLoops& loops, const BlurInput& input);

    /// Whether there is memory for it.
    explicit operator bool() const {
        return mWeights && mTaps && mIntermediate && mOut && (!mAcross || *mAcross);
    }

    /// Up to kQuad rows from row y on, in order.
    BlurredRows rows(int64_t y);

  private:
    IntermediateBuffer intermediateFor(const FullColumns& full);
    void feed(int64_t group);
    void blurAcross(const PassEnding& ending, uint8_t* out);

    const DotLoops& mLoops;
    Box mWindow;
    PassEnding mFirst;
    PassEnding mSecond;
    PackedWeights mWeights;
    ReachedSource mSource;
    int64_t mFirstRow;                  // of the source, the first of group 0
    int64_t mStride;                    // of results
    std::optional<LineBuffer> mAcross;  // results of the pass across, when it is the first
    TapGroups mTaps;
    int64_t mIntermediateLeft;  // column of the source, column 0 of the rows that are blurred across
    IntermediateBuffer mIntermediate;
    LineBuffer mOut;
};

}  // namespace VFontEffect::internal
