#include <cstddef>
#include <cstdlib>
#include <new>

// What C++ asks of its library to throw and to catch. The packaged library of C++ for WebAssembly has
// none of it, and ends the program where memory runs out; the C face is to tell its caller instead.
//
// The face throws for want of memory alone and catches all with `catch (...)`: so one exception is under
// way at a time, its place is set aside from the start, and its type is never asked for.

namespace {

/// Destructors return the object on WebAssembly.
using Destructor = void* (*)(void*);

constexpr std::size_t kLargestException = 64;
alignas(std::max_align_t) unsigned char exceptionUnderWay[kLargestException];
Destructor destructorOfIt = nullptr;

void* allocatedOrNull(std::size_t bytes) {
    return std::malloc(bytes == 0 ? 1 : bytes);
}

void* allocated(std::size_t bytes) {
    void* const block = allocatedOrNull(bytes);
    if (block == nullptr) throw std::bad_alloc();
    return block;
}

}  // namespace

extern "C" {

void* __cxa_allocate_exception(std::size_t bytes) noexcept {
    if (bytes > kLargestException) std::abort();
    return exceptionUnderWay;
}

void __cxa_free_exception(void* /*exception*/) noexcept {}

[[noreturn]] void __cxa_throw(void* exception, void* /*type*/, Destructor destructor) {
    constexpr int kTagOfCxx = 0;
    destructorOfIt = destructor;
    __builtin_wasm_throw(kTagOfCxx, exception);
}

void* __cxa_begin_catch(void* exception) noexcept {
    return exception;
}

void __cxa_end_catch() {
    if (destructorOfIt != nullptr) destructorOfIt(exceptionUnderWay);
    destructorOfIt = nullptr;
}

}  // extern "C"

// In the place of the packaged ones, which end the program.
void* operator new(std::size_t bytes) {
    return allocated(bytes);
}
void* operator new[](std::size_t bytes) {
    return allocated(bytes);
}
void* operator new(std::size_t bytes, const std::nothrow_t& /*tag*/) noexcept {
    return allocatedOrNull(bytes);
}
void* operator new[](std::size_t bytes, const std::nothrow_t& /*tag*/) noexcept {
    return allocatedOrNull(bytes);
}
