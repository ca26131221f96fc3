#pragma once

#include <cstdint>
#include <optional>

#include "core/box.h"
#include "core/strict_math.h"
#include "core/windows.h"
#include "cores/paint_input.h"
#include "cores/placed_target.h"
#include "cores/row_painter.h"
#include "ops/blur/blur_plan.h"
#include "ops/grow/growth_plan.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/ramp/stop_ramp.h"
#include "simd/cpu_level.h"
#include "voreleffect/VFECore.h"

/// The machinery of both glows.
namespace VFontEffect::internal {

/// Which side of the outline the glow lies on: around the coverage, or around its inverse.
enum class GlowSide { outside, inside };

/// What a glow reads from its record.
struct GlowRecord {
    float sizePx;
    uint32_t color;
    const VFGradient* stops;
    int count;

    bool hasOneColour() const { return count < 2; }
    uint32_t oneColour() const { return count == 1 ? stops[0].mColor : color; }

    /// A missing record is one of size 0; a missing array counts as no stops.
    template <class Property>
    static GlowRecord of(const Property* p) {
        if (p == nullptr) return {0.0F, 0, nullptr, 0};
        return {p->mSize, p->mColor, p->mGradient, p->mGradient != nullptr ? p->mGradientCount : 0};
    }
};

/// Pixels that a glow reaches beyond the text.
int glowReach(const GlowRecord& record);

/// The colours from the text outwards, straight; see VFOuterGlow::makeColorLUT.
void fillGlowTable(CpuLevel level, const GlowRecord& record, float fadeStart, int curve,
                   unsigned int* table);

/// Grows the coverage of a whole picture in place; see VFOuterGlow::increaseByBoxFilter. When memory
/// runs out it stays as it was.
void growByBoxFilter(CpuLevel level, unsigned char* mask, int passes, int width, int height);

/// What a glow of a size does around a box, in the coordinates of the box.
struct GlowShape {
    int passes;
    int radius;
    Box image;
    Box blurred;  ///< the part of the image that is not its border

    static GlowShape of(const CoverageBox& box, int pad);
};

/// The colours of the blurred values. Strong values lie near the text, at the start of the table.
/// Deliberate: values end at 255, so entry 0 is never taken.
class ValueColours {
  public:
    ValueColours(CpuLevel level, const GlowRecord& record);

    /// Paints values of a part that is seen beneath the destination, and may change them. A single
    /// colour differs in its alpha only: the values become that, and the mask of the opaque colour, for
    /// product(255, alpha) = alpha.
    void paint(const PlacedTarget& target, const Box& part, uint8_t* values, int64_t stride) const;

  private:
    const RampLoops& mRamps;
    bool mIsOne;
    uint32_t mColor;
    uint32_t mPixels[kTableLast];  ///< by value, as in memory, if there are several
};

/// A glow: what has grown, in the part that the blur of a window reaches, blurred. Around coverage's
/// inverse everything is full, and stays so; coverage itself spreads by a pixel a pass.
class GlowPainter final : public WindowPainter {
  public:
    GlowPainter(CpuLevel level, const PlacedTarget& target, const GlowRecord& record, GlowSide side,
                const CoverageRows& coverage, const GlowShape& shape, int64_t workingBytes);

    /// Whether there was memory for it.
    explicit operator bool() const { return !mBlur || (*mGrowth && *mBlur); }

    int64_t paintAbove(int64_t limit);

  private:
    void beginWindow(const Box& window) override;
    int64_t bandRows() const override { return mBlur->bandRows(); }
    void paintBand(const Box& band) override;

    void makePlans(CpuLevel level, const Box& visible, int64_t workingBytes);
    Box partFor(const Box& window) const {
        return intersection(expanded(window, mWeights.radius), mInput.whole());
    }
    BlurInput blurOf(const Box& window, const Box& part, const CoverageRows& grown) const;
    BlurInput largestBlur(const Windows& windows) const;
    void paintBorder(const Box& rows) const;
    void paintCorners(const Box& rows) const;

    GlowSide mSide;
    GlowShape mShape;
    ValueColours mColours;
    RemainingRows mBorder;
    GrowthInput mInput;
    BlurWeights mWeights;
    std::optional<GrowthPlan> mGrowth;  ///< and blur: where what is blurred is seen
    std::optional<BlurPlan> mBlur;
    Box mPart = {};  ///< of what has grown, of the window
};

/// Make a painter of a glow, in windows that take `workingBytes` at most, if they can, or none when
/// there is nothing to paint. Return false when memory ran out.
[[nodiscard]] bool begin(std::optional<GlowPainter>& painter, const VFECore::ParamPostProcessing* params,
                         const VFOuterGlowProperty& record, int64_t workingBytes = kWorkingBytes);
[[nodiscard]] bool begin(std::optional<GlowPainter>& painter, const VFECore::ParamPostProcessing* params,
                         const VFInnerGlowProperty& record, int64_t workingBytes = kWorkingBytes);

}  // namespace VFontEffect::internal
