#include "text/text_layout.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <string>
#include <utility>

#include "text/error.h"
#include "text/line_setter.h"
#include "text/paragraphs.h"
#include "text/rasteriser.h"
#include "text/units.h"
#include "unicode/characters.h"
#include "unicode/lines.h"

namespace voreltext {
namespace {

using vorelunicode::endsLine;
using vorelunicode::isBlank;

/// A font may step backwards as well as forwards.
void checkSide(int64_t units) {
    if (std::abs(units) <= TextLayout::kMaxSide * kUnit) return;
    throw TextError("the text would be more than " + std::to_string(TextLayout::kMaxSide) +
                    " pixels wide or high");
}

/// The part of a line's slack that stands on its left.
int64_t leftShare(Align align, bool isRightToLeft, int64_t slack) {
    switch (align) {
        case Align::center:
            return slack / 2;
        case Align::right:
            return slack;
        case Align::start:
            return isRightToLeft ? slack : 0;
        case Align::end:
            return isRightToLeft ? 0 : slack;
        default:
            return 0;
    }
}

/// A font may step backwards on the way.
void checkWidth(const SetLine& line) {
    int64_t width = 0;
    for (const ShapedGlyph& glyph : line.glyphs) {
        width += glyph.advance;
        checkSide(width);
    }
}

/// From baseline to baseline, in whole pixels.
int64_t lineAdvance(const Fonts& fonts, const TextSettings& settings) {
    const double units = static_cast<double>(fonts.main().lineHeight()) * double{settings.lineHeight};
    return std::max(int64_t{1}, static_cast<int64_t>(std::floor(units / kUnit + 0.5))) * kUnit;
}

/// An enlarged picture is kept as bytes, unlike an outline.
void checkPicture(const GlyphInk& ink) {
    if (ink.isPicture) checkSide(std::max(ink.box.width(), ink.box.height()) * kUnit);
}

/// The box of a line: from the main font's ascender to its descender, with half of what the line height
/// has beyond that above and the rest below. It reaches to that of the next line.
Box boxOf(const Font& main, int64_t left, int64_t width, int baseline, int64_t advance) {
    const int height = floorToPixel(advance);
    const int leading = height - floorToPixel(main.ascender() - main.descender());
    const int top = baseline - floorToPixel(main.ascender()) - static_cast<int>(floorOf(leading, 2));
    const int64_t right = left + std::max<int64_t>(width, 0);
    return {floorToPixel(left), top, ceilToPixel(right), top + height};
}

/// For each character which word it is of; those between words count to the one before.
std::vector<size_t> wordsOf(const std::vector<uint32_t>& text) {
    std::vector<size_t> words;
    words.reserve(text.size());
    size_t begun = 0;
    bool isWithin = false;
    for (const uint32_t code : text) {
        const bool isGap = isBlank(code) || endsLine(code);
        if (!isGap && !isWithin) ++begun;
        isWithin = !isGap;
        words.push_back(begun == 0 ? 0 : begun - 1);
    }
    return words;
}

}  // namespace

TextLayout::TextLayout(Fonts& fonts, const std::vector<uint32_t>& text, const TextSettings& settings)
    : mFonts(fonts) {
    checkSettings(settings);
    LineSetter setter(fonts, settings);
    const int64_t advance = lineAdvance(fonts, settings);
    std::vector<SetLine> lines;
    int64_t width = 0;
    for (const Paragraph& paragraph : splitParagraphs(text)) {
        setter.set(paragraph, [&](SetLine line) {
            checkWidth(line);
            width = std::max(width, line.width);
            lines.push_back(std::move(line));
            checkSide(static_cast<int64_t>(lines.size()) * advance);
        });
    }
    mMissing = setter.missing();
    const std::vector<size_t> words = wordsOf(text);
    for (const SetLine& line : lines) {
        const int64_t shift = leftShare(settings.align, line.isRightToLeft, width - line.width);
        placeLine(line, shift, -static_cast<int64_t>(mLines.size()) * advance, words);
        Line& placed = mLines.back();
        placed.box = boxOf(fonts.main(), shift, line.width, placed.baseline, advance);
    }
}

void TextLayout::placeLine(const SetLine& set, int64_t shift, int64_t baseline,
                           const std::vector<size_t>& words) {
    Line line{};
    line.baseline = -floorToPixel(baseline);
    line.begin = set.begin;
    line.end = set.end;
    line.isRightToLeft = set.isRightToLeft;
    int64_t pen = shift;
    for (const ShapedGlyph& each : set.glyphs) {
        const GlyphOrigin origin{each.index, pen + each.x, baseline + each.y};
        pen += each.advance;
        checkSide(origin.x);
        checkSide(origin.y);
        const GlyphInk ink = inkOf(mFonts[each.font], origin);
        if (ink.box.isEmpty()) continue;
        checkPicture(ink);
        line.ink.grow(ink.box);
        mGlyphs.push_back(
            {{ink.box, mLines.size(), words[each.cluster], each.cluster, each.font, ink.isPicture},
             origin.index,
             origin.x,
             origin.y});
    }
    mInkBox.grow(line.ink);
    mLines.push_back(line);
}

Box TextLayout::lineBox() const {
    Box box = mLines.front().box;
    for (const Line& line : mLines) {
        box = {std::min(box.left, line.box.left), std::min(box.top, line.box.top),
               std::max(box.right, line.box.right), std::max(box.bottom, line.box.bottom)};
    }
    return box;
}

std::vector<std::string> TextLayout::fontsUsed() const {
    std::vector<size_t> fonts;
    for (const Glyph& glyph : mGlyphs) {
        if (std::find(fonts.begin(), fonts.end(), glyph.font) == fonts.end())
            fonts.push_back(glyph.font);
    }
    std::vector<std::string> names;
    names.reserve(fonts.size());
    for (const size_t font : fonts)
        names.push_back(mFonts[font].name());
    return names;
}

GlyphMask TextLayout::rasterise(size_t index) const {
    const PlacedGlyph& glyph = mGlyphs[index];
    return rasterised(mFonts[glyph.font], {glyph.index, glyph.x, glyph.y});
}

}  // namespace voreltext
