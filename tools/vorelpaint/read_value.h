#pragma once

#include <charconv>
#include <optional>
#include <sstream>
#include <string>
#include <string_view>
#include <system_error>
#include <type_traits>
#include <utility>
#include <vector>

#include "error.h"
#include "ranges.h"
#include "style/vorelstyle.h"

/// How the values of settings are spelled. What is none of them throws ToolError: "'0' is no whole
/// number from 1 to 1000".
namespace vorelpaint {

[[noreturn]] inline void refuse(const std::string& text, const std::string& reason) {
    throw ToolError("'" + text + "' is " + reason);
}

/// A decimal number with nothing around it. "nan" is one, outside of all limits.
template <typename Number>
std::optional<Number> numberIn(std::string_view given) {
    Number number{};
    const char* end = given.data() + given.size();
    const auto [stop, error] = std::from_chars(given.data(), end, number);
    if (error != std::errc{} || stop != end) return std::nullopt;
    return number;
}

template <typename Number>
Number readNumber(const Limits<Number>& limits, const std::string& given) {
    const std::optional<Number> number = numberIn<Number>(given);
    if (number && contains(limits, *number)) return *number;
    refuse(given,
           (std::is_integral_v<Number> ? "no whole number from " : "no number from ") + spelled(limits));
}

/// The words with `separator` between them.
template <typename Words>
std::string listed(const Words& words, const char* separator) {
    std::string text;
    for (const auto& [word, value] : words)
        text.append(text.empty() ? "" : separator).append(word);
    return text;
}

template <typename Words>
auto wordAmong(const Words& words, const std::string& given) {
    std::vector<std::string_view> names;
    for (const auto& [word, value] : words) {
        if (given == word) return value;
        names.emplace_back(word);
    }
    refuse(given, vorelstyle::noneOf(given, names));
}

/// The parts of a list in one text, between its commas.
inline std::vector<std::string> partsOf(const std::string& given) {
    std::vector<std::string> parts;
    std::istringstream list(given);
    for (std::string part; std::getline(list, part, ',');)
        parts.push_back(part);
    return parts;
}

}  // namespace vorelpaint
