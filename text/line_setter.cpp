#include "text/line_setter.h"

#include <utility>

namespace voreltext {

LineSetter::LineSetter(Fonts& fonts, const TextSettings& settings)
    : mSettings(settings), mShaper(fonts, settings.features), mChooser(fonts, mShaper) {}

std::vector<SetLine> LineSetter::set(const Paragraph& paragraph) {
    (void)mSettings;
    SetLine line;
    line.begin = paragraph.begin;
    line.end = line.begin + paragraph.codes.size();
    line.isRightToLeft = isRightToLeft(paragraph);
    line.glyphs = std::move(mChooser.choose(paragraph).glyphs);
    for (ShapedGlyph& glyph : line.glyphs) {
        glyph.cluster += line.begin;
        line.width += glyph.advance;
    }
    return {line};
}

}  // namespace voreltext
