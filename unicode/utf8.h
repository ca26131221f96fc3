#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <string>
#include <string_view>

/// Code points and their bytes, for the rooms that read text or show it.
namespace vorelunicode {

/// A character of a text in UTF-8.
struct Decoded {
    uint32_t code;
    size_t length;  ///< in bytes; 0 where no well-formed sequence begins
};

/// The character that begins at byte `at`, which must lie within the text.
inline Decoded decodeAt(std::string_view text, size_t at) {
    constexpr Decoded kMalformed{0, 0};
    const auto byteAt = [&](size_t i) { return static_cast<uint8_t>(text[at + i]); };
    const uint32_t first = byteAt(0);
    if (first < 0x80) return {first, 1};
    const size_t length = first < 0xC0 ? 0 : first < 0xE0 ? 2 : first < 0xF0 ? 3 : first < 0xF8 ? 4 : 0;
    if (length == 0 || length > text.size() - at) return kMalformed;
    uint32_t code = first & (0x7FU >> length);
    for (size_t i = 1; i < length; ++i) {
        if ((byteAt(i) & 0xC0) != 0x80) return kMalformed;
        code = (code << 6) | (byteAt(i) & 0x3FU);
    }
    // Of every code point the shortest form alone is well-formed, and surrogates are none.
    constexpr uint32_t kLeast[]{0, 0, 0x80, 0x800, 0x10000};
    const bool surrogate = code >= 0xD800 && code <= 0xDFFF;
    if (code < kLeast[length] || code > 0x10FFFF || surrogate) return kMalformed;
    return {code, length};
}

/// The bytes of a code point in UTF-8.
inline std::string encoded(uint32_t code) {
    const auto part = [&](unsigned int shift) {
        return static_cast<char>(0x80U | ((code >> shift) & 0x3FU));
    };
    if (code < 0x80) return {static_cast<char>(code)};
    if (code < 0x800) return {static_cast<char>(0xC0U | code >> 6), part(0)};
    if (code < 0x10000) return {static_cast<char>(0xE0U | code >> 12), part(6), part(0)};
    return {static_cast<char>(0xF0U | code >> 18), part(12), part(6), part(0)};
}

/// Line feeds and tabs too.
constexpr bool isControl(uint32_t code) {
    return code < 0x20 || (code >= 0x7F && code < 0xA0);
}

/// "U+202E".
inline std::string nameOf(uint32_t code) {
    std::array<char, 16> name{};
    std::snprintf(name.data(), name.size(), "U+%04X", static_cast<unsigned int>(code));
    return name.data();
}

}  // namespace vorelunicode
