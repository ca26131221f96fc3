#pragma once

#include <algorithm>
#include <cstdint>

#include "core/line_buffer.h"
#include "core/pixel_buffer.h"
#include "cores/blur_kernel.h"
#include "cores/blur_kernels.h"
#include "cores/blur_window.h"

/// The blur by dot products, of any radius.
namespace VFontEffect::internal {

/// A kernel in the form of the chosen level's loops.
class BlurWeights {
  public:
    explicit BlurWeights(const BlurKernel& kernel);

    explicit operator bool() const { return static_cast<bool>(mMemory); }
    const PreparedBlur& operator*() const { return mBlur; }
    const PreparedBlur* operator->() const { return &mBlur; }

    /// Bytes of a pixel in a row between the passes.
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
    static GroupRange needed(const BlurWeights& weights, int64_t height, int64_t firstRow,
                             int64_t quads);
};

/// The rows in reach of the pass down, which come in groups of four while the results go by.
class TapGroups {
  public:
    /// For the groups of GroupRange::needed, of rows of `width` bytes.
    TapGroups(const BlurWeights& weights, int64_t width, int64_t height, int64_t firstRow,
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
class MiddleBuffer {
  public:
    MiddleBuffer(const BlurWeights& weights, int64_t inkColumn, int64_t columns,
                 const FullColumns& full);

    explicit operator bool() const { return mPixels && mInked; }
    const MiddleRows& rows() const { return mRows; }

  private:
    int64_t mStrideBytes;
    LineBuffer mPixels;
    PixelBuffer<uint8_t> mInked;
    MiddleRows mRows = {};
};

/// Blurs the columns first and then the rows, each pass rounding down, four rows at a time. What lies
/// around the source is 0, but for the full columns.
class DownThenAcross {
  public:
    DownThenAcross(const BlurKernel& kernel, const BlurSource& source, const Window& window,
                   const FullColumns& full);

    /// Whether there is memory for it.
    explicit operator bool() const { return mWeights && mTaps && mMiddle && mOut; }

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
    MiddleBuffer middleFor(const FullColumns& full);
    void blurQuad(int64_t quad, bool inverted);

    Window mWindow;
    BlurWeights mWeights;
    ReachedSource mSource;
    int64_t mFirstRow;  // of the source, the first of group 0
    TapGroups mTaps;
    int64_t mMiddleLeft;  // column of the source, column 0 between the passes
    MiddleBuffer mMiddle;
    int64_t mOutStride;
    LineBuffer mOut;
};

/// Blurs the rows of the source's inverse first and then the columns, each pass rounding down, four rows
/// at a time. What lies around the source is 255 in its inverse.
class AcrossThenDown {
  public:
    AcrossThenDown(const BlurKernel& kernel, const BlurSource& source, const Window& window);

    explicit operator bool() const { return mWeights && mMiddle && mAcross && mTaps && mOut; }

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

    Window mWindow;
    BlurWeights mWeights;
    ReachedSource mSource;
    int64_t mFirstRow;  // of the source, the first of group 0
    MiddleBuffer mMiddle;
    int64_t mStride;
    LineBuffer mAcross;
    TapGroups mTaps;
    LineBuffer mOut;
};

}  // namespace VFontEffect::internal
