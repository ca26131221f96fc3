#pragma once

#include <algorithm>
#include <cstdint>

#include "core/line_buffer.h"
#include "core/pixel_buffer.h"
#include "ops/blur/blur_weights.h"
#include "ops/blur/dot_loops.h"
#include "ops/blur/reached_source.h"

/// The blur by dot products, of any radius.
namespace VFontEffect::internal {

/// A kernel in the form of the chosen level's loops.
class PackedWeights {
  public:
    explicit PackedWeights(const BlurWeights& kernel);

    explicit operator bool() const { return static_cast<bool>(mMemory); }
    const PreparedBlur& operator*() const { return mBlur; }
    const PreparedBlur* operator->() const { return &mBlur; }

    /// U8s of a pixel in a row between the passes.
    int64_t pixelBytes() const { return mBlur.isNarrow ? kNarrowPixelBytes : 1; }

  private:
    PixelBuffer<uint8_t> mMemory;
    PreparedBlur mBlur;
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
    TapGroups(const PackedWeights& weights, int64_t width, int64_t height, int64_t firstRow,
              int64_t quads);

    explicit operator bool() const { return mMemory && mInked; }
    const TapColumns& columns() const { return mColumns; }

    /// Calls feed(group) for each group that is still missing for a quad of results.
    template <class Feed>
    void complete(int64_t quad, Feed feed) {
        const int64_t end = std::min(quad + mSteps, mMissing.end);
        for (; mMissing.first < end; ++mMissing.first) {
            if (mMissing.first == mColumns.firstGroup + mCapacity) forgetBefore(quad);
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
    PixelBuffer<int32_t> mInked;
    TapColumns mColumns = {};
};

/// Four rows between the passes.
class IntermediateBuffer {
  public:
    IntermediateBuffer(const PackedWeights& weights, int64_t inkColumn, int64_t columns,
                       const FullColumns& full);

    explicit operator bool() const { return mPixels && mInked; }
    const IntermediateRows& rows() const { return mRows; }

  private:
    int64_t mStrideBytes;
    LineBuffer mPixels;
    PixelBuffer<uint8_t> mInked;
    IntermediateRows mRows = {};
};

/// Blurs the columns first and then the rows, each pass rounding down, four rows at a time. What lies
/// around the source is 0, but for the full columns.
class DownThenAcross {
  public:
    DownThenAcross(const BlurWeights& kernel, const BlurSource& source, const Box& window,
                   const FullColumns& full);

    /// Whether there is memory for it.
    explicit operator bool() const { return mWeights && mTaps && mIntermediate && mOut; }

    /// Calls paint(y, rows, values, stride) for up to kQuad rows of the window at a time. `inverted`
    /// gives 255 minus the mean of the second pass, rounded down as a whole.
    template <class Paint>
    void run(bool inverted, Paint paint) {
        for (int64_t y = 0; y < mWindow.height(); y += kQuad) {
            blurQuad(y / kQuad, inverted);
            paint(mWindow.top + y, std::min(kQuad, mWindow.height() - y), mOut.data(), mOutStride);
        }
    }

  private:
    IntermediateBuffer intermediateFor(const FullColumns& full);
    void blurQuad(int64_t quad, bool inverted);

    Box mWindow;
    PackedWeights mWeights;
    ReachedSource mSource;
    int64_t mFirstRow;  // of the source, the first of group 0
    TapGroups mTaps;
    int64_t mIntermediateLeft;  // column of the source, column 0 between the passes
    IntermediateBuffer mIntermediate;
    int64_t mOutStride;
    LineBuffer mOut;
};

/// Blurs the rows of the source's inverse first and then the columns, each pass rounding down, four rows
/// at a time. What lies around the source is 255 in its inverse.
class AcrossThenDown {
  public:
    AcrossThenDown(const BlurWeights& kernel, const BlurSource& source, const Box& window);

    explicit operator bool() const { return mWeights && mIntermediate && mAcross && mTaps && mOut; }

    /// Calls paint(y, rows, values, stride) for up to kQuad rows of the window at a time.
    template <class Paint>
    void run(Paint paint) {
        for (int64_t y = 0; y < mWindow.height(); y += kQuad) {
            blurQuad(y / kQuad);
            paint(mWindow.top + y, std::min(kQuad, mWindow.height() - y), mOut.data(), mStride);
        }
    }

  private:
    void blurQuad(int64_t quad);

    Box mWindow;
    PackedWeights mWeights;
    ReachedSource mSource;
    int64_t mFirstRow;  // of the source, the first of group 0
    IntermediateBuffer mIntermediate;
    int64_t mStride;
    LineBuffer mAcross;
    TapGroups mTaps;
    LineBuffer mOut;
};

}  // namespace VFontEffect::internal
