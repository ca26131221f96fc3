#include "options.h"

#include <CLI/CLI.hpp>
#include <charconv>
#include <functional>
#include <sstream>
#include <system_error>
#include <type_traits>
#include <utility>

#include "colour.h"
#include "error.h"
#include "voreleffect/VFVersion.h"

namespace vorelpaint {
namespace {

constexpr const char* kExamples = R"(Examples:
  vorelpaint --preset gold -o title.png "Once upon a time"
  vorelpaint --style look.json --size 160 --color '#3366CC' -o title.png "Title"
  vorelpaint --preset subtitle --align center --text-file lines.txt -o lines.png
  fortune | vorelpaint --preset chalk --background '#204030' --text-file - -o - > page.png
  vorelpaint --preset neon -o cold.png -- "-40 degrees"
  vorelpaint --list-presets

A style file is a JSON object with one object per effect (outerShadow, innerShadow, outerGlow,
innerGlow, linearGradient, radialGradient, stroke, pattern, text, bevel, emboss); the last lies
on top. The presets are style files to start from; docs/style-files.md lists every key.

Text that begins with - stands behind --.

Exit codes: 0 done, 2 failed with one line on standard error.)";

/// How an option's text is read, and what a text that is refused is said to be.
template <typename Value>
struct Reader {
    std::function<std::optional<Value>(const std::string& text)> read;
    std::string refusal;
};

/// Adds an option that `reader` reads into `value`.
template <typename Target, typename Value>
CLI::Option* addParsed(CLI::App& app, const std::string& name, Target& value, Reader<Value> reader,
                       const std::string& description) {
    const auto assign = [&value, name, reader = std::move(reader)](const std::string& text) {
        const std::optional<Value> read = reader.read(text);
        if (!read) throw CLI::ValidationError(name, "'" + text + "' is " + reader.refusal);
        value = *read;
    };
    return app.add_option_function<std::string>(name, assign, description);
}

/// Reads decimal numbers and nothing around them.
template <typename Number>
Reader<Number> numberFrom(Number low, Number high) {
    const auto read = [low, high](const std::string& text) -> std::optional<Number> {
        Number number{};
        const char* end = text.data() + text.size();
        const auto [stop, error] = std::from_chars(text.data(), end, number);
        const bool whole = error == std::errc{} && stop == end;
        // "nan" is a number here; it fails both comparisons.
        if (whole && number >= low && number <= high) return number;
        return std::nullopt;
    };
    std::ostringstream refusal;
    refusal << (std::is_integral_v<Number> ? "no whole number from " : "no number from ") << low
            << " to " << high;
    return {read, refusal.str()};
}

std::optional<Align> parseAlign(const std::string& text) {
    if (text == "left") return Align::left;
    if (text == "center") return Align::center;
    if (text == "right") return Align::right;
    return std::nullopt;
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
    addParsed(app, "--size", options.size, numberFrom(1, 1000), "Size of the font in pixels")
        ->type_name("PX")
        ->default_str(std::to_string(options.size));
    addParsed(app, "--align", options.align, Reader<Align>{parseAlign, "none of left, center, right"},
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
    addParsed(app, "--effect-scale", options.effectScale, numberFrom(0.05F, 20.0F),
              "Multiply the effects' sizes (1); presets are made for text of about 100 pixels")
        ->type_name("FACTOR");
    addParsed(app, "--color", options.color, Reader<uint32_t>{parseColour, "no colour; write #RRGGBB"},
              "Fill of the text (the style's, else #000000)")
        ->type_name("#RRGGBB");
    addParsed(app, "--opacity", options.opacity, numberFrom(0.0F, 1.0F),
              "Opacity of the text, 0 to 1 (the style's, else 1)")
        ->type_name("NUMBER");
}

void addOutputOptions(CLI::App& app, Options& options) {
    app.add_option("-o,--output", options.output, "The PNG file to write, - for standard output")
        ->type_name("FILE");
    addParsed(app, "--background", options.background,
              Reader<Background>{parseBackground, "none of transparent, checkerboard, #RRGGBB"},
              "transparent, checkerboard or a colour (transparent)")
        ->type_name("KIND");
    addParsed(app, "--padding", options.padding, numberFrom(0, 1000),
              "Pixels around the text and its effects")
        ->type_name("PX")
        ->default_str(std::to_string(options.padding));
    app.add_flag("--print-key", options.printKey, "Print the look's cache key in hexadecimal");
    app.add_flag("--print-margins", options.printMargins, "Print the pixels that the effects need");
    app.set_version_flag("--version", "vorelpaint " VOREL_VERSION_STRING);
}

void checkCombination(const Options& options) {
    if (options.listPresets) return;
    const bool prints = options.printKey || options.printMargins;
    if (!options.output && !prints) {
        throw ToolError("nowhere to paint: give -o FILE, or -o - for standard output");
    }
    if (options.output == "-" && prints) {
        throw ToolError("standard output cannot take both the picture and what is printed");
    }
    if (options.output && !options.text && !options.textFile) {
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
