#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstring>

#include "core/effect_types.h"
#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "cores/covered_fill.h"
#include "cores/paint_input.h"
#include "cores/property_copy.h"
#include "ops/ramp/ramp_loops.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// Two neighbouring pattern pixels on one axis and their weights, which add up to 255.
struct Tap {
    int32_t near;
    int32_t far;
    uint32_t nearWeight;
    uint32_t farWeight;
};

/// One axis of the tiling: from an output coordinate to the pattern pixels that it is mixed from.
class TileAxis {
  public:
    TileAxis(int64_t patternSize, float scale)
        : mPatternSize(patternSize),
          mScale(scale),
          // A tile smaller than a pixel counts as one pixel.
          mTileSize(std::max(1, toInt(scale * static_cast<float>(patternSize)))) {}

    Tap at(int64_t coordinate) const {
        const float position = static_cast<float>(coordinate % mTileSize) / mScale;
        const float whole = std::floor(position);
        const auto farWeight =
            static_cast<uint32_t>(std::clamp(toInt((position - whole) * 255.0F), 0, 255));
        const int64_t near = std::clamp<int64_t>(toInt(whole), 0, mPatternSize - 1);
        const int64_t far = near + 1 < mPatternSize ? near + 1 : 0;
        return {static_cast<int32_t>(near), static_cast<int32_t>(far), 255 - farWeight, farWeight};
    }

    /// Output pixels after which the taps repeat.
    int64_t period() const { return mTileSize; }

  private:
    int64_t mPatternSize;
    float mScale;
    int64_t mTileSize;
};

/// The taps of the first columns of a box.
class TapRow {
  public:
    TapRow(const TileAxis& columns, int64_t count)
        : mWords(PixelBuffer<uint32_t>::uninitialised(count + kRowSlack, 4)),
          mLength(count + kRowSlack) {
        if (!mWords) return;
        // Pixels are looked up for the columns behind the last one too.
        for (int64_t plane = 0; plane < 4; ++plane)
            std::fill_n(at(plane) + count, kRowSlack, 0U);
        for (int64_t x = 0; x < count; ++x) {
            const Tap tap = columns.at(x);
            at(0)[x] = static_cast<uint32_t>(tap.near);
            at(1)[x] = static_cast<uint32_t>(tap.far);
            at(2)[x] = tap.nearWeight * kBothHalves;
            at(3)[x] = tap.farWeight * kBothHalves;
        }
    }

    explicit operator bool() const { return static_cast<bool>(mWords); }
    ColumnTaps taps() {
        return {reinterpret_cast<const int32_t*>(at(0)), reinterpret_cast<const int32_t*>(at(1)), at(2),
                at(3)};
    }

  private:
    static constexpr uint32_t kBothHalves = 0x00010001U;

    uint32_t* at(int64_t plane) { return mWords.data() + plane * mLength; }

    PixelBuffer<uint32_t> mWords;
    int64_t mLength;
};

/// The pattern as it lies under the box, row by row; of what repeats along a row, one tile is sampled.
///
/// A pixel is the sum of four pattern pixels times both their weights. No step of it is rounded, so it
/// may be mixed along the columns first, once for each row of the pattern, and the output rows between
/// two pattern rows share these.
class TiledRows {
  public:
    TiledRows(const ColourView& pattern, float scale, float opacity, int64_t width)
        : mPattern(pattern),
          mColumns(pattern.width, scale),
          mRows(pattern.height, scale),
          mOpacity(opacity),
          mWidth(width),
          mSampled(std::min(width, mColumns.period())),
          mTaps(mColumns, mSampled),
          mMixed{KeptRow(mSampled), KeptRow(mSampled)},
          mRow(PixelBuffer<uint32_t>::uninitialised(width + kRowSlack)) {}

    /// False when memory ran out.
    explicit operator bool() const { return mTaps && mMixed[0].planes && mMixed[1].planes && mRow; }

    const uint32_t* at(int64_t y) {
        const Tap rows = mRows.at(y);
        const MixedRow near = mixedRow(rows.near, rows.far);
        const MixedRow far = mixedRow(rows.far, rows.near);
        rampLoops().mixRows(near, far, rows.nearWeight, rows.farWeight, mOpacity, mSampled, mRow.data());
        repeat();
        return mRow.data();
    }

  private:
    static constexpr int32_t kNoRow = -1;

    /// A pattern row mixed along its columns.
    struct KeptRow {
        explicit KeptRow(int64_t width)
            : planes(PixelBuffer<uint32_t>::uninitialised(width + kRowSlack, 2)),
              length(width + kRowSlack) {}

        MixedRow mixed() { return {planes.data(), planes.data() + length}; }

        PixelBuffer<uint32_t> planes;
        int64_t length;
        int32_t row = kNoRow;
    };

    /// The mixed row of the pattern, in the place of whichever kept one is not `other`.
    MixedRow mixedRow(int32_t row, int32_t other) {
        for (KeptRow& kept : mMixed) {
            if (kept.row == row) return kept.mixed();
        }
        KeptRow& replaced = mMixed[0].row == other ? mMixed[1] : mMixed[0];
        replaced.row = row;
        const auto* const words = reinterpret_cast<const uint32_t*>(mPattern.at(0, row));
        rampLoops().mixColumns(words, mTaps.taps(), mSampled, replaced.mixed());
        return replaced.mixed();
    }

    /// Copies the tile to the rest of the row, twice as much each time.
    void repeat() {
        for (int64_t done = mSampled; done < mWidth; done *= 2) {
            const int64_t count = std::min(done, mWidth - done);
            std::memcpy(mRow.data() + done, mRow.data(), static_cast<size_t>(count) * sizeof(uint32_t));
        }
    }

    ColourView mPattern;
    TileAxis mColumns;
    TileAxis mRows;
    float mOpacity;
    int64_t mWidth;
    int64_t mSampled;
    TapRow mTaps;
    KeptRow mMixed[2];
    PixelBuffer<uint32_t> mRow;
};

/// The covered box. Unlike the other cores' boxes, one larger than the mask is first cut to the mask's
/// size; unless it starts at the left or top edge it still leaves the mask then, and nothing is drawn.
CoverageBox fillBox(const VFECore::ParamPostProcessing* params) {
    if (params == nullptr || params->dstBitmap == nullptr || params->textRect == nullptr) return {};
    const MaskView mask = MaskView::of(params->srcBitmap);
    const VFRect& box = *params->textRect;
    return CoverageBox::of(mask, box.mLeft, box.mTop,
                           std::min(mask.width, int64_t{box.mRight} - box.mLeft),
                           std::min(mask.height, int64_t{box.mBottom} - box.mTop));
}

}  // namespace

VFPattern::VFPattern() : mProperty(nullptr) {
    mEffectType = kPattern;
}

VFPattern::~VFPattern() {
    releaseCopy(mProperty);
}

void VFPattern::setProperty(VFProperty* property) {
    (void)replaceCopy(mProperty, property);
}

VFProperty* VFPattern::getProperty() {
    return mProperty;
}

void VFPattern::doPostProcessing(ParamPostProcessing* params) {
    const CoverageBox box = fillBox(params);
    if (!box || mProperty == nullptr || mProperty->mScale < kSmallestScale) return;
    const ColourView pattern = ColourView::of(mProperty->mPattern);
    if (!pattern || pattern.width == 0 || pattern.height == 0) return;

    TiledRows rows(pattern, mProperty->mScale, mProperty->mOpacity, box.width);
    if (!rows) return;
    fillCovered(box, params->dstBitmap, [&](const BlendJob& job) {
        for (int64_t y = 0; y < job.height; ++y) {
            BlendJob row = rowOf(job, y);
            row.image = reinterpret_cast<const uint8_t*>(rows.at(y));
            blendLoops().dstOverWhereCovered(row);
        }
    });
}

}  // namespace VFontEffect
