#pragma once

#include <string>
#include <string_view>

#include "style/message.h"
#include "unicode/nearest.h"

/// The name that was probably meant by one that is misspelt.
namespace vorelstyle {

using vorelunicode::editDistance;
using vorelunicode::isSameWord;
using vorelunicode::nearest;
using vorelunicode::resembles;

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

/// What a refusal of a word says that is not among the few that may stand: "none of a, b", or, where one
/// is resembled, "none of a, b; did you mean a?".
template <typename Names>
std::string noneOf(std::string_view word, const Names& names) {
    const std::string meant = nearest(word, names);
    return "none of " + joined(names) + (meant.empty() ? "" : "; did you mean " + meant + "?");
}

}  // namespace vorelstyle
