#include "text/colour_layers.h"

namespace voreltext {
namespace {

/// The product of two parts of 255, rounded to the nearest.
uint8_t product(unsigned int one, unsigned int other) {
    return static_cast<uint8_t>((one * other + 127) / 255);
}

void layOnPixel(uint8_t* pixel, unsigned int alpha, const LayerColour& colour) {
    const uint8_t laid[]{product(colour.red, alpha), product(colour.green, alpha),
                         product(colour.blue, alpha), static_cast<uint8_t>(alpha)};
    for (size_t i = 0; i < 4; ++i)
        pixel[i] = static_cast<uint8_t>(laid[i] + product(pixel[i], 255 - alpha));
}

}  // namespace

void layOn(GlyphMask& picture, const GlyphMask& coverage, const LayerColour& colour) {
    const auto width = static_cast<size_t>(picture.box.width());
    size_t from = 0;
    for (int y = coverage.box.top; y < coverage.box.bottom; ++y) {
        size_t at = static_cast<size_t>(y - picture.box.top) * width +
                    static_cast<size_t>(coverage.box.left - picture.box.left);
        for (int x = coverage.box.left; x < coverage.box.right; ++x, ++at, ++from) {
            layOnPixel(&picture.pixels[at * 4], product(coverage.coverage[from], colour.alpha), colour);
            picture.coverage[at] = picture.pixels[at * 4 + 3];
        }
    }
}

}  // namespace voreltext
