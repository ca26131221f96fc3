#include <charconv>
#include <cstdio>
#include <cstring>

#include "spelled_numbers.h"

// In the place of the packaged ones, whose tables of powers are a fifth of a module.

namespace std {
inline namespace _LIBCPP_ABI_NAMESPACE {
namespace {

to_chars_result copied(char* first, char* last, const char* text, size_t length) {
    if (last - first < static_cast<ptrdiff_t>(length)) return {last, errc::value_too_large};
    memcpy(first, text, length);
    return {first + length, errc{}};
}

template <typename Number>
to_chars_result shortest(char* first, char* last, Number number) {
    char text[vorelscript::kMostLetters]{};
    return copied(first, last, text, vorelscript::spellShortest(text, number));
}

}  // namespace

to_chars_result to_chars(char* first, char* last, double number) {
    return shortest(first, last, number);
}

to_chars_result to_chars(char* first, char* last, float number) {
    return shortest(first, last, number);
}

/// Of the format "general" alone, which is all that is asked for.
to_chars_result to_chars(char* first, char* last, double number, chars_format /*format*/, int digits) {
    char text[vorelscript::kMostLetters]{};
    const int length = snprintf(text, sizeof text, "%.*g", digits, number);
    return copied(first, last, text, static_cast<size_t>(length));
}

}  // namespace _LIBCPP_ABI_NAMESPACE
}  // namespace std
