#include <cstdint>
#include <optional>

#include "cores/painters.h"

namespace VFontEffect::internal {

BlurPainter::BlurPainter(CpuLevel level, const PlacedTarget& target, const CoverageRows& coverage, Of of,
                         int radius, const Box& part, uint32_t color, int64_t workingBytes)
    : WindowPainter(target),
      mColor(color),
      mWeights(gaussianOf100(radius)),
      mInput(of == Of::coverage ? BlurInput::down(mWeights, coverage, part, kNoFullColumns, false)
                                : BlurInput::inverseAcross(mWeights, coverage, part)),
      mWindows(blurWindows(level, mInput, workingBytes)),
      mPlan(level, mInput.largestOf(mWindows), mWindows.memoryBytes) {
    setWindows(mWindows);
}

void BlurPainter::paintBand(const Box& band) {
    const BlurredRows rows = mPlan.rows(band.top, band.height());
    mTarget.paint(&BlendLoops::dstOverMask, band, rows.values, rows.stride, mColor);
}

int64_t ShadowPainter::paintAbove(int64_t limit) {
    return mPlain ? mPlain->paintAbove(limit) : mBlurred->paintAbove(limit);
}

bool beginBlurred(std::optional<ShadowPainter>& painter, const PlacedTarget& target,
                  const CoverageRows& coverage, BlurPainter::Of of, int radius, const Box& part,
                  uint32_t color, int64_t workingBytes) {
    const Box visible = target.seen(part);
    if (visible.empty()) return true;
    painter.emplace(chosenLevel(), target, coverage, of, radius, visible, color, workingBytes);
    return static_cast<bool>(*painter);
}

}  // namespace VFontEffect::internal
