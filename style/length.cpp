#include "style/length.h"

#include <charconv>

namespace vorelstyle {
namespace {

constexpr size_t kMostDecimals = 3;

/// Takes the digits off the front of the text and returns how many there were.
size_t takeDigits(std::string_view& text) {
    size_t count = 0;
    while (count < text.size() && text[count] >= '0' && text[count] <= '9')
        ++count;
    text.remove_prefix(count);
    return count;
}

/// Whether the text is a number of the one spelling, such as -12.5; from_chars knows others, too.
bool isNumeral(std::string_view text) {
    if (!text.empty() && text.front() == '-') text.remove_prefix(1);
    const bool startsWithZero = !text.empty() && text.front() == '0';
    const size_t whole = takeDigits(text);
    if (whole == 0 || (startsWithZero && whole > 1)) return false;
    if (text.empty()) return true;
    if (text.front() != '.') return false;
    text.remove_prefix(1);
    const size_t decimals = takeDigits(text);
    return text.empty() && decimals >= 1 && decimals <= kMostDecimals;
}

/// Takes the suffix off the end of the text, where it stands there.
bool takeSuffix(std::string_view& text, std::string_view suffix) {
    if (text.size() < suffix.size() || text.substr(text.size() - suffix.size()) != suffix) return false;
    text.remove_suffix(suffix.size());
    return true;
}

}  // namespace

std::optional<Length> parseLength(std::string_view text) {
    Length length;
    if (takeSuffix(text, "%")) {
        length.unit = Length::Unit::percent;
    } else if (!takeSuffix(text, "px")) {
        return std::nullopt;
    }
    if (!isNumeral(text)) return std::nullopt;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), length.value);
    if (error != std::errc{}) return std::nullopt;  // more than a float holds
    return length;
}

}  // namespace vorelstyle
