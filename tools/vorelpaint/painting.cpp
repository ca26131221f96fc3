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
using vorelstyle::Stack;
using vorelstyle::Style;
using voreltext::Font;
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
    return vorelstyle::resolvedStyle(namedStyle(options), options.size, options.effectScale);
}

std::string chosenText(const Options& options) {
    if (options.text) return *options.text;
    std::string text = readFile(options.textFile.value(), kMaxTextBytes);
    if (!text.empty() && text.back() == '\n') text.pop_back();
    return text;
}

Look makeLook(const Options& options, const Style& style, const Warn& warn) {
    const Stack stack(style, options.color, options.opacity, imagesOf(style));
    for (const std::string& effect : stack.unpainted()) {
        warn("warning: the library has no core for " + effect + "; it is not painted");
    }
    return stack.looks().front().look;
}

TextLayout layOutText(const Options& options, const Font& font, const Warn& warn) {
    TextLayout text(font, voreltext::decodeUtf8(chosenText(options)), options.align);
    if (text.glyphCount() == 0) throw ToolError("nothing to paint: the text has no visible character");
    if (text.missingGlyphs() > 0) {
        warn("warning: characters missing from the font: " + std::to_string(text.missingGlyphs()));
    }
    return text;
}

void writePicture(const Options& options, Image picture) {
    layOn(picture, options.background);
    writeFile(options.output.value(), [&](std::FILE* file) { writePng(file, picture); });
}

void paintPicture(const Options& options, const Warn& warn) {
    Look look = makeLook(options, chosenStyle(options), warn);
    const Font font(findFont(options.font), options.size);
    writePicture(options, paint(look.effects(), layOutText(options, font, warn), options.padding));
}

}  // namespace vorelpaint
