#pragma once

#include <cstddef>

#include "tests/support/levels.h"

/// An input is run at one level of the instruction set, which its size names, so that fuzzing tries all
/// of them. A replay turns the offset to run an input at each.
namespace vorel_fuzz {

inline size_t levelOffset = 0;

inline void useLevelOfInput(size_t size) {
    const auto levels = vorel_test::levelsHere();
    vorel_test::useLevel(levels[(size + levelOffset) % levels.size()]);
}

}  // namespace vorel_fuzz
