#pragma once

#include <cstdint>

#include "core/inline.h"
#include "core/line_buffer.h"
#include "core/numeric.h"

namespace VFontEffect::internal {

constexpr int64_t kArenaAlignment = 64;

/// Hands out working memory, which is aligned; without any it only counts. So a layout is written once,
/// for its size and for its places.
struct Arena {
    uint8_t* memory;
    int64_t used = 0;

    template <class T>
    VOREL_INLINE T* take(int64_t count) {
        static_assert(alignof(T) <= kArenaAlignment, "all that is handed out is aligned for its type");
        const int64_t bytes = count * static_cast<int64_t>(sizeof(T));
        const int64_t end = roundedUp(bytes + kFenceBytes, kArenaAlignment);
        uint8_t* const taken = memory == nullptr ? nullptr : memory + used;
        if (taken != nullptr) {
            allowUse(taken, bytes);
            forbidUse(taken + bytes, end - bytes);
        }
        used += end;
        return reinterpret_cast<T*>(taken);
    }
};

}  // namespace VFontEffect::internal
