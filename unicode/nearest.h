#pragma once

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

/// The name that was probably meant by one that is misspelt.
namespace vorelunicode {

inline char lowerCase(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

inline bool areSameLetter(char one, char other) {
    return lowerCase(one) == lowerCase(other);
}

/// Whether two words are the same but for the case of ASCII.
inline bool isSameWord(std::string_view one, std::string_view other) {
    return std::equal(one.begin(), one.end(), other.begin(), other.end(), areSameLetter);
}

/// How many letters of a word have to be put in, left out, replaced or swapped with their neighbour for
/// the other one, without regard to the case of ASCII.
inline size_t editDistance(std::string_view one, std::string_view other) {
    // Rows of the table of distances between beginnings of the words: the one being filled and two
    // before.
    std::vector<size_t> older(other.size() + 1);
    std::vector<size_t> old(other.size() + 1);
    std::vector<size_t> row(other.size() + 1);
    for (size_t j = 0; j < row.size(); ++j)
        row[j] = j;
    for (size_t i = 1; i <= one.size(); ++i) {
        older.swap(old);
        old.swap(row);
        row[0] = i;
        for (size_t j = 1; j <= other.size(); ++j) {
            const size_t replaced = old[j - 1] + (areSameLetter(one[i - 1], other[j - 1]) ? 0 : 1);
            row[j] = std::min({replaced, old[j] + 1, row[j - 1] + 1});
            const bool swapped = i > 1 && j > 1 && areSameLetter(one[i - 1], other[j - 2]) &&
                                 areSameLetter(one[i - 2], other[j - 1]);
            if (swapped) row[j] = std::min(row[j], older[j - 2] + 1);
        }
    }
    return row.back();
}

/// Whether a word is so like a name that it is probably meant: a third of its letters may be wrong, or
/// its end be missing.
inline bool resembles(std::string_view word, std::string_view name) {
    constexpr size_t kShortestBeginning = 3;
    const size_t allowed = std::max<size_t>(1, name.size() / 3);
    // Before the distance is counted: a word from a file may be of any length.
    if (word.empty() || word.size() > name.size() + allowed) return false;
    const bool begins =
        word.size() <= name.size() && std::equal(word.begin(), word.end(), name.begin(), areSameLetter);
    if (begins && word.size() >= kShortestBeginning) return true;
    return editDistance(word, name) <= std::min(allowed, word.size() - 1);
}

/// The name that a word resembles most, the first of several; empty when it resembles none.
template <typename Names>
std::string nearest(std::string_view word, const Names& names) {
    std::string_view best;
    for (const std::string_view name : names) {
        if (!resembles(word, name)) continue;
        if (best.empty() || editDistance(word, name) < editDistance(word, best)) best = name;
    }
    return std::string(best);
}

}  // namespace vorelunicode
