#include "cores/glow.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/float_state.h"
#include "core/numeric.h"
#include "core/size_limit.h"
#include "core/windows.h"
#include "cores/paint_input.h"
#include "cores/placed_target.h"
#include "ops/blur/blur_plan.h"
#include "ops/grow/growth_plan.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/ramp/stop_ramp.h"

namespace VFontEffect::internal {
namespace {

constexpr float kFadeStart = 0.3F;
static_assert(kFadedValues == 256 - static_cast<int>(double{kFadeStart} * 256.0),
              "a glow of one colour fades as a table of colours does");
constexpr int kCurve = 0;
constexpr float kRadiusPerPad = 0.9F;
static_assert(totalBound(128, static_cast<uint32_t>((kLargestSizePx + 1) * kRadiusPerPad)) <=
                  kLargestTotal,
              "a glow of the size limit divides by reciprocals");
static_assert((kLargestSizePx + 1) * kRadiusPerPad <= static_cast<float>(BlurWeights::kLongestRadius),
              "and has room for its weights");

/// `pad`, the whole size + 1, is the unit of a glow: growth and blur are fractions of it, the margin is
/// twice of it.
int growthPasses(int pad) {
    return std::max(1, toInt(pad * 0.4750000089406967));
}
int blurRadius(int pad) {
    return toInt(static_cast<float>(pad) * kRadiusPerPad);
}

/// What a glow of a size does around a box, in the coordinates of the box.
struct Shape {
    int passes;
    int radius;
    Box image;
    Box blurred;  // the part of the image that is not its border

    static Shape of(const CoverageBox& box, int pad) {
        const int radius = blurRadius(pad);
        const Box image = expanded(wholeOf(box.rows()), 2 * int64_t{pad});
        return {growthPasses(pad), radius, image, expanded(image, -int64_t{radius})};
    }
};

/// The colours of the blurred values. Strong values lie near the text, at the start of the table.
/// Deliberate: values end at 255, so entry 0 is never taken.
class ValueColours {
  public:
    ValueColours(CpuLevel level, const GlowRecord& record)
        : mRamps(rampLoops(level)), mIsOne(record.hasOneColour()), mColor(record.oneColour()) {
        if (mIsOne) return;
        unsigned int table[kTableSize];
        fillGlowTable(level, record, kFadeStart, kCurve, table);
        mRamps.premultiplied(table + 1, kTableLast, mPixels);
        std::reverse(mPixels, mPixels + kTableLast);
    }

    /// Paints values of a part that is seen beneath the destination, and may change them. A single
    /// colour differs in its alpha only: the values become that, and the mask of the opaque colour, for
    /// product(255, alpha) = alpha.
    void paint(const PlacedTarget& target, const Box& part, uint8_t* values, int64_t stride) const {
        if (!mIsOne) return mRamps.byValue(target.jobOn(part, values, stride), mPixels);
        mRamps.fade(values, stride * (part.height() - 1) + part.width(), mColor >> 24);
        target.paint(&BlendLoops::dstOverMask, part, values, stride, mColor | 0xFF000000U);
    }

  private:
    const RampLoops& mRamps;
    bool mIsOne;
    uint32_t mColor;
    uint32_t mPixels[kTableLast];  ///< by value, as in memory, if there are several
};

/// What has grown, in the part that the blur of a window reaches, and the blur in its coordinates.
/// Around coverage's inverse everything is full, and stays so; coverage itself spreads by a pixel a
/// pass.
struct Growing {
    GrowthInput input;
    const BlurWeights& weights;
    FullColumns full;

    Box partFor(const Box& window) const {
        return intersection(expanded(window, weights.radius), input.whole());
    }
    int64_t widthFor(const Windows& windows) const {
        return windows.width + 2 * int64_t{weights.radius};
    }
    int64_t heightFor(const Windows& windows) const {
        return windows.height + 2 * int64_t{weights.radius};
    }

    BlurInput blurOf(const Box& window, const Box& part, const CoverageRows& grown) const {
        return BlurInput::down(weights, grown, translated(window, -part.left, -part.top),
                               {full.before - part.left, full.from - part.left},
                               input.source.invertMask == kInverse);
    }
    /// The blur that takes the most memory of those of any of the windows.
    BlurInput largestBlur(const Windows& windows) const {
        const Box part = partFor(windows.part);
        const CoverageRows sizes = {nullptr, 0, std::max<int64_t>(0, part.width()),
                                    std::max<int64_t>(0, part.height()), kAsIs};
        return blurOf(windows.part, part, sizes).largestOf(windows);
    }
};

/// Grows, blurs and paints the visible part of the glow. Returns false, with nothing painted, when
/// memory ran out.
[[nodiscard]] bool paintBlurred(CpuLevel level, const Growing& growing, const PlacedTarget& target,
                                const Box& visible, const ValueColours& colours, int64_t workingBytes) {
    const auto growthBytes = [&](const Windows& cut) {
        return GrowthPlan::memoryBytes(growing.input, growing.widthFor(cut), growing.heightFor(cut));
    };
    const auto memoryBytes = [&](const Windows& cut) {
        return growthBytes(cut) + BlurPlan::memoryBytes(level, growing.largestBlur(cut));
    };
    const int64_t reach = int64_t{growing.weights.radius} + growing.input.passes;
    const Windows windows = windowsWithin(workingBytes, visible, reach, memoryBytes);
    GrowthPlan growth(level, growing.input, growing.widthFor(windows), growing.heightFor(windows));
    BlurPlan blur(level, growing.largestBlur(windows), windows.memoryBytes - growthBytes(windows));
    if (!growth || !blur) return false;
    windows.forEach([&](const Box& window) {
        const Box part = growing.partFor(window);
        const CoverageRows grown = part.empty() ? CoverageRows{} : growth.grown(part);
        forBands(
            blur, growing.blurOf(window, part, grown), [&](const Box& band, const BlurredRows& rows) {
                colours.paint(target, translated(band, part.left, part.top), rows.values, rows.stride);
            });
    });
    return true;
}

/// Paints the border of an inner glow.
///
/// Deliberate: around an inner glow the pixels that the blur does not reach are opaque white, not
/// transparent. They are painted, and the text fill or the composite clips them away.
void paintBorder(const Shape& shape, const PlacedTarget& target) {
    constexpr int64_t kPiece = 1024;
    uint8_t full[kPiece];
    std::memset(full, 0xFF, sizeof full);
    const Box& outside = shape.image;
    const Box& inside = shape.blurred;
    const Box sides[] = {{outside.left, outside.top, outside.right, inside.top},
                         {outside.left, inside.bottom, outside.right, outside.bottom},
                         {outside.left, inside.top, inside.left, inside.bottom},
                         {inside.right, inside.top, outside.right, inside.bottom}};
    for (const Box& side : sides) {
        const Box seen = target.seen(side);
        if (seen.empty()) continue;
        const Windows pieces = {seen, kPiece, seen.height()};
        pieces.forEach([&](const Box& piece) {
            target.paint(&BlendLoops::dstOverGate, piece, full, 0, 0xFFFFFFFFU);
        });
    }
}

/// Paints the corners of an inner glow without a blur: growth clears the first and the last column but
/// for their ends.
void paintCorners(const Shape& shape, const PlacedTarget& target, const ValueColours& colours) {
    const Box& image = shape.image;
    for (const int64_t x : {image.left, image.right - 1}) {
        for (const int64_t y : {image.top, image.bottom - 1}) {
            const Box seen = target.seen({x, y, x + 1, y + 1});
            uint8_t strongest = 255;
            if (!seen.empty()) colours.paint(target, seen, &strongest, 0);
        }
    }
}

}  // namespace

void paintGlow(const VFECore::ParamPostProcessing* params, const GlowRecord& record, GlowSide side,
               int64_t workingBytes) {
    const OwnFloatState floatState;
    const CoverageBox box = coverageOf(params);
    const int pad = saturateToInt(int64_t{toInt(record.sizePx)} + 1);
    // With no padding at all (a size of -1) the image would be clear, as it is with a size of 0.
    if (!box || exceedsSizeLimit(record.sizePx) || pad <= 0 || record.sizePx == 0.0F) return;

    const Shape shape = Shape::of(box, pad);
    const CpuLevel level = chosenLevel();
    const PlacedTarget target(level, params->dstBitmap, box.left, box.top);
    if (target.seen(shape.image).empty()) return;
    const Box visible = target.seen(shape.blurred);
    const ValueColours colours(level, record);
    const bool inside = side == GlowSide::inside;
    // Deliberate: between the passes of an inner glow the columns that the first pass does not reach are
    // full; with a radius of 0 those that growth clears, the first one and the last.
    const int64_t open = std::max(1, shape.radius);
    const FullColumns full =
        inside ? FullColumns{shape.image.left + open, shape.image.right - open} : kNoFullColumns;
    const BlurWeights weights = gaussianOf128(shape.radius);
    const GrowthInput input = {box.rows(inside ? kInverse : kAsIs), inside ? 0 : shape.passes,
                               shape.passes};
    const Growing growing = {input, weights, full};
    const bool done =
        visible.empty() || paintBlurred(level, growing, target, visible, colours, workingBytes);
    if (!inside || !done) return;
    paintBorder(shape, target);
    if (shape.radius == 0) paintCorners(shape, target, colours);
}

}  // namespace VFontEffect::internal
