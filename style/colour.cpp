#include "style/colour.h"

#include <charconv>

namespace vorelstyle {

std::optional<uint32_t> parseColour(std::string_view text) {
    if ((text.size() != 7 && text.size() != 4) || text.front() != '#') return std::nullopt;
    uint32_t colour = 0;
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data() + 1, end, colour, 16);
    if (error != std::errc{} || stop != end) return std::nullopt;
    if (text.size() == 7) return colour;
    constexpr uint32_t kTwice = 0x11;
    return (colour >> 8) * kTwice << 16 | (colour >> 4 & 0xF) * kTwice << 8 | (colour & 0xF) * kTwice;
}

}  // namespace vorelstyle
