#include <algorithm>
#include <cstdint>
#include <optional>

#include "core/effect_types.h"
#include "core/float_state.h"
#include "core/numeric.h"
#include "core/size_limit.h"
#include "cores/paint_input.h"
#include "cores/placed_target.h"
#include "cores/property_copy.h"
#include "cores/stroke_shape.h"
#include "ops/dilate/dilation_plan.h"
#include "ops/dilate/disc_shape.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// The outline's coverage, a band of rows at a time; empty when memory ran out. What is centred lies
/// within the disc's radius of the edge on both sides of it.
class Outline {
  public:
    Outline(CpuLevel level, const CoverageBox& box, const DiscShape& disc, const Box& part,
            const StrokeShape& shape)
        : mGrown(level, box.rows(shape.growsGlyph ? kAsIs : kInverse), disc, part) {
        if (shape.side == StrokeSide::centre) mInverse.emplace(level, box.rows(kInverse), disc, part);
    }

    explicit operator bool() const { return mGrown && (!mInverse || *mInverse); }
    int64_t left() const { return mGrown.left(); }
    int64_t bandRows() const { return mGrown.bandRows(); }
    CoverageRows rows(int64_t y, int64_t count) {
        return mInverse ? mGrown.minRows(*mInverse, y, count) : mGrown.rows(y, count);
    }

  private:
    DilationPlan mGrown;
    std::optional<DilationPlan> mInverse;
};

}  // namespace

VOREL_KEEPS_RECORD(VFStroke, kStroke)

int VFStroke::getOffset() {
    return inOwnFloatState([&] { return mProperty != nullptr ? StrokeShape(*mProperty).reach : 0; });
}

void VFStroke::doPostProcessing(ParamPostProcessing* params) {
    const OwnFloatState floatState;
    const CoverageBox box = coverageOf(params);
    if (!box || mProperty == nullptr || exceedsSizeLimit(mProperty->mSize)) return;
    const StrokeShape shape(*mProperty);
    const DiscShape disc(shape.radiusPx);
    if (!disc) return;
    const CpuLevel level = chosenLevel();
    const PlacedTarget targets[] = {{level, params->dstBitmap, box.left, box.top},
                                    {level, params->subDstBitmap, box.left, box.top}};
    const Box reached = DilationPlan::reached(box.rows(), disc);
    const Box visible = boundingBox(targets[0].seen(reached), targets[1].seen(reached));
    if (visible.empty()) return;
    Outline outline(level, box, disc, visible, shape);
    if (!outline) return;

    const bool overText = shape.side == StrokeSide::centre && params->useOuterLayer != 1;
    const auto rule = overText ? &BlendLoops::srcOverMask : &BlendLoops::dstOverMask;
    for (int64_t y = visible.top; y < visible.bottom; y += outline.bandRows()) {
        const CoverageRows band = outline.rows(y, std::min(outline.bandRows(), visible.bottom - y));
        for (const PlacedTarget& target : targets)
            target.paintCoverage(rule, band, outline.left(), y, mProperty->mColor);
    }
}

}  // namespace VFontEffect
