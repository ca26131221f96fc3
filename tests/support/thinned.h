#pragma once

#include <algorithm>
#include <cstdlib>

/// How many random cases a sweep tries: all of them in one build, which proves the arithmetic; one of
/// VOREL_THINNED in those that show that another compiler, CPU or sanitizer finds nothing else, and are
/// many times slower. The environment variable of the same name has the last word.
namespace vorel_test {

inline int divisorOfCases() {
#ifdef VOREL_THINNED
    constexpr int kOfThisBuild = VOREL_THINNED;
#else
    constexpr int kOfThisBuild = 1;
#endif
    static_assert(kOfThisBuild >= 1);
    const char* asked = std::getenv("VOREL_THINNED");
    return asked ? std::max(1, std::atoi(asked)) : kOfThisBuild;
}

inline const int kThinned = divisorOfCases();

/// `whole` cases thinned, never none.
template <class Number>
Number thinned(Number whole) {
    const auto divisor = static_cast<Number>(kThinned);
    return (whole + divisor - 1) / divisor;
}

}  // namespace vorel_test
