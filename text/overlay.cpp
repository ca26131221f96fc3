#include "text/overlay.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace voreltext {
namespace {

/// x / 255, rounded to nearest, for x up to 255 * 255.
unsigned int dividedBy255(unsigned int x) {
    return (x + 127U) / 255U;
}

void layPixelOver(uint8_t* destination, const uint8_t* source) {
    const unsigned int rest = 255U - source[3];
    for (int c = 0; c < 4; ++c) {
        const unsigned int below = dividedBy255(destination[c] * rest);
        destination[c] = static_cast<uint8_t>(std::min(255U, source[c] + below));
    }
}

/// The part of a length from 0 to `length` that lies within `room` when it is moved by `shift`.
struct Visible {
    Visible(int length, int room, int shift)
        : begin(static_cast<int>(std::clamp<int64_t>(-int64_t{shift}, 0, length))),
          end(static_cast<int>(std::clamp<int64_t>(int64_t{room} - shift, begin, length))) {}

    int begin;
    int end;
};

}  // namespace

size_t offsetOf(const Image& image, int x, int y) {
    return (static_cast<size_t>(y) * static_cast<size_t>(image.width) + static_cast<size_t>(x)) * 4;
}

void layOver(Image& destination, const Image& source, int x, int y) {
    const Visible columns(source.width, destination.width, x);
    const Visible rows(source.height, destination.height, y);
    if (columns.begin == columns.end) return;
    for (int row = rows.begin; row < rows.end; ++row) {
        const uint8_t* from = &source.pixels[offsetOf(source, columns.begin, row)];
        uint8_t* to = &destination.pixels[offsetOf(destination, columns.begin + x, row + y)];
        for (int column = columns.begin; column < columns.end; ++column, from += 4, to += 4)
            layPixelOver(to, from);
    }
}

void fade(Image& image, float opacity) {
    // Written so that what is no number is 0.
    const float within = opacity > 0.0F ? std::min(opacity, 1.0F) : 0.0F;
    const auto factor = static_cast<unsigned int>(std::lround(within * 255.0F));
    for (uint8_t& channel : image.pixels)
        channel = static_cast<uint8_t>(dividedBy255(channel * factor));
}

}  // namespace voreltext
