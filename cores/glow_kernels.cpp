#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstring>

#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "cores/glow.h"
#include "cores/stop_ramp.h"

namespace VFontEffect::internal {
namespace {

constexpr int kCurveRoot = 1;
constexpr int kCurveSquare = 2;

float curved(float position, int curve) {
    if (curve == kCurveRoot) return std::sqrt(position);
    return curve == kCurveSquare ? position * position : position;
}

void fillRamp(const GlowRecord& record, int curve, unsigned int* table) {
    if (record.count < 2) {
        std::fill_n(table, kTableSize, record.count == 1 ? record.stops[0].mColor : record.color);
        return;
    }
    // Deliberate: the first segment starts at 0, whatever the position of stop 0.
    StopRamp ramp(record.stops, record.count, 0.0F);
    table[0] = record.stops[0].mColor;
    for (int i = 1; i < kTableLast; ++i)
        table[i] = ramp.colourAt(curved(tablePosition(i), curve));
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

uint32_t columnSum(const uint8_t* above, const uint8_t* row, const uint8_t* below, int x) {
    return uint32_t{above[x]} + row[x] + below[x];
}

}  // namespace

int glowReach(const GlowRecord& record) {
    return toInt(record.sizePx + 0.5F);
}

void fillGlowTable(const GlowRecord& record, float fadeStart, int curve, unsigned int* table) {
    if (table == nullptr) return;
    if (record.sizePx == 0.0F) {
        std::fill_n(table, kTableSize, 0U);
        return;
    }
    fillRamp(record, curve, table);
    fadeOut(fadeStart, table);
}

// Deliberate: the sum of nine is divided by 4, so every pass brightens as well as spreads.
bool growByBoxFilter(unsigned char* mask, int passes, int width, int height) {
    if (mask == nullptr || passes < 1 || width < 1 || height <= 2) return true;
    auto above = PixelBuffer<uint8_t>::uninitialised(width);
    auto grown = PixelBuffer<uint8_t>::zeroed(width);
    if (!above || !grown) return false;
    const auto rowBytes = static_cast<size_t>(width);
    for (int pass = 0; pass < passes; ++pass) {
        // A row is replaced only after its old values were saved for the row below it.
        std::memcpy(above.data(), mask, rowBytes);
        for (int y = 1; y < height - 1; ++y) {
            unsigned char* const row = mask + static_cast<size_t>(y) * rowBytes;
            const unsigned char* const below = row + rowBytes;
            for (int x = 1; x < width - 1; ++x) {
                const uint32_t sum = columnSum(above.data(), row, below, x - 1) +
                                     columnSum(above.data(), row, below, x) +
                                     columnSum(above.data(), row, below, x + 1);
                grown[static_cast<size_t>(x)] = static_cast<uint8_t>(std::min(sum >> 2, 255U));
            }
            std::memcpy(above.data(), row, rowBytes);
            std::memcpy(row, grown.data(), rowBytes);
        }
    }
    return true;
}

}  // namespace VFontEffect::internal
