#pragma once

#include <cstddef>
#include <cstdint>

/// What the character is, as far as setting a text asks for it. From the Unicode Character Database.
namespace vorelunicode {

struct CodeRange {
    uint32_t first;
    uint32_t last;
};

template <size_t kCount>
constexpr bool isIn(uint32_t code, const CodeRange (&ranges)[kCount]) {
    for (const CodeRange& range : ranges) {
        if (code >= range.first && code <= range.last) return true;
    }
    return false;
}

constexpr uint32_t kSoftHyphen = 0xAD;
constexpr uint32_t kZeroWidthJoiner = 0x200D;
constexpr uint32_t kTextPresentation = 0xFE0E;     ///< behind a character: without colours
constexpr uint32_t kPicturePresentation = 0xFE0F;  ///< behind a character: in colours

/// Default_Ignorable_Code_Point: nothing is shown where a font does not know it. The fillers of Hangul,
/// which are letters, and the vowels inherent to Khmer are left out.
constexpr bool isDefaultIgnorable(uint32_t code) {
    constexpr CodeRange kRanges[]{
        {0xAD, 0xAD},     {0x34F, 0x34F},   {0x61C, 0x61C},     {0x180B, 0x180F},
        {0x200B, 0x200F}, {0x202A, 0x202E}, {0x2060, 0x206F},   {0xFE00, 0xFE0F},
        {0xFEFF, 0xFEFF}, {0xFFF0, 0xFFF8}, {0x1D173, 0x1D17A}, {0xE0000, 0xE0FFF},
    };
    return isIn(code, kRanges);
}

/// Space_Separator without those that allow no line end, and the tab: what separates words.
constexpr bool isBlank(uint32_t code) {
    constexpr CodeRange kRanges[]{{'\t', '\t'},     {' ', ' '},       {0x1680, 0x1680}, {0x2000, 0x2006},
                                  {0x2008, 0x200A}, {0x205F, 0x205F}, {0x3000, 0x3000}};
    return isIn(code, kRanges);
}

/// The ends of a source line: LF, CR, next line, line and paragraph separator.
constexpr bool isLineEnd(uint32_t code) {
    return code == '\n' || code == '\r' || code == 0x85 || code == 0x2028 || code == 0x2029;
}

/// The five tones of skin, which belong to the pictograph before.
constexpr bool isSkinTone(uint32_t code) {
    return code >= 0x1F3FB && code <= 0x1F3FF;
}

/// The letters of which two are a flag.
constexpr bool isRegionalIndicator(uint32_t code) {
    return code >= 0x1F1E6 && code <= 0x1F1FF;
}

/// The symbols among which all pictographs are; no letters.
constexpr bool isSymbol(uint32_t code) {
    constexpr CodeRange kRanges[]{{0x2190, 0x2BFF}, {0x1F000, 0x1FAFF}};
    return isIn(code, kRanges);
}

}  // namespace vorelunicode
