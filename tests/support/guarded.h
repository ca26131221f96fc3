#pragma once

#if !defined(__wasm__)
#include <sys/mman.h>
#include <unistd.h>
#endif

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>

#include "voreleffect/VFBitmap.h"

/// Buffers between inaccessible pages: an operation that reads or writes one byte too far stops the
/// test.
namespace vorel_test {

/// Which end of the buffer touches an inaccessible page.
enum class Edge { kEnd, kStart };

#if defined(__wasm__)

/// Where no page can be forbidden: `size` zero bytes between bytes that must be as they were at its end.
/// So a write one byte too far stops the test, a read does not.
class GuardedBuffer {
  public:
    explicit GuardedBuffer(size_t size, Edge /*edge*/ = Edge::kEnd)
        : mSize(size), mBytes(new uint8_t[size + 2 * kGuard]) {
        std::fill(mBytes.get(), end() + kGuard, kUntouched);
        std::fill(begin(), end(), uint8_t{0});
    }
    ~GuardedBuffer() {
        const auto touched = [](uint8_t byte) { return byte != kUntouched; };
        if (std::any_of(mBytes.get(), begin(), touched)) abort();
        if (std::any_of(end(), end() + kGuard, touched)) abort();
    }
    GuardedBuffer(const GuardedBuffer&) = delete;
    GuardedBuffer& operator=(const GuardedBuffer&) = delete;

    uint8_t* data() const { return begin(); }
    uint8_t* begin() const { return mBytes.get() + kGuard; }
    uint8_t* end() const { return begin() + mSize; }
    size_t size() const { return mSize; }

  private:
    static constexpr size_t kGuard = 4096;
    static constexpr uint8_t kUntouched = 0xA5;

    size_t mSize;
    std::unique_ptr<uint8_t[]> mBytes;
};

#else

/// `size` zero bytes that end exactly at an inaccessible page, or start exactly behind one.
class GuardedBuffer {
  public:
    explicit GuardedBuffer(size_t size, Edge edge = Edge::kEnd) : mSize(size) {
        const auto page = static_cast<size_t>(sysconf(_SC_PAGESIZE));
        const size_t usable = (size + page - 1) / page * page;
        mMappedBytes = usable + 2 * page;
        void* mapped =
            mmap(nullptr, mMappedBytes, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        if (mapped == MAP_FAILED) abort();
        mMapped = static_cast<uint8_t*>(mapped);
        uint8_t* const first = mMapped + page;
        uint8_t* const end = first + usable;
        if (mprotect(mMapped, page, PROT_NONE) != 0 || mprotect(end, page, PROT_NONE) != 0) abort();
        mData = edge == Edge::kEnd ? end - size : first;
    }
    ~GuardedBuffer() { munmap(mMapped, mMappedBytes); }
    GuardedBuffer(const GuardedBuffer&) = delete;
    GuardedBuffer& operator=(const GuardedBuffer&) = delete;

    uint8_t* data() const { return mData; }
    uint8_t* begin() const { return mData; }
    uint8_t* end() const { return mData + mSize; }
    size_t size() const { return mSize; }

  private:
    size_t mSize;
    size_t mMappedBytes;
    uint8_t* mMapped;
    uint8_t* mData;
};

#endif

/// A VFBitmap whose pixels lie in a guarded buffer while it lives.
class GuardedBitmap {
  public:
    GuardedBitmap(int width, int height, int bytesPerPixel, Edge edge = Edge::kEnd)
        : mBitmap(static_cast<unsigned>(width), static_cast<unsigned>(height),
                  static_cast<unsigned>(bytesPerPixel)),
          mPixels(static_cast<size_t>(width) * static_cast<size_t>(height) *
                      static_cast<size_t>(bytesPerPixel),
                  edge),
          mOwnPixels(mBitmap.mData) {
        mBitmap.mData = mPixels.data();
    }
    ~GuardedBitmap() { mBitmap.mData = mOwnPixels; }
    GuardedBitmap(const GuardedBitmap&) = delete;
    GuardedBitmap& operator=(const GuardedBitmap&) = delete;

    VFontEffect::VFBitmap* bitmap() { return &mBitmap; }
    GuardedBuffer& pixels() { return mPixels; }

  private:
    VFontEffect::VFBitmap mBitmap;
    GuardedBuffer mPixels;
    unsigned char* mOwnPixels;
};

}  // namespace vorel_test
