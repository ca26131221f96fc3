#pragma once

#include <cstdint>
#include <optional>

#include "core/line_buffer.h"
#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "ops/blur/blur_input.h"
#include "ops/blur/difference_loops.h"

namespace VFontEffect::internal {

/// The second difference of weights as a sum of few lines.
class WeightTerms {
  public:
    WeightTerms(const DifferenceLoops& loops, const BlurWeights& weights);

    /// Whether there is memory for it.
    explicit operator bool() const { return static_cast<bool>(mMemory); }
    const DifferenceTerms& operator*() const { return mTerms; }

  private:
    PixelBuffer<int32_t> mMemory;
    DifferenceTerms mTerms;
};

/// A wide blur, by differences of the weights: either order of the passes is the same loop over strips a
/// vector wide, `side` lanes, from a strip of the source to a strip of the intermediate plane and from
/// there to one of results.
///
/// The lanes of the first pass are the source's columns, or its rows, transposed. It stores its results
/// transposed, so that in the intermediate plane a strip is as long as there are lanes, each a line of
/// `side` results: the lanes of the second pass. That one's strips are bands of results, asked for one
/// by one, or columns of all results at once.
class DifferenceBlur {
  public:
    DifferenceBlur(const DifferenceLoops& loops, const BlurInput& input);

    /// Whether there is memory for it.
    explicit operator bool() const {
        return mTerms && mLines && mIntermediate && mOut && (mDownFirst || *mTransposed);
    }

    /// Rows that are asked for at once.
    int64_t bandRows() const { return mDownFirst ? mSide : mWindow.height(); }

    /// A band of rows from row y on, in order.
    BlurredRows rows(int64_t y);

  private:
    /// Of a pass: `count` results from place `first` of a source of `length` places on.
    struct Axis {
        int64_t first;
        int64_t count;
        int64_t length;
    };

    /// The passes, and the lanes of the intermediate plane.
    struct Layout {
        Axis first;
        Axis second;
        int64_t sourceLane;  // the first that the first pass fills
        int64_t allocatedLanes;
        int64_t fullBefore;  // the lanes of full columns
        int64_t fullFrom;

        static Layout of(const BlurInput& input, const ReachedSource& source, int64_t side);
    };

    int64_t inSquares(int64_t places) const { return roundedUp(places, mSide); }
    /// The strip of the intermediate plane whose lines begin with that result of the first pass.
    uint8_t* strip(int64_t result) { return mIntermediate.data() + result * mLayout.allocatedLanes; }

    void blurStrip(const PassEnding& ending, const CoverageRows& source, int64_t x, const Axis& axis,
                   const SquareRows& out);
    void firstPass();
    void fillAround(uint8_t* strip, int64_t lanes);
    void secondPass(int64_t result, const SquareRows& out);

    const DifferenceLoops& mLoops;
    bool mDownFirst;
    Box mWindow;
    PassEnding mFirst;
    PassEnding mSecond;
    int mRadius;
    uint32_t mTotal;
    float mInverse;  // just above 1 / mTotal
    int64_t mSide;
    ReachedSource mSource;
    Layout mLayout;
    WeightTerms mTerms;
    LineBuffer mLines;         // what a strip's differences are made of
    LineBuffer mIntermediate;  // strips, one behind the other
    int64_t mStride;
    LineBuffer mOut;
    std::optional<LineBuffer> mTransposed;  // a strip of the source's rows, where they are the lanes
};

}  // namespace VFontEffect::internal
