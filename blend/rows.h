#pragma once

#include <algorithm>
#include <cstdint>

#include "blend/lanes.h"
#include "blend/rules.h"
#include "core/views.h"

/// The row driver of all kernels: clipping, the loop over rows and pixels, and the tail.
namespace VFontEffect::internal {

/// The part of a placed source that falls on the destination, half-open, in destination coordinates.
struct Clip {
    int64_t left;
    int64_t top;
    int64_t right;
    int64_t bottom;

    bool empty() const { return left >= right || top >= bottom; }
};

inline Clip clipPlacement(int x, int y, int64_t width, int64_t height, int64_t targetWidth,
                          int64_t targetHeight) {
    return {std::max<int64_t>(x, 0), std::max<int64_t>(y, 0), std::min(x + width, targetWidth),
            std::min(y + height, targetHeight)};
}

/// Paints `count` pixels: eight at a time, the rest one by one. `Row::paint<L>(i)` paints the pixels
/// from number i on.
template <class Row>
void paintRow(const Row& row, int64_t count) {
    constexpr auto kStep = static_cast<int64_t>(kPixels<EightLanes>);
    int64_t i = 0;
    for (; i + kStep <= count; i += kStep)
        row.template paint<EightLanes>(i);
    for (; i < count; ++i)
        row.template paint<OneLane>(i);
}

/// Paints the rows of a clip from top to bottom; `makeRow(y)` gives the row at destination row y.
template <class MakeRow>
void paintRows(const Clip& clip, MakeRow makeRow) {
    if (clip.empty()) return;
    for (int64_t y = clip.top; y < clip.bottom; ++y)
        paintRow(makeRow(y), clip.right - clip.left);
}

/// A colour pixel in memory: R, G, B, A.
template <class L>
Pixel<L> loadPixel(const unsigned char* from) {
    const Quad<L> quad = loadQuad<L>(from);
    return {quad.byte0, quad.byte1, quad.byte2, quad.byte3};
}

template <class L>
void storePixel(unsigned char* to, const Pixel<L>& pixel) {
    storeQuad<L>(to, {pixel.red, pixel.green, pixel.blue, pixel.alpha});
}

/// A colour word 0xAARRGGBB in every lane.
template <class L>
Pixel<L> spreadColour(uint32_t color) {
    const auto channel = [color](int shift) { return L(static_cast<int>((color >> shift) & 0xFFU)); };
    return {channel(16), channel(8), channel(0), channel(24)};
}

}  // namespace VFontEffect::internal
