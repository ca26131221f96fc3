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
/// at most, if they can, or none when there is nothing to paint. It returns false when memory ran out.
namespace VFontEffect::internal {

/// One colour through coverage as it is.
class CoveragePainter : public RowPainter {
  public:
    CoveragePainter(BlendLoop BlendLoops::*rule, const PlacedTarget& target,
                    const CoverageRows& coverage, uint32_t color)
        : mRule(rule),
          mTarget(target),
          mCoverage(coverage),
          mColor(color),
          mRest(target.seen(wholeOf(coverage))) {}

    int64_t paintAbove(int64_t limit);

  private:
    BlendLoop BlendLoops::*mRule;
    PlacedTarget mTarget;
    CoverageRows mCoverage;
    uint32_t mColor;
    RemainingRows mRest;
};

[[nodiscard]] bool begin(std::optional<CoveragePainter>& painter,
                         const VFECore::ParamPostProcessing* params, const VFTextProperty& record);

/// An outline.
class StrokePainter final : public WindowPainter {
  public:
    StrokePainter(const VFECore::ParamPostProcessing& params, const CoverageBox& box,
                  const StrokeShape& shape, uint32_t color, int64_t workingBytes);

    /// Whether there was memory for what it paints.
    explicit operator bool() const { return !mMemory || *mMemory; }

  private:
    void beginWindow(const Box& window) override;
    int64_t bandRows() const override { return mIsCutAnew ? kAllRows : mGrown->bandRows(); }
    void paintBand(const Box& band) override;

    bool beginPlans(const Box& window);
    bool paintNext(const Box& band);

    PlacedTarget mSecondTarget;
    BlendLoop BlendLoops::*mRule;
    uint32_t mColor;
    DiscShape mDisc;
    std::optional<LineBuffer> mMemory;
    // Windows are as wide as tiles' memory allows. Where those give up, which they do on no text, what
    // is left of a window, and all windows that follow, are cut once more, as squares' memory asks for,
    // and are then painted as a whole.
    Windows mWindowsOfSquares = {};
    bool mIsCutAnew = false;
    // What is centred lies within the disc's radius of the edge on both sides of it: in what has grown
    // and in what its inverse has.
    std::optional<DilationPlan> mGrown;
    std::optional<DilationPlan> mInverse;
};

[[nodiscard]] bool begin(std::optional<StrokePainter>& painter,
                         const VFECore::ParamPostProcessing* params, const VFStrokeProperty& record,
                         int64_t workingBytes = kWorkingBytes);

/// One colour through a blur of coverage, or of its inverse.
class BlurPainter final : public WindowPainter {
  public:
    enum class Of { coverage, inverse };

    /// The part is in the coordinates of the coverage, and seen.
    BlurPainter(CpuLevel level, const PlacedTarget& target, const CoverageRows& coverage, Of of,
                int radius, const Box& part, uint32_t color, int64_t workingBytes);

    explicit operator bool() const { return static_cast<bool>(mPlan); }

  private:
    void beginWindow(const Box& window) override { mPlan.begin(mInput.of(window)); }
    int64_t bandRows() const override { return mPlan.bandRows(); }
    void paintBand(const Box& band) override;

    uint32_t mColor;
    BlurWeights mWeights;
    BlurInput mInput;
    Windows mWindows;
    BlurPlan mPlan;
};

/// A shadow, by one of two painters.
class ShadowPainter : public RowPainter {
  public:
    /// Of coverage as it is.
    ShadowPainter(const PlacedTarget& target, const CoverageRows& coverage, uint32_t color) {
        mPlain.emplace(&BlendLoops::dstOverMask, target, coverage, color);
    }
    /// Of a blur, as BlurPainter says.
    ShadowPainter(CpuLevel level, const PlacedTarget& target, const CoverageRows& coverage,
                  BlurPainter::Of of, int radius, const Box& part, uint32_t color,
                  int64_t workingBytes) {
        mBlurred.emplace(level, target, coverage, of, radius, part, color, workingBytes);
    }

    /// How far a core's shadow is moved.
    static ShadowOffset offsetOf(const VFOuterShadow& core) { return {core.mOffsetX, core.mOffsetY}; }

    explicit operator bool() const { return mPlain || *mBlurred; }

    int64_t paintAbove(int64_t limit);

  private:
    std::optional<CoveragePainter> mPlain;
    std::optional<BlurPainter> mBlurred;
};

/// Makes one of the blur of a part in the coordinates of the coverage.
[[nodiscard]] bool beginBlurred(std::optional<ShadowPainter>& painter, const PlacedTarget& target,
                                const CoverageRows& coverage, BlurPainter::Of of, int radius,
                                const Box& part, uint32_t color, int64_t workingBytes);
[[nodiscard]] bool begin(std::optional<ShadowPainter>& painter,
                         const VFECore::ParamPostProcessing* params, const VFOuterShadowProperty& record,
                         const ShadowOffset& offset, int64_t workingBytes = kWorkingBytes);
[[nodiscard]] bool begin(std::optional<ShadowPainter>& painter,
                         const VFECore::ParamPostProcessing* params, const VFInnerShadowProperty& record,
                         int64_t workingBytes = kWorkingBytes);

}  // namespace VFontEffect::internal
