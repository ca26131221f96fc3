#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "text/glyph_mask.h"

/// Pictures of one size brought to another.
namespace voreltext {

/// A premultiplied picture of B, G, R, A bytes. The bytes are its owner's.
struct PictureView {
    const uint8_t* pixels;
    ptrdiff_t pitch;  ///< bytes from one row to the next below
    int width;
    int height;
};

/// Where a picture goes. Every of its pixels becomes a square of `to`/`from` pixels.
struct PicturePlace {
    int left;  ///< its corner at the top left in its own pixels, from the glyph's origin, y downwards
    int top;
    int to;  ///< at least 1, as is `from`
    int from;
    int64_t x;  ///< the glyph's origin in 64ths of a pixel, y downwards
    int64_t y;
};

/// The pixels that the picture touches. No side of the picture is beyond 32767, nor `to` or `from`
/// beyond 65535.
Box boxOf(const PictureView& picture, const PicturePlace& place);

/// The picture in the box: the colour of each pixel is the mean of what covers it, by area, rounded to
/// the nearest, where nothing lies as transparent.
///
/// In 64ths of `from`ths of a pixel the edges of the picture's pixels and those of the box's are whole
/// numbers, so areas are exact and sums are integers: the result is the same on every CPU. Both
/// directions are summed one after the other, at a cost of height x (width + new width) + new width x
/// (height + new height) steps.
GlyphMask scaledPicture(const PictureView& picture, const PicturePlace& place);

}  // namespace voreltext
