#include "set_text.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <string>
#include <utility>

#include "file_io.h"
#include "ranges.h"
#include "unicode/lines.h"
#include "unicode/utf8.h"

namespace vorelpaint {
namespace {

using voreltext::Box;
using voreltext::Fonts;
using voreltext::Glyph;
using voreltext::Room;
using voreltext::TextLayout;
using voreltext::TextSettings;

constexpr size_t kMostMissingNamed = 8;

std::string bytesOfText(const Options& options) {
    if (options.text) return *options.text;
    std::string text = readFile(options.textFile.value(), kMaxTextBytes);
    if (!text.empty() && text.back() == '\n') text.pop_back();
    return text;
}

/// In 64ths of a pixel.
int64_t letterSpacing(const Options& options, int size) {
    const vorelstyle::Length& length = options.letterSpacing;
    const bool isShare = length.unit == vorelstyle::Length::Unit::percent;
    const double pixels = isShare ? double{length.value} * size / 100.0 : double{length.value};
    return std::llround(pixels * 64.0);
}

std::unique_ptr<TextLayout> laidOut(const Options& options, OpenFonts& fonts,
                                    const std::vector<uint32_t>& text, int size, int wrapWidth) {
    return std::make_unique<TextLayout>(
        fonts.fonts(), text,
        TextSettings{options.align, options.lineHeight, letterSpacing(options, size), wrapWidth,
                     options.features});
}

const Glyph* glyphBeyond(const Room& room, const TextLayout& layout) {
    for (size_t i = 0; i < layout.glyphCount(); ++i) {
        if (!room.holds(layout.glyph(i).box)) return &layout.glyph(i);
    }
    return nullptr;
}

void requireRoomForGlyphs(const Room& room, const TextLayout& layout, const SourceText& source) {
    const Glyph* glyph = glyphBeyond(room, layout);
    if (glyph == nullptr) return;
    throw ToolError("the canvas is too small for one glyph: that of " +
                    vorelunicode::nameOf(source.text()[glyph->cluster]) + " at " +
                    source.placeName(glyph->cluster) + " is " + std::to_string(glyph->box.width()) +
                    " x " + std::to_string(glyph->box.height()) + " pixels");
}

SetText shrunk(const Options& options, FontShelf& shelf, const Room& room,
               const std::vector<uint32_t>& text) {
    std::optional<SetText> best;
    std::string fault;
    voreltext::largestThatFits(options.size, [&](int size) {
        try {
            SetText set(options, shelf, text, size);
            fault.clear();
            if (!room.holds(set.box())) return false;
            best = std::move(set);
            return true;
        } catch (const voreltext::TextError& error) {  // in a smaller size it may not be too wide
            fault = error.what();
            return false;
        }
    });
    if (best) return std::move(*best);
    throw ToolError(fault.empty() ? "the text does not fit the canvas at any size" : fault);
}

SetText setInCanvas(const Options& options, FontShelf& shelf, const Room& room,
                    const std::vector<uint32_t>& text) {
    if (options.fit == Fit::shrink) return shrunk(options, shelf, room, text);
    return {options, shelf, text, options.size, options.fit == Fit::wrap ? *room.width : 0};
}

}  // namespace

SourceText::SourceText(const Options& options) : mGiven(voreltext::decodeUtf8(bytesOfText(options))) {
    if (options.markup) {
        mMarked = vorelstyle::parseMarkup(mGiven);
    } else {
        mMarked.text = mGiven;
    }
}

std::string SourceText::placeName(size_t at) const {
    return vorelunicode::placeName(mGiven, mMarked.places.empty() ? at : mMarked.places[at]);
}

SetText::SetText(const Options& options, FontShelf& shelf, const std::vector<uint32_t>& text, int size,
                 int wrapWidth)
    : mSize(size) {
    const FontsKey key = shelf.keyOf(options);
    mFonts = shelf.open(key, size);
    mLayout = laidOut(options, *mFonts, text, size, wrapWidth);
    if (mFonts->fallbacks() > Fonts::kMostFallbacks) {
        // Texts before this one may have taken the places of its fonts.
        mLayout.reset();
        mFonts = shelf.fresh(key, size);
        mLayout = laidOut(options, *mFonts, text, size, wrapWidth);
    }
    mBox = options.box == TextBox::ink ? mLayout->inkBox() : mLayout->lineBox();
}

SetText setToFit(const Options& options, FontShelf& shelf, const SourceText& source) {
    const Room room = voreltext::roomOf(options.canvas);
    SetText set = setInCanvas(options, shelf, room, source.text());
    if (set.layout().glyphCount() == 0) throw InvisibleText();
    requireRoomForGlyphs(room, set.layout(), source);
    return set;
}

void noteMissing(const TextLayout& layout, const SourceText& source, const Note& note) {
    std::string names;
    size_t named = 0;
    for (const voreltext::MissingCharacter& missing : layout.missing()) {
        if (++named > kMostMissingNamed) continue;
        names += (names.empty() ? "" : ", ") + vorelunicode::nameOf(missing.code) + " (" +
                 source.placeName(missing.first) + ")";
    }
    if (named == 0) return;
    if (named > kMostMissingNamed) {
        names += " and " + std::to_string(named - kMostMissingNamed) + " more";
    }
    note("no font has " + names + "; its sign for missing characters is painted");
}

}  // namespace vorelpaint
