#pragma once

#include <voreleffect/VFEffect.h>

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <limits>
#include <string>
#include <vector>

#include "tests/support/bitmap_bytes.h"
#include "tests/support/fake_core.h"

namespace vorel_test {

constexpr int kOuterShadow = 1;
constexpr int kInnerShadow = 2;
constexpr int kOuterGlow = 3;
constexpr int kInnerGlow = 4;
constexpr int kBevel = 5;
constexpr int kEmboss = 6;
constexpr int kLinearGradient = 7;
constexpr int kRadialGradient = 8;
constexpr int kReserved = 9;
constexpr int kStroke = 10;
constexpr int kPattern = 11;
constexpr int kText = 12;
constexpr int kNone = 13;

/// The types that have a core.
constexpr int kCoreTypes[] = {kOuterShadow,    kInnerShadow, kOuterGlow, kInnerGlow, kLinearGradient,
                              kRadialGradient, kStroke,      kPattern,   kText};

constexpr unsigned int kNoEffect = 0xFFFFFFFFU;
constexpr float kNan = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();

/// A glyph with its own buffer of one coverage value.
class SolidGlyph {
  public:
    SolidGlyph(int width, int height, uint8_t coverage = 255)
        : pixels(static_cast<size_t>(width) * static_cast<size_t>(height), coverage),
          glyph{pixels.data(), static_cast<unsigned short>(width), static_cast<unsigned short>(height)} {
    }
    SolidGlyph(const SolidGlyph&) = delete;
    SolidGlyph& operator=(const SolidGlyph&) = delete;

    std::vector<uint8_t> pixels;
    VFontEffect::VFGlyph glyph;
};

inline void fillBytes(const VFontEffect::VFBitmap& bitmap, uint8_t value) {
    std::memset(bitmap.mData, value, size_t{bitmap.mWidth} * bitmap.mHeight * bitmap.mBytesPerPixel);
}

/// The record of the core of that type, taken as the class that belongs to it.
template <class Record>
const Record& recordOf(VFontEffect::VFEffect& set, int type) {
    return *static_cast<const Record*>(set.getEffect(type)->getProperty());
}

inline std::string takeKey(char* key) {
    std::string text = key;
    delete[] key;
    return text;
}

inline std::string keyOf(VFontEffect::VFEffect& set) {
    return takeKey(set.getMapKey());
}

/// The type letters of the key in list order: the only characters of it below 0x80.
inline std::string orderOf(VFontEffect::VFEffect& set) {
    std::string letters;
    for (const char c : keyOf(set)) {
        if (static_cast<unsigned char>(c) < 0x80) letters += c;
    }
    return letters;
}

/// The order after planning a run.
inline std::string planAndOrder(VFontEffect::VFEffect& set) {
    set.initEffect(4, 4);
    return orderOf(set);
}

/// Whether the set is in layered mode: there, and only there, an emboss is not an under-effect.
inline bool isLayered(VFontEffect::VFEffect& set) {
    FakeCore emboss(kEmboss);
    return !set.isUnderEffect(&emboss);
}

inline std::vector<int> sidesOf(const VFontEffect::VFRect& rect) {
    return {rect.mLeft, rect.mTop, rect.mRight, rect.mBottom};
}

}  // namespace vorel_test
