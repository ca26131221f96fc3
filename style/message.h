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

/// The text as it can be shown: it stays on one line, in the order in which it is read, whatever bytes a
/// file name or a message brings along. Control characters of ASCII become blanks; all others, and those
/// that break lines or change their direction, become "<U+202E>"; a byte that is not UTF-8 "<FF>".
std::string printable(std::string_view text);

/// What a fault of the style of this name begins with: "style 'NAME': ", nothing without a name.
std::string faultPrefix(std::string_view name);

}  // namespace vorelstyle
