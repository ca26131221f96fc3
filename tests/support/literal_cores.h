#pragma once

#include <cstdint>
#include <vector>

#include "literal_image.h"

/// The effect cores one pixel at a time: every sum is a loop, every step a plain statement, sides
/// and coordinates are added in 64 bits. The library's cores must paint the same bytes.
///
/// Angles, distances, sizes and scales are the numbers that the core's record holds. A box that is
/// empty or leaves the mask, a size above 256 pixels or one that makes a radius or a padding
/// negative paints nothing.
namespace vorel_test::literal {

// --- The cores ------------------------------------------------------------------------------------

/// An outline: position 0 is centred on the edge, 1 outside, any other value inside. `sub` is null
/// or a second picture that gets the same paint.
void paintStroke(Picture& dst, Picture* sub, const Mask& mask, Box text, bool useOuterLayer, float size,
                 uint32_t color, int position);

/// A blurred, moved shadow beneath what the picture holds.
void paintOuterShadow(Picture& dst, const Mask& mask, Box text, float angle, float distance, float size,
                      uint32_t color);

/// The inverse of the blurred, moved glyph over the text box.
void paintInnerShadow(Picture& dst, const Mask& mask, Box text, float angle, float distance, float size,
                      uint32_t color);

/// A halo. Without stops it has the one straight colour `color`.
void paintOuterGlow(Picture& dst, const Mask& mask, Box text, float size, uint32_t color,
                    const std::vector<Stop>& stops);

/// A glow from the edges inwards, over the text box and around it.
void paintInnerGlow(Picture& dst, const Mask& mask, Box text, float size, uint32_t color,
                    const std::vector<Stop>& stops);

/// A ramp across the text box. Without stops nothing is painted.
void paintLinearGradient(Picture& dst, const Mask& mask, Box text, float angle, float scale,
                         const std::vector<Stop>& stops);

/// A ramp from the centre of the text box outwards. Without stops nothing is painted.
void paintRadialGradient(Picture& dst, const Mask& mask, Box text, float scale,
                         const std::vector<Stop>& stops);

/// A tiled picture; `pattern` holds patternWidth * patternHeight pixels of four bytes A, R, G, B. A
/// box that is larger than the mask is cut to the mask's size first.
void paintPattern(Picture& dst, const Mask& mask, Box text, float opacity, float scale, int patternWidth,
                  int patternHeight, const std::vector<uint8_t>& pattern);

// --- Their pieces ---------------------------------------------------------------------------------

/// Cuts a number to a whole one: towards zero, NaN to 0, beyond 32 bits to the nearest limit.
int truncated(float value);
int truncated(double value);

/// The disc that a stroke stamps: side * side weights; side is 2R + 1, R = trunc(radius + 0.5).
/// Below a side of 1 there are no weights.
struct CircleKernel {
    int side = 0;
    std::vector<uint8_t> weights;
};
CircleKernel circleKernel(float radius);

/// Dilates the rows firstRow to endRow - 1 of `source` into a new plane that reaches the kernel's
/// radius further on every side. `inverse` grows 255 - coverage instead of the coverage.
std::vector<uint8_t> dilated(const std::vector<uint8_t>& source, int width, int height,
                             const CircleKernel& kernel, bool inverse, int firstRow, int endRow);

/// Gaussian weights 0 to R on a scale of 100.
std::vector<uint32_t> shadowWeights(int radius);

/// Gaussian weights 0 to r on a scale of 128.
std::vector<int32_t> glowWeights(int radius);

/// The 257 straight colours of a glow, from the text (0) to the end of the glow (256).
std::vector<uint32_t> glowColours(float size, uint32_t color, const std::vector<Stop>& stops,
                                  float fadeStart, int curve);

/// The 257 straight colours of a gradient. Needs one stop at least.
std::vector<uint32_t> gradientColours(const std::vector<Stop>& stops);

/// Grows coverage in place: each pass makes an inner pixel a quarter of its 3 x 3 sum.
void boxFilter(std::vector<uint8_t>& mask, int passes, int width, int height);

/// Where light from `angle` throws a shadow: x to the right, y downwards.
struct Offset {
    int x = 0, y = 0;
};
Offset shadowOffset(float angle, float distance);

/// How far each core paints beyond the text box.
struct Margins {
    int left = 0, top = 0, right = 0, bottom = 0;
};
Margins outerShadowMargins(float angle, float distance, float size);
int strokeOffset(float size, int position);
int glowOffset(float size);

}  // namespace vorel_test::literal
