#include "cores/glow.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "core/size_limit.h"
#include "cores/paint_input.h"
#include "cores/placed_target.h"
#include "ops/blur/blur_plan.h"
#include "ops/grow/growth_loops.h"
#include "ops/grow/growth_plan.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/ramp/stop_ramp.h"

namespace VFontEffect::internal {
namespace {

constexpr float kFadeStart = 0.3F;
static_assert(kFadedValues == 256 - static_cast<int>(double{kFadeStart} * 256.0),
              "a glow of one colour fades as a table of colours does");
constexpr int kCurve = 0;

/// `pad`, the whole size + 1, is the unit of a glow: growth and blur are fractions of it, the margin is
/// twice of it.
int growthPasses(int pad) {
    return std::max(1, toInt(pad * 0.4750000089406967));
}
int blurRadius(int pad) {
    return toInt(static_cast<float>(pad) * 0.9F);
}

/// What a glow of a size does around a box, in the coordinates of the box.
struct Shape {
    int passes;
    int radius;
    Box image;
    Box blurred;  // the part of the image that is not its border

    static Shape of(const CoverageBox& box, int pad) {
        const int radius = blurRadius(pad);
        const Box image = expanded(wholeOf(box), 2 * int64_t{pad});
        return {growthPasses(pad), radius, image, expanded(image, -int64_t{radius})};
    }
};

/// The colours of the blurred values. Strong values lie near the text, at the start of the table.
/// Deliberate: values end at 255, so entry 0 is never taken.
class ValueColours {
  public:
    explicit ValueColours(const GlowRecord& record)
        : mIsOne(record.hasOneColour()), mColor(record.oneColour()) {
        if (mIsOne) return;
        unsigned int table[kTableSize];
        fillGlowTable(record, kFadeStart, kCurve, table);
        rampLoops().premultiplied(table + 1, kTableLast, mPixels);
        std::reverse(mPixels, mPixels + kTableLast);
    }

    /// Paints the job's mask, the values, beneath the destination, and may change it. A single colour
    /// differs in its alpha only: the values become that, and the mask of the opaque colour, for
    /// product(255, alpha) = alpha.
    void paint(BlendJob job, uint8_t* values) const {
        job.mask = values;
        if (!mIsOne) return growthLoops().paint({job, mPixels});
        growthLoops().fade(values, job.maskStride * (job.height - 1) + job.width, mColor >> 24);
        job.color = mColor | 0xFF000000U;
        blendLoops().dstOverMask(job);
    }

  private:
    bool mIsOne;
    uint32_t mColor;
    uint32_t mPixels[kTableLast];  ///< by value, as in memory, if there are several
};

/// The coverage, or its inverse, with a margin that is empty or full, and so is the frame.
Growth coverageToGrow(const CoverageBox& box, uint8_t invertMask, int64_t margin) {
    Growth growth(box.width + 2 * margin, box.height + 2 * margin);
    if (!growth) return growth;
    const auto side = static_cast<size_t>(margin + 1);
    for (int64_t y = -1 - margin; y <= box.height + margin; ++y) {
        uint8_t* const row = growth.row(y + margin) - 1;
        if (y < 0 || y >= box.height) {
            std::memset(row, invertMask, 2 * side + static_cast<size_t>(box.width));
            continue;
        }
        std::memset(row, invertMask, side);
        growthLoops().copyInverted(box.row(y), box.width, invertMask, row + side);
        std::memset(row + side + box.width, invertMask, side);
    }
    return growth;
}

/// Grows, blurs and paints the part of the glow in the window. Returns false, with nothing painted, when
/// memory ran out.
bool paintBlurred(const CoverageBox& box, const Shape& shape, const PlacedTarget& target,
                  const Box& window, const ValueColours& colours, GlowSide sense) {
    const bool inverted = sense == GlowSide::inside;
    const uint8_t invertMask = inverted ? 0xFF : 0;
    // Coverage spreads by a pixel a pass. Around its inverse everything is full, and stays so.
    const int64_t margin = inverted ? 0 : shape.passes;
    Growth growth = coverageToGrow(box, invertMask, margin);
    if (!growth) return false;
    growth.grow(shape.passes, invertMask);
    growth.finish();

    // Deliberate: between the passes of an inner glow the columns that the first pass does not reach are
    // full; with a radius of 0 those that growth clears, the first one and the last.
    const int64_t open = std::max(1, shape.radius);
    const FullColumns full =
        inverted ? FullColumns{shape.image.left + open, shape.image.right - open} : kNoFullColumns;
    return blurDownThenAcross(
        glowWeights(shape.radius), growth.source(invertMask), translated(window, margin, margin), full,
        inverted, [&](int64_t y, int64_t rows, uint8_t* values, int64_t stride) {
            const Box part = {window.left, y - margin, window.right, y - margin + rows};
            colours.paint(target.jobOn(part, values, stride), values);
        });
}

/// Paints the border of an inner glow.
///
/// Deliberate: around an inner glow the pixels that the blur does not reach are opaque white, not
/// transparent. They are painted, and the text fill or the composite clips them away.
void paintBorder(const Shape& shape, const PlacedTarget& target, const uint8_t* full) {
    const Box& outside = shape.image;
    const Box& inside = shape.blurred;
    const Box sides[] = {{outside.left, outside.top, outside.right, inside.top},
                         {outside.left, inside.bottom, outside.right, outside.bottom},
                         {outside.left, inside.top, inside.left, inside.bottom},
                         {inside.right, inside.top, outside.right, inside.bottom}};
    for (const Box& side : sides) {
        const Box seen = target.seen(side);
        if (seen.empty()) continue;
        BlendJob job = target.jobOn(seen, full, 0);
        job.color = 0xFFFFFFFFU;
        blendLoops().dstOverGate(job);
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
            if (!seen.empty()) colours.paint(target.jobOn(seen, &strongest, 0), &strongest);
        }
    }
}

}  // namespace

void paintGlow(const VFECore::ParamPostProcessing* params, const GlowRecord& record, GlowSide sense) {
    const CoverageBox box = coverageOf(params);
    const int pad = saturateToInt(int64_t{toInt(record.sizePx)} + 1);
    // With no padding at all (a size of -1) the image would be clear, as it is with a size of 0.
    if (!box || exceedsSizeLimit(record.sizePx) || pad <= 0 || record.sizePx == 0.0F) return;

    const Shape shape = Shape::of(box, pad);
    const PlacedTarget target(params->dstBitmap, box.left, box.top);
    const Box seen = target.seen(shape.image);
    if (seen.empty()) return;
    const Box window = target.seen(shape.blurred);
    const ValueColours colours(record);
    if (sense == GlowSide::outside) {
        if (!window.empty()) paintBlurred(box, shape, target, window, colours, sense);
        return;
    }
    auto full = PixelBuffer<uint8_t>::uninitialised(seen.width());
    if (!full) return;
    std::memset(full.data(), 0xFF, static_cast<size_t>(seen.width()));
    if (!window.empty() && !paintBlurred(box, shape, target, window, colours, sense)) return;
    paintBorder(shape, target, full.data());
    if (shape.radius == 0) paintCorners(shape, target, colours);
}

}  // namespace VFontEffect::internal
