#include <algorithm>
#include <cstdint>
#include <optional>

#include "core/assert.h"
#include "core/effect_types.h"
#include "core/float_state.h"
#include "core/numeric.h"
#include "core/size_limit.h"
#include "cores/paint_input.h"
#include "cores/painters.h"
#include "cores/property_copy.h"
#include "cores/stroke_shape.h"
#include "ops/dilate/dilation_plan.h"
#include "ops/dilate/disc_shape.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

VOREL_KEEPS_RECORD(VFStroke, kStroke)

int VFStroke::getOffset() {
    return inOwnFloatState([&] { return mProperty != nullptr ? StrokeShape(*mProperty).reach : 0; });
}

void VFStroke::doPostProcessing(ParamPostProcessing* params) {
    if (mProperty != nullptr) paintAll<StrokePainter>(params, *mProperty);
}

namespace internal {

StrokePainter::StrokePainter(const VFECore::ParamPostProcessing& params, const CoverageBox& box,
                             const StrokeShape& shape, uint32_t color, int64_t workingBytes)
    : WindowPainter(chosenLevel(), params.dstBitmap, box.left, box.top),
      mSecondTarget(chosenLevel(), params.subDstBitmap, box.left, box.top),
      mRule(&BlendLoops::dstOverMask),
      mColor(color),
      mDisc(shape.radiusPx) {
    if (!mDisc) return;
    const bool isCentred = shape.side == StrokeSide::centre;
    if (isCentred && params.useOuterLayer != 1) mRule = &BlendLoops::srcOverMask;
    const CpuLevel level = chosenLevel();
    const DilationInput grown = {box.rows(shape.growsGlyph ? kAsIs : kInverse), mDisc};
    const Box reached = DilationPlan::reached(grown);
    const Box visible = boundingBox(mTarget.seen(reached), mSecondTarget.seen(reached));
    if (visible.empty()) return;
    const int64_t plans = isCentred ? 2 : 1;
    const auto windowsBy = [&](auto memoryBytes) {
        return windowsWithin(workingBytes / plans, visible, mDisc.reach,
                             [&](const Windows& cut) { return memoryBytes(level, grown, cut); });
    };
    Windows windows = windowsBy(DilationPlan::memoryBytes);
    int64_t bytes = windows.memoryBytes;
    if (windows.areCutAcross() || windows.areCutDown()) {
        mWindowsOfSquares = windows;
        windows = windowsBy(DilationPlan::memoryBytesOfTiles);
        bytes = std::max(bytes, windows.memoryBytes);
        // Else tiles could take more memory in a window that is cut anew than in the wide ones.
        VOREL_ASSERT(!windows.areCutAcross() || mWindowsOfSquares.areCutAcross());
    }
    mMemory.emplace(bytes, plans);
    if (!*mMemory) return;
    mGrown.emplace(level, grown, mMemory->data(), bytes);
    if (isCentred) {
        mInverse.emplace(level, DilationInput{box.rows(kInverse), mDisc}, mMemory->data() + bytes,
                         bytes);
    }
    setWindows(windows);
}

void StrokePainter::beginWindow(const Box& window) {
    mIsCutAnew = mIsCutAnew || !beginPlans(window);
}

void StrokePainter::paintBand(const Box& band) {
    if (!mIsCutAnew && paintNext(band)) return;
    mIsCutAnew = true;
    const Windows windows = {band, mWindowsOfSquares.width, mWindowsOfSquares.height};
    VOREL_ASSERT(windows.width > 0 && windows.height > 0);
    windows.forEach([&](const Box& window) {
        const bool hasBegun = beginPlans(window);
        VOREL_ASSERT(hasBegun);
        for (int64_t y = window.top; y < window.bottom; y += mGrown->bandRows()) {
            const int64_t end = std::min(y + mGrown->bandRows(), window.bottom);
            const bool isPainted = paintNext({window.left, y, window.right, end});
            VOREL_ASSERT(isPainted);
        }
    });
}

bool StrokePainter::beginPlans(const Box& window) {
    return mGrown->begin(window) && (!mInverse || mInverse->begin(window));
}

/// Paints the next band of the window that the plans have turned to, unless there is no memory for it.
bool StrokePainter::paintNext(const Box& band) {
    const CoverageRows rows = mInverse ? mGrown->minRows(*mInverse, band.top, band.height())
                                       : mGrown->rows(band.top, band.height());
    if (rows.start == nullptr) return false;
    for (const PlacedTarget* target : {&mTarget, &mSecondTarget})
        target->paintCoverage(mRule, rows, band.left, band.top, mColor);
    return true;
}

bool begin(std::optional<StrokePainter>& painter, const VFECore::ParamPostProcessing* params,
           const VFStrokeProperty& record, int64_t workingBytes) {
    const CoverageBox box = coverageOf(params);
    if (!box || exceedsSizeLimit(record.mSize)) return true;
    painter.emplace(*params, box, StrokeShape(record), record.mColor, workingBytes);
    return static_cast<bool>(*painter);
}

}  // namespace internal

}  // namespace VFontEffect
