#include "cores/glow.h"

#include <algorithm>
#include <cstdint>

#include "core/blend_modes.h"
#include "core/fixed_point.h"
#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "cores/blur.h"
#include "cores/paint_input.h"
#include "cores/stop_ramp.h"
#include "voreleffect/VFBlender.h"

namespace VFontEffect::internal {
namespace {

constexpr float kFadeStart = 0.3F;
constexpr int kCurve = 0;

/// `pad`, the whole size + 1, is the unit of a glow: growth and blur are fractions of it, the margin is
/// twice of it.
int growthPasses(int pad) {
    return std::max(1, toInt(pad * 0.4750000089406967));
}
int blurRadius(int pad) {
    return toInt(static_cast<float>(pad) * 0.9F);
}

/// Words of the glow image outside the part that the blur reaches.
///
/// Deliberate: around an inner glow they are opaque white, not transparent. They are painted, and the
/// text fill or the composite clips them away.
uint32_t borderWord(Sense sense) {
    return sense == Sense::inverted ? 0xFFFFFFFFU : 0;
}

}  // namespace

void paintGlow(const VFECore::ParamPostProcessing* params, const GlowRecord& record, Sense sense) {
    const CoverageBox box = coverageOf(params);
    const int pad = saturateToInt(int64_t{toInt(record.sizePx)} + 1);
    // With no padding at all (a size of -1) the image would be clear.
    if (!box || isAbsurd(record.sizePx) || pad <= 0) return;

    unsigned int table[kTableSize];
    fillGlowTable(record, kFadeStart, kCurve, table);
    std::transform(table, table + kTableSize, table, premultiply);

    const int64_t margin = 2 * int64_t{pad};
    Plane mask = paddedMask(box, margin, margin, sense);
    const BlurKernel kernel = glowKernel(blurRadius(pad));
    auto image = PixelBuffer<unsigned int>::uninitialised(mask.width, mask.height);
    if (!mask || !kernel || !image) return;
    const int width = saturateToInt(mask.width);
    const int height = saturateToInt(mask.height);
    if (!growByBoxFilter(mask.bytes.data(), growthPasses(pad), width, height)) return;

    std::fill_n(image.data(), mask.width * mask.height, borderWord(sense));
    const int64_t inner = mask.width - 2 * int64_t{kernel.radius};
    const bool blurred = blurPlane(mask, kernel, sense, [&](int64_t y, const uint8_t* values) {
        unsigned int* const row = image.data() + y * mask.width + kernel.radius;
        // Strong values lie near the text, at the start of the table. Deliberate: values end at 255, so
        // entry 0 is never taken.
        for (int64_t x = 0; x < inner; ++x)
            row[x] = table[kTableLast - values[x]];
    });
    if (!blurred) return;
    VFBlender().drawBitmapBlend32(saturateToInt(box.left - margin), saturateToInt(box.top - margin),
                                  params->dstBitmap, image.data(), width, height, width, kModeDstOver);
}

}  // namespace VFontEffect::internal
