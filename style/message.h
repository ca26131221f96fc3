#pragma once

#include <string>
#include <string_view>

/// How names and the bytes of others stand in a message.
namespace vorelstyle {

/// The names as a list: "left, center, right".
template <typename Names>
std::string joined(const Names& names) {
    std::string text;
    for (const std::string_view name : names)
        text.append(text.empty() ? "" : ", ").append(name);
    return text;
}

/// The text with control characters replaced by blanks: it stays on one line, whatever bytes a file name
/// or a message brings along.
std::string printable(std::string text);

/// What a fault of the style of this name begins with: "style 'NAME': ", nothing without a name.
std::string faultPrefix(std::string_view name);

}  // namespace vorelstyle
