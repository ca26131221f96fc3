#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <utility>

namespace VFontEffect::internal {

/// Working memory of one call: a move-only array over malloc, empty when memory ran out.
template <class T>
class [[nodiscard]] PixelBuffer {
  public:
    static PixelBuffer zeroed(int64_t width, int64_t height = 1) { return make(width, height, true); }
    static PixelBuffer uninitialised(int64_t width, int64_t height = 1) {
        return make(width, height, false);
    }

    /// Takes over a block from malloc.
    explicit PixelBuffer(T* block) : mData(block) {}

    PixelBuffer(PixelBuffer&& other) noexcept : mData(std::exchange(other.mData, nullptr)) {}
    PixelBuffer& operator=(PixelBuffer&&) = delete;
    ~PixelBuffer() { release(); }

    explicit operator bool() const { return mData != nullptr; }
    void release() { std::free(std::exchange(mData, nullptr)); }
    T* data() { return mData; }
    const T* data() const { return mData; }
    T& operator[](size_t i) { return mData[i]; }

  private:
    /// A larger request fails, and so do all beyond what pointers span, half of a 32-bit address space.
    /// No effect comes near it, whatever its picture: see core/windows.h.
    static constexpr uint64_t kMostBytes = std::min<uint64_t>(uint64_t{1} << 32, PTRDIFF_MAX);

    static PixelBuffer make(int64_t width, int64_t height, bool clear) {
        if (width < 0 || height < 0) return PixelBuffer(nullptr);
        const auto columns = static_cast<uint64_t>(width);
        const auto rows = static_cast<uint64_t>(height);
        if (rows != 0 && columns > kMostBytes / sizeof(T) / rows) return PixelBuffer(nullptr);
        // A buffer without elements asks malloc for one, so that null always means failure.
        const size_t count = static_cast<size_t>(columns * rows > 0 ? columns * rows : 1);
        return PixelBuffer(
            static_cast<T*>(clear ? std::calloc(count, sizeof(T)) : std::malloc(count * sizeof(T))));
    }

    T* mData;
};

}  // namespace VFontEffect::internal
