#include <algorithm>
#include <cstdint>
#include <optional>

#include "core/effect_types.h"
#include "core/float_state.h"
#include "core/line_buffer.h"
#include "core/numeric.h"
#include "core/size_limit.h"
#include "core/windows.h"
#include "cores/paint_input.h"
#include "cores/painters.h"
#include "cores/placed_target.h"
#include "cores/property_copy.h"
#include "cores/stroke_shape.h"
#include "ops/dilate/dilation_plan.h"
#include "ops/dilate/disc_shape.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

/// The outline's coverage in a window, a band of rows at a time; empty when memory ran out. What is
/// centred lies within the disc's radius of the edge on both sides of it.
class Outline {
  public:
    Outline(CpuLevel level, const CoverageBox& box, const DiscShape& disc, const StrokeShape& shape,
            int64_t bytesOfPlan)
        : mMemory(bytesOfPlan, plansOf(shape)),
          mGrown(level, {box.rows(shape.growsGlyph ? kAsIs : kInverse), disc}, mMemory.data(),
                 bytesOfPlan) {
        if (mMemory && plansOf(shape) == 2) {
            mInverse.emplace(level, DilationInput{box.rows(kInverse), disc},
                             mMemory.data() + bytesOfPlan, bytesOfPlan);
        }
    }

    explicit operator bool() const { return static_cast<bool>(mMemory); }

    static int64_t plansOf(const StrokeShape& shape) { return shape.side == StrokeSide::centre ? 2 : 1; }

    void begin(const Box& window) {
        mGrown.begin(window);
        if (mInverse) mInverse->begin(window);
    }
    int64_t bandRows() const { return mGrown.bandRows(); }
    CoverageRows rows(int64_t y, int64_t count) {
        return mInverse ? mGrown.minRows(*mInverse, y, count) : mGrown.rows(y, count);
    }

  private:
    LineBuffer mMemory;
    DilationPlan mGrown;
    std::optional<DilationPlan> mInverse;
};

}  // namespace

VOREL_KEEPS_RECORD(VFStroke, kStroke)

int VFStroke::getOffset() {
    return inOwnFloatState([&] { return mProperty != nullptr ? StrokeShape(*mProperty).reach : 0; });
}

void VFStroke::doPostProcessing(ParamPostProcessing* params) {
    if (mProperty != nullptr) paintStroke(params, *mProperty);
}

void internal::paintStroke(const VFECore::ParamPostProcessing* params, const VFStrokeProperty& record,
                           int64_t workingBytes) {
    const OwnFloatState floatState;
    const CoverageBox box = coverageOf(params);
    if (!box || exceedsSizeLimit(record.mSize)) return;
    const StrokeShape shape(record);
    const DiscShape disc(shape.radiusPx);
    if (!disc) return;
    const CpuLevel level = chosenLevel();
    const PlacedTarget targets[] = {{level, params->dstBitmap, box.left, box.top},
                                    {level, params->subDstBitmap, box.left, box.top}};
    const Box reached = DilationPlan::reached({box.rows(), disc});
    const Box visible = boundingBox(targets[0].seen(reached), targets[1].seen(reached));
    if (visible.empty()) return;
    const int64_t bytesOfEach = workingBytes / Outline::plansOf(shape);
    const auto bytesOfPlan = [&](const Windows& cut) {
        return DilationPlan::memoryBytes(level, {box.rows(), disc}, cut);
    };
    const Windows windows = windowsWithin(bytesOfEach, visible, disc.reach, bytesOfPlan);
    Outline outline(level, box, disc, shape, windows.memoryBytes);
    if (!outline) return;

    const bool overText = shape.side == StrokeSide::centre && params->useOuterLayer != 1;
    const auto rule = overText ? &BlendLoops::srcOverMask : &BlendLoops::dstOverMask;
    windows.forEach([&](const Box& window) {
        outline.begin(window);
        for (int64_t y = window.top; y < window.bottom; y += outline.bandRows()) {
            const CoverageRows band = outline.rows(y, std::min(outline.bandRows(), window.bottom - y));
            for (const PlacedTarget& target : targets)
                target.paintCoverage(rule, band, window.left, y, record.mColor);
        }
    });
}

}  // namespace VFontEffect
