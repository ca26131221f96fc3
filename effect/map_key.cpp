#include <cstddef>
#include <new>

#include "voreleffect/VFEffect.h"

namespace VFontEffect {
namespace {

/// Bytes. Only records with absurd stop counts reserve more; there is no key then.
constexpr std::size_t kLargestKey = std::size_t{1} << 28;

}  // namespace

// Deliberate: the fragments follow the list, which initEffect reorders; they are not sorted.
char* VFEffect::getMapKey() {
    std::size_t reserved = 0;
    for (VFECore* core : mEffects) {
        if (VFProperty* record = core->getProperty()) {
            reserved += static_cast<std::size_t>(record->getSequentialCharLength());
        }
    }
    if (reserved > kLargestKey) return nullptr;
    // Zeroed, because some records write less than they reserve: equal looks give equal keys to the
    // last byte, and a set that writes nothing gives an empty string.
    char* key = new (std::nothrow) char[reserved + 1]();
    if (key == nullptr) return nullptr;
    char* cursor = key;
    for (VFECore* core : mEffects) {
        if (VFProperty* record = core->getProperty()) record->toSequentialChar(&cursor);
    }
    return key;
}

char* VFEffect::getMapKey(unsigned int color) {
    mTextColor = color;
    addText(color, mTextOpacity);
    return getMapKey();
}

}  // namespace VFontEffect
