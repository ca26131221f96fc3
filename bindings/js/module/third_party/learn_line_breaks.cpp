#include <linebreak.h>
#include <linebreakdef.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <iterator>
#include <map>
#include <random>
#include <string>
#include <vector>

// Writes the line breaking of the installed libunibreak as tables, for linebreak.cpp: the kind of every
// character, and an automaton over kinds that tells whether a line may break before the character it
// takes.
//
// The library decides by classes of characters, from left to right, and looks no farther than the next
// one. So the automaton is learnt by asking it: a state is known by what it answers to all pairs of
// classes that may follow, and is found by the first text that leads to it.
//
//     learn_line_breaks > line_break_tables.h

namespace {

using Text = std::vector<utf32_t>;
using Answers = std::string;

constexpr utf32_t kLastCharacter = 0x10FFFF;
constexpr utf32_t kFirstFlag = 0x1F1E6;
constexpr utf32_t kLastFlag = 0x1F1FF;

/// A class of characters is told by its first one. Halves of flags end the library's program where they
/// are not the first: nobody asks for them (text/line_breaks.cpp), and they stand among the unknown ones
/// here.
struct Classes {
    std::vector<utf32_t> examples;
    std::vector<std::pair<utf32_t, size_t>> runs;  ///< where one begins, in order

    Classes() {
        std::map<int, size_t> known;
        utf32_t next = 0;
        for (const LineBreakProperties* range = lb_prop_default; range->prop != LBP_Undefined; ++range) {
            if (range->start > next) add(known, LBP_XX, next);
            add(known, range->prop == LBP_RI ? LBP_XX : range->prop, range->start);
            next = range->end + 1;
        }
        if (next <= kLastCharacter) add(known, LBP_XX, next);
    }

  private:
    void add(std::map<int, size_t>& known, int name, utf32_t first) {
        const auto [found, isNew] = known.try_emplace(name, examples.size());
        if (isNew) examples.push_back(first);
        if (runs.empty() || runs.back().second != found->second) runs.push_back({first, found->second});
    }
};

/// What the library says of the places before each of the last `count` characters.
Answers answersOf(const Text& text, size_t count) {
    Answers breaks(text.size(), '\0');
    set_linebreaks_utf32(text.data(), text.size(), nullptr, breaks.data());
    return breaks.substr(text.size() - 1 - count, count);
}

Text with(Text text, utf32_t next) {
    text.push_back(next);
    return text;
}

Answers answersToPairs(const Text& text, const std::vector<utf32_t>& examples) {
    Answers all;
    for (const utf32_t first : examples) {
        for (const utf32_t second : examples)
            all += answersOf(with(with(text, first), second), 2);
    }
    return all;
}

struct Automaton {
    /// Of each state, for each class: where it leads to, and the break before it.
    std::vector<std::vector<size_t>> next;
    std::vector<Answers> answers;
    std::vector<size_t> first;  ///< the state after the first character of a class
};

Automaton learnt(const std::vector<utf32_t>& examples) {
    Automaton automaton;
    std::map<Answers, size_t> known;
    std::vector<Text> texts;
    const auto stateOf = [&](const Text& text) {
        const auto [found, isNew] = known.try_emplace(answersToPairs(text, examples), texts.size());
        if (isNew) texts.push_back(text);
        return found->second;
    };
    for (const utf32_t example : examples)
        automaton.first.push_back(stateOf({example}));
    for (size_t state = 0; state < texts.size(); ++state) {
        automaton.next.emplace_back();
        automaton.answers.emplace_back();
        for (const utf32_t example : examples) {
            const Text text = with(texts[state], example);
            automaton.answers.back() += answersOf(text, 1);
            automaton.next.back().push_back(stateOf(text));
        }
    }
    return automaton;
}

size_t classOf(const Classes& classes, utf32_t code) {
    const auto behind =
        std::upper_bound(classes.runs.begin(), classes.runs.end(), code,
                         [](utf32_t place, const auto& run) { return place < run.first; });
    return std::prev(behind)->second;
}

/// What the library says of all places of a text but the last, by the automaton.
Answers walked(const Automaton& automaton, const Classes& classes, const Text& text) {
    Answers answers;
    size_t state = automaton.first[classOf(classes, text.front())];
    for (size_t i = 1; i < text.size(); ++i) {
        const size_t next = classOf(classes, text[i]);
        answers += automaton.answers[state][next];
        state = automaton.next[state][next];
    }
    return answers;
}

/// Whether the automaton says of long texts what the library does: of characters of all classes, and of
/// any.
bool isTrue(const Automaton& automaton, const Classes& classes) {
    constexpr int kTexts = 200000;
    std::mt19937 random(1);
    for (int i = 0; i < kTexts; ++i) {
        Text text;
        for (size_t length = 2 + random() % 30; length > 0; --length) {
            const utf32_t any = random() % (i % 2 == 0 ? 0x3100 : kLastCharacter);
            const bool isAskedFor = any != EOS && (any < kFirstFlag || any > kLastFlag);
            text.push_back(
                i % 4 < 2 || !isAskedFor ? classes.examples[random() % classes.examples.size()] : any);
        }
        if (answersOf(text, text.size() - 1) != walked(automaton, classes, text)) return false;
    }
    return true;
}

/// Classes that the automaton tells apart in no state are of one kind.
std::vector<size_t> kindsOf(const Automaton& automaton) {
    std::map<std::vector<size_t>, size_t> known;
    std::vector<size_t> kinds;
    for (size_t i = 0; i < automaton.first.size(); ++i) {
        std::vector<size_t> column{automaton.first[i]};
        for (size_t state = 0; state < automaton.next.size(); ++state) {
            column.push_back(automaton.next[state][i]);
            column.push_back(static_cast<size_t>(automaton.answers[state][i]));
        }
        kinds.push_back(known.try_emplace(column, known.size()).first->second);
    }
    return kinds;
}

void writeList(const char* type, const char* name, const std::vector<size_t>& numbers) {
    std::printf("constexpr %s %s[]{", type, name);
    for (size_t i = 0; i < numbers.size(); ++i)
        std::printf("%s%zu", i == 0 ? "" : i % 20 == 0 ? ",\n" : ",", numbers[i]);
    std::printf("};\n");
}

void writeRuns(const Classes& classes, const std::vector<size_t>& kinds) {
    std::vector<size_t> begins;
    std::vector<size_t> kindsOfRuns;
    for (const auto& [begin, name] : classes.runs) {
        if (!kindsOfRuns.empty() && kindsOfRuns.back() == kinds[name]) continue;
        begins.push_back(begin);
        kindsOfRuns.push_back(kinds[name]);
    }
    writeList("uint32_t", "kRunBegins", begins);
    writeList("uint8_t", "kRunKinds", kindsOfRuns);
}

void writeAutomaton(const Automaton& automaton, const std::vector<size_t>& kinds) {
    const size_t count = 1 + *std::max_element(kinds.begin(), kinds.end());
    std::vector<size_t> first(count);
    std::vector<size_t> steps(automaton.next.size() * count);
    for (size_t i = 0; i < kinds.size(); ++i) {
        first[kinds[i]] = automaton.first[i];
        for (size_t state = 0; state < automaton.next.size(); ++state) {
            const auto answer = static_cast<size_t>(automaton.answers[state][i]);
            steps[state * count + kinds[i]] = automaton.next[state][i] * 4 + answer;
        }
    }
    std::printf("constexpr unsigned int kKinds = %zu;\n", count);
    writeList("uint8_t", "kFirstStates", first);
    writeList("uint16_t", "kSteps", steps);
}

}  // namespace

int main() {
    init_linebreak();
    const Classes classes;
    const Automaton automaton = learnt(classes.examples);
    if (!isTrue(automaton, classes)) {
        std::fputs("libunibreak does not break lines by the class of the next character alone\n",
                   stderr);
        return 1;
    }
    const std::vector<size_t> kinds = kindsOf(automaton);
    std::puts("// Written by learn_line_breaks.");
    writeRuns(classes, kinds);
    writeAutomaton(automaton, kinds);
}
