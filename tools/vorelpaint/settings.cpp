#include "settings.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <sstream>
#include <string_view>
#include <system_error>
#include <type_traits>

#include "error.h"
#include "output_name.h"
#include "ranges.h"

namespace vorelpaint {
namespace {

using vorelstyle::parseColour;
using voreltext::Align;
using Read = Setting::Read;

[[noreturn]] void refuse(const std::string& text, const std::string& reason) {
    throw ToolError("'" + text + "' is " + reason);
}

Read flag(bool Options::*member) {
    return [member](Options& options, const std::string&) { options.*member = true; };
}

template <typename Member>
Read text(Member Options::*member) {
    return [member](Options& options, const std::string& given) { options.*member = given; };
}

/// Reads decimal numbers and nothing around them.
template <typename Number, typename Member>
Read numberWithin(const Limits<Number>& limits, Member Options::*member) {
    return [=](Options& options, const std::string& given) {
        Number number{};
        const char* end = given.data() + given.size();
        const auto [stop, error] = std::from_chars(given.data(), end, number);
        const bool whole = error == std::errc{} && stop == end;
        // "nan" is a number here; it fails both comparisons.
        if (whole && number >= limits.low && number <= limits.high) {
            options.*member = number;
            return;
        }
        refuse(given, (std::is_integral_v<Number> ? "no whole number from " : "no number from ") +
                          spelled(limits));
    };
}

/// Reads what `parse` understands.
template <typename Parse, typename Member>
Read parsed(Parse parse, Member Options::*member, const char* refusal) {
    return [=](Options& options, const std::string& given) {
        const auto value = parse(given);
        if (!value) refuse(given, refusal);
        options.*member = *value;
    };
}

std::optional<Align> parseAlign(std::string_view text) {
    if (text == "left") return Align::left;
    if (text == "center") return Align::center;
    if (text == "right") return Align::right;
    return std::nullopt;
}

std::optional<std::string> parseShell(const std::string& text) {
    if (text == "bash" || text == "zsh" || text == "fish") return text;
    return std::nullopt;
}

std::optional<std::string> parseOutput(const std::string& text) {
    if (namesOtherKind(text)) return std::nullopt;
    return text;
}

/// An option that paints a picture, of a job as well as of the command line.
Setting pictureOption(const char* name, const char* value, const char* initial, const char* group,
                      const std::string& description, Read read,
                      Setting::Kind kind = Setting::Kind::text) {
    return {name, "", value, initial, group, description, kind, true, false, std::move(read)};
}

Setting pictureNumber(const char* name, const char* value, const char* initial, const char* group,
                      const std::string& description, Read read) {
    return pictureOption(name, value, initial, group, description, std::move(read),
                         Setting::Kind::number);
}

/// An option of the command line alone.
Setting programOption(const char* name, const char* value, const char* group, const char* description,
                      Read read) {
    const auto kind = *value == '\0' ? Setting::Kind::flag : Setting::Kind::text;
    return {name, "", value, "", group, description, kind, false, false, std::move(read)};
}

std::vector<Setting> textSettings() {
    constexpr const char* kGroup = "Text";
    Setting words = pictureOption("text", "TEXT", "", kGroup, "The text; a line feed starts a new line",
                                  text(&Options::text));
    words.isPositional = true;
    return {
        words,
        pictureOption("text-file", "FILE", "", kGroup, "Read the text from FILE, - for standard input",
                      text(&Options::textFile)),
        pictureOption("font", "FONT", "DejaVu Sans", kGroup,
                      "Font file, or family such as 'DejaVu Sans:bold'", text(&Options::font)),
        pictureNumber("size", "PX", "96", kGroup, "Size of the font in pixels, " + spelled(kFontSize),
                      numberWithin(kFontSize, &Options::size)),
        pictureOption("align", "left|center|right", "left", kGroup, "Where short lines stand",
                      parsed(parseAlign, &Options::align, "none of left, center, right"))};
}

std::vector<Setting> lookSettings() {
    constexpr const char* kGroup = "Look";
    return {pictureOption("style", "FILE", "", kGroup, "Read the effects from a style file (JSON)",
                          text(&Options::style)),
            pictureOption("preset", "PRESET", "", kGroup, "Take the effects of a preset",
                          text(&Options::preset)),
            pictureNumber("effect-scale", "FACTOR", "1", kGroup,
                          "Multiply the effects' sizes by " + spelled(kEffectScale) +
                              "; presets are made for text of about 100 pixels",
                          numberWithin(kEffectScale, &Options::effectScale)),
            pictureOption("color", "#RRGGBB", "", kGroup, "Fill of the text (the style's, else #000000)",
                          parsed(parseColour, &Options::color, "no colour; write #RRGGBB or #RGB")),
            pictureNumber("opacity", "NUMBER", "", kGroup,
                          "Opacity of the text, " + spelled(kOpacity) + " (the style's, else 1)",
                          numberWithin(kOpacity, &Options::opacity))};
}

std::vector<Setting> outputSettings() {
    constexpr const char* kGroup = "Picture";
    Setting output =
        pictureOption("output", "FILE", "", kGroup, "The PNG file to write, - for standard output",
                      parsed(parseOutput, &Options::output,
                             "named like another kind of file; only PNG is written: end it with .png"));
    output.letter = "o";
    return {output,
            pictureOption("background", "transparent|checkerboard|#RRGGBB", "transparent", kGroup,
                          "What lies behind the text",
                          parsed(parseBackground, &Options::background,
                                 "none of transparent, checkerboard, #RRGGBB, #RGB")),
            pictureNumber("padding", "PX", "8", kGroup,
                          "Pixels around the text and its effects, " + spelled(kPadding),
                          numberWithin(kPadding, &Options::padding))};
}

std::vector<Setting> seriesSettings() {
    constexpr const char* kGroup = "Many pictures";
    return {programOption("batch", "FILE", kGroup,
                          "Paint the jobs of FILE, one JSON object a line; - for standard input",
                          text(&Options::batch)),
            programOption("sheet", "", kGroup, "Paint TEXT in every preset, with their names",
                          flag(&Options::sheet))};
}

std::vector<Setting> reportSettings() {
    constexpr const char* kGroup = "Reports";
    return {
        programOption("list-presets", "", kGroup, "List the presets and what they show",
                      flag(&Options::listPresets)),
        programOption("explain", "", kGroup,
                      "Tell how the look is painted: order, margins, cache key; with TEXT also time and "
                      "memory",
                      flag(&Options::explain)),
        programOption("write-cpp", "", kGroup, "Print the look as C++ calls of the library",
                      flag(&Options::writeCpp)),
        programOption("print-key", "", kGroup, "Print the look's cache key in hexadecimal",
                      flag(&Options::printKey)),
        programOption("print-margins", "", kGroup, "Print the pixels that the effects need",
                      flag(&Options::printMargins))};
}

std::vector<Setting> helpSettings() {
    constexpr const char* kGroup = "Help";
    Setting help = programOption("help", "", kGroup, "Print this help and exit", nullptr);
    help.letter = "h";
    return {
        help,
        programOption("version", "", kGroup, "Print the version and exit", flag(&Options::version)),
        programOption("man", "", kGroup, "Print the manual page, for man -l -", flag(&Options::manual)),
        programOption("completion", "bash|zsh|fish", kGroup, "Print the completions of a shell",
                      parsed(parseShell, &Options::completion, "none of bash, zsh, fish"))};
}

std::vector<Setting> allSettings() {
    std::vector<Setting> all;
    for (auto part : {textSettings(), lookSettings(), outputSettings(), seriesSettings(),
                      reportSettings(), helpSettings()}) {
        all.insert(all.end(), part.begin(), part.end());
    }
    return all;
}

}  // namespace

const std::vector<Setting>& settings() {
    static const std::vector<Setting> all = allSettings();
    return all;
}

const Setting& settingNamed(std::string_view name) {
    return *std::find_if(settings().begin(), settings().end(),
                         [&](const Setting& setting) { return setting.name == name; });
}

std::string optionName(const Setting& setting) {
    return setting.isPositional ? setting.value : "--" + setting.name;
}

std::vector<std::string> wordsOf(const Setting& setting) {
    std::vector<std::string> words;
    std::istringstream alternatives(setting.value);
    for (std::string word; std::getline(alternatives, word, '|');) {
        const bool literal =
            std::all_of(word.begin(), word.end(), [](char c) { return c >= 'a' && c <= 'z'; });
        if (literal) words.push_back(word);
    }
    return words;
}

}  // namespace vorelpaint
