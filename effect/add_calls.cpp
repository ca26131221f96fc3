#include <algorithm>

#include "core/effect_types.h"
#include "core/float_state.h"
#include "core/numeric.h"
#include "effect/normalise.h"
#include "property/limits.h"
#include "voreleffect/VFEffect.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// Puts the effect of the record that `make` computes into the set and returns its id, which is
/// 0xFFFFFFFF for none. Adding may throw, which would leave out what restores the caller's
/// floating-point state: it comes after.
template <class Make>
unsigned int add(VFEffect& set, EffectType type, Make make) {
    auto record = inOwnFloatState(make);
    return static_cast<unsigned int>(set.addEffect(type, &record));
}

template <class Shadow>
Shadow shadowRecord(float angle, float distance, float size, unsigned int color, float opacity) {
    const float o = clampedOpacity(opacity);
    return Shadow(static_cast<float>(wholeDegrees(angle, kTurn)), wholePixels(distance),
                  wholePixels(size), premultipliedColour(color, o), o);
}

template <class Glow>
unsigned int addGlow(VFEffect& set, EffectType type, float size, unsigned int color, float opacity,
                     int count, const VFGradient* gradient) {
    NormalisedStops stops;
    return add(set, type, [&] {
        const float o = clampedOpacity(opacity);
        stops.fill(gradient, count, o);
        return Glow(wholePixels(size), straightColour(color, o), o, stops.count(), stops.data());
    });
}

/// Bevel and emboss: each colour carries the product of the effect's opacity and its own.
template <class Relief>
Relief reliefRecord(int style, float size, float depth, int technique, int direction, int soften,
                    float opacity, float angle, float altitude, unsigned int highlightColor,
                    float highlightOpacity, unsigned int shadowColor, float shadowOpacity) {
    const float o = clampedOpacity(opacity);
    const float highlight = clampedOpacity(highlightOpacity);
    const float shadow = clampedOpacity(shadowOpacity);
    return Relief(style, size, clampOrLow(depth, 0.0F, kLargestDepth), technique, direction,
                  std::clamp(soften, 0, kLargestSoften), o,
                  static_cast<float>(wholeDegrees(angle, kTurn)),
                  static_cast<float>(wholeDegrees(altitude, kQuarterTurn)),
                  straightColour(highlightColor, clampedOpacity(o * highlight)), highlight,
                  straightColour(shadowColor, clampedOpacity(o * shadow)), shadow);
}

}  // namespace

unsigned int VFEffect::addOuterShadowText(float angle, float distance, float size, unsigned int color,
                                          float opacity) {
    return add(*this, kOuterShadow, [&] {
        return shadowRecord<VFOuterShadowProperty>(angle, distance, size, color, opacity);
    });
}

unsigned int VFEffect::addInnerShadowText(float angle, float distance, float size, unsigned int color,
                                          float opacity) {
    return add(*this, kInnerShadow, [&] {
        return shadowRecord<VFInnerShadowProperty>(angle, distance, size, color, opacity);
    });
}

unsigned int VFEffect::addOuterGlowText(float size, unsigned int color, float opacity, int count,
                                        VFGradient* gradient) {
    return addGlow<VFOuterGlowProperty>(*this, kOuterGlow, size, color, opacity, count, gradient);
}

unsigned int VFEffect::addInnerGlowText(float size, unsigned int color, float opacity, int count,
                                        VFGradient* gradient) {
    return addGlow<VFInnerGlowProperty>(*this, kInnerGlow, size, color, opacity, count, gradient);
}

unsigned int VFEffect::addBevelText(int style, float size, float depth, int technique, int direction,
                                    int soften, float opacity, float angle, float altitude,
                                    unsigned int highlightColor, float highlightOpacity,
                                    unsigned int shadowColor, float shadowOpacity) {
    return add(*this, kBevel, [&] {
        return reliefRecord<VFBevelProperty>(style, size, depth, technique, direction, soften, opacity,
                                             angle, altitude, highlightColor, highlightOpacity,
                                             shadowColor, shadowOpacity);
    });
}

unsigned int VFEffect::addEmbossText(int style, float size, float depth, int technique, int direction,
                                     int soften, float opacity, float angle, float altitude,
                                     unsigned int highlightColor, float highlightOpacity,
                                     unsigned int shadowColor, float shadowOpacity) {
    return add(*this, kEmboss, [&] {
        return reliefRecord<VFEmbossProperty>(style, size, depth, technique, direction, soften, opacity,
                                              angle, altitude, highlightColor, highlightOpacity,
                                              shadowColor, shadowOpacity);
    });
}

unsigned int VFEffect::addLinearGradientText(float angle, float scale, float opacity, int count,
                                             VFGradient* gradient) {
    NormalisedStops stops;
    return add(*this, kLinearGradient, [&] {
        const float o = clampedOpacity(opacity);
        stops.fill(gradient, count, o);
        return VFLinearGradientProperty(static_cast<float>(wholeDegrees(angle, kTurn)),
                                        clampOrLow(scale, 0.0F, kLargestGradientScale), o, stops.count(),
                                        stops.data());
    });
}

unsigned int VFEffect::addRadialGradientText(float scale, float opacity, int count,
                                             VFGradient* gradient) {
    NormalisedStops stops;
    return add(*this, kRadialGradient, [&] {
        const float o = clampedOpacity(opacity);
        stops.fill(gradient, count, o);
        // Deliberate: the record has an angle, the call offers none.
        return VFRadialGradientProperty(0.0F, clampOrLow(scale, 0.0F, kLargestGradientScale), o,
                                        stops.count(), stops.data());
    });
}

unsigned int VFEffect::addStrokeText(float size, unsigned int color, float opacity, int strokeStyle,
                                     int position) {
    return add(*this, kStroke, [&] {
        const float o = clampedOpacity(opacity);
        return VFStrokeProperty(wholePixels(size), premultipliedColour(color, o), o, strokeStyle,
                                position);
    });
}

unsigned int VFEffect::addPatternText(VFBitmap* pattern, float scale, float opacity) {
    return add(*this, kPattern, [&] {
        return VFPatternProperty(pattern, clampOrLow(scale, 0.0F, kLargestPatternScale),
                                 clampedOpacity(opacity));
    });
}

unsigned int VFEffect::addText(unsigned int color, float opacity) {
    mTextAlpha = static_cast<unsigned char>(color >> 24);
    return add(*this, kText, [&] {
        const float o = clampedOpacity(opacity);
        return VFTextProperty(premultipliedColour(color, o), o);
    });
}

}  // namespace VFontEffect
