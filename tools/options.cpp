#include "options.h"

#include <CLI/CLI.hpp>
#include <iostream>
#include <map>
#include <sstream>

#include "colour.h"
#include "error.h"

namespace vorelpaint {
namespace {

constexpr const char* kExamples = R"(Examples:
  vorelpaint --preset gold -o title.png "Once upon a time"
  vorelpaint --style look.json --size 160 --color '#3366CC' -o title.png "Title"
  vorelpaint --preset subtitle --align center --text-file lines.txt -o lines.png
  fortune | vorelpaint --preset chalk --background '#204030' --text-file - -o - > page.png
  vorelpaint --list-presets

A style file is a JSON object with one object per effect (outerShadow, innerShadow, outerGlow,
innerGlow, linearGradient, radialGradient, stroke, pattern, text, bevel, emboss); the last lies
on top. The presets are style files to start from.

Exit codes: 0 done, 2 failed with one line on standard error.)";

uint32_t colourOption(const std::string& text) {
    const std::optional<uint32_t> colour = parseColour(text);
    if (!colour) throw CLI::ValidationError("--color", "'" + text + "' is no colour; write #RRGGBB");
    return *colour;
}

/// Also refuses "nan", which lies in no range but passes a comparison with its ends.
float numberOption(const char* name, const std::string& text, float low, float high) {
    float number = 0;
    if (CLI::detail::lexical_cast(text, number) && number >= low && number <= high) return number;
    std::ostringstream fault;
    fault << "'" << text << "' is no number from " << low << " to " << high;
    throw CLI::ValidationError(name, fault.str());
}

Background backgroundOption(const std::string& text) {
    const std::optional<Background> background = parseBackground(text);
    if (!background) {
        throw CLI::ValidationError("--background",
                                   "'" + text + "' is none of transparent, checkerboard, #RRGGBB");
    }
    return *background;
}

Align alignOption(const std::string& text) {
    static const std::map<std::string, Align> kAligns{
        {"left", Align::left}, {"center", Align::center}, {"right", Align::right}};
    const auto found = kAligns.find(text);
    if (found == kAligns.end()) {
        throw CLI::ValidationError("--align", "'" + text + "' is none of left, center, right");
    }
    return found->second;
}

void addTextOptions(CLI::App& app, Options& options) {
    auto* text =
        app.add_option("TEXT", options.text, "The text; a line feed starts a new line")->type_name("");
    app.add_option("--text-file", options.textFile, "Read the text from FILE, - for standard input")
        ->type_name("FILE")
        ->excludes(text);
    app.add_option("--font", options.font, "Font file, or family such as 'DejaVu Sans:bold'")
        ->type_name("FONT")
        ->capture_default_str();
    app.add_option("--size", options.size, "Size of the font in pixels")
        ->type_name("PX")
        ->check(CLI::Range(1, 1000))
        ->capture_default_str();
    app.add_option_function<std::string>(
           "--align", [&](const std::string& value) { options.align = alignOption(value); },
           "Lines stand left, center or right (left)")
        ->type_name("SIDE");
}

void addLookOptions(CLI::App& app, Options& options) {
    auto* style = app.add_option("--style", options.style, "Read the effects from a style file (JSON)")
                      ->type_name("FILE");
    app.add_option("--preset", options.preset, "Take the effects of a preset")
        ->type_name("NAME")
        ->excludes(style);
    app.add_flag("--list-presets", options.listPresets, "List the presets and what they show");
    app.add_option_function<std::string>(
           "--effect-scale",
           [&](const std::string& value) {
               options.effectScale = numberOption("--effect-scale", value, 0.05F, 20);
           },
           "Multiply the effects' sizes (1); presets are made for text of about 100 pixels")
        ->type_name("FACTOR");
    app.add_option_function<std::string>(
           "--color", [&](const std::string& value) { options.color = colourOption(value); },
           "Fill of the text (the style's, else #000000)")
        ->type_name("#RRGGBB");
    app.add_option_function<std::string>(
           "--opacity",
           [&](const std::string& value) { options.opacity = numberOption("--opacity", value, 0, 1); },
           "Opacity of the text, 0 to 1 (the style's, else 1)")
        ->type_name("NUMBER");
}

void addOutputOptions(CLI::App& app, Options& options) {
    app.add_option("-o,--output", options.output, "The PNG file to write, - for standard output")
        ->type_name("FILE");
    app.add_option_function<std::string>(
           "--background",
           [&](const std::string& value) { options.background = backgroundOption(value); },
           "transparent, checkerboard or a colour (transparent)")
        ->type_name("KIND");
    app.add_option("--padding", options.padding, "Pixels around the text and its effects")
        ->type_name("PX")
        ->check(CLI::Range(0, 1000))
        ->capture_default_str();
    app.add_flag("--print-key", options.printKey, "Print the look's cache key in hexadecimal");
    app.add_flag("--print-margins", options.printMargins, "Print the pixels that the effects need");
    app.set_version_flag("--version", "vorelpaint " VOREL_VERSION);
}

void checkCombination(const Options& options) {
    if (options.listPresets) return;
    const bool prints = options.printKey || options.printMargins;
    if (options.output.empty() && !prints) {
        throw ToolError("nowhere to paint: give -o FILE, or -o - for standard output");
    }
    if (options.output == "-" && prints) {
        throw ToolError("standard output cannot take both the picture and what is printed");
    }
    if (!options.output.empty() && !options.text && options.textFile.empty()) {
        throw ToolError("nothing to paint: give TEXT, or --text-file FILE");
    }
}

}  // namespace

std::optional<Options> parseOptions(int argc, const char* const* argv) {
    Options options;
    CLI::App app("Paints text with effects into a PNG file.", "vorelpaint");
    app.footer(kExamples);
    addTextOptions(app, options);
    addLookOptions(app, options);
    addOutputOptions(app, options);
    try {
        app.parse(argc, argv);
    } catch (const CLI::Success& answer) {
        app.exit(answer);
        return std::nullopt;
    } catch (const CLI::ParseError& error) {
        throw ToolError(error.what());
    }
    checkCombination(options);
    return options;
}

}  // namespace vorelpaint
