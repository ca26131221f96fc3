#include "linebreak/linebreak.h"

#include <line_break_tables.h>

#include <algorithm>
#include <iterator>

// What learn_line_breaks has learnt of the installed libunibreak, walked: one step for each character.

namespace {

uint8_t kindOf(utf32_t code) {
    const auto* const behind = std::upper_bound(std::begin(kRunBegins), std::end(kRunBegins), code);
    return kRunKinds[std::prev(behind) - std::begin(kRunBegins)];
}

}  // namespace

void init_linebreak() {}

void set_linebreaks_utf32(const utf32_t* text, size_t length, const char* /*language*/, char* breaks) {
    if (length == 0) return;
    constexpr unsigned int kAnswers = 4;  // the low bits of a step
    unsigned int state = kFirstStates[kindOf(text[0])];
    for (size_t i = 1; i < length; ++i) {
        const unsigned int step = kSteps[state * kKinds + kindOf(text[i])];
        breaks[i - 1] = static_cast<char>(step % kAnswers);
        state = step / kAnswers;
    }
    breaks[length - 1] = LINEBREAK_MUSTBREAK;
}
