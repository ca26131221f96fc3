#pragma once

/// The effect type numbers: what addEffect takes and getStyle returns.
namespace VFontEffect::internal {

enum EffectType : int {
    kOuterShadow = 1,
    kInnerShadow = 2,
    kOuterGlow = 3,
    kInnerGlow = 4,
    kBevel = 5,
    kEmboss = 6,
    kLinearGradient = 7,
    kRadialGradient = 8,
    kReservedStroke = 9,  // placed like a stroke; no core of this type exists
    kStroke = 10,
    kPattern = 11,
    kText = 12,
    kNoEffect = 13
};

}  // namespace VFontEffect::internal
