#include "style/length.h"

#include <limits>

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

/// Whether the text is a number of the one spelling, such as -12.5.
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

/// What such a numeral says. Whole digits and tens are exact in double precision as far as any length
/// goes, so that the quotient is the nearest number to what is written, and is so as a float as well:
/// with three decimals nothing lies close enough to the middle of two floats for the two roundings to
/// part.
double valueOf(std::string_view numeral) {
    double digits = 0;
    double tens = 1;
    bool isFraction = false;
    for (const char each : numeral) {
        if (each == '.') isFraction = true;
        if (each < '0' || each > '9') continue;
        digits = digits * 10 + (each - '0');
        if (isFraction) tens *= 10;
    }
    return (numeral.front() == '-' ? -digits : digits) / tens;
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
    const double value = valueOf(text);
    constexpr double kLargest = std::numeric_limits<float>::max();
    if (value < -kLargest || value > kLargest) return std::nullopt;
    length.value = static_cast<float>(value);
    return length;
}

}  // namespace vorelstyle
