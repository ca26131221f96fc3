#include "literal_cores.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "literal_blend.h"

namespace vorel_test::literal {
namespace {

constexpr float kLn100 = 4.60517F;
constexpr float kLargestSize = 256.0F;
constexpr int kTableSize = 257;
constexpr int kUnder = 2;  // the blend mode that slides paint beneath the picture

// The float nearest to each function's value, by way of double precision: what single-precision C
// libraries return may miss it by a unit in the last place. Angles beyond 100,000 radians are left to
// them.

float sine(float radians) {
    return fabsf(radians) <= 1e5F ? static_cast<float>(std::sin(static_cast<double>(radians)))
                                  : sinf(radians);
}
float cosine(float radians) {
    return fabsf(radians) <= 1e5F ? static_cast<float>(std::cos(static_cast<double>(radians)))
                                  : cosf(radians);
}
float tangent(float radians) {
    return fabsf(radians) <= 1e5F ? static_cast<float>(std::tan(static_cast<double>(radians)))
                                  : tanf(radians);
}
float exponential(float x) {
    return static_cast<float>(std::exp(static_cast<double>(x)));
}

int64_t widthOf(Box box) {
    return int64_t{box.right} - box.left;
}
int64_t heightOf(Box box) {
    return int64_t{box.bottom} - box.top;
}

bool liesInside(Box box, const Mask& mask) {
    return widthOf(box) > 0 && heightOf(box) > 0 && box.left >= 0 && box.top >= 0 &&
           box.right <= mask.width && box.bottom <= mask.height;
}

uint8_t coverage(const Mask& mask, int64_t x, int64_t y) {
    return mask.bytes[static_cast<size_t>(y * mask.width + x)];
}

/// A packed plane of bytes or words, addressed by 64-bit coordinates.
template <class T>
struct Plane {
    Plane(int64_t planeWidth, int64_t planeHeight, T fill = 0)
        : width(planeWidth), height(planeHeight), values(static_cast<size_t>(width * height), fill) {}

    T& at(int64_t x, int64_t y) { return values[static_cast<size_t>(y * width + x)]; }
    const T& at(int64_t x, int64_t y) const { return values[static_cast<size_t>(y * width + x)]; }
    bool has(int64_t x, int64_t y) const { return x >= 0 && y >= 0 && x < width && y < height; }

    int64_t width;
    int64_t height;
    std::vector<T> values;
};

void blendMask(Picture& dst, int64_t x, int64_t y, const Plane<uint8_t>& plane, uint32_t color,
               int mode) {
    drawBitmapBlend8(static_cast<int>(x), static_cast<int>(y), dst.bytes.data(), dst.width, dst.height,
                     plane.values.data(), static_cast<int>(plane.width), static_cast<int>(plane.height),
                     static_cast<int>(plane.width), color, mode);
}

void blendUnder(Picture& dst, int64_t x, int64_t y, const Plane<uint32_t>& plane) {
    drawBitmapBlend32(static_cast<int>(x), static_cast<int>(y), dst.bytes.data(), dst.width, dst.height,
                      plane.values.data(), static_cast<int>(plane.width), static_cast<int>(plane.height),
                      static_cast<int>(plane.width), kUnder);
}

/// The box's coverage with a border of `side` columns and `ends` rows of `fill`, inverted or not.
Plane<uint8_t> padded(const Mask& mask, Box box, int64_t side, int64_t ends, uint8_t fill,
                      bool inverse) {
    Plane<uint8_t> plane(widthOf(box) + 2 * side, heightOf(box) + 2 * ends, fill);
    for (int64_t y = 0; y < heightOf(box); ++y) {
        for (int64_t x = 0; x < widthOf(box); ++x) {
            const uint8_t c = coverage(mask, box.left + x, box.top + y);
            plane.at(x + side, y + ends) = inverse ? static_cast<uint8_t>(255 - c) : c;
        }
    }
    return plane;
}

template <class Weight>
int64_t totalOf(const std::vector<Weight>& weights) {
    int64_t total = weights[0];
    for (size_t i = 1; i < weights.size(); ++i)
        total += 2 * int64_t{weights[i]};
    return total;
}

uint32_t premultiplied(uint32_t color) {
    const uint32_t a = color >> 24;
    const uint32_t r = color >> 16 & 0xFF;
    const uint32_t g = color >> 8 & 0xFF;
    const uint32_t b = color & 0xFF;
    return a << 24 | (((r + 1) * a) >> 8) << 16 | (((g + 1) * a) >> 8) << 8 | ((b + 1) * a) >> 8;
}

/// The colour `w` 256ths of the way from a to b.
uint32_t mixed(uint32_t a, uint32_t b, int w) {
    if (w < 1) return a;
    if (w >= 256) return b;
    const auto weight = static_cast<uint32_t>(w);
    const uint32_t rest = 256 - weight;
    const uint32_t low = ((weight * (b & 0x00FF00FF) + rest * (a & 0x00FF00FF)) >> 8) & 0x00FF00FF;
    const uint32_t high =
        (weight * ((b >> 8) & 0x00FF00FF) + rest * ((a >> 8) & 0x00FF00FF)) & 0xFF00FF00;
    return low | high;
}

/// The piece of a ramp between two stops, moved on by at most one stop per table entry.
struct Segment {
    uint32_t lower;
    uint32_t upper;
    float start;
    float end;
    float span;
    size_t next;

    void advancePast(float position, const std::vector<Stop>& stops) {
        if (!(end < position) || next >= stops.size()) return;
        const Stop& stop = stops[next];
        start = end;
        lower = upper;
        upper = stop.color;
        span = stop.location - end;
        end = stop.location;
        ++next;
    }

    uint32_t colourAt(float position) const {
        return mixed(lower, upper, truncated((position - start) / span * 256.0F));
    }
};

}  // namespace

// --- Pieces ---------------------------------------------------------------------------------------

int truncated(double value) {
    if (std::isnan(value)) return 0;
    if (value >= 2147483647.0) return std::numeric_limits<int>::max();
    if (value <= -2147483648.0) return std::numeric_limits<int>::min();
    return static_cast<int>(value);
}

int truncated(float value) {
    return truncated(static_cast<double>(value));
}

CircleKernel circleKernel(float radius) {
    const int64_t reach = truncated(radius + 0.5F);
    const int64_t side = 2 * reach + 1;
    if (side < 1) return {};
    CircleKernel kernel;
    kernel.side = static_cast<int>(side);
    for (int64_t y = 0; y < side; ++y) {
        for (int64_t x = 0; x < side; ++x) {
            const auto dx = static_cast<float>(std::abs(x - reach));
            const auto dy = static_cast<float>(std::abs(y - reach));
            const float d = sqrtf(dx * dx + dy * dy);
            float weight = 1.0F - (d - radius);
            if (weight < 0.0F) weight = 0.0F;
            if (weight > 1.0F) weight = 1.0F;
            weight = weight * 255.0F + 0.5F;
            if (weight > 255.0F) weight = 255.0F;
            kernel.weights.push_back(static_cast<uint8_t>(truncated(weight)));
        }
    }
    return kernel;
}

std::vector<uint8_t> dilated(const std::vector<uint8_t>& source, int width, int height,
                             const CircleKernel& kernel, bool inverse, int firstRow, int endRow) {
    const int64_t grown = kernel.side - 1;
    Plane<uint8_t> plane(width + grown, height + grown);
    for (int64_t y = firstRow; y < endRow; ++y) {
        for (int64_t x = 0; x < width; ++x) {
            int c = source[static_cast<size_t>(y * width + x)];
            if (inverse) c = 255 - c;
            if (c == 0) continue;
            for (int64_t ky = 0; ky < kernel.side; ++ky) {
                for (int64_t kx = 0; kx < kernel.side; ++kx) {
                    const int k = kernel.weights[static_cast<size_t>(ky * kernel.side + kx)];
                    uint8_t& target = plane.at(x + kx, y + ky);
                    const int stamped = k == 255 ? c : std::max(c - (255 - k), 0);
                    target = static_cast<uint8_t>(std::max(int{target}, stamped));
                }
            }
        }
    }
    return plane.values;
}

std::vector<uint32_t> shadowWeights(int radius) {
    std::vector<uint32_t> weights{100};
    const float d = static_cast<float>(radius) * static_cast<float>(radius) / kLn100;
    for (int i = 1; i <= radius; ++i) {
        weights.push_back(static_cast<uint32_t>(
            truncated(exponential(static_cast<float>(-(i * i)) / d) * 100.0F + 0.5F)));
    }
    return weights;
}

std::vector<int32_t> glowWeights(int radius) {
    std::vector<int32_t> weights{128};
    const float d = static_cast<float>(radius * radius) / kLn100;
    for (int i = 1; i <= radius; ++i) {
        weights.push_back(truncated(
            static_cast<double>(exponential(static_cast<float>(-(i * i)) / d) * 128.0F) + 0.5));
    }
    return weights;
}

std::vector<uint32_t> glowColours(float size, uint32_t color, const std::vector<Stop>& stops,
                                  float fadeStart, int curve) {
    if (size == 0.0F) return std::vector<uint32_t>(kTableSize, 0);

    std::vector<uint32_t> table(kTableSize, color);
    if (stops.size() == 1) table.assign(kTableSize, stops[0].color);
    if (stops.size() >= 2) {
        // The first segment starts at 0 whatever the position of the first stop.
        Segment segment{stops[0].color, stops[1].color, 0.0F, stops[1].location, stops[1].location, 2};
        table[0] = stops.front().color;
        table[256] = stops.back().color;
        for (int i = 1; i <= 255; ++i) {
            const float x = static_cast<float>(i) * 0.00390625F;
            float t = x;
            if (curve == 1) t = sqrtf(x);
            if (curve == 2) t = x * x;
            segment.advancePast(t, stops);
            table[static_cast<size_t>(i)] = segment.colourAt(t);
        }
    }

    float fade = fadeStart;
    if (fade >= 1.0F) {
        fade = 0.99F;
    } else if (fade <= 0.0F) {
        fade = 0.01F;
    }
    const int first = truncated(static_cast<double>(fade) * 256.0);
    if (first < 0 || first > 256) return table;
    for (int i = first; i <= 256; ++i) {
        const auto kept = static_cast<uint32_t>(truncated((256.0F * (256.0F - static_cast<float>(i))) /
                                                          (256.0F - static_cast<float>(first))));
        uint32_t& entry = table[static_cast<size_t>(i)];
        entry = ((entry >> 24) * kept >> 8) << 24 | (entry & 0x00FFFFFF);
    }
    table[256] = 0;
    return table;
}

std::vector<uint32_t> gradientColours(const std::vector<Stop>& stops) {
    std::vector<uint32_t> table(kTableSize, stops[0].color);
    if (stops.size() == 1) return table;
    table[256] = stops.back().color;
    Segment segment{stops[0].color,
                    stops[1].color,
                    stops[0].location,
                    stops[1].location,
                    stops[1].location - stops[0].location,
                    2};
    for (int i = 1; i <= 255; ++i) {
        const float x = static_cast<float>(i) * 0.00390625F;
        segment.advancePast(x, stops);
        table[static_cast<size_t>(i)] = segment.colourAt(x);
    }
    return table;
}

void boxFilter(std::vector<uint8_t>& mask, int passes, int width, int height) {
    if (width < 1 || height <= 2) return;
    for (int pass = 0; pass < passes; ++pass) {
        const std::vector<uint8_t> before = mask;
        for (int64_t y = 1; y < height - 1; ++y) {
            for (int64_t x = 0; x < width; ++x) {
                uint8_t& target = mask[static_cast<size_t>(y * width + x)];
                if (x == 0 || x == width - 1) {
                    target = 0;
                    continue;
                }
                int sum = 0;
                for (int64_t ny = y - 1; ny <= y + 1; ++ny) {
                    for (int64_t nx = x - 1; nx <= x + 1; ++nx) {
                        sum += before[static_cast<size_t>(ny * width + nx)];
                    }
                }
                target = static_cast<uint8_t>(std::min(sum >> 2, 255));
            }
        }
    }
}

Offset shadowOffset(float angle, float distance) {
    const float radians = angle * 3.14159F / 180.0F;
    const float h = cosine(radians) * distance;
    const float v = sine(radians) * distance;
    return {truncated((h < -0.0F ? 0.5F : -0.5F) - h), truncated(v + (v > 0.0F ? 0.5F : -0.5F))};
}

Margins outerShadowMargins(float angle, float distance, float size) {
    const Offset move = shadowOffset(angle, distance);
    const int64_t reach = truncated(size + 0.5F);
    const auto margin = [](int64_t pixels) {
        return static_cast<int>(std::clamp<int64_t>(pixels, 0, std::numeric_limits<int>::max()));
    };
    return {margin(reach - move.x), margin(reach - move.y), margin(reach + move.x),
            margin(reach + move.y)};
}

int strokeOffset(float size, int position) {
    if (position == 1) return truncated(size + 0.5F);
    if (position == 0) return truncated(size * 0.5F + 0.5F);
    return 0;
}

int glowOffset(float size) {
    return truncated(size + 0.5F);
}

// --- Cores ----------------------------------------------------------------------------------------

void paintStroke(Picture& dst, Picture* sub, const Mask& mask, Box text, bool useOuterLayer, float size,
                 uint32_t color, int position) {
    if (!liesInside(text, mask) || size > kLargestSize) return;
    const CircleKernel kernel = circleKernel(position != 0 ? size : size * 0.5F);
    if (kernel.side < 1) return;
    const int64_t reach = (kernel.side - 1) / 2;

    const Plane<uint8_t> source = padded(mask, text, 1, 1, 0, false);
    const auto dilate = [&](bool inverse) {
        return dilated(source.values, static_cast<int>(source.width), static_cast<int>(source.height),
                       kernel, inverse, 0, static_cast<int>(source.height));
    };
    Plane<uint8_t> plane(source.width + 2 * reach, source.height + 2 * reach);
    if (position == 0) {
        const std::vector<uint8_t> outside = dilate(false);
        const std::vector<uint8_t> inside = dilate(true);
        for (size_t i = 0; i < outside.size(); ++i)
            plane.values[i] = std::min(outside[i], inside[i]);
    } else {
        plane.values = dilate(position != 1);
    }

    const int mode = position == 0 && !useOuterLayer ? 1 : kUnder;
    blendMask(dst, text.left - 1 - reach, text.top - 1 - reach, plane, color, mode);
    if (sub != nullptr) blendMask(*sub, text.left - 1 - reach, text.top - 1 - reach, plane, color, mode);
}

namespace {

int64_t shadowRadius(float size) {
    return std::max(0, truncated(static_cast<double>(size) + 0.5));
}

}  // namespace

void paintOuterShadow(Picture& dst, const Mask& mask, Box text, float angle, float distance, float size,
                      uint32_t color) {
    if (!liesInside(text, mask) || size > kLargestSize) return;
    const int64_t r = shadowRadius(size);
    const Offset move = shadowOffset(angle, distance);
    if (text.right + 2 * r + move.x < 0 || text.left - 2 * r + move.x >= dst.width) return;
    if (text.bottom + 2 * r + move.y < 0 || text.top - 2 * r + move.y >= dst.height) return;

    const std::vector<uint32_t> weights = shadowWeights(static_cast<int>(r));
    const int64_t sum = totalOf(weights);
    const Plane<uint8_t> mid = padded(mask, text, 2 * r, 2 * r, 0, false);
    Plane<uint8_t> shadow(mid.width, mid.height);
    for (int64_t y = r; y < mid.height - r; ++y) {
        std::vector<int64_t> row(static_cast<size_t>(mid.width), 0);
        for (int64_t x = r; x < mid.width - r; ++x) {
            int64_t weighted = 0;
            for (int64_t k = -r; k <= r; ++k) {
                weighted += int64_t{mid.at(x, y + k)} * weights[static_cast<size_t>(std::abs(k))];
            }
            row[static_cast<size_t>(x)] = weighted / sum;
        }
        for (int64_t x = r; x < mid.width - r; ++x) {
            int64_t weighted = 0;
            for (int64_t k = -r; k <= r; ++k) {
                weighted += row[static_cast<size_t>(x + k)] * weights[static_cast<size_t>(std::abs(k))];
            }
            shadow.at(x, y) = static_cast<uint8_t>(std::min<int64_t>(255, weighted / sum));
        }
    }
    blendMask(dst, text.left - 2 * r + move.x, text.top - 2 * r + move.y, shadow, color, kUnder);
}

void paintInnerShadow(Picture& dst, const Mask& mask, Box text, float angle, float distance, float size,
                      uint32_t color) {
    if (!liesInside(text, mask) || size > kLargestSize) return;
    const int64_t w = widthOf(text);
    const int64_t h = heightOf(text);
    const int64_t r = shadowRadius(size);
    const Offset move = shadowOffset(angle, distance);

    const bool overlaps = text.right + r + move.x >= text.left && text.left - r + move.x < text.right &&
                          int64_t{text.top} + move.y < text.bottom + r &&
                          int64_t{text.bottom} + move.y >= text.top - r;
    if (!overlaps) {
        blendMask(dst, text.left, text.top, padded(mask, text, 0, 0, 0, false), color, kUnder);
        return;
    }

    const std::vector<uint32_t> weights = shadowWeights(static_cast<int>(r));
    const int64_t sum = totalOf(weights);
    const Plane<uint8_t> wide = padded(mask, text, r, 0, 0, false);
    Plane<uint8_t> inverse(wide.width, wide.height);
    for (int64_t y = 0; y < wide.height; ++y) {
        for (int64_t x = 0; x < wide.width; ++x) {
            int64_t weighted = 0;
            for (int64_t k = -r; k <= r; ++k) {
                if (!wide.has(x + k, y)) continue;
                weighted += int64_t{wide.at(x + k, y)} * weights[static_cast<size_t>(std::abs(k))];
            }
            inverse.at(x, y) = static_cast<uint8_t>((255 * sum - weighted) / sum);
        }
    }

    Plane<uint8_t> shadow(w, h);
    for (int64_t y = 0; y < h; ++y) {
        for (int64_t x = 0; x < w; ++x) {
            int64_t weighted = 0;
            for (int64_t k = -r; k <= r; ++k) {
                const int64_t fromX = x - move.x + r;
                const int64_t fromY = y - move.y + k;
                const int64_t value = inverse.has(fromX, fromY) ? inverse.at(fromX, fromY) : 255;
                weighted += value * weights[static_cast<size_t>(std::abs(k))];
            }
            shadow.at(x, y) = static_cast<uint8_t>(weighted / sum);
        }
    }
    blendMask(dst, text.left, text.top, shadow, color, kUnder);
}

namespace {

/// What the two glows have in common: `inner` blurs the inverse of the coverage and marks the border
/// that the blur does not reach with opaque white.
void paintGlow(Picture& dst, const Mask& mask, Box text, float size, uint32_t color,
               const std::vector<Stop>& stops, bool inner) {
    if (!liesInside(text, mask) || size > kLargestSize) return;
    const int64_t pad = int64_t{truncated(size)} + 1;
    if (pad <= 0) return;  // with a padding of 0 the image is clear: blending it changes nothing

    const std::vector<uint32_t> table = glowColours(size, color, stops, 0.3F, 0);
    const uint8_t fill = inner ? 255 : 0;
    Plane<uint8_t> grown = padded(mask, text, 2 * pad, 2 * pad, fill, inner);
    const int passes = std::max(1, truncated(static_cast<double>(pad) * 0.4750000089406967));
    boxFilter(grown.values, passes, static_cast<int>(grown.width), static_cast<int>(grown.height));

    const int64_t r = truncated(static_cast<float>(pad) * 0.9F);
    const std::vector<int32_t> weights = glowWeights(static_cast<int>(r));
    const int64_t total = totalOf(weights);
    const auto normalised = [&](int64_t weighted) {
        return inner ? (255 * total - weighted) / total : weighted / total;
    };

    Plane<uint32_t> glow(grown.width, grown.height, inner ? 0xFFFFFFFF : 0);
    for (int64_t y = r; y < grown.height - r; ++y) {
        std::vector<int64_t> row(static_cast<size_t>(grown.width), fill);
        for (int64_t x = r; x < grown.width - r; ++x) {
            int64_t weighted = int64_t{grown.at(x, y)} * 128;
            for (int64_t i = 1; i <= r; ++i) {
                weighted +=
                    (int64_t{grown.at(x, y - i)} + grown.at(x, y + i)) * weights[static_cast<size_t>(i)];
            }
            row[static_cast<size_t>(x)] = normalised(weighted);
        }
        for (int64_t x = r; x < grown.width - r; ++x) {
            int64_t weighted = row[static_cast<size_t>(x)] * 128;
            for (int64_t i = 1; i <= r; ++i) {
                weighted += (row[static_cast<size_t>(x - i)] + row[static_cast<size_t>(x + i)]) *
                            weights[static_cast<size_t>(i)];
            }
            const int64_t index = 256 - std::min<int64_t>(normalised(weighted), 256);
            glow.at(x, y) = premultiplied(table[static_cast<size_t>(index)]);
        }
    }
    blendUnder(dst, text.left - 2 * pad, text.top - 2 * pad, glow);
}

}  // namespace

void paintOuterGlow(Picture& dst, const Mask& mask, Box text, float size, uint32_t color,
                    const std::vector<Stop>& stops) {
    paintGlow(dst, mask, text, size, color, stops, false);
}

void paintInnerGlow(Picture& dst, const Mask& mask, Box text, float size, uint32_t color,
                    const std::vector<Stop>& stops) {
    paintGlow(dst, mask, text, size, color, stops, true);
}

void paintLinearGradient(Picture& dst, const Mask& mask, Box text, float angle, float scale,
                         const std::vector<Stop>& stops) {
    if (scale < 0.1F || stops.empty() || !liesInside(text, mask)) return;
    const std::vector<uint32_t> table = gradientColours(stops);
    const auto w = static_cast<float>(widthOf(text));
    const auto h = static_cast<float>(heightOf(text));
    const float radians = angle * -0.01745328F;
    const float c = cosine(radians);
    const float s = sine(radians);
    const float length = fabsf(tangent(radians)) < h / w ? w / fabsf(c) : h / fabsf(s);
    const float kx = c * ((256.0F / scale) / length);
    const float ky = s * ((256.0F / scale) / length);
    const float cx = w * 0.5F;
    const float cy = h * 0.5F;

    Plane<uint32_t> image(widthOf(text), heightOf(text));
    for (int64_t y = 0; y < image.height; ++y) {
        for (int64_t x = 0; x < image.width; ++x) {
            if (coverage(mask, text.left + x, text.top + y) == 0) continue;
            const float t = ky * (static_cast<float>(y) - cy) + kx * (static_cast<float>(x) - cx);
            const int64_t index = std::clamp<int64_t>(int64_t{truncated(t)} + 128, 0, 255);
            image.at(x, y) = premultiplied(table[static_cast<size_t>(index)]);
        }
    }
    blendUnder(dst, text.left, text.top, image);
}

void paintRadialGradient(Picture& dst, const Mask& mask, Box text, float scale,
                         const std::vector<Stop>& stops) {
    if (scale < 0.1F || stops.empty() || !liesInside(text, mask)) return;
    const std::vector<uint32_t> table = gradientColours(stops);
    const auto w = static_cast<float>(widthOf(text));
    const auto h = static_cast<float>(heightOf(text));
    const float k = (256.0F / w + 256.0F / w) / scale;
    const float cx = w * 0.5F;
    const float cy = h * 0.5F;

    Plane<uint32_t> image(widthOf(text), heightOf(text));
    for (int64_t y = 0; y < image.height; ++y) {
        for (int64_t x = 0; x < image.width; ++x) {
            if (coverage(mask, text.left + x, text.top + y) == 0) continue;
            const float dy = static_cast<float>(y) - cy;
            const float dx = static_cast<float>(x) - cx;
            const float d = sqrtf(dy * dy + dx * dx);
            const int index = std::clamp(truncated(k * d), 0, 255);
            image.at(x, y) = premultiplied(table[static_cast<size_t>(index)]);
        }
    }
    blendUnder(dst, text.left, text.top, image);
}

namespace {

/// Where one output coordinate falls in the pattern: between two of its rows or columns, the second
/// weighted by `fraction` and the first by 255 - fraction.
struct Sample {
    int64_t first;
    int64_t second;
    int fraction;
};

Sample samplePosition(int64_t coordinate, float scale, int patternSide) {
    // A tile smaller than a pixel counts as one pixel.
    const int64_t tile = std::max(1, truncated(scale * static_cast<float>(patternSide)));
    const float position = static_cast<float>(coordinate % tile) / scale;
    const float whole = floorf(position);
    const int64_t first = std::clamp<int64_t>(truncated(whole), 0, patternSide - 1);
    const int64_t second = first + 1 < patternSide ? first + 1 : 0;
    return {first, second, truncated((position - whole) * 255.0F)};
}

}  // namespace

void paintPattern(Picture& dst, const Mask& mask, Box text, float opacity, float scale, int patternWidth,
                  int patternHeight, const std::vector<uint8_t>& pattern) {
    if (scale < 0.1F || patternWidth < 1 || patternHeight < 1 || pattern.empty()) return;
    const int64_t w = std::min<int64_t>(mask.width, widthOf(text));
    const int64_t h = std::min<int64_t>(mask.height, heightOf(text));
    if (w < 1 || h < 1) return;
    const Box cut{text.left, text.top, static_cast<int>(text.left + w), static_cast<int>(text.top + h)};
    if (!liesInside(cut, mask)) return;

    Plane<uint32_t> image(w, h);
    for (int64_t y = 0; y < h; ++y) {
        const Sample row = samplePosition(y, scale, patternHeight);
        for (int64_t x = 0; x < w; ++x) {
            if (coverage(mask, text.left + x, text.top + y) == 0) continue;
            const Sample column = samplePosition(x, scale, patternWidth);
            int v[4];
            for (int k = 0; k < 4; ++k) {
                const auto byteAt = [&](int64_t py, int64_t px) {
                    return int{pattern[static_cast<size_t>((py * patternWidth + px) * 4 + k)]};
                };
                const int gx = 255 - column.fraction;
                const int gy = 255 - row.fraction;
                const int upper = byteAt(row.first, column.first) * gx +
                                  byteAt(row.first, column.second) * column.fraction;
                const int lower = byteAt(row.second, column.first) * gx +
                                  byteAt(row.second, column.second) * column.fraction;
                v[k] = (upper * gy + lower * row.fraction) >> 16 & 0xFF;
            }
            const int a = std::clamp(truncated(static_cast<float>(v[0]) * opacity), 0, 255);
            const auto channel = [&](int value) {
                const int product = a * (value + 1);
                return static_cast<uint32_t>(product > 65535 ? 255 : product >> 8);
            };
            image.at(x, y) = static_cast<uint32_t>(a) << 24 | channel(v[1]) << 16 | channel(v[2]) << 8 |
                             channel(v[3]);
        }
    }
    blendUnder(dst, text.left, text.top, image);
}

}  // namespace vorel_test::literal
