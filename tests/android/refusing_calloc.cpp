#include <cstddef>

/// Loaded before everything else, this refuses the layers of two sizes that only the tests of refused
/// memory paint: the mask of 211 x 199 pixels, the outer layer of 197 x 223.

extern "C" {
void* __libc_calloc(size_t count, size_t size) noexcept;
void* calloc(size_t count, size_t size) noexcept;
}

void* calloc(size_t count, size_t size) noexcept {
    constexpr size_t kRefused[] = {size_t{211} * 199, size_t{197} * 223 * 4};
    for (const size_t bytes : kRefused) {
        if (count * size == bytes) return nullptr;
    }
    return __libc_calloc(count, size);
}
