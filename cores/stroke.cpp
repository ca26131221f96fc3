#include <algorithm>
#include <cstdint>
#include <optional>

#include "core/blend_modes.h"
#include "core/effect_types.h"
#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "core/views.h"
#include "cores/dilation.h"
#include "cores/disc_shape.h"
#include "cores/paint_input.h"
#include "cores/property_copy.h"
#include "voreleffect/VFBlender.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// The dilation takes its source with a border of one pixel.
constexpr int64_t kBorder = 1;

constexpr uint8_t kCoverage = 0;
constexpr uint8_t kInverse = 0xFF;

/// Rows that are dilated and blended at once: enough not to prepare too many twice, few enough to stay
/// in the cache, and fewer where the columns around a narrow outline outweigh its own.
constexpr int64_t kBandRows = 32;
constexpr int64_t kNarrowBandRows = 16;
constexpr int64_t kNarrow = 256;

/// A part of the outline, in the coordinates of the bordered source.
struct Area {
    int64_t left;
    int64_t top;
    int64_t right;
    int64_t bottom;

    bool empty() const { return left >= right || top >= bottom; }
};

/// The part that at least one of the targets shows.
Area visibleArea(const CoverageBox& box, int64_t reach, const VFECore::ParamPostProcessing& params) {
    int64_t targetWidth = 0;
    int64_t targetHeight = 0;
    for (const VFBitmap* target : {params.dstBitmap, params.subDstBitmap}) {
        const ColourView view = ColourView::of(target);
        targetWidth = std::max(targetWidth, view.width);
        targetHeight = std::max(targetHeight, view.height);
    }
    const int64_t left = box.left - kBorder;
    const int64_t top = box.top - kBorder;
    const int64_t right = box.width + 2 * kBorder + reach;
    const int64_t bottom = box.height + 2 * kBorder + reach;
    return {std::max(-reach, -left), std::max(-reach, -top), std::min(right, targetWidth - left),
            std::min(bottom, targetHeight - top)};
}

/// The coverage, or its inverse, grown by a disc; empty when memory ran out.
class GrownCoverage {
  public:
    GrownCoverage(const CoverageBox& box, const DiscShape& disc, const Area& area, uint8_t flip)
        : mDilation(dilationOf(box, disc, area, flip)), mMemory(memoryFor(mDilation)) {
        mDilation.memory = mMemory.data();
        if (mMemory) dilationKernels().begin(mDilation);
    }

    explicit operator bool() const { return static_cast<bool>(mMemory); }
    const Dilation& dilation() const { return mDilation; }
    void rows(int64_t y, int64_t count, uint8_t* results) const {
        dilationKernels().dilateRows(mDilation, y, count, results);
    }

  private:
    static Dilation dilationOf(const CoverageBox& box, const DiscShape& disc, const Area& area,
                               uint8_t flip) {
        Dilation dilation = {};
        dilation.box = box.row(0);
        dilation.boxStride = box.mask.width;
        dilation.width = box.width + 2 * kBorder;
        dilation.height = box.height + 2 * kBorder;
        dilation.flip = flip;
        dilation.disc = &disc;
        dilation.left = std::min<int64_t>(area.left, 0);
        dilation.right = std::max(area.right, dilation.width);
        const bool narrow = dilation.right - dilation.left < kNarrow;
        dilation.bandRows = std::min(narrow ? kNarrowBandRows : kBandRows, area.bottom - area.top);
        return dilation;
    }
    static PixelBuffer<uint8_t> memoryFor(const Dilation& dilation) {
        const size_t bytes = dilationKernels().memoryBytes(dilation);
        return PixelBuffer<uint8_t>::uninitialised(static_cast<int64_t>(bytes));
    }

    Dilation mDilation;
    PixelBuffer<uint8_t> mMemory;
};

/// The outline's coverage, a band of rows at a time; empty when memory ran out. What is centred lies
/// within the disc's radius of the edge on both sides of it.
class Outline {
  public:
    Outline(const CoverageBox& box, const DiscShape& disc, const Area& area, int position)
        : mGrown(box, disc, area, position == kStrokeInside ? kInverse : kCoverage),
          mStride(dilatedStride(mGrown.dilation())),
          mBand(PixelBuffer<uint8_t>::uninitialised(mStride * bandRows(),
                                                    position == kStrokeCentre ? 2 : 1)) {
        if (position == kStrokeCentre) mInverse.emplace(box, disc, area, kInverse);
    }

    explicit operator bool() const { return mGrown && (!mInverse || *mInverse) && mBand; }
    int64_t left() const { return mGrown.dilation().left; }
    int64_t width() const { return mGrown.dilation().right - left(); }
    int64_t stride() const { return mStride; }
    int64_t bandRows() const { return mGrown.dilation().bandRows; }

    uint8_t* band(int64_t y, int64_t count) {
        mGrown.rows(y, count, mBand.data());
        if (mInverse) {
            uint8_t* const second = mBand.data() + mStride * bandRows();
            mInverse->rows(y, count, second);
            dilationKernels().keepSmaller(mBand.data(), second, mStride * count);
        }
        return mBand.data();
    }

  private:
    GrownCoverage mGrown;
    std::optional<GrownCoverage> mInverse;
    int64_t mStride;
    PixelBuffer<uint8_t> mBand;
};

}  // namespace

VFStroke::VFStroke() : mProperty(nullptr) {
    mEffectType = kStroke;
}

VFStroke::~VFStroke() {
    releaseCopy(mProperty);
}

void VFStroke::setProperty(VFProperty* property) {
    replaceCopy(mProperty, property);
}

VFProperty* VFStroke::getProperty() {
    return mProperty;
}

int VFStroke::getOffset() {
    if (mProperty == nullptr) return 0;
    if (mProperty->mPosition == kStrokeOutside) return toInt(mProperty->mSize + 0.5F);
    return mProperty->mPosition == kStrokeCentre ? toInt(mProperty->mSize * 0.5F + 0.5F) : 0;
}

void VFStroke::doPostProcessing(ParamPostProcessing* params) {
    const CoverageBox box = coverageOf(params);
    if (!box || mProperty == nullptr || isAbsurd(mProperty->mSize)) return;
    const bool centred = mProperty->mPosition == kStrokeCentre;
    const bool outside = mProperty->mPosition == kStrokeOutside;
    const DiscShape disc(centred ? mProperty->mSize * 0.5F : mProperty->mSize);
    if (!disc) return;
    const Area area = visibleArea(box, disc.reach, *params);
    if (area.empty()) return;
    Outline outline(box, disc, area, centred || outside ? mProperty->mPosition : kStrokeInside);
    if (!outline) return;

    const int left = saturateToInt(box.left - kBorder + outline.left());
    const int width = saturateToInt(outline.width());
    const int stride = saturateToInt(outline.stride());
    const int mode = centred && params->useOuterLayer != 1 ? kModeSrcOver : kModeDstOver;
    for (int64_t y = area.top; y < area.bottom; y += outline.bandRows()) {
        const int64_t count = std::min(outline.bandRows(), area.bottom - y);
        uint8_t* const band = outline.band(y, count);
        for (const VFBitmap* target : {params->dstBitmap, params->subDstBitmap}) {
            VFBlender().drawBitmapBlend8(left, saturateToInt(box.top - kBorder + y), target, band, width,
                                         static_cast<int>(count), stride, mProperty->mColor, mode);
        }
    }
}

}  // namespace VFontEffect
