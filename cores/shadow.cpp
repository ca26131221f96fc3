#include <cstdint>
#include <optional>

#include "cores/painters.h"

namespace VFontEffect::internal {

BlurPainter::BlurPainter(CpuLevel level, const PlacedTarget& target, const CoverageRows& coverage, Of of,
                         int radius, const Box& part, uint32_t color, int64_t workingBytes)
    : mTarget(target),
      mColor(color),
      mWeights(gaussianOf100(radius)),
      mBlur(level,
            of == Of::coverage ? BlurInput::down(mWeights, coverage, part, kNoFullColumns, false)
                               : BlurInput::inverseAcross(mWeights, coverage, part),
            workingBytes) {}

int64_t BlurPainter::paintAbove(int64_t limit) {
    const auto paint = [&](const Box& band, const BlurredRows& rows) {
        mTarget.paint(&BlendLoops::dstOverMask, band, rows.values, rows.stride, mColor);
    };
    return mTarget.destinationRow(mBlur.paintAbove(mTarget.ownRow(limit), paint));
}

void beginPlain(std::optional<ShadowPainter>& painter, const PlacedTarget& target,
                const CoverageRows& coverage, uint32_t color) {
    painter.emplace().plain.emplace(&BlendLoops::dstOverMask, target, coverage, color);
}

void beginBlurred(std::optional<ShadowPainter>& painter, const PlacedTarget& target,
                  const CoverageRows& coverage, BlurPainter::Of of, int radius, const Box& part,
                  uint32_t color, int64_t workingBytes) {
    const Box visible = target.seen(part);
    if (visible.empty()) return;
    painter.emplace().blurred.emplace(chosenLevel(), target, coverage, of, radius, visible, color,
                                      workingBytes);
    if (!*painter->blurred) painter.reset();
}

}  // namespace VFontEffect::internal
