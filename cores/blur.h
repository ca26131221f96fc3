#pragma once

#include <algorithm>
#include <cstdint>

#include "blend/clip.h"
#include "core/pixel_buffer.h"
#include "cores/blur_kernels.h"
#include "cores/paint_input.h"

/// The separable integer Gaussian blur of shadows and glows.
///
/// A tap at distance k weighs weights[|k|]. The weight falls as exp(-k^2 / d), where d = R^2 / ln 100
/// makes the weight at the radius one hundredth of the centre's. Each pass divides its sum by the
/// total of all weights, truncating, so the order of the passes shows in single units and is fixed.
namespace VFontEffect::internal {

constexpr int kShadowScale = 100;
constexpr int kGlowScale = 128;

struct BlurKernel {
    PixelBuffer<uint32_t> weights;
    int radius;
    uint32_t total;

    explicit operator bool() const { return static_cast<bool>(weights); }
};

/// Weights on a scale of 100, rounded in single precision.
BlurKernel shadowKernel(int radius);

/// Weights on a scale of 128, rounded in double precision.
BlurKernel glowKernel(int radius);

/// The smallest float that is not below 1 / total. With it the product in single precision of any sum up
/// to 256 * total - 1, truncated, is the whole quotient, while total is at most 26,000: a sum of
/// n * total gives n or more, and one less gives n - 1 / total plus at most 2^-15, which is more than
/// half a step of single precision below n.
float inverseAbove(uint32_t total);

/// For sums up to 256 * divisor - 1, a divisor of 2 to 255.
NarrowDivision narrowDivision(uint32_t divisor);

/// The blur in the form of the chosen level's loops, which read from `room`.
PreparedBlur prepareBlur(const BlurKernel& kernel, PixelBuffer<uint8_t>& room);
PixelBuffer<uint8_t> roomForWeights(int radius);

/// A part of a picture, in the coordinates of what is blurred.
using Window = Clip;

/// The coverage of a box.
inline BlurSource sourceOf(const CoverageBox& box) {
    return {box.row(0), box.mask.width, box.width, box.height, 0};
}

/// The part of a source that the results in a window depend on, and its place in the source.
struct ReachedSource {
    BlurSource part;
    int64_t left;
    int64_t top;

    static ReachedSource of(const BlurSource& source, int64_t radius, const Window& window);
};

/// Columns before the one and from the other on count as 255 between the passes.
struct FullColumns {
    int64_t before;
    int64_t from;
};
constexpr FullColumns kNoFullColumns = {INT64_MIN, INT64_MAX};

/// Rows of the middle plane and their memory.
struct MiddleBuffer {
    PixelBuffer<uint8_t> pixels;
    PixelBuffer<uint8_t> inked;
    MiddlePlane plane;

    explicit operator bool() const { return pixels && inked; }

    /// For `rows` rows; the source's columns are those from `inkColumn` on.
    static MiddleBuffer of(const PreparedBlur& blur, int64_t rows, int64_t inkColumn, int64_t columns,
                           const FullColumns& full);
};

/// Blurs the columns first and then the rows, each pass rounding down, a band of rows at a time: the
/// working memory is that of a band. What lies around the source is 0, but for the full columns.
class DownThenAcross {
  public:
    DownThenAcross(const BlurKernel& kernel, const BlurSource& source, const Window& window,
                   const FullColumns& full);

    /// Whether there is memory for it.
    explicit operator bool() const { return mBlur && mStrip && mMiddle && mOut; }

    /// Calls paint(y, rows, values, stride) for up to kQuad rows of the window at a time; `inverted`
    /// gives 255 minus the mean in the second pass, rounded down as a whole.
    template <class Paint>
    void run(bool inverted, Paint paint) {
        for (int64_t top = mWindow.top; top < mWindow.bottom; top += kBandRows) {
            const int64_t rows = std::min(kBandRows, mWindow.bottom - top);
            blurBandDown(top, rows);
            for (int64_t y = 0; y < rows; y += kQuad) {
                blurQuadAcross(y / kQuad, inverted);
                paint(top + y, std::min(kQuad, rows - y), mOut.data(), mOutStride);
            }
        }
    }

  private:
    static constexpr int64_t kBandRows = 64;

    MiddleBuffer middleFor(const FullColumns& full);
    void blurBandDown(int64_t top, int64_t rows);
    void blurQuadAcross(int64_t quad, bool inverted);

    Window mWindow;
    PixelBuffer<uint8_t> mWeights;
    PreparedBlur mBlur;
    ReachedSource mSource;
    int64_t mMiddleLeft;  // column of the source that is column 0 of the middle plane
    PixelBuffer<uint8_t> mStrip;
    MiddleBuffer mMiddle;
    int64_t mOutStride;
    PixelBuffer<uint8_t> mOut;
};

/// Blurs the rows of the source's inverse first and then the columns, each pass rounding down. What lies
/// around the source is 255 in its inverse.
class AcrossThenDown {
  public:
    AcrossThenDown(const BlurKernel& kernel, const BlurSource& source, const Window& window);

    explicit operator bool() const { return mBlur && mStrip && mMiddle && mAcross && mOut; }

    /// Calls paint(y, rows, values, stride) for some rows of the window at a time.
    template <class Paint>
    void run(Paint paint) {
        blurAcross();
        for (int64_t top = mWindow.top; top < mWindow.bottom; top += kBandRows) {
            const int64_t rows = std::min(kBandRows, mWindow.bottom - top);
            blurBandDown(top, rows);
            paint(top, rows, mOut.data(), mStride);
        }
    }

  private:
    static constexpr int64_t kBandRows = 64;

    void blurAcross();
    void blurBandDown(int64_t top, int64_t rows);

    Window mWindow;
    PixelBuffer<uint8_t> mWeights;
    PreparedBlur mBlur;
    ReachedSource mSource;
    PixelBuffer<uint8_t> mStrip;
    MiddleBuffer mMiddle;
    int64_t mStride;
    PixelBuffer<uint8_t> mAcross;
    PixelBuffer<uint8_t> mOut;
};

}  // namespace VFontEffect::internal
