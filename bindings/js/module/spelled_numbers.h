#pragma once

#include <cstddef>

namespace vorelscript {

/// Letters that a number is spelled with at most, and the zero behind them.
constexpr size_t kMostLetters = 48;

/// Writes the shortest spelling that is read as the same number, as std::to_chars does: in full where
/// that is not longer, as 0.1 or 100, else as 1e-05. A zero stands behind it. Returns how many letters
/// it has.
size_t spellShortest(char (&text)[kMostLetters], double number);
size_t spellShortest(char (&text)[kMostLetters], float number);

}  // namespace vorelscript
