#include "literal_blend.h"

#include <algorithm>

namespace vorel_test::literal {

namespace {

/// The part of the destination that a placed source covers, half-open. 64 bits wide, because a
/// placement may lie anywhere in the range of an int.
struct Clip {
    int64_t x0, x1, y0, y1;
};

Clip clipTo(int dstWidth, int dstHeight, int x, int y, int width, int height) {
    Clip clip{};
    clip.x0 = std::max<int64_t>(x, 0);
    clip.x1 = std::min<int64_t>(int64_t{x} + width, dstWidth);
    clip.y0 = std::max<int64_t>(y, 0);
    clip.y1 = std::min<int64_t>(int64_t{y} + height, dstHeight);
    return clip;
}

int sat(int value) {
    return std::min(value, 255);
}

uint8_t byteOf(int value) {
    return static_cast<uint8_t>(value);
}

/// The channels of a colour word or of a source pixel.
struct Channels {
    int a, r, g, b;
};

Channels channelsOf(uint32_t word) {
    Channels c{};
    c.a = static_cast<int>((word >> 24) & 0xFF);
    c.r = static_cast<int>((word >> 16) & 0xFF);
    c.g = static_cast<int>((word >> 8) & 0xFF);
    c.b = static_cast<int>(word & 0xFF);
    return c;
}

Channels channelsAt(const uint8_t* pixel) {
    return Channels{pixel[3], pixel[0], pixel[1], pixel[2]};
}

void store(uint8_t* pixel, const Channels& c) {
    pixel[0] = byteOf(c.r);
    pixel[1] = byteOf(c.g);
    pixel[2] = byteOf(c.b);
    pixel[3] = byteOf(c.a);
}

using MaskRule = void (*)(uint8_t* pixel, int m, const Channels& color);

void srcOver(uint8_t* pixel, int m, const Channels& color) {
    const int sA = (m * (color.a + 1)) >> 8;
    if (sA == 0) return;
    const int inv = 255 - sA;
    if (inv == 0) {
        store(pixel, color);
        return;
    }
    const Channels d = channelsAt(pixel);
    Channels out{};
    out.r = sat((((d.r + 1) * inv) >> 8) + ((m * (color.r + 1)) >> 8));
    out.g = sat((((d.g + 1) * inv) >> 8) + ((m * (color.g + 1)) >> 8));
    out.b = sat((((d.b + 1) * inv) >> 8) + ((m * (color.b + 1)) >> 8));
    out.a = sat(sA + (((d.a + 1) * inv) >> 8));
    store(pixel, out);
}

void dstOver(uint8_t* pixel, int m, const Channels& color) {
    const Channels d = channelsAt(pixel);
    if (d.a == 255 || m == 0) return;
    Channels s{};
    s.r = (m * (color.r + 1)) >> 8;
    s.g = (m * (color.g + 1)) >> 8;
    s.b = (m * (color.b + 1)) >> 8;
    s.a = (m * (color.a + 1)) >> 8;
    if (d.a == 0) {
        store(pixel, s);
        return;
    }
    const int inv = 255 - d.a;
    Channels out{};
    out.r = sat(d.r + (((s.r + 1) * inv) >> 8));
    out.g = sat(d.g + (((s.g + 1) * inv) >> 8));
    out.b = sat(d.b + (((s.b + 1) * inv) >> 8));
    out.a = sat(d.a + (((s.a + 1) * inv) >> 8));
    store(pixel, out);
}

void dstOverGated(uint8_t* pixel, int m, const Channels& color) {
    const Channels d = channelsAt(pixel);
    if (d.a == 255 || m == 0) return;
    if (d.a == 0) {
        store(pixel, color);
        return;
    }
    const int inv = 255 - d.a;
    Channels out{};
    out.r = sat(d.r + ((inv * (color.r + 1)) >> 8));
    out.g = sat(d.g + ((inv * (color.g + 1)) >> 8));
    out.b = sat(d.b + ((inv * (color.b + 1)) >> 8));
    out.a = sat(d.a + ((inv * (color.a + 1)) >> 8));
    store(pixel, out);
}

void dstOverClipped(uint8_t* pixel, int m, const Channels& color) {
    if (m == 0) {
        store(pixel, Channels{0, 0, 0, 0});
        return;
    }
    Channels s{};
    s.a = sat((m * (color.a + 1)) >> 8);
    s.r = sat((m * (color.r + 1)) >> 8);
    s.g = sat((m * (color.g + 1)) >> 8);
    s.b = sat((m * (color.b + 1)) >> 8);
    const Channels d = channelsAt(pixel);
    if (d.a == 0) {
        store(pixel, s);
        return;
    }
    const int inv = 255 - d.a;
    Channels out{};
    if (m == 255) {
        out.r = sat(d.r + ((inv * (color.r + 1)) >> 8));
        out.g = sat(d.g + ((inv * (color.g + 1)) >> 8));
        out.b = sat(d.b + ((inv * (color.b + 1)) >> 8));
        out.a = sat(d.a + ((inv * (s.a + 1)) >> 8));
    } else if (d.a == 255) {
        out.r = sat(((d.r + 1) * m) >> 8);
        out.g = sat(((d.g + 1) * m) >> 8);
        out.b = sat(((d.b + 1) * m) >> 8);
        out.a = m;
    } else {
        const int maskedR = (m * (color.r + 1)) >> 8;
        const int maskedG = (m * (color.g + 1)) >> 8;
        const int maskedB = (m * (color.b + 1)) >> 8;
        out.r = sat(((d.r + (((maskedR + 1) * inv) >> 8) + 1) * m) >> 8);
        out.g = sat(((d.g + (((maskedG + 1) * inv) >> 8) + 1) * m) >> 8);
        out.b = sat(((d.b + (((maskedB + 1) * inv) >> 8) + 1) * m) >> 8);
        out.a = sat(((d.a + ((inv * (s.a + 1)) >> 8) + 1) * m) >> 8);
    }
    store(pixel, out);
}

void drawMask(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask, int width,
              int height, int maskStride, uint32_t color, MaskRule rule) {
    if (dst == nullptr || mask == nullptr) return;
    const Clip clip = clipTo(dstWidth, dstHeight, x, y, width, height);
    for (int64_t row = clip.y0; row < clip.y1; ++row) {
        for (int64_t col = clip.x0; col < clip.x1; ++col) {
            const int m = mask[(row - y) * maskStride + (col - x)];
            rule(dst + (row * dstWidth + col) * 4, m, channelsOf(color));
        }
    }
}

void underPixel(uint8_t* pixel, const Channels& s) {
    const Channels d = channelsAt(pixel);
    if (d.a == 255) return;
    if (s.a == 0) return;
    if (d.a == 0) {
        store(pixel, s);
        return;
    }
    const int inv = 255 - d.a;
    Channels out{};
    out.r = sat(d.r + (((s.r + 1) * inv) >> 8));
    out.g = sat(d.g + (((s.g + 1) * inv) >> 8));
    out.b = sat(d.b + (((s.b + 1) * inv) >> 8));
    out.a = sat(d.a + (((s.a + 1) * inv) >> 8));
    store(pixel, out);
}

void overPixel(uint8_t* pixel, const Channels& s) {
    if (s.a == 255) {
        store(pixel, s);
        return;
    }
    const Channels d = channelsAt(pixel);
    const int inv = 255 - s.a;
    Channels out{};
    out.r = sat(s.r + (((d.r + 1) * inv) >> 8));
    out.g = sat(s.g + (((d.g + 1) * inv) >> 8));
    out.b = sat(s.b + (((d.b + 1) * inv) >> 8));
    out.a = sat(s.a + (((d.a + 1) * inv) >> 8));
    store(pixel, out);
}

}  // namespace

int product(int x, int y) {
    return ((x + 1) * y) >> 8;
}

void drawBitmap8To8(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                    int maskWidth, int maskHeight) {
    if (dst == nullptr || mask == nullptr) return;
    const Clip clip = clipTo(dstWidth, dstHeight, x, y, maskWidth, maskHeight);
    for (int64_t row = clip.y0; row < clip.y1; ++row) {
        for (int64_t col = clip.x0; col < clip.x1; ++col) {
            uint8_t& d = dst[row * dstWidth + col];
            d = std::max(d, mask[(row - y) * maskWidth + (col - x)]);
        }
    }
}

void drawBitmap8To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                     int maskWidth, int maskHeight, uint32_t color) {
    if (dst == nullptr || mask == nullptr) return;
    const Channels c = channelsOf(color);
    const Clip clip = clipTo(dstWidth, dstHeight, x, y, maskWidth, maskHeight);
    for (int64_t row = clip.y0; row < clip.y1; ++row) {
        uint8_t* pixel = dst + int64_t{dstWidth} * row + clip.x0;
        for (int64_t col = clip.x0; col < clip.x1; ++col) {
            const int m = mask[(row - y) * maskWidth + (col - x)];
            store(pixel, Channels{(m * (c.a + 1)) >> 8, c.r, c.g, c.b});
            pixel += 4;
        }
    }
}

void drawBitmapBlend8(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                      int width, int height, int maskStride, uint32_t color, int mode) {
    if (mode == 1)
        blendSrcOver8To32(x, y, dst, dstWidth, dstHeight, mask, width, height, maskStride, color);
    if (mode == 2)
        blendDstOver8To32(x, y, dst, dstWidth, dstHeight, mask, width, height, maskStride, color);
    if (mode == 3)
        blendDstOver8To32NSA(x, y, dst, dstWidth, dstHeight, mask, width, height, maskStride, color);
    if (mode == 7)
        blendDstOverSA8To32(x, y, dst, dstWidth, dstHeight, mask, width, height, maskStride, color);
}

void blendSrcOver8To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                       int width, int height, int maskStride, uint32_t color) {
    drawMask(x, y, dst, dstWidth, dstHeight, mask, width, height, maskStride, color, srcOver);
}

void blendDstOver8To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                       int width, int height, int maskStride, uint32_t color) {
    drawMask(x, y, dst, dstWidth, dstHeight, mask, width, height, maskStride, color, dstOver);
}

void blendDstOver8To32NSA(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                          int width, int height, int maskStride, uint32_t color) {
    drawMask(x, y, dst, dstWidth, dstHeight, mask, width, height, maskStride, color, dstOverGated);
}

void blendDstOverSA8To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                         int width, int height, int maskStride, uint32_t color) {
    drawMask(x, y, dst, dstWidth, dstHeight, mask, width, height, maskStride, color, dstOverClipped);
}

void drawBitmapBlend32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint32_t* src,
                       int width, int height, int srcStride, int mode) {
    if (mode == 1) blendSrcOver32To32(x, y, dst, dstWidth, dstHeight, src, width, height, srcStride);
    if (mode == 2) blendDstOver32To32(x, y, dst, dstWidth, dstHeight, src, width, height, srcStride);
}

void drawBitmapBlend32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* src,
                       int width, int height, int srcStride, int order) {
    blendDstOver32To32(x, y, dst, dstWidth, dstHeight, src, width, height, srcStride, order);
}

void blendSrcOver32To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint32_t* src,
                        int width, int height, int srcStride) {
    if (dst == nullptr || src == nullptr) return;
    const Clip clip = clipTo(dstWidth, dstHeight, x, y, width, height);
    for (int64_t row = clip.y0; row < clip.y1; ++row) {
        for (int64_t col = clip.x0; col < clip.x1; ++col) {
            const uint32_t word = src[(row - y) * srcStride + (col - x)];
            overPixel(dst + (row * dstWidth + col) * 4, channelsOf(word));
        }
    }
}

void blendDstOver32To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint32_t* src,
                        int width, int height, int srcStride) {
    if (dst == nullptr || src == nullptr) return;
    const Clip clip = clipTo(dstWidth, dstHeight, x, y, width, height);
    for (int64_t row = clip.y0; row < clip.y1; ++row) {
        for (int64_t col = clip.x0; col < clip.x1; ++col) {
            const uint32_t word = src[(row - y) * srcStride + (col - x)];
            underPixel(dst + (row * dstWidth + col) * 4, channelsOf(word));
        }
    }
}

void blendDstOver32To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* src,
                        int width, int height, int srcStride, int order) {
    if (dst == nullptr || src == nullptr) return;
    if (order != 0 && order != 1) return;
    const Clip clip = clipTo(dstWidth, dstHeight, x, y, width, height);
    for (int64_t row = clip.y0; row < clip.y1; ++row) {
        const int64_t skippedColumns = clip.x0 - x;
        const uint8_t* pixel = src + (row - y) * srcStride + skippedColumns;
        for (int64_t col = clip.x0; col < clip.x1; ++col) {
            Channels s{};
            if (order == 0) {
                s = Channels{pixel[0], pixel[1], pixel[2], pixel[3]};
            } else {
                s = Channels{pixel[3], pixel[0], pixel[1], pixel[2]};
            }
            underPixel(dst + (row * dstWidth + col) * 4, s);
            pixel += 4;
        }
    }
}

void composite(uint8_t* dst, const uint8_t* outer, const uint8_t* mask, int pixels) {
    for (int i = 0; i < pixels; ++i) {
        const int m = mask[i];
        for (int c = 0; c < 4; ++c) {
            const int L = outer[i * 4 + c];
            const int D = dst[i * 4 + c];
            dst[i * 4 + c] = byteOf(std::min(255, (((L + 1) * (255 - m)) >> 8) + (((D + 1) * m) >> 8)));
        }
    }
}

}  // namespace vorel_test::literal
