#pragma once

/// Mode numbers of VFBlender::drawBitmapBlend8 and drawBitmapBlend32 (which knows the first two).
/// 4 to 6 and all others draw nothing.
namespace VFontEffect::internal {

constexpr int kModeSrcOver = 1;
constexpr int kModeDstOver = 2;
constexpr int kModeDstOverGate = 3;
constexpr int kModeDstOverClip = 7;

}  // namespace VFontEffect::internal
