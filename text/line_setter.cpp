#include "text/line_setter.h"

#include <string>
#include <utility>

#include "text/error.h"
#include "text/letter_spacing.h"
#include "text/units.h"
#include "text/wrapping.h"
#include "unicode/characters.h"
#include "unicode/utf8.h"

namespace voreltext {
namespace {

/// The features that are asked for. With letters apart, those that join them come first, as what stands
/// behind outdoes it.
std::vector<std::string> featuresOf(const TextSettings& settings) {
    std::vector<std::string> features;
    if (settings.letterSpacing != 0) features = {"-liga", "-clig"};
    features.insert(features.end(), settings.features.begin(), settings.features.end());
    return features;
}

/// What shows that a word goes on in the next line, if the font has it.
std::optional<uint32_t> hyphenOf(const Font& font) {
    constexpr uint32_t kHyphen = 0x2010;
    for (const uint32_t code : {kHyphen, uint32_t{'-'}}) {
        if (font.has(code)) return code;
    }
    return std::nullopt;
}

[[noreturn]] void refuseWidth(const Paragraph& paragraph, size_t at, int width) {
    throw TextError(vorelunicode::nameOf(paragraph.codes[at]) + " in line " +
                    std::to_string(paragraph.number) + ", character " + std::to_string(at + 1) +
                    " of the text is wider than " + std::to_string(width) + " pixels");
}

}  // namespace

/// A source line with what it takes to set its parts.
struct LineSetter::Source {
    const Paragraph& paragraph;
    const FontedParagraph& fonted;
    const Wrapping& wrapping;
};

LineSetter::LineSetter(Fonts& fonts, const TextSettings& settings)
    : mFonts(fonts),
      mSpacing(settings.letterSpacing),
      mWidth(settings.wrapWidth),
      mShaper(fonts, featuresOf(settings)),
      mChooser(fonts, mShaper) {}

void LineSetter::set(const Paragraph& paragraph, const Take& take) {
    FontedParagraph fonted = mChooser.choose(paragraph);
    addLetterSpacing(fonted.glyphs, paragraph.codes, mSpacing);
    const size_t end = paragraph.codes.size();
    if (mWidth == 0 || end == 0) {
        take(placed(std::move(fonted.glyphs), paragraph, 0, end));
        return;
    }
    const Wrapping wrapping(paragraph, fonted.glyphs);
    const Source source{paragraph, fonted, wrapping};
    for (size_t begin = 0; begin < end;) {
        SetLine line = nextLine(source, begin);
        begin = line.end - paragraph.begin;
        take(std::move(line));
    }
}

/// The line that begins at `begin`.
SetLine LineSetter::nextLine(const Source& source, size_t begin) {
    if (auto line = longestLine(source, Wrapping::Ends::ofWords, begin)) return *std::move(line);
    if (auto line = longestLine(source, Wrapping::Ends::ofClusters, begin)) return *std::move(line);
    refuseWidth(source.paragraph, begin, mWidth);
}

/// The longest line that begins at `begin` and is not too wide; none where all are.
std::optional<SetLine> LineSetter::longestLine(const Source& source, Wrapping::Ends ends, size_t begin) {
    const int64_t width = mWidth * kUnit;
    // About as wide, it may turn out no wider; beyond that a long word would be shaped in vain for each
    // of its lines.
    const int64_t atMost = 2 * (width + mFonts.main().sizePx() * kUnit);
    size_t end = source.wrapping.lastFitting(ends, begin, width);
    if (source.wrapping.width(begin, end) > atMost) return std::nullopt;
    SetLine line = part(source, begin, end);
    while (line.width > width) {
        end = source.wrapping.shorter(ends, begin, end);
        if (end == begin) return std::nullopt;
        line = part(source, begin, end);
    }
    while (end < source.paragraph.codes.size()) {
        end = source.wrapping.longer(ends, begin, end);
        if (source.wrapping.width(begin, end) > atMost) break;
        SetLine longer = part(source, begin, end);
        if (longer.width > width) break;
        line = std::move(longer);
    }
    return line;
}

/// A part of a source line, shaped by itself without the blanks behind it.
SetLine LineSetter::part(const Source& source, size_t begin, size_t end) {
    const size_t inkEnd = source.wrapping.withoutBlanks(begin, end);
    const auto from = static_cast<ptrdiff_t>(begin);
    const auto to = static_cast<ptrdiff_t>(inkEnd);
    const Paragraph& whole = source.paragraph;
    std::vector<uint32_t> codes(whole.codes.begin() + from, whole.codes.begin() + to);
    std::vector<size_t> fonts(source.fonted.fonts.begin() + from, source.fonted.fonts.begin() + to);
    if (source.wrapping.isHyphenated(end) && codes.size() > 1) {
        fonts.back() = fonts[fonts.size() - 2];
        codes.back() = hyphenOf(mFonts[fonts.back()]).value_or(codes.back());
    }
    std::vector<ShapedGlyph> glyphs =
        mShaper.shape({codes.data(), fonts.data(), whole.scripts.data() + begin,
                       whole.levels.data() + begin, codes.size(), whole.isRightToLeft});
    addLetterSpacing(glyphs, codes, mSpacing);
    for (ShapedGlyph& glyph : glyphs)
        glyph.cluster += begin;
    return placed(std::move(glyphs), whole, begin, end);
}

/// The line of the glyphs of a part of a source line.
SetLine LineSetter::placed(std::vector<ShapedGlyph> glyphs, const Paragraph& paragraph, size_t begin,
                           size_t end) {
    SetLine line{std::move(glyphs), 0, paragraph.begin + begin, paragraph.begin + end,
                 paragraph.isRightToLeft};
    for (ShapedGlyph& glyph : line.glyphs) {
        glyph.cluster += paragraph.begin;
        line.width += glyph.advance;
    }
    return line;
}

}  // namespace voreltext
