#include "text/line_breaks.h"

#include <linebreak.h>

#include "unicode/characters.h"

namespace voreltext {
namespace {

/// The character in whose stead libunibreak is asked, which has not met all of them: pictographs that
/// are younger than its tables, and flags, break like ideographs, a tone of skin goes with what is
/// before it as a mark does, and U+FFFF, by which it knows the end of a text, is nobody's letter.
uint32_t knownOf(uint32_t code) {
    constexpr uint32_t kLetter = 'A';
    constexpr uint32_t kMark = 0x300;
    constexpr uint32_t kIdeograph = 0x4E00;
    constexpr uint32_t kFirstPictograph = 0x1F000;
    if (code == 0xFFFF || code > 0x10FFFF) return kLetter;
    if (vorelunicode::isSkinTone(code)) return kMark;
    return code >= kFirstPictograph && vorelunicode::isSymbol(code) ? kIdeograph : code;
}

}  // namespace

std::vector<bool> lineBreaks(const std::vector<uint32_t>& codes) {
    static const bool kIsReady = (init_linebreak(), true);
    std::vector<utf32_t> known;
    known.reserve(codes.size());
    for (const uint32_t code : codes)
        known.push_back(knownOf(code));
    std::vector<char> breaks(codes.size(), LINEBREAK_NOBREAK);
    if (kIsReady && !known.empty()) {
        set_linebreaks_utf32(known.data(), known.size(), nullptr, breaks.data());
    }
    std::vector<bool> allowed;
    allowed.reserve(codes.size());
    for (size_t i = 0; i < codes.size(); ++i) {
        const bool joins = codes[i] == vorelunicode::kZeroWidthJoiner;
        allowed.push_back(i + 1 == codes.size() || (breaks[i] == LINEBREAK_ALLOWBREAK && !joins));
    }
    return allowed;
}

}  // namespace voreltext
