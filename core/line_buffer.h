#pragma once

#include <cstddef>
#include <cstdint>

#include "core/pixel_buffer.h"

#if defined(__SANITIZE_ADDRESS__)
#define VOREL_ADDRESS_SANITIZER
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define VOREL_ADDRESS_SANITIZER
#endif
#endif
#if defined(VOREL_ADDRESS_SANITIZER)
#include <sanitizer/asan_interface.h>
#endif

namespace VFontEffect::internal {

/// Working memory of bytes, aligned to a cache line, so that no vector at a multiple of its own size
/// straddles two lines. Empty when memory ran out.
class LineBuffer {
  public:
    explicit LineBuffer(int64_t width, int64_t height = 1)
        : mBytes(PixelBuffer<uint8_t>::uninitialised(width * height + kLineBytes)) {
        if (!mBytes) return;
        const int64_t before = data() - mBytes.data();
        forbid(mBytes.data(), before);
        forbid(data() + width * height, kLineBytes - before);
    }

    explicit operator bool() const { return static_cast<bool>(mBytes); }
    void release() { mBytes.release(); }
    uint8_t* data() {
        const uintptr_t offset = 0 - reinterpret_cast<uintptr_t>(mBytes.data());
        return mBytes.data() + offset % kLineBytes;
    }

  private:
    static constexpr int64_t kLineBytes = 64;

    /// Poisons the padding that is there for alignment only: the address sanitizer reports its use.
    static void forbid([[maybe_unused]] const void* start, [[maybe_unused]] int64_t bytes) {
#if defined(VOREL_ADDRESS_SANITIZER)
        __asan_poison_memory_region(start, static_cast<size_t>(bytes));
#endif
    }

    PixelBuffer<uint8_t> mBytes;
};

}  // namespace VFontEffect::internal
