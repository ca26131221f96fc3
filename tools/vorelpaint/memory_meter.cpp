#include "memory_meter.h"

#include <malloc.h>

#include <algorithm>
#include <cstdlib>

// A library's call to malloc finds the function of the program first, so defining it here is enough to
// see every request. Sanitizers have an allocator of their own, which has to stay.
#if defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer) || \
    __has_feature(memory_sanitizer)
#define VORELPAINT_SANITIZED
#endif
#endif
#if defined(__GLIBC__) && !defined(__SANITIZE_ADDRESS__) && !defined(__SANITIZE_THREAD__) && \
    !defined(VORELPAINT_SANITIZED)
#define VORELPAINT_COUNTS_MEMORY
#endif

namespace {

bool gCounting = false;
std::ptrdiff_t gInUse = 0;  ///< less than 0 after blocks from before the start were given back
std::ptrdiff_t gPeak = 0;

}  // namespace

namespace vorelpaint {

MemoryMeter::MemoryMeter() {
    gInUse = 0;
    gPeak = 0;
    gCounting = true;
}

MemoryMeter::~MemoryMeter() {
    gCounting = false;
}

size_t MemoryMeter::peak() const {
    return static_cast<size_t>(gPeak);
}

bool MemoryMeter::works() {
#ifdef VORELPAINT_COUNTS_MEMORY
    return true;
#else
    return false;
#endif
}

}  // namespace vorelpaint

#ifdef VORELPAINT_COUNTS_MEMORY

extern "C" {

// The C library's own allocator, beneath the functions that are defined here.
// NOLINTBEGIN(readability-identifier-naming)
void* __libc_malloc(size_t size) noexcept;
void* __libc_calloc(size_t count, size_t size) noexcept;
void* __libc_realloc(void* block, size_t size) noexcept;
void __libc_free(void* block) noexcept;
// NOLINTEND(readability-identifier-naming)

}  // extern "C"

namespace {

std::ptrdiff_t sizeOf(void* block) {
    return static_cast<std::ptrdiff_t>(::malloc_usable_size(block));
}

void* handedOut(void* block) {
    if (gCounting) {
        gInUse += sizeOf(block);
        gPeak = std::max(gPeak, gInUse);
    }
    return block;
}

void givenBack(void* block) {
    if (gCounting) gInUse -= sizeOf(block);
}

}  // namespace

extern "C" {

void* malloc(size_t size) noexcept {
    return handedOut(__libc_malloc(size));
}
void* calloc(size_t count, size_t size) noexcept {
    return handedOut(__libc_calloc(count, size));
}
void* realloc(void* block, size_t size) noexcept {
    givenBack(block);
    void* const moved = __libc_realloc(block, size);
    // A block that could not be moved is still in use.
    return moved == nullptr && size > 0 ? (handedOut(block), nullptr) : handedOut(moved);
}
void free(void* block) noexcept {
    givenBack(block);
    __libc_free(block);
}

}  // extern "C"

#endif
