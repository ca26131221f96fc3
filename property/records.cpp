#include <algorithm>

#include "core/float_state.h"
#include "core/numeric.h"
#include "property/limits.h"
#include "voreleffect/VFProperty.h"

namespace VFontEffect {

using namespace internal;

namespace {

float reducedAngle(float degrees, int turn) {
    return inOwnFloatState([&] { return static_cast<float>(reducedDegrees(degrees, turn)); });
}

/// Inside [0, largest]; a NaN stays.
float clamped(float value, float largest) {
    return inOwnFloatState([&] { return clampKeepingNan(value, 0.0F, largest); });
}

}  // namespace

VFProperty::VFProperty(unsigned int color, float opacity) : mColor(color), mOpacity(opacity) {}
VFProperty::~VFProperty() = default;

VFTextProperty::VFTextProperty(unsigned int color, float opacity) : VFProperty(color, opacity) {}

// Deliberate: the outer shadow keeps its angle as given, the inner shadow reduces it.
VFOuterShadowProperty::VFOuterShadowProperty(float angle, float distance, float size, unsigned int color,
                                             float opacity)
    : VFProperty(color, opacity), mAngle(angle), mDistance(distance), mSize(size) {}

VFInnerShadowProperty::VFInnerShadowProperty(float angle, float distance, float size, unsigned int color,
                                             float opacity)
    : VFProperty(color, opacity), mAngle(reducedAngle(angle, kTurn)), mDistance(distance), mSize(size) {}

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
      mAngle(reducedAngle(angle, kTurn)),
      mScale(clamped(scale, kLargestGradientScale)),
      mGradientCount(count),
      mGradient(gradient) {}

VFRadialGradientProperty::VFRadialGradientProperty(float angle, float scale, float opacity, int count,
                                                   VFGradient* gradient)
    : VFProperty(0, opacity),
      mAngle(reducedAngle(angle, kTurn)),
      mScale(clamped(scale, kLargestGradientScale)),
      mGradientCount(count),
      mGradient(gradient) {}

VFBevelProperty::VFBevelProperty(int style, float size, float depth, int technique, int direction,
                                 int soften, float opacity, float angle, float altitude,
                                 unsigned int highlightColor, float highlightOpacity,
                                 unsigned int shadowColor, float shadowOpacity)
    : VFProperty(0, opacity),
      mStyle(style),
      mSize(size),
      mDepth(clamped(depth, kLargestDepth)),
      mTechnique(technique),
      mDirection(direction),
      mSoften(std::clamp(soften, 0, kLargestSoften)),
      mAngle(reducedAngle(angle, kTurn)),
      mAltitude(reducedAngle(altitude, kQuarterTurn)),
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
      mDepth(clamped(depth, kLargestDepth)),
      mTechnique(technique),
      mDirection(direction),
      mSoften(std::clamp(soften, 0, kLargestSoften)),
      mAngle(reducedAngle(angle, kTurn)),
      mAltitude(reducedAngle(altitude, kQuarterTurn)),
      mHighlightColor(highlightColor),
      mHighlightOpacity(highlightOpacity),
      mShadowColor(shadowColor),
      mShadowOpacity(shadowOpacity) {}

VFPatternProperty::VFPatternProperty(VFBitmap* pattern, float scale, float opacity)
    : VFProperty(0, opacity), mPattern(pattern), mScale(clamped(scale, kLargestPatternScale)) {}

}  // namespace VFontEffect
