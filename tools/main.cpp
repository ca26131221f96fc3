#include <cstdio>
#include <exception>
#include <iostream>
#include <new>
#include <string>

#include "background.h"
#include "error.h"
#include "file_io.h"
#include "font.h"
#include "font_finder.h"
#include "look.h"
#include "options.h"
#include "png_io.h"
#include "style_file.h"
#include "style_scale.h"
#include "text_layout.h"
#include "utf8.h"

namespace vorelpaint {
namespace {

constexpr int kFailed = 2;
constexpr size_t kMaxTextBytes = size_t{1} << 16;

/// One line on standard error, whatever bytes a file name or a message brings along.
void say(std::string line) {
    for (char& c : line) {
        if (static_cast<unsigned char>(c) < 0x20 || c == 0x7F) c = ' ';
    }
    std::cerr << "vorelpaint: " << line << '\n';
}

void printPresets() {
    for (const std::string& name : presetNames()) {
        std::cout << name << std::string(name.size() < 12 ? 12 - name.size() : 1, ' ')
                  << loadStyle(findPreset(name)).description << '\n';
    }
}

void printKey(const std::string& key) {
    constexpr const char* kDigits = "0123456789abcdef";
    std::cout << "key ";
    for (const char c : key) {
        const auto byte = static_cast<unsigned char>(c);
        std::cout << kDigits[byte >> 4] << kDigits[byte & 15];
    }
    std::cout << '\n';
}

void printMargins(const Margins& margins) {
    std::cout << "margins left " << margins.left << " top " << margins.top << " right " << margins.right
              << " bottom " << margins.bottom << '\n';
}

Style chosenStyle(const Options& options) {
    if (options.preset) return loadStyle(findPreset(*options.preset));
    if (options.style) return loadStyle(*options.style);
    return {};
}

/// The command line's colour, else the style's, else black.
uint32_t chosenFill(const Options& options, const Style& style) {
    if (options.color) return *options.color;
    for (const Effect& effect : style.effects) {
        if (const auto* text = std::get_if<TextFill>(&effect)) return text->color;
    }
    return style.color.value_or(0);
}

std::string chosenText(const Options& options) {
    if (options.text) return *options.text;
    std::string text = readFile(options.textFile.value(), kMaxTextBytes);
    if (!text.empty() && text.back() == '\n') text.pop_back();
    return text;
}

void paint(const Options& options, Look& look) {
    const Font font(findFont(options.font), options.size);
    const TextLayout text(font, decodeUtf8(chosenText(options)), options.align);
    if (text.glyphCount() == 0) throw ToolError("nothing to paint: the text has no visible character");
    if (text.missingGlyphs() > 0) {
        say("warning: characters missing from the font: " + std::to_string(text.missingGlyphs()));
    }
    Image picture = look.paint(text, options.padding);
    layOn(picture, options.background);
    writeFile(options.output.value(), [&](std::FILE* file) { writePng(file, picture); });
}

void run(const Options& options) {
    if (options.listPresets) return printPresets();
    const Style style = scaledStyle(chosenStyle(options), options.effectScale);
    const float opacity = options.opacity.value_or(style.textOpacity.value_or(1.0F));
    Look look(style, chosenFill(options, style), opacity);
    for (const std::string& effect : look.unpainted()) {
        say("warning: the library has no core for " + effect + "; it is not painted");
    }
    if (options.printKey) printKey(look.key());
    if (options.printMargins) printMargins(look.margins());
    if (options.output) paint(options, look);
}

int runProgram(int argc, const char* const* argv) {
    try {
        const std::optional<Options> options = parseOptions(argc, argv);
        if (options) run(*options);
        if (!std::cout.flush()) throw ToolError("cannot write standard output");
        return 0;
    } catch (const std::bad_alloc&) {
        say("not enough memory");
    } catch (const std::exception& error) {
        say(error.what());
    }
    return kFailed;
}

}  // namespace
}  // namespace vorelpaint

int main(int argc, char** argv) {
    return vorelpaint::runProgram(argc, argv);
}
