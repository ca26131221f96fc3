#include "spelled_numbers.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <limits>

// The digits come from printf, one more at a time until they are read as the number: slower than tables
// of powers, which are larger than all else that spells numbers.

namespace vorelscript {
namespace {

double readAs(double /*kind*/, const char* text) {
    return std::strtod(text, nullptr);
}
float readAs(float /*kind*/, const char* text) {
    return std::strtof(text, nullptr);
}

/// Makes the last digit one more; false for nines alone.
bool raiseLastDigit(char* text) {
    for (char* at = std::strchr(text, 'e'); at != text;) {
        --at;
        if (*at < '0') continue;  // the point, or the sign
        *at = *at == '9' ? '0' : static_cast<char>(*at + 1);
        if (*at != '0') return true;
    }
    return false;
}

/// With so few digits behind the point as will do, of which it returns the number. The nearest of so
/// many digits is taken, or where that is not read as the number the one above: of a power of two, from
/// which the next number is twice as far as the one before, that one may be.
template <typename Number>
int spellScientific(char (&text)[kMostLetters], Number number) {
    constexpr int kMost = std::numeric_limits<Number>::max_digits10 - 1;
    for (int decimals = 0;; ++decimals) {
        std::snprintf(text, kMostLetters, "%.*e", decimals, double{number});
        if (decimals == kMost || readAs(number, text) == number) return decimals;
        if (raiseLastDigit(text) && readAs(number, text) == number) return decimals;
    }
}

/// How many letters the number has in full, without its sign.
int lettersInFull(int decimals, int exponent) {
    if (exponent >= decimals) return exponent + 1;
    constexpr int kPoint = 1;
    return decimals + 1 + kPoint + std::max(-exponent, 0);
}

template <typename Number>
size_t spell(char (&text)[kMostLetters], Number number) {
    if (!std::isfinite(number)) {
        std::snprintf(text, kMostLetters, "%g", double{number});
        return std::strlen(text);
    }
    const int decimals = spellScientific(text, number);
    const int exponent = std::atoi(std::strchr(text, 'e') + 1);
    const auto letters = static_cast<int>(std::strlen(text)) - (std::signbit(number) ? 1 : 0);
    if (lettersInFull(decimals, exponent) <= letters)
        std::snprintf(text, kMostLetters, "%.*f", std::max(decimals - exponent, 0), double{number});
    return std::strlen(text);
}

}  // namespace

size_t spellShortest(char (&text)[kMostLetters], double number) {
    return spell(text, number);
}

size_t spellShortest(char (&text)[kMostLetters], float number) {
    return spell(text, number);
}

}  // namespace vorelscript
