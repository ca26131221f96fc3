#include "painting.h"

#include <utility>

#include "background.h"
#include "error.h"
#include "file_io.h"
#include "font_choice.h"
#include "png_io.h"
#include "ranges.h"
#include "style_file.h"

namespace vorelpaint {
namespace {

using vorelstyle::Look;
using vorelstyle::Style;
using voreltext::Font;
using voreltext::Fonts;
using voreltext::Image;
using voreltext::TextLayout;

Style namedStyle(const Options& options) {
    if (options.inlineStyle) return *options.inlineStyle;
    if (options.preset) return loadStyle(findPreset(*options.preset));
    if (options.style) return loadStyle(*options.style);
    return {};
}

}  // namespace

Style chosenStyle(const Options& options) {
    return vorelstyle::scaledStyle(namedStyle(options), options.effectScale);
}

uint32_t chosenFill(const Options& options, const Style& style) {
    return options.color.value_or(fillOf(style));
}

float chosenOpacity(const Options& options, const Style& style) {
    return options.opacity.value_or(opacityOf(style));
}

std::string chosenText(const Options& options) {
    if (options.text) return *options.text;
    std::string text = readFile(options.textFile.value(), kMaxTextBytes);
    if (!text.empty() && text.back() == '\n') text.pop_back();
    return text;
}

Look makeLook(const Options& options, const Style& style, const Warn& warn) {
    Look look(style, chosenFill(options, style), chosenOpacity(options, style), imagesOf(style));
    for (const std::string& effect : look.unpainted()) {
        warn("warning: the library has no core for " + effect + "; it is not painted");
    }
    return look;
}

TextLayout layOutText(const Options& options, Fonts& fonts, const Warn& warn) {
    TextLayout text(fonts, voreltext::decodeUtf8(chosenText(options)), {options.align});
    if (text.glyphCount() == 0) throw ToolError("nothing to paint: the text has no visible character");
    size_t missing = 0;
    for (const voreltext::MissingCharacter& character : text.missing())
        missing += character.count;
    if (missing > 0) warn("warning: characters missing from the font: " + std::to_string(missing));
    return text;
}

void writePicture(const Options& options, Image picture) {
    layOn(picture, options.background);
    writeFile(options.output.value(), [&](std::FILE* file) { writePng(file, picture); });
}

void paintPicture(const Options& options, const Warn& warn) {
    Look look = makeLook(options, chosenStyle(options), warn);
    Fonts fonts{Font(findFont(options.font), options.size)};
    writePicture(options, paint(look.effects(), layOutText(options, fonts, warn), options.padding));
}

}  // namespace vorelpaint
