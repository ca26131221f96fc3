#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "voreleffect/VFBitmap.h"

namespace VFontEffect::internal {

constexpr int kMaskBytes = 1;
constexpr int kColourBytes = 4;

/// Whether the byte count of width x height pixels fits in 32 bits, and in what pointers span, which is
/// less where addresses have 32 bits. Beyond the one a bitmap, which counts its bytes in 32 bits, has a
/// smaller buffer than its numbers claim; beyond the other no two of its pixels can be told apart by a
/// distance.
inline bool fitsByteCount(unsigned int width, unsigned int height, unsigned int bytesPerPixel) {
    constexpr uint64_t kMost = std::min<uint64_t>(UINT32_MAX, PTRDIFF_MAX);
    const uint64_t pixels = static_cast<uint64_t>(width) * height;
    return bytesPerPixel != 0 && pixels <= kMost / bytesPerPixel;
}

/// The pixels of a bitmap, with 64-bit sizes and packed rows. Empty, with null data, for a bitmap
/// without pixels, of other bytes per pixel, or whose buffer is smaller than its numbers claim.
template <int BytesPerPixel>
struct PixelView {
    unsigned char* data = nullptr;
    int64_t width = 0;
    int64_t height = 0;

    static PixelView of(const VFBitmap* bitmap) {
        return bitmap != nullptr && bitmap->mBytesPerPixel == BytesPerPixel ? ofBytes(bitmap)
                                                                            : PixelView{};
    }

    /// Views a bitmap of so many bytes per pixel or more as if its bytes were width x height of these.
    static PixelView ofBytes(const VFBitmap* bitmap) {
        if (bitmap == nullptr || bitmap->mData == nullptr || bitmap->mBytesPerPixel < BytesPerPixel ||
            !fitsByteCount(bitmap->mWidth, bitmap->mHeight, bitmap->mBytesPerPixel)) {
            return {};
        }
        return {bitmap->mData, bitmap->mWidth, bitmap->mHeight};
    }

    explicit operator bool() const { return data != nullptr; }
    unsigned char* at(int64_t x, int64_t y) const { return data + (y * width + x) * BytesPerPixel; }
};

using MaskView = PixelView<kMaskBytes>;
using ColourView = PixelView<kColourBytes>;

}  // namespace VFontEffect::internal
