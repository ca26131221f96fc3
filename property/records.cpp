#include <algorithm>

#include "core/numeric.h"
#include "property/limits.h"
#include "voreleffect/VFProperty.h"

namespace VFontEffect {

using namespace internal;

VFProperty::VFProperty(unsigned int color, float opacity) : mColor(color), mOpacity(opacity) {}
VFProperty::~VFProperty() = default;

VFTextProperty::VFTextProperty(unsigned int color, float opacity) : VFProperty(color, opacity) {}

// Deliberate: the outer shadow keeps its angle as given, the inner shadow reduces it.
VFOuterShadowProperty::VFOuterShadowProperty(float angle, float distance, float size, unsigned int color,
                                             float opacity)
    : VFProperty(color, opacity), mAngle(angle), mDistance(distance), mSize(size) {}

VFInnerShadowProperty::VFInnerShadowProperty(float angle, float distance, float size, unsigned int color,
                                             float opacity)
    : VFProperty(color, opacity),
      mAngle(static_cast<float>(reducedDegrees(angle, kTurn))),
      mDistance(distance),
      mSize(size) {}

VFStrokeProperty::VFStrokeProperty(float size, unsigned int color, float opacity, int strokeStyle,
                                   int position)
    : VFProperty(color, opacity), mSize(size), mStrokeStyle(strokeStyle), mPosition(position) {}

VFOuterGlowProperty::VFOuterGlowProperty(float size, unsigned int color, float opacity, int count,
                                         VFGradient* gradient)
    : VFProperty(color, opacity), mSize(size), mGradientCount(count), mGradient(gradient) {}

VFInnerGlowProperty::VFInnerGlowProperty(float size, unsigned int color, float opacity, int count,
                                         VFGradient* gradient)
    : VFProperty(color, opacity), mSize(size), mGradientCount(count), mGradient(gradient) {}

VFLinearGradientProperty::VFLinearGradientProperty(float angle, float scale, float opacity, int count,
                                                   VFGradient* gradient)
    : VFProperty(0, opacity),
      mAngle(static_cast<float>(reducedDegrees(angle, kTurn))),
      mScale(clampKeepingNan(scale, 0.0F, kLargestGradientScale)),
      mGradientCount(count),
      mGradient(gradient) {}

VFRadialGradientProperty::VFRadialGradientProperty(float angle, float scale, float opacity, int count,
                                                   VFGradient* gradient)
    : VFProperty(0, opacity),
      mAngle(static_cast<float>(reducedDegrees(angle, kTurn))),
      mScale(clampKeepingNan(scale, 0.0F, kLargestGradientScale)),
      mGradientCount(count),
      mGradient(gradient) {}

VFBevelProperty::VFBevelProperty(int style, float size, float depth, int technique, int direction,
                                 int soften, float opacity, float angle, float altitude,
                                 unsigned int highlightColor, float highlightOpacity,
                                 unsigned int shadowColor, float shadowOpacity)
    : VFProperty(0, opacity),
      mStyle(style),
      mSize(size),
      mDepth(clampKeepingNan(depth, 0.0F, kLargestDepth)),
      mTechnique(technique),
      mDirection(direction),
      mSoften(std::clamp(soften, 0, kLargestSoften)),
      mAngle(static_cast<float>(reducedDegrees(angle, kTurn))),
      mAltitude(static_cast<float>(reducedDegrees(altitude, kQuarterTurn))),
      mHighlightColor(highlightColor),
      mHighlightOpacity(highlightOpacity),
      mShadowColor(shadowColor),
      mShadowOpacity(shadowOpacity) {}

VFEmbossProperty::VFEmbossProperty(int style, float size, float depth, int technique, int direction,
                                   int soften, float opacity, float angle, float altitude,
                                   unsigned int highlightColor, float highlightOpacity,
                                   unsigned int shadowColor, float shadowOpacity)
    : VFProperty(0, opacity),
      mStyle(style),
      mSize(size),
      mDepth(clampKeepingNan(depth, 0.0F, kLargestDepth)),
      mTechnique(technique),
      mDirection(direction),
      mSoften(std::clamp(soften, 0, kLargestSoften)),
      mAngle(static_cast<float>(reducedDegrees(angle, kTurn))),
      mAltitude(static_cast<float>(reducedDegrees(altitude, kQuarterTurn))),
      mHighlightColor(highlightColor),
      mHighlightOpacity(highlightOpacity),
      mShadowColor(shadowColor),
      mShadowOpacity(shadowOpacity) {}

VFPatternProperty::VFPatternProperty(VFBitmap* pattern, float scale, float opacity)
    : VFProperty(0, opacity),
      mPattern(pattern),
      mScale(clampKeepingNan(scale, 0.0F, kLargestPatternScale)) {}

}  // namespace VFontEffect
