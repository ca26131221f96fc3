#include "effect/strips.h"

#include <algorithm>
#include <memory>
#include <new>
#include <optional>

#include "core/assert.h"
#include "core/effect_types.h"
#include "core/float_state.h"
#include "core/views.h"
#include "cores/fills.h"
#include "cores/glow.h"
#include "cores/painters.h"
#include "cores/row_painter.h"

namespace VFontEffect::internal {

namespace {

/// Targets of fewer bytes stay in the caches while one effect after the other paints them. There turns
/// cost more than they save: what an effect keeps from row to row has to come back into the nearest
/// cache.
constexpr int64_t kLargeBytes = 16 << 20;
/// So many of the targets stay in the cache that a CPU has for itself, with the mask and what effects
/// keep.
constexpr int64_t kStripBytes = 512 << 10;
/// What is dilated comes in bands of so many rows: lower strips would wait for each other.
constexpr int64_t kFewestRows = 32;

struct ByteRange {
    uintptr_t start;
    int64_t count;

    template <int BytesPerPixel>
    static ByteRange of(const PixelView<BytesPerPixel>& view) {
        return {reinterpret_cast<uintptr_t>(view.data), view.width * view.height * BytesPerPixel};
    }
    bool meets(const ByteRange& other) const {
        return start < other.start + static_cast<uintptr_t>(other.count) &&
               other.start < start + static_cast<uintptr_t>(count);
    }
};

}  // namespace

int64_t stripRowsFor(const RunBitmaps& run) {
    const ColourView destination = ColourView::of(run.destination);
    const ColourView outer = ColourView::of(run.outerLayer);
    const MaskView mask = MaskView::of(run.mask);
    if (!destination || !mask) return 0;
    const ByteRange all[] = {ByteRange::of(destination), ByteRange::of(outer), ByteRange::of(mask)};
    const int64_t targetBytes = all[0].count + all[1].count;
    if (all[0].count == 0 || targetBytes < kLargeBytes) return 0;
    const bool areApart = !all[0].meets(all[1]) && !all[0].meets(all[2]) && !all[1].meets(all[2]);
    return areApart ? std::max(kFewestRows, kStripBytes / (targetBytes / destination.height)) : 0;
}

// --- Turns ----------------------------------------------------------------------------------------

namespace {

/// The painters of a run, in its order: of each kind there is one at most.
class RunPainters {
  public:
    /// Returns false when there is no memory for what the core paints.
    [[nodiscard]] bool add(VFECore& core, const VFECore::ParamPostProcessing& params) {
        VFProperty* const record = core.getProperty();
        if (record == nullptr) return true;
        const int style = core.getStyle();
        mStyles[mCount++] = style;
        switch (style) {
            case kOuterShadow:
                return begin(mOuterShadow, &params, *static_cast<const VFOuterShadowProperty*>(record),
                             ShadowPainter::offsetOf(static_cast<const VFOuterShadow&>(core)));
            case kInnerShadow:
                return begin(mInnerShadow, &params, *static_cast<const VFInnerShadowProperty*>(record));
            case kOuterGlow:
                return begin(mOuterGlow, &params, *static_cast<const VFOuterGlowProperty*>(record));
            case kInnerGlow:
                return begin(mInnerGlow, &params, *static_cast<const VFInnerGlowProperty*>(record));
            case kLinearGradient:
                return begin(mLinear, &params, *static_cast<const VFLinearGradientProperty*>(record));
            case kRadialGradient:
                return begin(mRadial, &params, *static_cast<const VFRadialGradientProperty*>(record));
            case kStroke:
                return begin(mStroke, &params, *static_cast<const VFStrokeProperty*>(record));
            case kPattern:
                return begin(mPattern, &params, *static_cast<const VFPatternProperty*>(record));
            case kText:
                return begin(mText, &params, *static_cast<const VFTextProperty*>(record));
            default:
                VOREL_ASSERT(false);
                return true;
        }
    }

    /// What one has painted the next may paint on.
    void paintAbove(int64_t limit) {
        for (int i = 0; i < mCount; ++i)
            limit = paintAbove(mStyles[i], limit);
    }

  private:
    template <class Painter>
    static int64_t goOn(std::optional<Painter>& painter, int64_t limit) {
        return painter ? painter->paintAbove(limit) : limit;
    }

    int64_t paintAbove(int style, int64_t limit) {
        switch (style) {
            case kOuterShadow:
                return goOn(mOuterShadow, limit);
            case kInnerShadow:
                return goOn(mInnerShadow, limit);
            case kOuterGlow:
                return goOn(mOuterGlow, limit);
            case kInnerGlow:
                return goOn(mInnerGlow, limit);
            case kLinearGradient:
                return goOn(mLinear, limit);
            case kRadialGradient:
                return goOn(mRadial, limit);
            case kStroke:
                return goOn(mStroke, limit);
            case kPattern:
                return goOn(mPattern, limit);
            default:
                return goOn(mText, limit);
        }
    }

    std::optional<ShadowPainter> mOuterShadow;
    std::optional<ShadowPainter> mInnerShadow;
    std::optional<GlowPainter> mOuterGlow;
    std::optional<GlowPainter> mInnerGlow;
    std::optional<LinearPainter> mLinear;
    std::optional<RadialPainter> mRadial;
    std::optional<StrokePainter> mStroke;
    std::optional<PatternPainter> mPattern;
    std::optional<CoveragePainter> mText;
    int mStyles[kNoEffect];
    int mCount = 0;
};

}  // namespace

bool paintInStrips(const std::vector<VFECore*>& cores, const RunBitmaps& run, int64_t stripRows) {
    // All painters together take more than the rest of a small stack.
    const std::unique_ptr<RunPainters> painters(new (std::nothrow) RunPainters);
    if (!painters) return false;
    const OwnFloatState floatState;
    for (VFECore* core : cores) {
        if (!painters->add(*core, run.paramsFor(*core))) return false;
    }
    const int64_t height = ColourView::of(run.destination).height;
    for (int64_t limit = stripRows; limit < height; limit += stripRows)
        painters->paintAbove(limit);
    painters->paintAbove(kAllRows);
    return true;
}

}  // namespace VFontEffect::internal
