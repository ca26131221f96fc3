#include "text/utf8.h"

#include <cstddef>
#include <string>

#include "text/error.h"

namespace voreltext {
namespace {

struct Sequence {
    size_t length;
    uint32_t firstBits;  ///< payload of the first byte
    uint32_t least;      ///< smallest code point that needs this length
};

/// Length 0 for a byte that starts no sequence.
Sequence sequenceOf(uint8_t first) {
    if (first < 0x80) return {1, first, 0};
    if ((first & 0xE0) == 0xC0) return {2, first & 0x1FU, 0x80};
    if ((first & 0xF0) == 0xE0) return {3, first & 0x0FU, 0x800};
    if ((first & 0xF8) == 0xF0) return {4, first & 0x07U, 0x10000};
    return {0, 0, 0};
}

bool isCharacter(uint32_t code) {
    return code <= 0x10FFFF && (code < 0xD800 || code > 0xDFFF);
}

[[noreturn]] void fail(size_t at) {
    throw TextError("the text is not valid UTF-8 at byte " + std::to_string(at + 1));
}

}  // namespace

std::vector<uint32_t> decodeUtf8(std::string_view text) {
    std::vector<uint32_t> codes;
    codes.reserve(text.size());
    for (size_t at = 0; at < text.size();) {
        const Sequence sequence = sequenceOf(static_cast<uint8_t>(text[at]));
        if (sequence.length == 0 || sequence.length > text.size() - at) fail(at);
        uint32_t code = sequence.firstBits;
        for (size_t i = 1; i < sequence.length; ++i) {
            const auto next = static_cast<uint8_t>(text[at + i]);
            if ((next & 0xC0) != 0x80) fail(at);
            code = (code << 6) | (next & 0x3FU);
        }
        if (code < sequence.least || !isCharacter(code)) fail(at);
        codes.push_back(code);
        at += sequence.length;
    }
    return codes;
}

}  // namespace voreltext
