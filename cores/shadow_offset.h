#pragma once

#include <algorithm>

#include "core/numeric.h"
#include "core/portable_math.h"
#include "core/size_limit.h"
#include "ops/blur/blur_weights.h"

/// What both shadows derive from their record.
namespace VFontEffect::internal {

struct ShadowOffset {
    int x;
    int y;
};

/// How far the shadow is moved, in whole pixels rounded half away from zero. The angle names where
/// the light comes from, with y downwards; the shadow falls on the far side. Deliberate: only the
/// horizontal move is negated, and pi has six digits.
inline ShadowOffset shadowOffset(float angleDeg, float distancePx) {
    const Turn angle = portableTurn(angleDeg * 3.14159F / 180.0F);
    const float across = angle.cosine * distancePx;
    const float down = angle.sine * distancePx;
    return {toInt((across < 0.0F ? 0.5F : -0.5F) - across), toInt(down + (down > 0.0F ? 0.5F : -0.5F))};
}

static_assert(totalBound(100, static_cast<uint32_t>(kLargestSizePx)) <= kLargestTotal,
              "a shadow of the size limit divides by reciprocals");
static_assert(kLargestSizePx + 0.5F < static_cast<float>(BlurWeights::kLongestRadius + 1),
              "and has room for its weights");

/// The blur radius of a shadow; a negative size does not blur.
inline int shadowRadius(float sizePx) {
    return std::max(0, toInt(static_cast<double>(sizePx) + 0.5));
}

}  // namespace VFontEffect::internal
