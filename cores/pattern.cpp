#include <algorithm>
#include <cmath>
#include <cstdint>

#include "core/effect_types.h"
#include "core/fixed_point.h"
#include "core/numeric.h"
#include "cores/covered_fill.h"
#include "cores/paint_input.h"
#include "cores/property_copy.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// Two neighbouring pattern pixels on one axis and their weights, which add up to 255.
struct Tap {
    int64_t near;
    int64_t far;
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
        return {near, near + 1 < mPatternSize ? near + 1 : 0, 255 - farWeight, farWeight};
    }

  private:
    int64_t mPatternSize;
    float mScale;
    int64_t mTileSize;
};

/// The mix of four bytes. Deliberate: weights of 255 and a shift by 16 sample an opaque pattern as 253.
uint32_t mixed(uint32_t nearNear, uint32_t farNear, uint32_t nearFar, uint32_t farFar, const Tap& x,
               const Tap& y) {
    const uint32_t upper = nearNear * x.nearWeight + farNear * x.farWeight;
    const uint32_t lower = nearFar * x.nearWeight + farFar * x.farWeight;
    return ((upper * y.nearWeight + lower * y.farWeight) >> 16) & 0xFFU;
}

/// The pattern sampled between four pixels, its alpha times the opacity, premultiplied.
uint32_t sample(const ColourView& pattern, const Tap& x, const Tap& y, float opacity) {
    const unsigned char* const nearNear = pattern.at(x.near, y.near);
    const unsigned char* const farNear = pattern.at(x.far, y.near);
    const unsigned char* const nearFar = pattern.at(x.near, y.far);
    const unsigned char* const farFar = pattern.at(x.far, y.far);
    // Deliberate: pattern pixels stand in memory as A, R, G, B, unlike the destination's.
    const auto channel = [&](int k) {
        return mixed(nearNear[k], farNear[k], nearFar[k], farFar[k], x, y);
    };
    const auto alpha = static_cast<uint32_t>(toInt(static_cast<float>(channel(0)) * opacity));
    return premultiply(alpha << 24 | channel(1) << 16 | channel(2) << 8 | channel(3));
}

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

    const TileAxis columns(pattern.width, mProperty->mScale);
    const TileAxis rows(pattern.height, mProperty->mScale);
    const float opacity = clampOrLow(mProperty->mOpacity, 0.0F, 1.0F);
    fillCovered(box, params->dstBitmap, [&](int64_t y) {
        return [&, rowTap = rows.at(y)](int64_t x) {
            return sample(pattern, columns.at(x), rowTap, opacity);
        };
    });
}

}  // namespace VFontEffect
