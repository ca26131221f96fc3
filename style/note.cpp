#include "style/note.h"

#include <array>
#include <charconv>

namespace vorelstyle {
namespace {

template <typename Number>
std::string shortest(Number number) {
    std::array<char, 32> text{};
    const auto [end, error] = std::to_chars(text.data(), text.data() + text.size(), number);
    return {text.data(), end};
}

}  // namespace

std::string spelled(double number) {
    return shortest(number);
}

std::string spelled(float number) {
    return shortest(number);
}

}  // namespace vorelstyle
