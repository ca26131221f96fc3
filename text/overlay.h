#pragma once

#include <cstddef>

#include "text/image.h"

namespace voreltext {

/// Where the pixel (x, y), which lies within the picture, begins among its bytes.
size_t offsetOf(const Image& image, int x, int y);

/// Lays a premultiplied picture over another one with its top left corner at (x, y), which may lie
/// outside, as may any part of it: each channel becomes source + destination * (255 - alpha) / 255,
/// rounded to nearest.
void layOver(Image& destination, const Image& source, int x, int y);

/// Multiplies all channels by an opacity from 0 to 1, rounded to nearest.
void fade(Image& image, float opacity);

}  // namespace voreltext
