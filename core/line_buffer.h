#pragma once

#include <cstdint>

#include "core/pixel_buffer.h"

namespace VFontEffect::internal {

/// Working memory of bytes that begins with a line of the cache, so that no vector at a multiple of its
/// own size crosses two lines. Empty when memory ran out.
class LineBuffer {
  public:
    explicit LineBuffer(int64_t width, int64_t height = 1)
        : mBytes(PixelBuffer<uint8_t>::uninitialised(width * height + kLineBytes)) {}

    explicit operator bool() const { return static_cast<bool>(mBytes); }
    void release() { mBytes.release(); }
    uint8_t* data() {
        const uintptr_t offset = 0 - reinterpret_cast<uintptr_t>(mBytes.data());
        return mBytes.data() + offset % kLineBytes;
    }

  private:
    static constexpr int64_t kLineBytes = 64;

    PixelBuffer<uint8_t> mBytes;
};

}  // namespace VFontEffect::internal
