#include "style/nearest.h"

#include <algorithm>
#include <vector>

namespace vorelstyle {
namespace {

constexpr size_t kShortestBeginning = 3;

char lower(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

bool areSame(char one, char other) {
    return lower(one) == lower(other);
}

}  // namespace

bool isSameWord(std::string_view one, std::string_view other) {
    return std::equal(one.begin(), one.end(), other.begin(), other.end(), areSame);
}

size_t editDistance(std::string_view one, std::string_view other) {
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
            const size_t replaced = old[j - 1] + (areSame(one[i - 1], other[j - 1]) ? 0 : 1);
            row[j] = std::min({replaced, old[j] + 1, row[j - 1] + 1});
            const bool swapped =
                i > 1 && j > 1 && areSame(one[i - 1], other[j - 2]) && areSame(one[i - 2], other[j - 1]);
            if (swapped) row[j] = std::min(row[j], older[j - 2] + 1);
        }
    }
    return row.back();
}

bool resembles(std::string_view word, std::string_view name) {
    const size_t allowed = std::max<size_t>(1, name.size() / 3);
    // Before the distance is counted: a word from a file may be of any length.
    if (word.empty() || word.size() > name.size() + allowed) return false;
    const bool begins =
        word.size() <= name.size() && std::equal(word.begin(), word.end(), name.begin(), areSame);
    if (begins && word.size() >= kShortestBeginning) return true;
    return editDistance(word, name) <= std::min(allowed, word.size() - 1);
}

}  // namespace vorelstyle
