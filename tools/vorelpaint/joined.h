#pragma once

#include <string>
#include <string_view>

namespace vorelpaint {

/// The names as a message lists them: "left, center, right".
template <typename Names>
std::string joined(const Names& names) {
    std::string text;
    for (const std::string_view name : names)
        text.append(text.empty() ? "" : ", ").append(name);
    return text;
}

}  // namespace vorelpaint
