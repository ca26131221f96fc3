#pragma once

#include <string_view>

namespace vorelpaint {

constexpr std::string_view kBlanks = " \t";

/// Without the blanks and tabs at its ends.
inline std::string_view trimmed(std::string_view text) {
    const size_t begin = text.find_first_not_of(kBlanks);
    if (begin == std::string_view::npos) return {};
    return text.substr(begin, text.find_last_not_of(kBlanks) + 1 - begin);
}

}  // namespace vorelpaint
