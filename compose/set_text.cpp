#include "compose/set_text.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <string>
#include <utility>

#include "compose/error.h"
#include "unicode/lines.h"
#include "unicode/utf8.h"

namespace vorelcompose {
namespace {

using voreltext::Box;
using voreltext::Fonts;
using voreltext::Glyph;
using voreltext::Room;
using voreltext::TextLayout;
using voreltext::TextSettings;

constexpr size_t kMostMissingNamed = 8;

/// In 64ths of a pixel.
int64_t letterSpacing(const Request& request, int size) {
    const vorelstyle::Length& length = request.letterSpacing;
    const bool isShare = length.unit == vorelstyle::Length::Unit::percent;
    const double pixels = isShare ? double{length.value} * size / 100.0 : double{length.value};
    return std::llround(pixels * 64.0);
}

std::unique_ptr<TextLayout> laidOut(const Request& request, OpenFonts& fonts,
                                    const std::vector<uint32_t>& text, int size, int wrapWidth) {
    return std::make_unique<TextLayout>(
        fonts.fonts(), text,
        TextSettings{request.align, request.lineHeight, letterSpacing(request, size), wrapWidth,
                     request.features});
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
    throw ComposeError("the canvas is too small for one glyph: that of " +
                       vorelunicode::nameOf(source.text()[glyph->cluster]) + " at " +
                       source.placeName(glyph->cluster) + " is " + std::to_string(glyph->box.width()) +
                       " x " + std::to_string(glyph->box.height()) + " pixels");
}

SetText shrunk(const Request& request, FontShelf& shelf, const Room& room,
               const std::vector<uint32_t>& text) {
    std::optional<SetText> best;
    std::string fault;
    voreltext::largestThatFits(request.size, [&](int size) {
        try {
            SetText set(request, shelf, text, size);
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
    throw ComposeError(fault.empty() ? "the text does not fit the canvas at any size" : fault);
}

SetText setInCanvas(const Request& request, FontShelf& shelf, const Room& room,
                    const std::vector<uint32_t>& text) {
    if (request.fit == Fit::shrink) return shrunk(request, shelf, room, text);
    return {request, shelf, text, request.size, request.fit == Fit::wrap ? *room.width : 0};
}

}  // namespace

SourceText::SourceText(const std::string& utf8, bool hasMarkup) : mGiven(voreltext::decodeUtf8(utf8)) {
    if (hasMarkup) {
        mMarked = vorelstyle::parseMarkup(mGiven);
    } else {
        mMarked.text = mGiven;
    }
}

std::string SourceText::placeName(size_t at) const {
    return vorelunicode::placeName(mGiven, mMarked.places.empty() ? at : mMarked.places[at]);
}

SetText::SetText(const Request& request, FontShelf& shelf, const std::vector<uint32_t>& text, int size,
                 int wrapWidth)
    : mSize(size) {
    const FontsKey key = shelf.keyOf(request);
    mFonts = shelf.open(key, size);
    mLayout = laidOut(request, *mFonts, text, size, wrapWidth);
    if (mFonts->fallbacks() > Fonts::kMostFallbacks) {
        // Texts before this one may have taken the places of its fonts.
        mLayout.reset();
        mFonts = shelf.fresh(key, size);
        mLayout = laidOut(request, *mFonts, text, size, wrapWidth);
    }
    mBox = request.box == TextBox::ink ? mLayout->inkBox() : mLayout->lineBox();
}

SetText setToFit(const Request& request, FontShelf& shelf, const SourceText& source) {
    const Room room = voreltext::roomOf(request.canvas);
    SetText set = setInCanvas(request, shelf, room, source.text());
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

}  // namespace vorelcompose
