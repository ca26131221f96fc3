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

/// The dilation takes its source with a border of one pixel: that is how far its corner (0, 0) lies
/// outside of the text box.
constexpr int64_t kBorder = 1;

constexpr uint8_t kCoverage = 0;
constexpr uint8_t kInverse = 0xFF;

/// What is to be seen of the outline, relative to the dilation's source.
struct Area {
    int64_t left;
    int64_t top;
    int64_t right;
    int64_t bottom;

    bool empty() const { return left >= right || top >= bottom; }
};

/// The part of the outline that lies on one of the targets at least.
Area visibleArea(const CoverageBox& box, int64_t reach, const VFECore::ParamPostProcessing& params) {
    Area outline = {-reach, -reach, box.width + 2 * kBorder + reach, box.height + 2 * kBorder + reach};
    int64_t targetWidth = 0;
    int64_t targetHeight = 0;
    for (const VFBitmap* target : {params.dstBitmap, params.subDstBitmap}) {
        const ColourView view = ColourView::of(target);
        targetWidth = std::max(targetWidth, view.width);
        targetHeight = std::max(targetHeight, view.height);
    }
    const int64_t left = box.left - kBorder;
    const int64_t top = box.top - kBorder;
    return {std::max(outline.left, -left), std::max(outline.top, -top),
            std::min(outline.right, targetWidth - left), std::min(outline.bottom, targetHeight - top)};
}

/// The coverage, or its inverse, grown by a disc. Needs memory, of which it may have got none.
class GrownCoverage {
  public:
    GrownCoverage(const CoverageBox& box, const DiscShape& disc, const Area& area, uint8_t flip)
        : mKernels(dilationKernels()),
          mDilation(dilationOf(box, disc, area, flip)),
          mMemory(memoryFor()) {
        mDilation.memory = mMemory.data();
        if (mMemory) mKernels.begin(mDilation);
    }
    explicit operator bool() const { return static_cast<bool>(mMemory); }

    /// The first column that rows have, and how many bytes they are apart.
    int64_t left() const { return mDilation.left; }
    int64_t width() const { return mDilation.right - mDilation.left; }
    int64_t stride() const { return dilatedStride(mDilation); }
    void rows(int64_t y, int64_t count, uint8_t* results) const {
        mKernels.dilateRows(mDilation, y, count, results);
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
        return dilation;
    }
    PixelBuffer<uint8_t> memoryFor() const {
        return PixelBuffer<uint8_t>::uninitialised(
            static_cast<int64_t>(mKernels.memoryBytes(mDilation)));
    }

    const DilationKernels& mKernels;
    Dilation mDilation;
    PixelBuffer<uint8_t> mMemory;
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

namespace {

/// Blends a band of the outline's rows.
struct Brush {
    const VFECore::ParamPostProcessing& params;
    int64_t left;  ///< of the rows, in the target
    int64_t width;
    int64_t stride;
    uint32_t color;
    int mode;

    void paint(int64_t top, int64_t count, uint8_t* rows) const {
        for (const VFBitmap* target : {params.dstBitmap, params.subDstBitmap}) {
            VFBlender().drawBitmapBlend8(saturateToInt(left), saturateToInt(top), target, rows,
                                         saturateToInt(width), static_cast<int>(count),
                                         saturateToInt(stride), color, mode);
        }
    }
};

}  // namespace

void VFStroke::doPostProcessing(ParamPostProcessing* params) {
    const CoverageBox box = coverageOf(params);
    if (!box || mProperty == nullptr || isAbsurd(mProperty->mSize)) return;
    const bool centred = mProperty->mPosition == kStrokeCentre;
    const DiscShape disc(centred ? mProperty->mSize * 0.5F : mProperty->mSize);
    if (!disc) return;
    const Area area = visibleArea(box, disc.reach, *params);
    if (area.empty()) return;

    // A centred stroke is what lies within the radius of the edge on both sides of it.
    const bool outside = mProperty->mPosition == kStrokeOutside || centred;
    const GrownCoverage grown(box, disc, area, outside ? kCoverage : kInverse);
    if (!grown) return;
    std::optional<GrownCoverage> inverse;
    if (centred) {
        inverse.emplace(box, disc, area, kInverse);
        if (!*inverse) return;
    }
    const int64_t bandBytes = grown.stride() * kBandRows;
    auto band = PixelBuffer<uint8_t>::uninitialised(bandBytes, centred ? 2 : 1);
    if (!band) return;

    const Brush brush = {
        *params,           box.left - kBorder + grown.left(),
        grown.width(),     grown.stride(),
        mProperty->mColor, centred && params->useOuterLayer != 1 ? kModeSrcOver : kModeDstOver};
    for (int64_t y = area.top; y < area.bottom; y += kBandRows) {
        const int64_t count = std::min(kBandRows, area.bottom - y);
        grown.rows(y, count, band.data());
        if (inverse) {
            inverse->rows(y, count, band.data() + bandBytes);
            dilationKernels().keepSmaller(band.data(), band.data() + bandBytes, count * grown.stride());
        }
        brush.paint(box.top - kBorder + y, count, band.data());
    }
}

}  // namespace VFontEffect
