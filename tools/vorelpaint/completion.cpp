#include "completion.h"

#include <string_view>
#include <vector>

#include "settings.h"

namespace vorelpaint {
namespace {

/// What may stand behind an option.
enum class Value { none, file, preset, word, other };

Value valueOf(const Setting& setting) {
    if (setting.kind == Setting::Kind::flag) return Value::none;
    if (setting.value == "FILE" || setting.value == "FONT") return Value::file;
    if (setting.value == "PRESET") return Value::preset;
    return wordsOf(setting).empty() ? Value::other : Value::word;
}

/// The settings that have names on the command line.
std::vector<Setting> options() {
    std::vector<Setting> named;
    for (const Setting& setting : settings()) {
        if (!setting.isPositional) named.push_back(setting);
    }
    return named;
}

std::string separated(const std::vector<std::string>& words, std::string_view separator) {
    std::string text;
    for (const std::string& word : words)
        text.append(text.empty() ? "" : separator).append(word);
    return text;
}

/// The spellings of an option: "--output", "-o".
std::vector<std::string> spellings(const Setting& setting) {
    std::vector<std::string> names{optionName(setting)};
    if (!setting.letter.empty()) names.push_back("-" + setting.letter);
    return names;
}

std::string replaced(std::string text, std::string_view from, std::string_view to) {
    for (size_t at = 0; (at = text.find(from, at)) != std::string::npos; at += to.size())
        text.replace(at, from.size(), to);
    return text;
}

/// In single quotes for a shell of the Bourne family.
std::string quoted(const std::string& text) {
    return "'" + replaced(text, "'", "'\\''") + "'";
}

// --- bash -------------------------------------------------------------------------------------------

std::string bashBranch(const std::vector<std::string>& names, const std::string& body) {
    return names.empty() ? ""
                         : "        " + separated(names, "|") + ")\n            " + body +
                               "\n            return ;;\n";
}

/// The spellings of all options with this kind of value.
std::vector<std::string> spellingsWith(Value value) {
    std::vector<std::string> names;
    for (const Setting& setting : options()) {
        if (valueOf(setting) != value) continue;
        for (const std::string& name : spellings(setting))
            names.push_back(name);
    }
    return names;
}

std::string bashScript() {
    std::string script = R"(# bash completion of vorelpaint; made by vorelpaint --completion bash
_vorelpaint() {
    local word=${COMP_WORDS[COMP_CWORD]} option=${COMP_WORDS[COMP_CWORD - 1]}
    # bash takes --style=look.json for three words.
    if [[ $word == = ]]; then
        word=
    elif [[ $option == = ]]; then
        option=${COMP_WORDS[COMP_CWORD - 2]}
    fi
    COMPREPLY=()
    case $option in
)";
    script += bashBranch(spellingsWith(Value::file),
                         "compopt -o filenames 2> /dev/null\n"
                         "            mapfile -t COMPREPLY < <(compgen -f -- \"$word\")");
    script += bashBranch(spellingsWith(Value::preset),
                         "mapfile -t COMPREPLY < <(compgen -W \"$(\"${COMP_WORDS[0]}\" --list-presets "
                         "2> /dev/null | cut -d ' ' -f 1)\" -- \"$word\")");
    for (const Setting& setting : options()) {
        if (valueOf(setting) != Value::word) continue;
        script += bashBranch(spellings(setting), "mapfile -t COMPREPLY < <(compgen -W " +
                                                     quoted(separated(wordsOf(setting), " ")) +
                                                     " -- \"$word\")");
    }
    script += bashBranch(spellingsWith(Value::other), ": # nothing to choose from");
    std::vector<std::string> names;
    for (const Setting& setting : options())
        names.push_back(optionName(setting));
    return script + "    esac\n    [[ $word == -* ]] && mapfile -t COMPREPLY < <(compgen -W " +
           quoted(separated(names, " ")) + " -- \"$word\")\n}\ncomplete -F _vorelpaint vorelpaint\n";
}

// --- zsh --------------------------------------------------------------------------------------------

/// A description as _arguments takes it, in brackets.
std::string zshDescription(const Setting& setting) {
    std::string text = replaced(setting.description, "[", "\\[");
    text = replaced(text, "]", "\\]");
    return "[" + replaced(text, ":", "\\:") + "]";
}

std::string zshAction(const Setting& setting) {
    std::string message = ":" + replaced(setting.value, ":", "\\:") + ":";
    switch (valueOf(setting)) {
        case Value::none:
            return "";
        case Value::file:
            return message + "_files";
        case Value::preset:
            return message + "_vorelpaint_presets";
        case Value::word:
            return message + "(" + separated(wordsOf(setting), " ") + ")";
        case Value::other:
            return message;
    }
    return "";
}

std::string zshScript() {
    std::string script = R"sh(#compdef vorelpaint
# zsh completion of vorelpaint; made by vorelpaint --completion zsh
_vorelpaint_presets() {
    local -a presets
    presets=(${${(f)"$(_call_program presets $words[1] --list-presets 2> /dev/null)"}/ ##/:})
    _describe -t presets preset presets
}
_vorelpaint() {
    _arguments -s -S \
)sh";
    for (const Setting& setting : options()) {
        const std::string tail = zshDescription(setting) + zshAction(setting);
        for (const std::string& name : spellings(setting)) {
            const std::string others = quoted("(" + separated(spellings(setting), " ") + ")");
            script += "        " + others + quoted(name + tail) + " \\\n";
        }
    }
    return script + "        '::TEXT:'\n}\n_vorelpaint \"$@\"\n";
}

// --- fish -------------------------------------------------------------------------------------------

std::string fishQuoted(const std::string& text) {
    return "'" + replaced(replaced(text, "\\", "\\\\"), "'", "\\'") + "'";
}

std::string fishAction(const Setting& setting) {
    switch (valueOf(setting)) {
        case Value::none:
            return "";
        case Value::file:
            return " -r -F";
        case Value::preset:
            return " -x -a '(vorelpaint --list-presets 2> /dev/null | string replace -r \" +\" \\t)'";
        case Value::word:
            return " -x -a " + fishQuoted(separated(wordsOf(setting), " "));
        case Value::other:
            return " -x";
    }
    return "";
}

std::string fishScript() {
    std::string script =
        "# fish completion of vorelpaint; made by vorelpaint --completion fish\n"
        "complete -c vorelpaint -f\n";
    for (const Setting& setting : options()) {
        script += "complete -c vorelpaint -l " + setting.name;
        if (!setting.letter.empty()) script += " -s " + setting.letter;
        script += fishAction(setting) + " -d " + fishQuoted(setting.description) + "\n";
    }
    return script;
}

}  // namespace

std::string completionScript(const std::string& shell) {
    if (shell == "bash") return bashScript();
    return shell == "zsh" ? zshScript() : fishScript();
}

}  // namespace vorelpaint
