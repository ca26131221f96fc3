#pragma once

#include <cstdio>
#include <cstdlib>
#include <string_view>

/// What the targets demand of what they call: the process ends where it is not so.
namespace vorel_fuzz {

[[noreturn]] inline void fail(const char* what) {
    std::fprintf(stderr, "%s\n", what);
    std::abort();
}

inline void demand(bool condition, const char* what) {
    if (!condition) fail(what);
}

/// A NaN is in no range.
inline void demandIn(double value, double low, double high, const char* name) {
    demand(value >= low && value <= high, name);
}

/// 0xRRGGBB.
inline void demandColour(unsigned int colour) {
    demand(colour <= 0xFFFFFF, "a colour has an alpha byte");
}

/// A message is one line and not empty.
inline void demandLine(std::string_view message) {
    demand(!message.empty() && message.find('\n') == std::string_view::npos,
           "a message is not one line");
}

}  // namespace vorel_fuzz
