#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "style/message.h"

/// The name that was probably meant by one that is misspelt.
namespace vorelstyle {

/// Whether two words are the same but for the case of ASCII.
bool isSameWord(std::string_view one, std::string_view other);

/// How many letters of a word have to be put in, left out, replaced or swapped with their neighbour for
/// the other one, without regard to the case of ASCII.
size_t editDistance(std::string_view one, std::string_view other);

/// Whether a word is so like a name that it is probably meant: a third of its letters may be wrong, or
/// its end be missing.
bool resembles(std::string_view word, std::string_view name);

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

/// What a refusal of an unknown name ends with: "; known are a, b", or, where one is resembled,
/// "; did you mean a? Known are a, b".
template <typename Names>
std::string choices(std::string_view word, const Names& names, const std::string& verb) {
    const std::string meant = nearest(word, names);
    if (meant.empty()) return "; " + verb + " " + joined(names);
    std::string sentence = verb;
    sentence.front() = static_cast<char>(sentence.front() - 'a' + 'A');
    return "; did you mean " + meant + "? " + sentence + " " + joined(names);
}

}  // namespace vorelstyle
