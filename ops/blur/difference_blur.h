#pragma once

#include <cstdint>

#include "core/arena.h"
#include "core/line_buffer.h"
#include "core/numeric.h"
#include "ops/blur/blur_input.h"
#include "ops/blur/difference_loops.h"

namespace VFontEffect::internal {

/// The second difference of weights as a sum of few lines, whose list takes termBytes(radius).
int64_t termBytes(int radius);
DifferenceTerms differenceTerms(const DifferenceLoops& loops, const BlurWeights& weights,
                                uint8_t* memory);

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
    /// What a blur takes for an input beside its weights.
    static int64_t memoryBytes(const DifferenceLoops& loops, const BlurInput& input);

    /// For inputs that take no more than this one, which is `memoryBytes`.
    DifferenceBlur(const DifferenceLoops& loops, const BlurInput& largest, int64_t memoryBytes);

    /// Whether there is memory for it.
    explicit operator bool() const { return static_cast<bool>(mMemory); }

    void begin(const BlurInput& input);

    /// Rows that are asked for at once.
    int64_t bandRows() const { return mLayout.bandRows; }

    /// A band of rows from row y on, in order.
    BlurredRows rows(int64_t y);

  private:
    /// Of a pass: `count` results from place `first` of a source of `length` places on.
    struct Axis {
        int64_t first;
        int64_t count;
        int64_t length;
    };

    /// A window, its passes, the lanes of the intermediate plane, and the places in the working memory.
    struct Layout {
        Box window;
        ReachedSource source;
        int64_t bandRows;
        Axis first;
        Axis second;
        int64_t sourceLane;  // the first that the first pass fills
        int64_t allocatedLanes;
        int64_t fullBefore;  // the lanes of full columns
        int64_t fullFrom;
        uint8_t* lines;         // what a strip's differences are made of
        uint8_t* intermediate;  // strips, one behind the other
        int64_t stride;         // of results
        uint8_t* out;
        uint8_t* transposed;  // a strip of the source's rows, where they are the lanes

        static Layout of(const DifferenceLoops& loops, const BlurInput& input, Arena& arena);

      private:
        void placeLanes(const BlurInput& input, int64_t side);
    };

    int64_t inSquares(int64_t places) const { return roundedUp(places, mSide); }
    /// The strip of the intermediate plane whose lines begin with that result of the first pass.
    uint8_t* strip(int64_t result) const {
        return mLayout.intermediate + result * mLayout.allocatedLanes;
    }

    void blurStrip(const PassEnding& ending, const CoverageRows& source, int64_t x, const Axis& axis,
                   const SquareRows& out);
    void firstPass();
    void fillAround(uint8_t* strip, int64_t lanes);
    void secondPass(int64_t result, const SquareRows& out);

    const DifferenceLoops& mLoops;
    bool mDownFirst;
    PassEnding mFirst;
    PassEnding mSecond;
    int mRadius;
    uint32_t mTotal;
    float mInverse;  // just above 1 / mTotal
    int64_t mSide;
    int64_t mMemoryBytes;
    LineBuffer mMemory;  // of the layout, and behind it of the terms
    DifferenceTerms mTerms = {};
    Layout mLayout = {};
};

}  // namespace VFontEffect::internal
