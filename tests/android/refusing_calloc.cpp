#include <cstddef>
#include <cstdlib>
#include <new>
#include <utility>

/// Loaded before everything else, this refuses the layers of two sizes that only the tests of refused
/// memory paint: the mask of 211 x 199 pixels, the outer layer of 197 x 223. And once, after a pattern
/// of 1009 pixels, an object of thirteen pointers: a look's list, which has room for each type of
/// effect.

namespace {

thread_local bool gRefusesList = false;

}  // namespace

extern "C" {
void* __libc_calloc(size_t count, size_t size) noexcept;
void* calloc(size_t count, size_t size) noexcept;
}

void* calloc(size_t count, size_t size) noexcept {
    constexpr size_t kRefused[] = {size_t{211} * 199, size_t{197} * 223 * 4};
    for (const size_t bytes : kRefused) {
        if (count * size == bytes) return nullptr;
    }
    if (count * size == size_t{1009} * 4) gRefusesList = true;
    return __libc_calloc(count, size);
}

void* operator new(size_t size) {
    const bool refused = size == 13 * sizeof(void*) && std::exchange(gRefusesList, false);
    void* const block = refused ? nullptr : std::malloc(size);
    if (block == nullptr) throw std::bad_alloc();
    return block;
}
