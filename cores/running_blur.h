#pragma once

#include <algorithm>
#include <cstdint>

#include "core/line_buffer.h"
#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "cores/blur_kernel.h"
#include "cores/blur_window.h"
#include "cores/running_kernels.h"

/// The blur by running sums, for wide kernels.
namespace VFontEffect::internal {

/// A difference of a kernel as a sum of few lines.
class KernelTerms {
  public:
    explicit KernelTerms(const BlurKernel& kernel);

    /// Whether there is memory for it.
    explicit operator bool() const { return static_cast<bool>(mMemory); }
    const RunningTerms& operator*() const { return mTerms; }

  private:
    PixelBuffer<int32_t> mMemory;
    RunningTerms mTerms;
};

/// What both orders of the passes need.
class RunningPasses {
  public:
    RunningPasses(const BlurKernel& kernel, const BlurSource& source, const Window& window);

    explicit operator bool() const { return static_cast<bool>(mTerms); }
    const Window& window() const { return mWindow; }
    const ReachedSource& source() const { return mSource; }
    int radius() const { return mRadius; }

    /// A vector's bytes, the sides of squares.
    int64_t side() const { return mSide; }
    int64_t inSquares(int64_t pixels) const { return roundedUp(pixels, mSide); }
    /// The working memory of strips whose sources have up to so many rows.
    LineBuffer linesFor(int64_t rows) const;

    void blurStrip(const BlurEnding& ending, const BlurSource& source, int64_t x, LineBuffer& lines,
                   int64_t first, int64_t count, const SquareRows& out) const;

  private:
    Window mWindow;
    ReachedSource mSource;
    int64_t mSide;
    int mRadius;
    uint32_t mTotal;
    float mInverse;
    KernelTerms mTerms;
};

/// Blurs the columns first and then the rows, as DownThenAcross does.
class RunningDownThenAcross {
  public:
    RunningDownThenAcross(const BlurKernel& kernel, const BlurSource& source, const Window& window,
                          const FullColumns& full);

    /// Whether there is memory for it.
    explicit operator bool() const { return mPasses && mLines && mMiddle && mOut; }

    /// Calls paint(y, rows, values, stride) for some rows of the window at a time.
    template <class Paint>
    void run(bool inverted, Paint paint) {
        blurDown();
        const Window& window = mPasses.window();
        for (int64_t y = 0; y < window.height(); y += mPasses.side()) {
            blurAcross(y, inverted);
            paint(window.top + y, std::min(mPasses.side(), window.height() - y), mOut.data(),
                  mOutStride);
        }
    }

  private:
    /// Between the passes there are the columns of the source, or when some of the full ones are in
    /// reach all columns that are.
    struct MiddleColumns {
        int64_t left;       // column of the source, column 0 here
        int64_t count;      // that the second pass reads
        int64_t allocated;  // and those of whole squares

        static MiddleColumns of(const RunningPasses& passes, const FullColumns& full);
    };

    void blurDown();
    void fillAround(uint8_t* band);
    void blurAcross(int64_t y, bool inverted);
    uint8_t* bandAt(int64_t y) { return mMiddle.data() + y * mColumns.allocated; }

    RunningPasses mPasses;
    FullColumns mFull;
    MiddleColumns mColumns;
    LineBuffer mLines;
    LineBuffer mMiddle;  // for each column a line of a square's side, in bands one below the other
    int64_t mOutStride;
    LineBuffer mOut;
};

/// Blurs the rows of the source's inverse first and then the columns, as AcrossThenDown does.
class RunningAcrossThenDown {
  public:
    RunningAcrossThenDown(const BlurKernel& kernel, const BlurSource& source, const Window& window);

    explicit operator bool() const { return mPasses && mLines && mTurned && mMiddle && mOut; }

    /// Calls paint(y, rows, values, stride) for all rows of the window.
    template <class Paint>
    void run(Paint paint) {
        blurAcross();
        blurDown();
        paint(mPasses.window().top, mPasses.window().height(), mOut.data(), mOutStride);
    }

  private:
    void blurAcross();
    void blurDown();

    RunningPasses mPasses;
    LineBuffer mLines;
    LineBuffer mTurned;  // rows of the source, as many as a square has
    int64_t mStripBytes;
    LineBuffer mMiddle;  // for each row a line of a square's side, in strips one beside the other
    int64_t mOutStride;
    LineBuffer mOut;
};

}  // namespace VFontEffect::internal
