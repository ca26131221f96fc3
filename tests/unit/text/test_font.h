#pragma once

#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "text/error.h"
#include "text/text_layout.h"
#include "text/utf8.h"

/// Installed fonts, of Debian's packages.
namespace vorel_test {

constexpr const char* kArabicFont = VOREL_FONTS "/opentype/fonts-hosny-amiri/Amiri-Regular.ttf";
constexpr const char* kLayeredFont = VOREL_FONTS "/opentype/fonts-hosny-amiri/AmiriQuranColored.ttf";
constexpr const char* kHebrewFont = VOREL_FONTS "/truetype/culmus/FrankRuehlCLM-Medium.ttf";
constexpr const char* kDevanagariFont = VOREL_FONTS "/truetype/lohit-devanagari/Lohit-Devanagari.ttf";
constexpr const char* kThaiFont = VOREL_FONTS "/truetype/tlwg/Loma.ttf";
constexpr const char* kJapaneseFont = VOREL_FONTS "/truetype/vlgothic/VL-PGothic-Regular.ttf";
constexpr const char* kKoreanFont = VOREL_FONTS "/truetype/alee/Bandal.ttf";
constexpr const char* kEmojiFont = VOREL_FONTS "/truetype/noto/NotoColorEmoji.ttf";
constexpr const char* kVariableFont = VOREL_FONTS "/truetype/inter-vf/Inter-roman.var.ttf";

/// The bytes of the font of the tests.
inline std::string testFontBytes() {
    std::ifstream file(VOREL_TEST_FONT, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

/// What the refusal of a call says; empty when it is none.
template <typename Call>
std::string faultOf(Call call) {
    try {
        call();
        return "";
    } catch (const voreltext::TextError& error) {
        return error.what();
    }
}

/// A box as one value: left, top, right, bottom.
inline std::vector<int> edges(const voreltext::Box& box) {
    return {box.left, box.top, box.right, box.bottom};
}

}  // namespace vorel_test
