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

int64_t withReach(int64_t length, const BlurWeights& weights) {
    return length + 2 * int64_t{weights.radius};
}

}  // namespace

BlurInput GrownBlur::blurOf(const Box& window, const Box& part, const CoverageRows& grown) const {
    return BlurInput::down(mWeights, grown, translated(window, -part.left, -part.top),
                           {mFull.before - part.left, mFull.from - part.left},
                           mInput.source.invertMask == kInverse);
}

/// The blur that takes the most memory of those of any of the windows.
BlurInput GrownBlur::largestBlur(const Windows& windows) const {
    const Box part = partFor(windows.part);
    const CoverageRows sizes = {nullptr, 0, std::max<int64_t>(0, part.width()),
                                std::max<int64_t>(0, part.height()), kAsIs};
    return blurOf(windows.part, part, sizes).largestOf(windows);
}

int64_t GrownBlur::growthBytes(const Windows& windows) const {
    return GrowthPlan::memoryBytes(mInput, withReach(windows.width, mWeights),
                                   withReach(windows.height, mWeights));
}

GrownBlur::GrownBlur(CpuLevel level, const GrowthInput& input, int radius, const FullColumns& full,
                     const Box& visible, int64_t workingBytes)
    : mInput(input), mWeights(gaussianOf128(radius)), mFull(full) {
    const auto memoryBytes = [&](const Windows& cut) {
        return growthBytes(cut) + BlurPlan::memoryBytes(level, largestBlur(cut));
    };
    const int64_t reach = int64_t{radius} + input.passes;
    const Windows windows = windowsWithin(workingBytes, visible, reach, memoryBytes);
    mGrowth.emplace(level, input, withReach(windows.width, mWeights),
                    withReach(windows.height, mWeights));
    mBlur.emplace(level, largestBlur(windows), windows.memoryBytes - growthBytes(windows));
    mWalk.emplace(windows);
}

template <class Paint>
int64_t GrownBlur::paintAbove(int64_t limit, Paint paint) {
    struct Bands {
        GrownBlur& blur;
        Paint& paintRows;

        void begin(const Box& window) {
            blur.mPart = blur.partFor(window);
            const bool isClear = blur.mPart.empty();
            const CoverageRows grown = isClear ? CoverageRows{} : blur.mGrowth->grown(blur.mPart);
            blur.mBlur->begin(blur.blurOf(window, blur.mPart, grown));
        }
        int64_t bandRows() const { return blur.mBlur->bandRows(); }
        void paint(const Box& band) {
            paintRows(band, blur.mBlur->rows(band.top - blur.mPart.top, band.height()));
        }
    };
    return mWalk->goAbove(limit, Bands{*this, paint});
}

// --- Both glows -------------------------------------------------------------------------------------

namespace {

// Deliberate: between the passes of an inner glow the columns that the first pass does not reach are
// full; with a radius of 0 those that growth clears, the first one and the last.
FullColumns fullColumns(const GlowShape& shape) {
    const int64_t open = std::max(1, shape.radius);
    return {shape.image.left + open, shape.image.right - open};
}

}  // namespace

GlowPainter::GlowPainter(const CoverageBox& box, const VFBitmap* destination, const GlowRecord& record,
                         GlowSide side, int pad, int64_t workingBytes)
    : mTarget(chosenLevel(), destination, box.left, box.top),
      mSide(side),
      mShape(GlowShape::of(box, pad)),
      mColours(chosenLevel(), record),
      mBorder(mTarget.seen(mShape.image)) {
    if (mTarget.seen(mShape.image).empty()) return;
    const Box visible = mTarget.seen(mShape.blurred);
    const bool inside = side == GlowSide::inside;
    const GrowthInput input = {box.rows(inside ? kInverse : kAsIs), inside ? 0 : mShape.passes,
                               mShape.passes};
    if (!visible.empty()) {
        mBlur.emplace(chosenLevel(), input, mShape.radius, inside ? fullColumns(mShape) : kNoFullColumns,
                      visible, workingBytes);
    }
    mIsReady = !mBlur || *mBlur;
}

int64_t GlowPainter::paintAbove(int64_t limit) {
    int64_t row = mTarget.ownRow(limit);
    if (mBlur) {
        row = mBlur->paintAbove(row, [&](const Box& band, const BlurredRows& rows) {
            mColours.paint(mTarget, band, rows.values, rows.stride);
        });
    }
    if (mSide == GlowSide::inside) {
        const Box rows = mBorder.takenAbove(row);
        paintBorder(rows);
        if (mShape.radius == 0) paintCorners(rows);
    }
    return mTarget.destinationRow(row);
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

void begin(std::optional<GlowPainter>& painter, const VFECore::ParamPostProcessing* params,
           const GlowRecord& record, GlowSide side, int64_t workingBytes) {
    const CoverageBox box = coverageOf(params);
    const int pad = saturateToInt(int64_t{toInt(record.sizePx)} + 1);
    // With no padding at all (a size of -1) the image would be clear, as it is with a size of 0.
    if (!box || exceedsSizeLimit(record.sizePx) || pad <= 0 || record.sizePx == 0.0F) return;
    painter.emplace(box, params->dstBitmap, record, side, pad, workingBytes);
    if (!*painter) painter.reset();
}

}  // namespace VFontEffect::internal
