#include <cstdint>
#include <cstdlib>
#include <cstring>

#include "core/views.h"
#include "voreleffect/VFBitmap.h"

namespace VFontEffect {
namespace {

unsigned int formatOf(unsigned int bytesPerPixel) {
    return bytesPerPixel == internal::kColourBytes ? 1 : 2;
}

/// The byte count of a bitmap's buffer: the product of its numbers in 32-bit unsigned arithmetic.
unsigned int byteCount(unsigned int width, unsigned int height, unsigned int bytesPerPixel) {
    return width * height * bytesPerPixel;
}

unsigned int byteCount(const VFBitmap& bitmap) {
    return byteCount(bitmap.mWidth, bitmap.mHeight, bitmap.mBytesPerPixel);
}

[[nodiscard]] unsigned char* allocateZeroed(size_t bytes) {
    return static_cast<unsigned char*>(std::calloc(bytes, 1));
}

/// A copy of `bytes` bytes from `source`; null for no source or no memory.
[[nodiscard]] unsigned char* duplicate(const unsigned char* source, size_t bytes) {
    if (source == nullptr) return nullptr;
    auto* copy = static_cast<unsigned char*>(std::malloc(bytes));
    if (copy != nullptr && bytes != 0) std::memcpy(copy, source, bytes);
    return copy;
}

unsigned int distance(int from, int to) {
    const int64_t difference = static_cast<int64_t>(to) - from;
    return static_cast<unsigned int>(difference < 0 ? -difference : difference);
}

/// Whether the box is not inverted and lies inside a source whose buffer is as large as it claims.
bool liesInside(const VFRect& box, const VFBitmap& source) {
    return box.mLeft >= 0 && box.mTop >= 0 && box.mRight >= box.mLeft && box.mBottom >= box.mTop &&
           static_cast<unsigned int>(box.mRight) <= source.mWidth &&
           static_cast<unsigned int>(box.mBottom) <= source.mHeight &&
           internal::fitsByteCount(source.mWidth, source.mHeight, source.mBytesPerPixel);
}

}  // namespace

VFRect::VFRect() : VFRect(0, 0, 0, 0) {}

VFRect::VFRect(int left, int top, int right, int bottom)
    : mLeft(left), mTop(top), mRight(right), mBottom(bottom) {}

VFRect::~VFRect() = default;

VFBitmap::VFBitmap() : mWidth(0), mHeight(0), mData(nullptr), mFormat(4), mBytesPerPixel(0) {}

VFBitmap::VFBitmap(unsigned int width, unsigned int height, unsigned int bytesPerPixel)
    : mWidth(width),
      mHeight(height),
      mData(allocateZeroed(byteCount(width, height, bytesPerPixel))),
      mFormat(formatOf(bytesPerPixel)),
      mBytesPerPixel(bytesPerPixel) {}

VFBitmap::VFBitmap(unsigned int width, unsigned int height, unsigned char* data,
                   unsigned int bytesPerPixel)
    : mWidth(width),
      mHeight(height),
      mData(nullptr),
      mFormat(formatOf(bytesPerPixel)),
      mBytesPerPixel(bytesPerPixel) {
    // Here the byte count is a signed 32-bit number; a negative one, from 2^31 on, gives no buffer.
    const auto bytes = static_cast<int32_t>(byteCount(*this));
    if (bytes >= 0) mData = duplicate(data, static_cast<size_t>(bytes));
}

VFBitmap::VFBitmap(const VFBitmap& other)
    : mWidth(other.mWidth),
      mHeight(other.mHeight),
      mData(duplicate(other.mData, byteCount(other))),
      mFormat(other.mFormat),
      mBytesPerPixel(other.mBytesPerPixel) {}

VFBitmap::VFBitmap(const VFBitmap& source, VFRect* rect)
    : mWidth(0),
      mHeight(0),
      mData(nullptr),
      mFormat(source.mFormat),
      mBytesPerPixel(source.mBytesPerPixel) {
    if (rect == nullptr) return;
    mWidth = distance(rect->mLeft, rect->mRight);
    mHeight = distance(rect->mTop, rect->mBottom);
    if (source.mData == nullptr || !internal::fitsByteCount(mWidth, mHeight, mBytesPerPixel)) return;
    mData = allocateZeroed(byteCount(*this));
    if (mData == nullptr || !liesInside(*rect, source)) return;
    // Deliberate: one byte moves per pixel and rows are counted in pixels, whatever the source's
    // bytes per pixel. A crop of a colour image holds width * height bytes of it, the rest is zero.
    for (size_t row = 0; row < mHeight; ++row) {
        const size_t sourceRow = static_cast<size_t>(rect->mTop) + row;
        std::memcpy(mData + row * mWidth,
                    source.mData + sourceRow * source.mWidth + static_cast<size_t>(rect->mLeft), mWidth);
    }
}

VFBitmap& VFBitmap::operator=(const VFBitmap& other) {
    if (this == &other) return *this;
    mWidth = other.mWidth;
    mHeight = other.mHeight;
    mFormat = other.mFormat;
    mBytesPerPixel = other.mBytesPerPixel;
    std::free(mData);
    mData = duplicate(other.mData, byteCount(other));
    return *this;
}

VFBitmap::~VFBitmap() {
    std::free(mData);
    mData = nullptr;
}

}  // namespace VFontEffect
