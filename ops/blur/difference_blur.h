#pragma once

#include <algorithm>
#include <cstdint>

#include "core/line_buffer.h"
#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "ops/blur/blur_weights.h"
#include "ops/blur/difference_loops.h"
#include "ops/blur/reached_source.h"

/// The blur by running sums, for wide kernels.
namespace VFontEffect::internal {

/// A difference of a kernel as a sum of few lines.
class KernelTerms {
  public:
    explicit KernelTerms(const BlurWeights& kernel);

    /// Whether there is memory for it.
    explicit operator bool() const { return static_cast<bool>(mMemory); }
    const DifferenceTerms& operator*() const { return mTerms; }

  private:
    PixelBuffer<int32_t> mMemory;
    DifferenceTerms mTerms;
};

/// What both orders of the passes need.
class DifferencePasses {
  public:
    DifferencePasses(const BlurWeights& kernel, const BlurSource& source, const Box& window);

    explicit operator bool() const { return static_cast<bool>(mTerms); }
    const Box& window() const { return mWindow; }
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
    Box mWindow;
    ReachedSource mSource;
    int64_t mSide;
    int mRadius;
    uint32_t mTotal;
    float mInverse;
    KernelTerms mTerms;
};

/// Blurs the columns first and then the rows, as DownThenAcross does.
class DifferenceDownThenAcross {
  public:
    DifferenceDownThenAcross(const BlurWeights& kernel, const BlurSource& source, const Box& window,
                             const FullColumns& full);

    /// Whether there is memory for it.
    explicit operator bool() const { return mPasses && mLines && mIntermediate && mOut; }

    /// Calls paint(y, rows, values, stride) for some rows of the window at a time.
    template <class Paint>
    void run(bool inverted, Paint paint) {
        blurDown();
        const Box& window = mPasses.window();
        for (int64_t y = 0; y < window.height(); y += mPasses.side()) {
            blurAcross(y, inverted);
            paint(window.top + y, std::min(mPasses.side(), window.height() - y), mOut.data(),
                  mOutStride);
        }
    }

  private:
    /// Between the passes there are the columns of the source, or when some of the full ones are in
    /// reach all columns that are.
    struct IntermediateColumns {
        int64_t left;       // column of the source, column 0 here
        int64_t count;      // that the second pass reads
        int64_t allocated;  // and those of whole squares

        static IntermediateColumns of(const DifferencePasses& passes, const FullColumns& full);
    };

    void blurDown();
    void fillAround(uint8_t* band);
    void blurAcross(int64_t y, bool inverted);
    uint8_t* bandAt(int64_t y) { return mIntermediate.data() + y * mColumns.allocated; }

    DifferencePasses mPasses;
    FullColumns mFull;
    IntermediateColumns mColumns;
    LineBuffer mLines;
    LineBuffer mIntermediate;  // for each column a line of a square's side, in bands one below the other
    int64_t mOutStride;
    LineBuffer mOut;
};

/// Blurs the rows of the source's inverse first and then the columns, as AcrossThenDown does.
class DifferenceAcrossThenDown {
  public:
    DifferenceAcrossThenDown(const BlurWeights& kernel, const BlurSource& source, const Box& window);

    explicit operator bool() const { return mPasses && mLines && mTransposed && mIntermediate && mOut; }

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

    DifferencePasses mPasses;
    LineBuffer mLines;
    LineBuffer mTransposed;  // rows of the source, as many as a square has
    int64_t mStripBytes;
    LineBuffer mIntermediate;  // for each row a line of a square's side, in strips one beside the other
    int64_t mOutStride;
    LineBuffer mOut;
};

}  // namespace VFontEffect::internal
