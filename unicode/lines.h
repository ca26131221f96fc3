#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace vorelunicode {

/// Line feed, carriage return, next line, line separator and paragraph separator.
inline bool endsLine(uint32_t code) {
    return code == '\n' || code == '\r' || code == 0x85 || code == 0x2028 || code == 0x2029;
}

/// Whether the character at a place of the text is the second of CR LF, which end one line together.
inline bool isSecondOfLineEnd(const std::vector<uint32_t>& text, size_t at) {
    return text[at] == '\n' && at > 0 && text[at - 1] == '\r';
}

/// "line 2, character 5": a place in a text as an editor counts it, from 1 and in code points.
inline std::string placeName(const std::vector<uint32_t>& text, size_t at) {
    size_t line = 1;
    size_t character = 1;
    for (size_t i = 0; i < at; ++i) {
        ++character;
        if (!endsLine(text[i])) continue;
        if (!isSecondOfLineEnd(text, i)) ++line;
        character = 1;
    }
    return "line " + std::to_string(line) + ", character " + std::to_string(character);
}

}  // namespace vorelunicode
