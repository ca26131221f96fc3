#include "spelled_numbers.h"

#include <gtest/gtest.h>

#include <array>
#include <charconv>
#include <cmath>
#include <cstring>
#include <limits>
#include <random>
#include <string>

namespace vorelscript {
namespace {

template <typename Number>
std::string spelled(Number number) {
    char text[kMostLetters];
    return {text, spellShortest(text, number)};
}

template <typename Number>
std::string byLibrary(Number number) {
    std::array<char, 64> text{};
    return {text.data(), std::to_chars(text.data(), text.data() + text.size(), number).ptr};
}

/// Powers of two, which lie nearer to the number before them than to the next, and their neighbours.
template <typename Number>
void expectTheLibrarysAroundPowers() {
    using Limits = std::numeric_limits<Number>;
    for (int power = Limits::min_exponent - Limits::digits; power < Limits::max_exponent; ++power) {
        const Number number = std::ldexp(Number{1}, power);
        for (const Number each :
             {number, std::nextafter(number, Number{0}), std::nextafter(number, Limits::max())})
            EXPECT_EQ(spelled(each), byLibrary(each));
    }
}

TEST(SpelledNumbers, Numbers_AreShort) {
    EXPECT_EQ(spelled(0.1F), "0.1");
    EXPECT_EQ(spelled(0.1), "0.1");
    EXPECT_EQ(spelled(-12.5F), "-12.5");
    EXPECT_EQ(spelled(1000.0), "1000");
    EXPECT_EQ(spelled(100000.0F), "1e+05");
    EXPECT_EQ(spelled(0.0001F), "1e-04");
    EXPECT_EQ(spelled(-0.0), "-0");
    EXPECT_EQ(spelled(std::numeric_limits<double>::infinity()), "inf");
}

TEST(SpelledNumbers, PowersOfTwo_AreSpelledAsByTheLibrary) {
    expectTheLibrarysAroundPowers<float>();
    expectTheLibrarysAroundPowers<double>();
}

TEST(SpelledNumbers, AnyNumber_IsSpelledAsByTheLibrary) {
    std::mt19937_64 random(16);
    for (int i = 0; i < 50000; ++i) {
        const uint64_t bits = random();
        float single = 0;
        double twice = 0;
        std::memcpy(&single, &bits, sizeof single);
        std::memcpy(&twice, &bits, sizeof twice);
        if (std::isfinite(single)) {
            EXPECT_EQ(spelled(single), byLibrary(single));
        }
        if (std::isfinite(twice)) {
            EXPECT_EQ(spelled(twice), byLibrary(twice));
        }
    }
}

TEST(SpelledNumbers, NumbersOfStyles_AreSpelledAsByTheLibrary) {
    for (int i = -100000; i <= 100000; ++i) {
        const float number = static_cast<float>(i) / 1000;
        EXPECT_EQ(spelled(number), byLibrary(number));
        EXPECT_EQ(spelled(float(i) * 16), byLibrary(float(i) * 16));
    }
}

}  // namespace
}  // namespace vorelscript
