#include "allocation_watch.h"

#include <malloc.h>

#include <atomic>
#include <cerrno>
#include <cstddef>
#include <cstdlib>
#include <new>

#include "build_kind.h"

// The allocator beneath: a sanitizer's own, else the C library's. A library's call to malloc finds the
// function of the program first, so defining it here is enough to see every request. clang links a
// sanitizer into the program, where its allocator can be stood before; g++ loads it as a library, which
// needs malloc for itself before it is ready.
#if VOREL_TEST_SANITIZED && defined(__clang__)
#define VOREL_RAW(name) __interceptor_##name
#elif !VOREL_TEST_SANITIZED && defined(__GLIBC__)
#define VOREL_RAW(name) __libc_##name
#endif

namespace {

constexpr long kNever = -1;

std::atomic<long> gLive{0};
std::atomic<long> gBytes{0};
std::atomic<long> gPeakBytes{0};
std::atomic<long> gRequests{0};
std::atomic<long> gFirstRefused{kNever};
std::atomic<bool> gRefuseOn{false};
std::atomic<bool> gObjectsRefused{false};

}  // namespace

namespace vorel_test {

long liveBlocks() {
    return gLive;
}

PeakMemory::PeakMemory() : mBefore(gBytes) {
    gPeakBytes = mBefore;
}

long PeakMemory::bytes() const {
    return gPeakBytes - mBefore;
}

RefusedMemory::RefusedMemory(long first, Refusal refusal) {
    gRequests = 0;
    gRefuseOn = refusal == Refusal::kFromThenOn;
    gFirstRefused = first;
}

RefusedMemory::~RefusedMemory() {
    gFirstRefused = kNever;
}

long RefusedMemory::requests() {
    return gRequests;
}

RefusedObjects::RefusedObjects() {
    gObjectsRefused = true;
}

RefusedObjects::~RefusedObjects() {
    gObjectsRefused = false;
}

bool RefusedMemory::refused() {
    return gFirstRefused > 0 && gRequests >= gFirstRefused;
}

}  // namespace vorel_test

#ifndef VOREL_RAW

bool vorel_test::canWatchMemory() {
    return false;
}

#else

bool vorel_test::canWatchMemory() {
    return true;
}

extern "C" {
void* VOREL_RAW(malloc)(size_t size) noexcept;
void* VOREL_RAW(calloc)(size_t count, size_t size) noexcept;
void* VOREL_RAW(realloc)(void* block, size_t size) noexcept;
void* VOREL_RAW(memalign)(size_t alignment, size_t size) noexcept;
void VOREL_RAW(free)(void* block) noexcept;
}

namespace {

/// Counts a request that may fail and tells whether it must.
bool refuses() {
    const long first = gFirstRefused;
    if (first == kNever) return false;
    const long number = ++gRequests;
    return gRefuseOn ? first > 0 && number >= first : number == first;
}

/// A sanitizer cannot be asked before it is ready, but hands out memory: there all sizes count as 0.
long sizeOf(void* block) {
    return VOREL_TEST_SANITIZED ? 0 : static_cast<long>(malloc_usable_size(block));
}

void* counted(void* block) {
    if (block == nullptr) return block;
    ++gLive;
    const long bytes = gBytes += sizeOf(block);
    if (bytes > gPeakBytes) gPeakBytes = bytes;
    return block;
}

void forget(void* block) {
    if (block == nullptr) return;
    --gLive;
    gBytes -= sizeOf(block);
}

void release(void* block) {
    forget(block);
    VOREL_RAW(free)(block);
}

void* objectMemory(size_t size) {
    return counted(VOREL_RAW(malloc)(size > 0 ? size : 1));
}

void* objectMemoryOrThrow(size_t size) {
    void* const block = gObjectsRefused ? nullptr : objectMemory(size);
    if (block == nullptr) throw std::bad_alloc();
    return block;
}

}  // namespace

extern "C" {

void* malloc(size_t size) noexcept {
    return refuses() ? nullptr : counted(VOREL_RAW(malloc)(size));
}
void* calloc(size_t count, size_t size) noexcept {
    return refuses() ? nullptr : counted(VOREL_RAW(calloc)(count, size));
}
void* realloc(void* block, size_t size) noexcept {
    if (refuses()) return nullptr;
    const long before = block != nullptr ? sizeOf(block) : 0;
    void* const moved = VOREL_RAW(realloc)(block, size);
    if (moved == nullptr && size > 0) return nullptr;
    if (block != nullptr) --gLive;
    gBytes -= before;
    return counted(moved);
}
/// What a C++ runtime may keep exceptions in; not refused.
int posix_memalign(void** block, size_t alignment, size_t size) noexcept {
    void* const made = counted(VOREL_RAW(memalign)(alignment, size));
    if (made == nullptr) return ENOMEM;
    *block = made;
    return 0;
}
void free(void* block) noexcept {
    release(block);
}

}  // extern "C"

void* operator new(size_t size) {
    return objectMemoryOrThrow(size);
}
void* operator new[](size_t size) {
    return objectMemoryOrThrow(size);
}
void* operator new(size_t size, const std::nothrow_t&) noexcept {
    return refuses() ? nullptr : objectMemory(size);
}
void* operator new[](size_t size, const std::nothrow_t&) noexcept {
    return refuses() ? nullptr : objectMemory(size);
}
void operator delete(void* block) noexcept {
    release(block);
}
void operator delete[](void* block) noexcept {
    release(block);
}
void operator delete(void* block, size_t) noexcept {
    release(block);
}
void operator delete[](void* block, size_t) noexcept {
    release(block);
}
void operator delete(void* block, const std::nothrow_t&) noexcept {
    release(block);
}
void operator delete[](void* block, const std::nothrow_t&) noexcept {
    release(block);
}

#endif
