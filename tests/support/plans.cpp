#include "plans.h"

#include <algorithm>
#include <cstddef>

#include "core/assert.h"
#include "core/effect_types.h"
#include "core/line_buffer.h"
#include "cores/glow.h"
#include "cores/painters.h"
#include "ops/blur/blur_plan.h"
#include "ops/dilate/dilation_plan.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/tile/tile_plan.h"
#include "simd/level_table.h"
#include "tests/support/lanes_check.h"

namespace VFontEffect::internal {

VOREL_LEVEL_TABLE(VOREL_EACH_VECTOR_LEVEL, lanesCheck, LanesCheck, kLanesCheck)

}  // namespace VFontEffect::internal

namespace vorel_test {
namespace {

using namespace VFontEffect;
using namespace VFontEffect::internal;

/// The values of a part, which come in pieces.
class Collected {
  public:
    explicit Collected(const Box& part)
        : mPart(part), mValues(static_cast<size_t>(part.width() * part.height())) {}

    /// Stores rows whose first value lies at (x, y), as they are to be taken.
    void put(const CoverageRows& rows, int64_t x, int64_t y) {
        for (int64_t row = 0; row < rows.height; ++row) {
            for (int64_t i = 0; i < rows.width; ++i) {
                const int64_t at = (y + row - mPart.top) * mPart.width() + x + i - mPart.left;
                mValues.at(static_cast<size_t>(at)) =
                    rows.start[row * rows.stride + i] ^ rows.invertMask;
            }
        }
    }
    void put(const Box& band, const BlurredRows& rows) {
        put({rows.values, rows.stride, band.width(), band.height(), kAsIs}, band.left, band.top);
    }
    std::vector<uint8_t> values() const { return mValues; }

  private:
    Box mPart;
    std::vector<uint8_t> mValues;
};

/// The input's window of that size, or as a whole.
Windows cut(const Box& part, const WindowSize& size) {
    if (size.width == 0) return Windows::oneOf(part);
    return {part, std::min<int64_t>(size.width, part.width()),
            std::min<int64_t>(size.height, part.height())};
}

/// Strips down to below the mask, then the rest.
template <class Painter, class... Arguments>
void paintRowByRow(int64_t stripRows, const VFECore::ParamPostProcessing* params,
                   const Arguments&... arguments) {
    const OwnFloatState floatState;
    std::optional<Painter> painter;
    if (!begin(painter, params, arguments...) || !painter) return;
    for (int64_t limit = stripRows; limit < params->srcBitmap->mHeight; limit += stripRows)
        painter->paintAbove(limit);
    painter->paintAbove(kAllRows);
}

template <class Blur>
std::vector<uint8_t> collected(Blur& blur, const BlurInput& input, const Windows& windows) {
    if (!blur) return {};
    Collected values(input.window);
    windows.forEach([&](const Box& window) {
        const BlurInput part = input.of(window);
        blur.begin(part);
        for (int64_t y = window.top; y < window.bottom; y += blur.bandRows()) {
            const int64_t end = std::min(y + blur.bandRows(), window.bottom);
            values.put({window.left, y, window.right, end}, blur.rows(y));
        }
    });
    return values.values();
}

void append(const TermList& list, int sign, std::vector<Term>& terms) {
    const int64_t lineBytes = kLinePixelBytes * differenceLoops(chosenLevel()).vectorBytes;
    const int64_t rowBytes = kLinesOfRow * lineBytes;
    for (int64_t i = 0; i < list.count; ++i) {
        const int64_t offset = list.offsets[i];
        const int64_t row = (offset < 0 ? offset - rowBytes + 1 : offset) / rowBytes;
        const int64_t line = offset - row * rowBytes;
        if (line != 0 && line != lineBytes) sign = 0;  // neither taps nor pairs: no term of any weights
        terms.push_back({row, line != 0, sign});
    }
}

}  // namespace

void paintWithin(int64_t workingBytes, int64_t stripRows, int type, const VFProperty& record,
                 const VFECore::ParamPostProcessing* params) {
    if (type == kStroke) {
        const auto& stroke = static_cast<const VFStrokeProperty&>(record);
        paintRowByRow<StrokePainter>(stripRows, params, stroke, workingBytes);
    } else if (type == kOuterShadow) {
        const auto& shadow = static_cast<const VFOuterShadowProperty&>(record);
        const ShadowOffset offset = shadowOffset(shadow.mAngle, shadow.mDistance);
        paintRowByRow<ShadowPainter>(stripRows, params, shadow, offset, workingBytes);
    } else if (type == kInnerShadow) {
        const auto& shadow = static_cast<const VFInnerShadowProperty&>(record);
        paintRowByRow<ShadowPainter>(stripRows, params, shadow, workingBytes);
    } else if (type == kOuterGlow) {
        const auto& glow = static_cast<const VFOuterGlowProperty&>(record);
        paintRowByRow<GlowPainter>(stripRows, params, glow, workingBytes);
    } else if (type == kInnerGlow) {
        const auto& glow = static_cast<const VFInnerGlowProperty&>(record);
        paintRowByRow<GlowPainter>(stripRows, params, glow, workingBytes);
    }
}

bool paintByTurns(const std::vector<VFECore*>& cores, const RunBitmaps& run, int64_t stripRows) {
    return paintInStrips(cores, run, stripRows);
}

int64_t rowsOfStrips(const RunBitmaps& run) {
    return stripRowsFor(run);
}

std::vector<uint8_t> blurredByDots(const BlurInput& input, const WindowSize& size) {
    const Windows windows = cut(input.window, size);
    const DotLoops& loops = dotLoops(chosenLevel());
    const BlurInput largest = input.largestOf(windows);
    DotBlur blur(loops, largest, DotBlur::memoryBytes(loops, largest));
    return collected(blur, input, windows);
}

std::vector<uint8_t> blurredIn16Bits(const BlurInput& input, const WindowSize& size) {
    const Windows windows = cut(input.window, size);
    const NarrowLoops& loops = narrowLoops(chosenLevel());
    const BlurInput largest = input.largestOf(windows);
    NarrowBlur blur(loops, largest, NarrowBlur::memoryBytes(loops, largest));
    return collected(blur, input, windows);
}

std::vector<uint8_t> blurredByDifferences(const BlurInput& input, const WindowSize& size) {
    const Windows windows = cut(input.window, size);
    const DifferenceLoops& loops = differenceLoops(chosenLevel());
    const BlurInput largest = input.largestOf(windows);
    DifferenceBlur blur(loops, largest, DifferenceBlur::memoryBytes(loops, largest));
    return collected(blur, input, windows);
}

std::vector<uint8_t> blurred(const BlurInput& input) {
    BlurPlan plan(chosenLevel(), input, BlurPlan::memoryBytes(chosenLevel(), input));
    if (!plan) return {};
    Collected values(input.window);
    plan.begin(input);
    const Box& window = input.window;
    for (int64_t y = window.top; y < window.bottom; y += plan.bandRows()) {
        const int64_t end = std::min(y + plan.bandRows(), window.bottom);
        values.put({window.left, y, window.right, end}, plan.rows(y, end - y));
    }
    return values.values();
}

std::vector<uint8_t> dilated(const CoverageRows& source, const DiscShape& disc, const Box& part,
                             bool andInverse, const WindowSize& size, LargeDiscs largeDiscs) {
    const Windows windows = cut(part, size);
    const int64_t bytes = DilationPlan::memoryBytes(chosenLevel(), {source, disc}, windows);
    LineBuffer memory(bytes, 2);
    if (!memory) return {};
    DilationPlan plan(chosenLevel(), {source, disc}, memory.data(), bytes);
    CoverageRows inverse = source;
    inverse.invertMask ^= kInverse;
    DilationPlan other(chosenLevel(), {inverse, disc}, memory.data() + bytes, bytes);
    if (largeDiscs == LargeDiscs::bySquares) {
        plan.giveUpTiles();
        other.giveUpTiles();
    }
    Collected values(part);
    windows.forEach([&](const Box& window) {
        const bool hasBegun = plan.begin(window) && other.begin(window);
        VOREL_ASSERT(hasBegun);
        for (int64_t y = window.top; y < window.bottom; y += plan.bandRows()) {
            const int64_t count = std::min(plan.bandRows(), window.bottom - y);
            values.put(andInverse ? plan.minRows(other, y, count) : plan.rows(y, count), window.left, y);
        }
    });
    return values.values();
}

std::vector<uint8_t> grown(const GrowthInput& input, const WindowSize& size) {
    const Windows windows = cut(input.whole(), size);
    GrowthPlan plan(chosenLevel(), input, windows.width, windows.height);
    if (!plan) return {};
    Collected values(input.whole());
    windows.forEach([&](const Box& part) { values.put(plan.grown(part), part.left, part.top); });
    return values.values();
}

std::vector<uint32_t> tiled(const ColourView& pattern, float scale, float opacity, int64_t width,
                            int64_t height) {
    TilePlan plan(chosenLevel(), pattern, scale, opacity, width);
    if (!plan) return {};
    std::vector<uint32_t> pixels;
    for (int64_t y = 0; y < height; ++y) {
        const uint32_t* const row = plan.row(y);
        pixels.insert(pixels.end(), row, row + width);
    }
    return pixels;
}

std::vector<uint8_t> faded(std::vector<uint8_t> values, uint32_t alpha) {
    rampLoops(chosenLevel()).fade(values.data(), static_cast<int64_t>(values.size()), alpha);
    return values;
}

const char* wrongLanesOperation(uint64_t seed) {
    return lanesCheck(chosenLevel()).wrongOperation(seed);
}

void askForRowsOutOfOrder() {
    const uint8_t pixel = 255;
    const DiscShape disc(1.0F);
    const Box part = {0, 0, 1, 2};
    const DilationInput input = {{&pixel, 1, 1, 1, kAsIs}, disc};
    const int64_t bytes = DilationPlan::memoryBytes(chosenLevel(), input, Windows::oneOf(part));
    LineBuffer memory(bytes);
    DilationPlan plan(chosenLevel(), input, memory.data(), bytes);
    if (plan.begin(part)) plan.rows(1, 1);
}

TermsOfWeights termsOf(const BlurWeights& weights) {
    std::vector<int32_t> memory(static_cast<size_t>(termBytes(weights.radius)) / sizeof(int32_t));
    const DifferenceTerms terms = differenceTerms(differenceLoops(chosenLevel()), weights,
                                                  reinterpret_cast<uint8_t*>(memory.data()));
    TermsOfWeights result = {terms.pairs.distance, terms.pairs.areDifferences, {}};
    append(terms.added, 1, result.terms);
    append(terms.takenAway, -1, result.terms);
    return result;
}

}  // namespace vorel_test
