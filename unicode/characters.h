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
/// which are letters, and the controls of shorthand are left out.
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

/// Emoji_Presentation: shown in colours where nothing else is asked for.
constexpr bool isPictureByDefault(uint32_t code) {
    constexpr CodeRange kRanges[]{
        {0x231A, 0x231B},   {0x23E9, 0x23EC},   {0x23F0, 0x23F0},   {0x23F3, 0x23F3},
        {0x25FD, 0x25FE},   {0x2614, 0x2615},   {0x2648, 0x2653},   {0x267F, 0x267F},
        {0x2693, 0x2693},   {0x26A1, 0x26A1},   {0x26AA, 0x26AB},   {0x26BD, 0x26BE},
        {0x26C4, 0x26C5},   {0x26CE, 0x26CE},   {0x26D4, 0x26D4},   {0x26EA, 0x26EA},
        {0x26F2, 0x26F3},   {0x26F5, 0x26F5},   {0x26FA, 0x26FA},   {0x26FD, 0x26FD},
        {0x2705, 0x2705},   {0x270A, 0x270B},   {0x2728, 0x2728},   {0x274C, 0x274C},
        {0x274E, 0x274E},   {0x2753, 0x2755},   {0x2757, 0x2757},   {0x2795, 0x2797},
        {0x27B0, 0x27B0},   {0x27BF, 0x27BF},   {0x2B1B, 0x2B1C},   {0x2B50, 0x2B50},
        {0x2B55, 0x2B55},   {0x1F004, 0x1F004}, {0x1F0CF, 0x1F0CF}, {0x1F18E, 0x1F18E},
        {0x1F191, 0x1F19A}, {0x1F1E6, 0x1F1FF}, {0x1F201, 0x1F201}, {0x1F21A, 0x1F21A},
        {0x1F22F, 0x1F22F}, {0x1F232, 0x1F236}, {0x1F238, 0x1F23A}, {0x1F250, 0x1F251},
        {0x1F300, 0x1F320}, {0x1F32D, 0x1F335}, {0x1F337, 0x1F37C}, {0x1F37E, 0x1F393},
        {0x1F3A0, 0x1F3CA}, {0x1F3CF, 0x1F3D3}, {0x1F3E0, 0x1F3F0}, {0x1F3F4, 0x1F3F4},
        {0x1F3F8, 0x1F43E}, {0x1F440, 0x1F440}, {0x1F442, 0x1F4FC}, {0x1F4FF, 0x1F53D},
        {0x1F54B, 0x1F54E}, {0x1F550, 0x1F567}, {0x1F57A, 0x1F57A}, {0x1F595, 0x1F596},
        {0x1F5A4, 0x1F5A4}, {0x1F5FB, 0x1F64F}, {0x1F680, 0x1F6C5}, {0x1F6CC, 0x1F6CC},
        {0x1F6D0, 0x1F6D2}, {0x1F6D5, 0x1F6D7}, {0x1F6DC, 0x1F6DF}, {0x1F6EB, 0x1F6EC},
        {0x1F6F4, 0x1F6FC}, {0x1F7E0, 0x1F7EB}, {0x1F7F0, 0x1F7F0}, {0x1F90C, 0x1F93A},
        {0x1F93C, 0x1F945}, {0x1F947, 0x1F9FF}, {0x1FA70, 0x1FA7C}, {0x1FA80, 0x1FA88},
        {0x1FA90, 0x1FABD}, {0x1FABF, 0x1FAC5}, {0x1FACE, 0x1FADB}, {0x1FAE0, 0x1FAE8},
        {0x1FAF0, 0x1FAF8},
    };
    return isIn(code, kRanges);
}

}  // namespace vorelunicode
