#pragma once

/// The ranges that the records and the add-calls bring their numbers into.
namespace VFontEffect::internal {

/// Degrees that angles and altitudes are taken modulo.
constexpr int kTurn = 360;
constexpr int kQuarterTurn = 90;

/// Upper limits; the lower limit of each is 0.
constexpr float kLargestGradientScale = 2.0F;
constexpr float kLargestPatternScale = 10.0F;
constexpr float kLargestDepth = 10.0F;
constexpr int kLargestSoften = 16;

}  // namespace VFontEffect::internal
