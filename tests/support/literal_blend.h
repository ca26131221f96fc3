#pragma once

#include <cstdint>

/// The blending operations one pixel at a time.
///
/// Every operation takes the placement (x, y), the destination's bytes, width and height, then its
/// source with its size and stride, as the library's operation of the same name does. A null
/// destination or source draws nothing. The destination holds 4 bytes R, G, B, A per pixel unless
/// said otherwise.
namespace vorel_test::literal {

/// The fixed-point stand-in for x * y / 255.
int product(int x, int y);

/// dst = max(dst, mask) into a destination of one byte per pixel. The mask is packed.
void drawBitmap8To8(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                    int maskWidth, int maskHeight);

/// Writes the colour with the coverage as its alpha. The run of a row starts dstWidth * row + column
/// bytes into the destination: neither is counted in pixels. The mask is packed.
void drawBitmap8To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                     int maskWidth, int maskHeight, uint32_t color);

/// The operation of `mode`: 1, 2, 3 or 7; any other mode draws nothing.
void drawBitmapBlend8(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                      int width, int height, int maskStride, uint32_t color, int mode);

/// Colour times mask over the destination (mode 1).
void blendSrcOver8To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                       int width, int height, int maskStride, uint32_t color);

/// Colour times mask under the destination (mode 2).
void blendDstOver8To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                       int width, int height, int maskStride, uint32_t color);

/// Full colour under the destination where the mask is not 0 (mode 3).
void blendDstOver8To32NSA(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                          int width, int height, int maskStride, uint32_t color);

/// Full colour under the destination, then the pixel times the mask (mode 7).
void blendDstOverSA8To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* mask,
                         int width, int height, int maskStride, uint32_t color);

/// Source words 0xAARRGGBB: mode 1 blendSrcOver32To32, mode 2 blendDstOver32To32, else nothing.
/// The stride counts words.
void drawBitmapBlend32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint32_t* src,
                       int width, int height, int srcStride, int mode);

/// Source bytes: blendDstOver32To32 from bytes. The stride counts bytes.
void drawBitmapBlend32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* src,
                       int width, int height, int srcStride, int order);

void blendSrcOver32To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint32_t* src,
                        int width, int height, int srcStride);

void blendDstOver32To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint32_t* src,
                        int width, int height, int srcStride);

/// Order 0 is A, R, G, B, order 1 is R, G, B, A, any other draws nothing. The columns left of the
/// destination are skipped as that many bytes, not pixels.
void blendDstOver32To32(int x, int y, uint8_t* dst, int dstWidth, int dstHeight, const uint8_t* src,
                        int width, int height, int srcStride, int order);

/// Merges `outer` into `dst`, both of `pixels` colour pixels: inside the glyphs `dst` is kept,
/// outside them `outer` replaces it, edges mix.
void composite(uint8_t* dst, const uint8_t* outer, const uint8_t* mask, int pixels);

}  // namespace vorel_test::literal
