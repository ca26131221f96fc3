#include <cstddef>
#include <cstdint>
#include <new>

#include "voreleffect/VFEffect.h"

namespace VFontEffect {
namespace {

/// Bytes. Only records with absurd stop counts reserve more; there is no key then.
constexpr int64_t kLargestKey = int64_t{1} << 28;

}  // namespace

// Deliberate: the fragments follow the list, which initEffect reorders; they are not sorted.
char* VFEffect::getMapKey() {
    int64_t reserved = 0;
    for (VFECore* core : mEffects) {
        if (VFProperty* record = core->getProperty()) reserved += record->getSequentialCharLength();
    }
    if (reserved < 0 || reserved > kLargestKey) return nullptr;
    // Zeroed, because some records write less than they reserve: equal looks give equal keys to the
    // last byte, and a set that writes nothing gives an empty string.
    char* key = new (std::nothrow) char[static_cast<std::size_t>(reserved) + 1]();
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
