#include <algorithm>

#include "core/float_state.h"
#include "core/numeric.h"
#include "property/limits.h"
#include "voreleffect/VFProperty.h"

namespace VFontEffect {

using namespace internal;

namespace {

float reducedAngle(float degrees, int turn) {
    return static_cast<float>(reducedDegrees(degrees, turn));
}

/// Reduces the angle of a gradient and limits its scale; a NaN stays.
void normaliseGradient(float& angle, float& scale) {
    const OwnFloatState floatState;
    angle = reducedAngle(angle, kTurn);
    scale = clampKeepingNan(scale, 0.0F, kLargestGradientScale);
}

/// Likewise with the angles and the depth of a bevel or an emboss.
void normaliseRelief(float& angle, float& altitude, float& depth) {
    const OwnFloatState floatState;
    angle = reducedAngle(angle, kTurn);
    altitude = reducedAngle(altitude, kQuarterTurn);
    depth = clampKeepingNan(depth, 0.0F, kLargestDepth);
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
    : VFProperty(color, opacity),
      mAngle(inOwnFloatState([&] { return reducedAngle(angle, kTurn); })),
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
    : VFProperty(0, opacity), mAngle(angle), mScale(scale), mGradientCount(count), mGradient(gradient) {
    normaliseGradient(mAngle, mScale);
}

VFRadialGradientProperty::VFRadialGradientProperty(float angle, float scale, float opacity, int count,
                                                   VFGradient* gradient)
    : VFProperty(0, opacity), mAngle(angle), mScale(scale), mGradientCount(count), mGradient(gradient) {
    normaliseGradient(mAngle, mScale);
}

VFBevelProperty::VFBevelProperty(int style, float size, float depth, int technique, int direction,
                                 int soften, float opacity, float angle, float altitude,
                                 unsigned int highlightColor, float highlightOpacity,
                                 unsigned int shadowColor, float shadowOpacity)
    : VFProperty(0, opacity),
      mStyle(style),
      mSize(size),
      mDepth(depth),
      mTechnique(technique),
      mDirection(direction),
      mSoften(std::clamp(soften, 0, kLargestSoften)),
      mAngle(angle),
      mAltitude(altitude),
      mHighlightColor(highlightColor),
      mHighlightOpacity(highlightOpacity),
      mShadowColor(shadowColor),
      mShadowOpacity(shadowOpacity) {
    normaliseRelief(mAngle, mAltitude, mDepth);
}

VFEmbossProperty::VFEmbossProperty(int style, float size, float depth, int technique, int direction,
                                   int soften, float opacity, float angle, float altitude,
                                   unsigned int highlightColor, float highlightOpacity,
                                   unsigned int shadowColor, float shadowOpacity)
    : VFProperty(0, opacity),
      mStyle(style),
      mSize(size),
      mDepth(depth),
      mTechnique(technique),
      mDirection(direction),
      mSoften(std::clamp(soften, 0, kLargestSoften)),
      mAngle(angle),
      mAltitude(altitude),
      mHighlightColor(highlightColor),
      mHighlightOpacity(highlightOpacity),
      mShadowColor(shadowColor),
      mShadowOpacity(shadowOpacity) {
    normaliseRelief(mAngle, mAltitude, mDepth);
}

VFPatternProperty::VFPatternProperty(VFBitmap* pattern, float scale, float opacity)
    : VFProperty(0, opacity),
      mPattern(pattern),
      mScale(inOwnFloatState([&] { return clampKeepingNan(scale, 0.0F, kLargestPatternScale); })) {}

}  // namespace VFontEffect
