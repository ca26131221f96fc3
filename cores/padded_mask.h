#pragma once

#include <cstdint>
#include <cstring>

#include "core/pixel_buffer.h"
#include "cores/paint_input.h"

namespace VFontEffect::internal {

/// Whether a step gives its values or 255 minus them: a padded mask the coverage with an empty border or
/// its inverse with a full one, a blur the mean of the taps or its inverse.
enum class Sense { plain, inverted };

/// A plane of bytes in working memory; empty when memory ran out.
struct Plane {
    PixelBuffer<uint8_t> bytes;
    int64_t width;
    int64_t height;

    explicit operator bool() const { return static_cast<bool>(bytes); }
    uint8_t* row(int64_t y) { return bytes.data() + y * width; }
    const uint8_t* row(int64_t y) const { return bytes.data() + y * width; }

    static Plane filled(int64_t width, int64_t height, uint8_t value) {
        Plane plane = {PixelBuffer<uint8_t>::uninitialised(width, height), width, height};
        if (plane) std::memset(plane.bytes.data(), value, static_cast<size_t>(width * height));
        return plane;
    }
};

/// The coverage of a box with `padX` columns and `padY` rows of border on each side.
inline Plane paddedMask(const CoverageBox& box, int64_t padX, int64_t padY, Sense sense = Sense::plain) {
    const uint8_t flip = sense == Sense::inverted ? 0xFF : 0;
    Plane plane = Plane::filled(box.width + 2 * padX, box.height + 2 * padY, flip);
    if (!plane) return plane;
    for (int64_t y = 0; y < box.height; ++y) {
        const uint8_t* const source = box.row(y);
        uint8_t* const target = plane.row(y + padY) + padX;
        for (int64_t x = 0; x < box.width; ++x)
            target[x] = static_cast<uint8_t>(source[x] ^ flip);
    }
    return plane;
}

}  // namespace VFontEffect::internal
