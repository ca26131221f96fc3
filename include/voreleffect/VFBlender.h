#pragma once

#include "VFBitmap.h"

namespace VFontEffect {

/// The blending operations: stateless, callable from any thread on separate destinations.
///
/// Every operation places a source of width x height pixels with its top left corner at (x, y) of the
/// destination, which may lie partly or wholly outside, and clips to the destination. The
/// destination record is not changed, only the pixels that it points to.
///
/// All products are 8-bit fixed point: product(x, y) = ((x + 1) * y) >> 8 stands for x * y / 255.
///
/// Nothing is drawn and nothing is read when the destination or the source is null, the destination
/// has no pixels, has another number of bytes per pixel than the operation writes, or a byte count that
/// does not fit in 32 bits; nor for a width or height below 1, a negative stride, or an unknown mode
/// or byte order. Source and destination must not overlap unless said otherwise.
class VF_API VFBlender {
  public:
    VFBlender();
    ~VFBlender();

    /// @name Copies of a coverage mask
    /// @{

    /// Copies the pixels of the mask `src` as the next operation does. Of wider pixels the first
    /// width * height bytes are taken.
    void drawBitmap(int x, int y, const VFBitmap* dst, VFBitmap* src, unsigned int color);

    /// drawBitmap8To32 into a destination of 4 bytes per pixel, drawBitmap8To8 into any other.
    /// The mask is packed: its row stride is maskWidth bytes.
    void drawBitmap(int x, int y, const VFBitmap* dst, unsigned char* mask, int maskWidth,
                    int maskHeight, unsigned int color);

    /// dst = max(dst, mask) into a destination of 1 byte per pixel, or into the first width * height
    /// bytes of a wider one. A mask over itself changes nothing.
    void drawBitmap8To8(int x, int y, const VFBitmap* dst, unsigned char* mask, int maskWidth,
                        int maskHeight);

    /// Writes the channels of `color` with alpha product(alpha of color, mask), 4 bytes a pixel.
    ///
    /// The run of a row starts at byte width * row + column of the destination: neither is counted
    /// in 4-byte pixels, so only a run at the very start of the image lands where its row is and
    /// later rows overlap earlier ones. Required behaviour; the writes stay inside the buffer.
    void drawBitmap8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int maskWidth,
                         int maskHeight, unsigned int color);

    /// @}
    /// @name One colour through a mask, into 32 bits
    /// @{

    /// Draws `color` (premultiplied 0xAARRGGBB) through `mask` with the operation of `mode`:
    /// 1 blendSrcOver8To32, 2 blendDstOver8To32, 3 blendDstOver8To32NSA, 7 blendDstOverSA8To32.
    /// Any other mode draws nothing. maskStride is in bytes.
    void drawBitmapBlend8(int x, int y, const VFBitmap* dst, unsigned char* mask, int width, int height,
                          int maskStride, unsigned int color, int mode);

    /// Colour times mask over the destination.
    void blendSrcOver8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int width, int height,
                           int maskStride, unsigned int color);

    /// Colour times mask under the destination.
    void blendDstOver8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int width, int height,
                           int maskStride, unsigned int color);

    /// The full colour under the destination wherever the mask is not 0: the mask is only a gate.
    void blendDstOver8To32NSA(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                              int height, int maskStride, unsigned int color);

    /// The full colour under the destination, then the whole pixel times the mask. Erases every
    /// pixel of the clipped rectangle where the mask is 0.
    void blendDstOverSA8To32(int x, int y, const VFBitmap* dst, unsigned char* mask, int width,
                             int height, int maskStride, unsigned int color);

    /// @}
    /// @name A colour image into 32 bits
    /// @{

    /// Draws premultiplied 0xAARRGGBB words: mode 1 blendSrcOver32To32, mode 2 blendDstOver32To32,
    /// any other mode nothing. srcStride is in words.
    void drawBitmapBlend32(int x, int y, const VFBitmap* dst, unsigned int* src, int width, int height,
                           int srcStride, int mode);

    /// blendDstOver32To32 from bytes; see there for `order`.
    void drawBitmapBlend32(int x, int y, const VFBitmap* dst, unsigned char* src, int width, int height,
                           int srcStride, int order);

    /// Source over destination. srcStride is in words.
    void blendSrcOver32To32(int x, int y, const VFBitmap* dst, unsigned int* src, int width, int height,
                            int srcStride);

    /// Source under destination. srcStride is in words.
    void blendDstOver32To32(int x, int y, const VFBitmap* dst, unsigned int* src, int width, int height,
                            int srcStride);

    /// Source under destination, from four bytes a pixel: order 0 is A, R, G, B, order 1 is
    /// R, G, B, A, any other order draws nothing. srcStride is in bytes.
    ///
    /// When x is negative, the columns left of the destination are skipped as that many bytes, not
    /// pixels. Required behaviour; the reads stay inside the source.
    void blendDstOver32To32(int x, int y, const VFBitmap* dst, unsigned char* src, int width, int height,
                            int srcStride, int order);
    /// @}
};

}  // namespace VFontEffect
