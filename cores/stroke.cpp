#include <algorithm>
#include <cstdint>
#include <optional>

#include "core/blend_modes.h"
#include "core/effect_types.h"
#include "core/line_buffer.h"
#include "core/numeric.h"
#include "core/size_limit.h"
#include "cores/paint_input.h"
#include "cores/placed_target.h"
#include "cores/property_copy.h"
#include "cores/stroke_shape.h"
#include "ops/dilate/dilation_loops.h"
#include "ops/dilate/disc_shape.h"
#include "voreleffect/VFBlender.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// The dilation takes its source with a border of one pixel.
constexpr int64_t kBorder = 1;

/// Rows that are dilated and blended at once: few enough to stay in the cache.
constexpr int64_t kBandRows = 32;

/// The part of an outline that at least one of the targets shows, in the coordinates of the bordered
/// source.
Box visiblePart(const CoverageBox& box, int64_t reach, const VFECore::ParamPostProcessing& params) {
    const Box bordered = {0, 0, box.width + 2 * kBorder, box.height + 2 * kBorder};
    Box visible = {};
    for (const VFBitmap* target : {params.dstBitmap, params.subDstBitmap}) {
        const PlacedTarget placed(target, box.left - kBorder, box.top - kBorder);
        visible = boundingBox(visible, placed.seen(expanded(bordered, reach)));
    }
    return visible;
}

/// The coverage, or its inverse, grown by a disc; empty when memory ran out.
class GrownCoverage {
  public:
    GrownCoverage(const CoverageBox& box, const DiscShape& disc, const Box& part, uint8_t invertMask)
        : mDilation(dilationOf(box, disc, part, invertMask)),
          mMemory(dilationLoops().memoryBytes(mDilation)) {
        mDilation.memory = mMemory.data();
        if (mMemory) dilationLoops().begin(mDilation);
    }

    explicit operator bool() const { return static_cast<bool>(mMemory); }
    const Dilation& dilation() const { return mDilation; }
    uint8_t* rows(int64_t y, int64_t count) const {
        return dilationLoops().dilateRows(mDilation, y, count);
    }

  private:
    static Dilation dilationOf(const CoverageBox& box, const DiscShape& disc, const Box& part,
                               uint8_t invertMask) {
        Dilation dilation = {};
        dilation.box = box.row(0);
        dilation.boxStride = box.mask.width;
        dilation.width = box.width + 2 * kBorder;
        dilation.height = box.height + 2 * kBorder;
        dilation.invertMask = invertMask;
        dilation.disc = &disc;
        dilation.left = std::min<int64_t>(part.left, 0);
        dilation.right = std::max(part.right, dilation.width);
        dilation.top = part.top;
        dilation.bandRows = std::min(kBandRows, part.height());
        return dilation;
    }

    Dilation mDilation;
    LineBuffer mMemory;
};

/// The outline's coverage, a band of rows at a time; empty when memory ran out. What is centred lies
/// within the disc's radius of the edge on both sides of it.
class Outline {
  public:
    Outline(const CoverageBox& box, const DiscShape& disc, const Box& part, const StrokeShape& shape)
        : mGrown(box, disc, part, shape.growsGlyph ? kCoverage : kInverse) {
        if (shape.side == StrokeSide::centre) mInverse.emplace(box, disc, part, kInverse);
    }

    explicit operator bool() const { return mGrown && (!mInverse || *mInverse); }
    int64_t left() const { return mGrown.dilation().left; }
    int64_t width() const { return mGrown.dilation().right - left(); }
    int64_t stride() const { return dilatedStride(mGrown.dilation()); }
    int64_t bandRows() const { return mGrown.dilation().bandRows; }

    uint8_t* band(int64_t y, int64_t count) {
        uint8_t* const band = mGrown.rows(y, count);
        if (mInverse) dilationLoops().keepSmaller(band, mInverse->rows(y, count), stride() * count);
        return band;
    }

  private:
    GrownCoverage mGrown;
    std::optional<GrownCoverage> mInverse;
};

}  // namespace

VFStroke::VFStroke() : mProperty(nullptr) {
    mEffectType = kStroke;
}

VFStroke::~VFStroke() {
    releaseCopy(mProperty);
}

void VFStroke::setProperty(VFProperty* property) {
    (void)replaceCopy(mProperty, property);
}

VFProperty* VFStroke::getProperty() {
    return mProperty;
}

int VFStroke::getOffset() {
    return mProperty != nullptr ? StrokeShape(*mProperty).reach : 0;
}

void VFStroke::doPostProcessing(ParamPostProcessing* params) {
    const CoverageBox box = coverageOf(params);
    if (!box || mProperty == nullptr || exceedsSizeLimit(mProperty->mSize)) return;
    const StrokeShape shape(*mProperty);
    const DiscShape disc(shape.radiusPx);
    if (!disc) return;
    const Box visible = visiblePart(box, disc.reach, *params);
    if (visible.empty()) return;
    Outline outline(box, disc, visible, shape);
    if (!outline) return;

    const int left = saturateToInt(box.left - kBorder + outline.left());
    const int width = saturateToInt(outline.width());
    const int stride = saturateToInt(outline.stride());
    const bool centred = shape.side == StrokeSide::centre;
    const int mode = centred && params->useOuterLayer != 1 ? kModeSrcOver : kModeDstOver;
    for (int64_t y = visible.top; y < visible.bottom; y += outline.bandRows()) {
        const int64_t count = std::min(outline.bandRows(), visible.bottom - y);
        uint8_t* const band = outline.band(y, count);
        for (const VFBitmap* target : {params->dstBitmap, params->subDstBitmap}) {
            VFBlender().drawBitmapBlend8(left, saturateToInt(box.top - kBorder + y), target, band, width,
                                         static_cast<int>(count), stride, mProperty->mColor, mode);
        }
    }
}

}  // namespace VFontEffect
