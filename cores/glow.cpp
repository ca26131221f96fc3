#include "cores/glow.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "core/numeric.h"
#include "core/size_limit.h"

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

}  // namespace

GlowShape GlowShape::of(const CoverageBox& box, int pad) {
    const int radius = blurRadius(pad);
    const Box image = expanded(wholeOf(box.rows()), 2 * int64_t{pad});
    return {growthPasses(pad), radius, image, expanded(image, -int64_t{radius})};
}

// --- Colours ----------------------------------------------------------------------------------------

ValueColours::ValueColours(CpuLevel level, const GlowRecord& record)
    : mRamps(rampLoops(level)), mIsOne(record.hasOneColour()), mColor(record.oneColour()) {
    if (mIsOne) return;
    unsigned int table[kTableSize];
    fillGlowTable(level, record, kFadeStart, kCurve, table);
    mRamps.premultiplied(table + 1, kTableLast, mPixels);
    std::reverse(mPixels, mPixels + kTableLast);
}

void ValueColours::paint(const PlacedTarget& target, const Box& part, uint8_t* values,
                         int64_t stride) const {
    if (!mIsOne) return mRamps.byValue(target.jobOn(part, values, stride), mPixels);
    mRamps.fade(values, stride * (part.height() - 1) + part.width(), mColor >> 24);
    target.paint(&BlendLoops::dstOverMask, part, values, stride, mColor | 0xFF000000U);
}

// --- Growth and blur --------------------------------------------------------------------------------

namespace {

/// Deliberate: between the passes of an inner glow the columns that the first pass does not reach are
/// full; with a radius of 0 those that growth clears, the first one and the last.
FullColumns fullColumns(const GlowShape& shape, GlowSide side) {
    if (side == GlowSide::outside) return kNoFullColumns;
    const int64_t open = std::max(1, shape.radius);
    return {shape.image.left + open, shape.image.right - open};
}

GrowthInput growthOf(const CoverageRows& coverage, const GlowShape& shape, GlowSide side) {
    GrowthInput input = {coverage, shape.passes, shape.passes};
    if (side == GlowSide::outside) return input;
    input.source.invertMask = kInverse;
    input.margin = 0;
    return input;
}

}  // namespace

GlowPainter::GlowPainter(CpuLevel level, const PlacedTarget& target, const GlowRecord& record,
                         GlowSide side, const CoverageRows& coverage, const GlowShape& shape,
                         int64_t workingBytes)
    : WindowPainter(target),
      mSide(side),
      mShape(shape),
      mColours(level, record),
      mBorder(target.seen(shape.image)),
      mInput(growthOf(coverage, shape, side)),
      mWeights(gaussianOf128(shape.radius)) {
    const Box visible = target.seen(shape.blurred);
    if (!visible.empty()) makePlans(level, visible, workingBytes);
}

BlurInput GlowPainter::blurOf(const Box& window, const Box& part, const CoverageRows& grown) const {
    const FullColumns full = fullColumns(mShape, mSide);
    return BlurInput::down(mWeights, grown, translated(window, -part.left, -part.top),
                           {full.before - part.left, full.from - part.left}, mSide == GlowSide::inside);
}

/// The blur that takes the most memory of those of any of the windows.
BlurInput GlowPainter::largestBlur(const Windows& windows) const {
    const Box part = partFor(windows.part);
    const CoverageRows sizes = {nullptr, 0, std::max<int64_t>(0, part.width()),
                                std::max<int64_t>(0, part.height()), kAsIs};
    return blurOf(windows.part, part, sizes).largestOf(windows);
}

void GlowPainter::makePlans(CpuLevel level, const Box& visible, int64_t workingBytes) {
    const int64_t around = 2 * int64_t{mWeights.radius};
    const auto growthBytes = [&](const Windows& cut) {
        return GrowthPlan::memoryBytes(mInput, cut.width + around, cut.height + around);
    };
    const auto memoryBytes = [&](const Windows& cut) {
        return growthBytes(cut) + BlurPlan::memoryBytes(level, largestBlur(cut));
    };
    const int64_t reach = int64_t{mWeights.radius} + mInput.passes;
    const Windows windows = windowsWithin(workingBytes, visible, reach, memoryBytes);
    mGrowth.emplace(level, mInput, windows.width + around, windows.height + around);
    mBlur.emplace(level, largestBlur(windows), windows.memoryBytes - growthBytes(windows));
    setWindows(windows);
}

void GlowPainter::beginWindow(const Box& window) {
    mPart = partFor(window);
    const CoverageRows grown = mPart.empty() ? CoverageRows{} : mGrowth->grown(mPart);
    mBlur->begin(blurOf(window, mPart, grown));
}

void GlowPainter::paintBand(const Box& band) {
    const BlurredRows rows = mBlur->rows(band.top - mPart.top, band.height());
    mColours.paint(mTarget, band, rows.values, rows.stride);
}

// --- Both glows -------------------------------------------------------------------------------------

int64_t GlowPainter::paintAbove(int64_t limit) {
    const int64_t done = WindowPainter::paintAbove(limit);
    if (mSide == GlowSide::inside) {
        const Box rows = mBorder.takenAbove(mTarget.ownRow(done));
        if (rows.empty()) return done;
        paintBorder(rows);
        if (mShape.radius == 0) paintCorners(rows);
    }
    return done;
}

/// Paints the border of an inner glow.
///
/// Deliberate: around an inner glow the pixels that the blur does not reach are opaque white, not
/// transparent. They are painted, and the text fill or the composite clips them away.
void GlowPainter::paintBorder(const Box& rows) const {
    constexpr int64_t kPiece = 1024;
    uint8_t full[kPiece];
    std::memset(full, 0xFF, sizeof full);
    const Box& outside = mShape.image;
    const Box& inside = mShape.blurred;
    const Box sides[] = {{outside.left, outside.top, outside.right, inside.top},
                         {outside.left, inside.bottom, outside.right, outside.bottom},
                         {outside.left, inside.top, inside.left, inside.bottom},
                         {inside.right, inside.top, outside.right, inside.bottom}};
    for (const Box& side : sides) {
        const Box seen = intersection(side, rows);
        if (seen.empty()) continue;
        const Windows pieces = {seen, kPiece, seen.height()};
        pieces.forEach([&](const Box& piece) {
            mTarget.paint(&BlendLoops::dstOverGate, piece, full, 0, 0xFFFFFFFFU);
        });
    }
}

/// Paints the corners of an inner glow without a blur: growth clears the first and the last column but
/// for their ends.
void GlowPainter::paintCorners(const Box& rows) const {
    const Box& image = mShape.image;
    for (const int64_t x : {image.left, image.right - 1}) {
        for (const int64_t y : {image.top, image.bottom - 1}) {
            const Box seen = intersection(rows, {x, y, x + 1, y + 1});
            uint8_t strongest = 255;
            if (!seen.empty()) mColours.paint(mTarget, seen, &strongest, 0);
        }
    }
}

namespace {

bool beginGlow(std::optional<GlowPainter>& painter, const VFECore::ParamPostProcessing* params,
               const GlowRecord& record, GlowSide side, int64_t workingBytes) {
    const CoverageBox box = coverageOf(params);
    const int pad = saturateToInt(int64_t{toInt(record.sizePx)} + 1);
    // With no padding at all (a size of -1) the image would be clear, as it is with a size of 0.
    if (!box || exceedsSizeLimit(record.sizePx) || pad <= 0 || record.sizePx == 0.0F) return true;
    const CpuLevel level = chosenLevel();
    const PlacedTarget target(level, params->dstBitmap, box.left, box.top);
    const GlowShape shape = GlowShape::of(box, pad);
    if (target.seen(shape.image).empty()) return true;
    painter.emplace(level, target, record, side, box.rows(), shape, workingBytes);
    return static_cast<bool>(*painter);
}

}  // namespace

bool begin(std::optional<GlowPainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFOuterGlowProperty& record, int64_t workingBytes) {
    return beginGlow(painter, params, GlowRecord::of(&record), GlowSide::outside, workingBytes);
}

bool begin(std::optional<GlowPainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFInnerGlowProperty& record, int64_t workingBytes) {
    return beginGlow(painter, params, GlowRecord::of(&record), GlowSide::inside, workingBytes);
}

}  // namespace VFontEffect::internal
