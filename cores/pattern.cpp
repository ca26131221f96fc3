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
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

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
        return {static_cast<uint32_t>(near), static_cast<uint32_t>(far), 255 - farWeight, farWeight};
    }

    /// Output pixels after which the taps repeat.
    int64_t period() const { return mTileSize; }

  private:
    int64_t mPatternSize;
    float mScale;
    int64_t mTileSize;
};

/// The pattern as it lies under the box, row by row. What repeats is sampled once: the columns' taps for
/// all rows, and of each row one tile.
///
/// A pixel is the sum of four pattern pixels times both their weights. The sum is exact, so its rows are
/// mixed first, once for all columns.
class TiledRows {
  public:
    TiledRows(const ColourView& pattern, float scale, float opacity, int64_t width)
        : mPattern(pattern),
          mColumns(pattern.width, scale),
          mRows(pattern.height, scale),
          mWidth(width),
          mSampled(std::min(width, mColumns.period())),
          mTaps(PixelBuffer<Tap>::uninitialised(mSampled)),
          mMixed(PixelBuffer<uint16_t>::uninitialised(pattern.width, kColourBytes)),
          mRow(PixelBuffer<uint32_t>::zeroed(width)) {
        if (!*this) return;
        for (int64_t x = 0; x < mSampled; ++x)
            mTaps[static_cast<size_t>(x)] = mColumns.at(x);
        for (int alpha = 0; alpha < 256; ++alpha) {
            mAlphas[alpha] = static_cast<uint8_t>(toInt(static_cast<float>(alpha) * opacity));
        }
    }

    /// False when memory ran out.
    explicit operator bool() const { return mTaps && mMixed && mRow; }

    /// The pixels of row y, right wherever the coverage of the row is not 0.
    const uint32_t* at(int64_t y, const uint8_t* coverage) {
        const Tap rows = mRows.at(y);
        fillKernels().mixRows(mPattern.at(0, rows.near), mPattern.at(0, rows.far), rows,
                              usedColumns() * kColourBytes, mMixed.data());
        if (mSampled < mWidth) {
            sample(0, mSampled);
            repeat();
        } else {
            sampleCovered(coverage);
        }
        return mRow.data();
    }

  private:
    int64_t usedColumns() const {
        // The taps ascend within a tile; the last pixel of the pattern mixes with its first.
        return std::min(mPattern.width, int64_t{mTaps.data()[mSampled - 1].near} + 2);
    }

    void sample(int64_t first, int64_t count) {
        fillKernels().sampleRow(mMixed.data(), mTaps.data() + first, count, mAlphas,
                                mRow.data() + first);
    }

    /// Copies the tile to the rest of the row, twice as much each time.
    void repeat() {
        for (int64_t done = mSampled; done < mWidth; done *= 2) {
            const int64_t count = std::min(done, mWidth - done);
            std::memcpy(mRow.data() + done, mRow.data(), static_cast<size_t>(count) * sizeof(uint32_t));
        }
    }

    void sampleCovered(const uint8_t* coverage) {
        constexpr int64_t kBlock = 16;
        for (int64_t x = 0; x < mWidth; x += kBlock) {
            const int64_t count = std::min(kBlock, mWidth - x);
            const auto covered = [](uint8_t c) { return c != 0; };
            if (std::any_of(coverage + x, coverage + x + count, covered)) sample(x, count);
        }
    }

    ColourView mPattern;
    TileAxis mColumns;
    TileAxis mRows;
    int64_t mWidth;
    int64_t mSampled;
    PixelBuffer<Tap> mTaps;
    PixelBuffer<uint16_t> mMixed;
    PixelBuffer<uint32_t> mRow;
    uint8_t mAlphas[256];
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
    replaceCopy(mProperty, property);
}

VFProperty* VFPattern::getProperty() {
    return mProperty;
}

void VFPattern::doPostProcessing(ParamPostProcessing* params) {
    const CoverageBox box = fillBox(params);
    if (!box || mProperty == nullptr || mProperty->mScale < kSmallestScale) return;
    const ColourView pattern = ColourView::of(mProperty->mPattern);
    if (!pattern || pattern.width == 0 || pattern.height == 0) return;

    TiledRows rows(pattern, mProperty->mScale, clampOrLow(mProperty->mOpacity, 0.0F, 1.0F), box.width);
    if (!rows) return;
    fillCovered(box, params->dstBitmap, [&](const FillJob& job) {
        for (int64_t y = 0; y < job.blend.height; ++y) {
            BlendJob row = rowOf(job.blend, y);
            const uint32_t* const pixels = rows.at(job.top + y, row.mask - job.left);
            row.image = reinterpret_cast<const uint8_t*>(pixels + job.left);
            blendKernels().dstOverWhereCovered(row);
        }
    });
}

}  // namespace VFontEffect
