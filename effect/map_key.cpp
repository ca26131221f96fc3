#include <cstddef>
#include <new>

#include "voreleffect/VFEffect.h"

namespace VFontEffect {
namespace {

/// A key that reserves more than this comes from records whose stop counts are not what they claim.
constexpr std::size_t kLargestKey = std::size_t{1} << 28;

}  // namespace

// Deliberate: fragments follow the list, whose order planning changes; they are not sorted.
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
