#pragma once

#include <cstdint>
#include <optional>

#include "cores/paint_input.h"
#include "cores/placed_target.h"
#include "cores/row_painter.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/ramp/stop_ramp.h"
#include "ops/tile/tile_plan.h"
#include "voreleffect/VFECore.h"

/// What paints gradients and patterns. Each begin() makes a painter of what the core of the record does,
/// or none when there is nothing to paint. It returns false when memory ran out.
namespace VFontEffect::internal {

/// A gradient or pattern below this scale draws nothing. A NaN is not below it.
constexpr float kSmallestScale = 0.1F;

/// Whether a gradient record has what it takes to draw.
template <class Property>
bool canFill(const Property& record) {
    return !(record.mScale < kSmallestScale) && record.mGradient != nullptr && record.mGradientCount > 0;
}

/// The covered pixels of a box, beneath what the destination holds. Deliberate: coverage gates a pixel,
/// it does not scale its colour.
class CoveredFill {
  public:
    CoveredFill(CpuLevel level, const CoverageBox& box, const VFBitmap* destination)
        : mTarget(level, destination, box.left, box.top),
          mCoverage(box.rows()),
          mRest(mTarget.seen(wholeOf(mCoverage))) {}

    /// Calls fill(job, y) for the rows that lie above a row of the mask and on the destination, from row
    /// y of the box on, if there are any. They start at the box's left edge, for a box lies inside its
    /// mask.
    template <class Fill>
    int64_t paintAbove(int64_t limit, Fill fill) {
        const Box part = mRest.takenAbove(mTarget.ownRow(limit));
        if (!part.empty()) {
            const uint8_t* const mask = mCoverage.start + part.top * mCoverage.stride;
            fill(mTarget.jobOn(part, mask, mCoverage.stride), part.top);
        }
        return limit;
    }

  private:
    PlacedTarget mTarget;
    CoverageRows mCoverage;
    RemainingRows mRest;
};

class LinearPainter : public RowPainter {
  public:
    LinearPainter(CpuLevel level, const CoverageBox& box, const VFBitmap* destination,
                  const VFLinearGradientProperty& record);

    int64_t paintAbove(int64_t limit);

  private:
    const RampLoops& mLoops;
    CoveredFill mFill;
    GradientTable mTable;
    LinearRamp mRamp;
};

[[nodiscard]] bool begin(std::optional<LinearPainter>& painter,
                         const VFECore::ParamPostProcessing* params,
                         const VFLinearGradientProperty& record);

class RadialPainter : public RowPainter {
  public:
    RadialPainter(CpuLevel level, const CoverageBox& box, const VFBitmap* destination,
                  const VFRadialGradientProperty& record);

    int64_t paintAbove(int64_t limit);

  private:
    const RampLoops& mLoops;
    CoveredFill mFill;
    GradientTable mTable;
    RadialRamp mRamp;
};

[[nodiscard]] bool begin(std::optional<RadialPainter>& painter,
                         const VFECore::ParamPostProcessing* params,
                         const VFRadialGradientProperty& record);

class PatternPainter : public RowPainter {
  public:
    PatternPainter(CpuLevel level, const CoverageBox& box, const VFBitmap* destination,
                   const ColourView& pattern, const VFPatternProperty& record);

    /// Whether there was memory for it.
    explicit operator bool() const { return static_cast<bool>(mTiles); }

    int64_t paintAbove(int64_t limit);

  private:
    BlendLoop mPaint;
    CoveredFill mFill;
    TilePlan mTiles;
};

[[nodiscard]] bool begin(std::optional<PatternPainter>& painter,
                         const VFECore::ParamPostProcessing* params, const VFPatternProperty& record);

}  // namespace VFontEffect::internal
