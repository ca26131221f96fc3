#pragma once

/// Upper limits that the records and the add-calls clamp to; the lower limit of each is 0.
namespace VFontEffect::internal {

constexpr float kLargestGradientScale = 2.0F;
constexpr float kLargestPatternScale = 10.0F;
constexpr float kLargestDepth = 10.0F;
constexpr int kLargestSoften = 16;

}  // namespace VFontEffect::internal
