#include <algorithm>
#include <cmath>
#include <cstdint>

#include "core/float_state.h"
#include "core/numeric.h"
#include "cores/glow.h"
#include "ops/ramp/stop_ramp.h"

namespace VFontEffect::internal {
namespace {

constexpr int kCurveRoot = 1;
constexpr int kCurveSquare = 2;

float curved(float position, int curve) {
    if (curve == kCurveRoot) return std::sqrt(position);
    return curve == kCurveSquare ? position * position : position;
}

void fillRamp(CpuLevel level, const GlowRecord& record, int curve, unsigned int* table) {
    if (record.hasOneColour()) {
        std::fill_n(table, kTableSize, record.oneColour());
        return;
    }
    TablePositions positions;
    for (float& position : positions.of)
        position = curved(position, curve);
    table[0] = record.stops[0].mColor;
    // Deliberate: the first segment starts at 0, whatever the position of stop 0.
    fillBetweenStops(rampLoops(level), record.stops, record.count, 0.0F, positions, table);
    table[kTableLast] = record.stops[record.count - 1].mColor;
}

/// Lets the alpha fall linearly to 0 from the entry at `fadeStart` on.
void fadeOut(float fadeStart, unsigned int* table) {
    const float start = fadeStart >= 1.0F ? 0.99F : fadeStart <= 0.0F ? 0.01F : fadeStart;
    const int first = toInt(static_cast<double>(start) * 256.0);
    for (int i = first; i <= kTableLast; ++i) {
        const float left = 256.0F - static_cast<float>(i);
        const auto factor =
            static_cast<uint32_t>(toInt(256.0F * left / (256.0F - static_cast<float>(first))));
        const uint32_t alpha = ((table[i] >> 24) * factor) >> 8;
        table[i] = (table[i] & 0x00FFFFFFU) | alpha << 24;
    }
    table[kTableLast] = 0;
}

}  // namespace

int glowReach(const GlowRecord& record) {
    return inOwnFloatState([&] { return toInt(record.sizePx + 0.5F); });
}

void fillGlowTable(CpuLevel level, const GlowRecord& record, float fadeStart, int curve,
                   unsigned int* table) {
    if (table == nullptr) return;
    inOwnFloatState([&] {
        if (record.sizePx == 0.0F) {
            std::fill_n(table, kTableSize, 0U);
            return;
        }
        fillRamp(level, record, curve, table);
        fadeOut(fadeStart, table);
    });
}

}  // namespace VFontEffect::internal
