#pragma once

#include <cstddef>
#include <cstdint>

#include "core/inline.h"
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

/// The address sanitizer reports a use of bytes that are forbidden. Elsewhere nothing is done, and what
/// is handed out has no fence behind it.
#if defined(VOREL_ADDRESS_SANITIZER)
constexpr int64_t kFenceBytes = 64;
inline void forbidUse(const void* start, int64_t bytes) {
    __asan_poison_memory_region(start, static_cast<size_t>(bytes));
}
inline void allowUse(const void* start, int64_t bytes) {
    __asan_unpoison_memory_region(start, static_cast<size_t>(bytes));
}
#else
constexpr int64_t kFenceBytes = 0;
VOREL_INLINE void forbidUse(const void* /*start*/, int64_t /*bytes*/) {}
VOREL_INLINE void allowUse(const void* /*start*/, int64_t /*bytes*/) {}
#endif

/// Working memory of bytes, aligned to a cache line, so that no vector at a multiple of its own size
/// straddles two lines. Empty when memory ran out.
class LineBuffer {
  public:
    explicit LineBuffer(int64_t width, int64_t height = 1)
        : mBytes(PixelBuffer<uint8_t>::uninitialised(width * height + kLineBytes)) {
        if (!mBytes) return;
        const int64_t before = data() - mBytes.data();
        // The padding is there for alignment only.
        forbidUse(mBytes.data(), before);
        forbidUse(data() + width * height, kLineBytes - before);
    }

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
