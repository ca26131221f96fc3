#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>

#include "voreleffect/VFBitmap.h"

namespace VFontEffect::internal {

constexpr int kMaskBytes = 1;
constexpr int kColourBytes = 4;

/// Whether width x height pixels of that many bytes fit in a 32-bit byte count, the limit up to
/// which a bitmap's buffer is as large as its numbers claim.
inline bool fitsByteCount(unsigned int width, unsigned int height, unsigned int bytesPerPixel) {
    const uint64_t pixels = static_cast<uint64_t>(width) * height;
    return bytesPerPixel != 0 && pixels <= std::numeric_limits<uint32_t>::max() / bytesPerPixel;
}

/// Pixels of a bitmap with the sizes widened to 64 bits; empty for a bitmap that cannot be trusted.
/// The stride is width * BytesPerPixel.
template <int BytesPerPixel>
struct PixelView {
    unsigned char* data = nullptr;
    int64_t width = 0;
    int64_t height = 0;

    static PixelView of(const VFBitmap* bitmap) {
        return bitmap != nullptr && bitmap->mBytesPerPixel == BytesPerPixel ? ofBytes(bitmap)
                                                                            : PixelView{};
    }

    /// Takes the bytes of a bitmap for such pixels, of which each must have as many or more.
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
