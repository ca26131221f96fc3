#pragma once

#include <array>
#include <charconv>
#include <string>

namespace vorelunicode {

/// A number as messages show it, with a point in every locale and six digits at most: "0.5", "900".
inline std::string decimal(double number) {
    constexpr int kDigits = 6;
    std::array<char, 32> text{};
    const auto [end, error] = std::to_chars(text.data(), text.data() + text.size(), number,
                                            std::chars_format::general, kDigits);
    return {text.data(), end};
}

}  // namespace vorelunicode
