#pragma once

/// Mode numbers of VFBlender::drawBitmapBlend8 and drawBitmapBlend32 (which knows the first two).
/// 4 to 6 and all others draw nothing.
namespace VFontEffect::internal {

constexpr int kModeSrcOver = 1;      // colour times coverage over the destination
constexpr int kModeDstOver = 2;      // colour times coverage under the destination
constexpr int kModeDstOverGate = 3;  // the full colour under it, wherever there is coverage
constexpr int kModeDstOverClip = 7;  // the full colour under it, then the result times coverage

}  // namespace VFontEffect::internal
