#pragma once

#include "VFExport.h"

/// Pixel buffers and the small value types that cross the library's boundary.
///
/// Conventions, true in every header:
///  - A colour word is 0xAARRGGBB: alpha in bits 24 to 31, blue in bits 0 to 7.
///  - A colour pixel in memory is four bytes R, G, B, A, premultiplied; rows are packed, so a row
///    takes width * 4 bytes. A mask pixel is one byte of coverage, 0 (outside) to 255 (inside).
///  - Coordinates are whole pixels, x to the right, y downwards. Rectangles are half-open: the left
///    and top edges belong to them, the right and bottom edges do not.
///  - Nothing throws, but std::bad_alloc when the list of a set's effects cannot grow, be it by adding
///    or by copying the set. No drawing code logs. A null argument draws nothing.
///  - Whatever rounding mode, flushing of subnormal numbers or traps the calling thread has set up: the
///    bytes are the same, and it finds its floating-point state as it left it.
namespace VFontEffect {

/// A box of whole pixels, half-open: mRight and mBottom are exclusive. Starts as all zeros.
class VF_API VFRect {
  public:
    VFRect();                                          ///< all zeros
    VFRect(int left, int top, int right, int bottom);  ///< stores the four numbers as they are
    VFRect(const VFRect&) = default;                   ///< copies the four numbers
    VFRect& operator=(const VFRect&) = default;        ///< copies the four numbers
    virtual ~VFRect();

    int mLeft;    ///< first column
    int mTop;     ///< first row
    int mRight;   ///< one past the last column
    int mBottom;  ///< one past the last row
};

/// A pixel buffer that owns its pixels: an 8-bit coverage mask (1 byte per pixel) or a 32-bit colour
/// image (4 bytes per pixel). Rows stand back to back: the stride is mWidth * mBytesPerPixel bytes.
///
/// The byte count is the 32-bit unsigned product of the three numbers. Where the true product does
/// not fit in 32 bits the buffer is smaller than the numbers claim, and the blender draws nothing
/// into such a bitmap and reads nothing from it.
class VF_API VFBitmap {
  public:
    /// An empty bitmap: no pixels, 0 x 0, 0 bytes per pixel, format 4.
    VFBitmap();

    /// Allocates width x height pixels, all zero. If memory runs out mData is null and the numbers
    /// stay as given.
    VFBitmap(unsigned int width, unsigned int height, unsigned int bytesPerPixel);

    /// Allocates width x height pixels and copies them from `data` (packed rows), which stays the
    /// caller's. A null `data`, a byte count above 2^31 - 1 or no memory leaves mData null.
    VFBitmap(unsigned int width, unsigned int height, unsigned char* data, unsigned int bytesPerPixel);

    /// A deep copy. A bitmap without pixels gives one without pixels.
    VFBitmap(const VFBitmap& other);

    /// A crop of a coverage mask: |right - left| x |bottom - top| pixels, copied from `source`.
    ///
    /// One byte is moved per pixel whatever the source's bytes per pixel. An inverted rectangle
    /// gives a bitmap of positive size whose pixels are zero; so does one that leaves the source.
    /// A null rectangle, or a source without pixels, gives a bitmap without pixels.
    VFBitmap(const VFBitmap& source, VFRect* rect);

    /// Deep copy; assigning a bitmap to itself changes nothing. If memory runs out mData is null
    /// and the numbers are those of `other`.
    VFBitmap& operator=(const VFBitmap& other);

    virtual ~VFBitmap();

    unsigned int mWidth;          ///< pixels per row
    unsigned int mHeight;         ///< rows
    unsigned char* mData;         ///< the pixels, from malloc, owned; may be null
    unsigned int mFormat;         ///< 1 for 4 bytes per pixel, 2 otherwise; never read by the library
    unsigned int mBytesPerPixel;  ///< 1 mask, 4 colour, 0 in an empty bitmap
};

/// One rasterised glyph. The record and its buffer stay the caller's and are read only during the
/// call that they are handed to.
struct VFGlyph {
    unsigned char* mBuffer;  ///< 8-bit coverage, mHeight rows of mWidth bytes, top row first
    unsigned short mWidth;   ///< pixels per row
    unsigned short mHeight;  ///< rows
};

/// One colour stop of a gradient. An array of stops travels as a pointer and a separate count.
struct VFGradient {
    unsigned int mColor;  ///< 0xAARRGGBB; the add-calls replace the alpha byte
    float mOpacity;       ///< 0 to 1
    float mLocation;      ///< position along the gradient, 0 to 1, ascending from stop to stop
};

}  // namespace VFontEffect
