#include "manual.h"

#include <algorithm>
#include <cctype>
#include <sstream>
#include <string>
#include <vector>

#include "help_text.h"
#include "settings.h"
#include "voreleffect/VFVersion.h"
#include "wrap.h"

namespace vorelpaint {
namespace {

constexpr size_t kLineWidth = 76;

/// A text within a line for groff: a plain - would become a hyphen, and a backslash begins a command.
std::string escaped(const std::string& text) {
    std::string roff;
    for (const char c : text) {
        if (c == '-') {
            roff += "\\-";
        } else if (c == '\\') {
            roff += "\\e";
        } else if (c == '\'') {
            roff += "\\(aq";
        } else {
            roff += c;
        }
    }
    return roff;
}

/// A paragraph in lines of a decent length. A line that begins with a full stop would be a command.
std::string paragraph(const std::string& text) {
    std::istringstream lines(wrapped(escaped(text), kLineWidth, 0));
    std::string roff;
    for (std::string line; std::getline(lines, line);)
        roff += (line.front() == '.' ? "\\&" : "") + line + "\n";
    return roff;
}

std::string bold(const std::string& text) {
    return "\\fB" + escaped(text) + "\\fR";
}

std::string italic(const std::string& text) {
    return "\\fI" + escaped(text) + "\\fR";
}

std::string upperCase(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
    return text;
}

/// "left|center|right" with its literal words bold, the others italic.
std::string valueText(const Setting& setting) {
    const std::vector<std::string> literal = wordsOf(setting);
    std::string roff;
    std::string rest = setting.value;
    while (!rest.empty()) {
        const std::string word = rest.substr(0, rest.find('|'));
        rest.erase(0, word.size() + 1);
        const bool isLiteral = std::find(literal.begin(), literal.end(), word) != literal.end();
        roff += (roff.empty() ? "" : "|") + (isLiteral ? bold(word) : italic(word));
    }
    return roff;
}

std::string settingText(const Setting& setting) {
    std::string roff = ".TP\n";
    if (!setting.letter.empty()) roff += bold("-" + setting.letter) + ", ";
    if (!setting.isPositional) roff += bold(optionName(setting));
    if (!setting.value.empty()) roff += (setting.isPositional ? "" : " ") + valueText(setting);
    const std::string initial = setting.initial.empty() ? "" : " [" + setting.initial + "]";
    return roff + "\n" + paragraph(setting.description + initial + ".");
}

std::string allSettings() {
    std::string roff = ".SH OPTIONS\n";
    std::string group;
    for (const Setting& setting : settings()) {
        if (setting.group != group) roff += ".SS " + escaped(setting.group) + "\n";
        group = setting.group;
        roff += settingText(setting);
    }
    return roff;
}

std::string allExamples() {
    std::string roff = ".SH EXAMPLES\n.nf\n";
    for (const std::string& command : exampleCommands())
        roff += escaped(command) + "\n";
    return roff + ".fi\n";
}

}  // namespace

std::string manualPage() {
    std::string roff =
        ".TH VORELPAINT 1 " VOREL_RELEASE_DATE " \"vorelpaint " VOREL_VERSION_STRING "\"\n";
    roff += ".SH NAME\nvorelpaint \\- paint text with effects into a PNG file\n";
    roff += ".SH SYNOPSIS\n" + bold("vorelpaint") + " [" + italic("options") + "] [" + italic("TEXT") +
            "]\n";
    roff += ".SH DESCRIPTION\n" + paragraph(kPurpose);
    roff += allSettings();
    for (const Topic& topic : topics())
        roff += ".SH " + upperCase(topic.heading) + "\n" + paragraph(topic.text);
    return roff + allExamples();
}

}  // namespace vorelpaint
