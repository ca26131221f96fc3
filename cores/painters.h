#pragma once

#include <cstdint>
#include <optional>

#include "core/coverage_rows.h"
#include "core/line_buffer.h"
#include "core/windows.h"
#include "cores/paint_input.h"
#include "cores/placed_target.h"
#include "cores/row_painter.h"
#include "cores/shadow_offset.h"
#include "cores/stroke_shape.h"
#include "ops/blur/blur_plan.h"
#include "ops/dilate/dilation_plan.h"
#include "voreleffect/VFECore.h"

/// What paints the plain fill, the strokes and the shadows; glows stand in glow.h, gradients and
/// patterns in fills.h.
///
/// Each begin() makes a painter of what the core of the record does, in windows that take `workingBytes`
/// at most, if they can; none when there is nothing to paint, or no memory for it.
namespace VFontEffect::internal {

/// One colour through coverage as it is.
class CoveragePainter final : public RowPainter {
  public:
    CoveragePainter(BlendLoop BlendLoops::*rule, const PlacedTarget& target,
                    const CoverageRows& coverage, uint32_t color)
        : mRule(rule),
          mTarget(target),
          mCoverage(coverage),
          mColor(color),
          mRest(target.seen(wholeOf(coverage))) {}

    int64_t paintAbove(int64_t limit) override;

  private:
    BlendLoop BlendLoops::*mRule;
    PlacedTarget mTarget;
    CoverageRows mCoverage;
    uint32_t mColor;
    RemainingRows mRest;
};

void begin(std::optional<CoveragePainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFTextProperty& record);

/// An outline.
class StrokePainter final : public RowPainter {
  public:
    StrokePainter(const VFECore::ParamPostProcessing& params, const VFStrokeProperty& record,
                  const CoverageBox& box, int64_t workingBytes);

    explicit operator bool() const { return mWalk.has_value(); }

    int64_t paintAbove(int64_t limit) override;

  private:
    PlacedTarget mTargets[2];
    BlendLoop BlendLoops::*mRule;
    uint32_t mColor;
    DiscShape mDisc;
    std::optional<LineBuffer> mMemory;
    // What is centred lies within the disc's radius of the edge on both sides of it: in what has grown
    // and in what its inverse has.
    std::optional<DilationPlan> mGrown;
    std::optional<DilationPlan> mInverse;
    std::optional<WindowWalk> mWalk;
};

void begin(std::optional<StrokePainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFStrokeProperty& record, int64_t workingBytes = kWorkingBytes);

/// One colour through a blur of coverage, or of its inverse.
class BlurPainter final : public RowPainter {
  public:
    enum class Of { coverage, inverse };

    /// The part is in the coordinates of the coverage, and seen.
    BlurPainter(CpuLevel level, const PlacedTarget& target, const CoverageRows& coverage, Of of,
                int radius, const Box& part, uint32_t color, int64_t workingBytes);

    explicit operator bool() const { return static_cast<bool>(mBlur); }

    int64_t paintAbove(int64_t limit) override;

  private:
    PlacedTarget mTarget;
    uint32_t mColor;
    BlurWeights mWeights;
    WindowedBlur mBlur;
};

/// A shadow, by one of two painters.
class ShadowPainter final : public RowPainter {
  public:
    int64_t paintAbove(int64_t limit) override {
        return plain ? plain->paintAbove(limit) : blurred->paintAbove(limit);
    }

    /// How far a core's shadow is moved.
    static ShadowOffset offsetOf(const VFOuterShadow& core) { return {core.mOffsetX, core.mOffsetY}; }

    std::optional<CoveragePainter> plain;
    std::optional<BlurPainter> blurred;
};

/// Makes one of coverage as it is.
void beginPlain(std::optional<ShadowPainter>& painter, const PlacedTarget& target,
                const CoverageRows& coverage, uint32_t color);
/// Makes one of a blur, in a part in the coordinates of the coverage.
void beginBlurred(std::optional<ShadowPainter>& painter, const PlacedTarget& target,
                  const CoverageRows& coverage, BlurPainter::Of of, int radius, const Box& part,
                  uint32_t color, int64_t workingBytes);

void begin(std::optional<ShadowPainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFOuterShadowProperty& record, const ShadowOffset& offset,
           int64_t workingBytes = kWorkingBytes);
void begin(std::optional<ShadowPainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFInnerShadowProperty& record, int64_t workingBytes = kWorkingBytes);

}  // namespace VFontEffect::internal
