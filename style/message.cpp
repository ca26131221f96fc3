#include "style/message.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>

#include "unicode/utf8.h"

namespace vorelstyle {
namespace {

/// Whether a character without ink breaks the line that it stands in or changes the order in which it is
/// read: line and paragraph separator, the marks, embeddings, overrides and isolates of direction.
bool ordersLines(uint32_t code) {
    return code == 0x061C || code == 0x200E || code == 0x200F || (code >= 0x2028 && code <= 0x202E) ||
           (code >= 0x2066 && code <= 0x2069);
}

std::string inHexadecimal(char byte) {
    std::array<char, 4> text{};
    std::snprintf(text.data(), text.size(), "%02X",
                  static_cast<unsigned int>(static_cast<uint8_t>(byte)));
    return text.data();
}

}  // namespace

std::string printable(std::string_view text) {
    std::string safe;
    for (size_t at = 0; at < text.size();) {
        const auto [code, length] = vorelunicode::decodeAt(text, at);
        if (length == 0) {
            safe += "<" + inHexadecimal(text[at]) + ">";
        } else if (code < 0x20 || code == 0x7F) {
            safe += ' ';
        } else if (vorelunicode::isControl(code) || ordersLines(code)) {
            safe += "<" + vorelunicode::nameOf(code) + ">";
        } else {
            safe += text.substr(at, length);
        }
        at += std::max<size_t>(length, 1);
    }
    return safe;
}

std::string faultPrefix(std::string_view name) {
    return name.empty() ? "" : "style '" + std::string(name) + "': ";
}

}  // namespace vorelstyle
