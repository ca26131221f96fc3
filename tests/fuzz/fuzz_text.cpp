/// The first 40 bytes are choices for a layout, a canvas and a stack of two looks; the others are a text
/// with markup. Either it is laid out, with every glyph in its line and every line in its box, and
/// painted, or it is refused in one line; nothing else may be thrown.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "style/error.h"
#include "style/markup.h"
#include "tests/fuzz/decoder.h"
#include "tests/fuzz/demand.h"
#include "text/voreltext.h"

namespace {

using namespace voreltext;
using namespace vorel_fuzz;
using VFontEffect::VFEffect;
using vorelstyle::ColourRange;
using vorelstyle::MarkedText;

constexpr int kSize = 16;
constexpr size_t kChoices = 40;      ///< bytes of them, in front of the text
constexpr size_t kMostPainted = 40;  ///< glyphs; more take long, and go the same ways

/// Opened once: a font is slower to open than a text to lay out.
Fonts& fonts() {
    static Fonts all{Font(FontFile{VOREL_TEST_FONT}, kSize)};
    return all;
}

void demandRanges(const MarkedText& marked, size_t sourceLength) {
    demand(marked.text.size() <= sourceLength, "markup adds characters");
    demand(marked.places.size() == marked.text.size(), "a character has no place");
    size_t before = 0;
    for (const ColourRange& range : marked.colours) {
        demand(before <= range.begin && range.begin < range.end, "ranges overlap or are empty");
        demand(range.end <= marked.text.size(), "a range reaches beyond the text");
        demandColour(range.colour);
        before = range.end;
    }
}

bool contains(const Box& outer, const Box& inner) {
    return inner.isEmpty() || (outer.left <= inner.left && outer.top <= inner.top &&
                               outer.right >= inner.right && outer.bottom >= inner.bottom);
}

void demandLines(const TextLayout& layout, size_t textLength) {
    demand(!layout.lines().empty(), "a text has no line");
    const int height = layout.lines().front().box.height();
    size_t before = 0;
    for (const Line& line : layout.lines()) {
        demand(line.box.height() == height, "line boxes differ in height");
        demand(before <= line.begin && line.begin <= line.end && line.end <= textLength,
               "lines are out of order");
        demand(contains(layout.inkBox(), line.ink), "a line's ink is not in the text's");
        before = line.end;
    }
}

void demandGlyphs(const TextLayout& layout) {
    for (size_t i = 0; i < layout.glyphCount(); ++i) {
        const Glyph& glyph = layout.glyph(i);
        demand(glyph.line < layout.lines().size(), "a glyph has no line");
        const Line& line = layout.lines()[glyph.line];
        demand(line.begin <= glyph.cluster && glyph.cluster < line.end, "a glyph is not of its line");
        demand(contains(line.ink, glyph.box), "a glyph's ink is not in its line's");
    }
}

TextSettings settingsOf(Decoder& in) {
    TextSettings settings;
    settings.align = static_cast<Align>(in.between(0, 4));
    settings.lineHeight = in.wildFloat(0.5F, 3);
    settings.letterSpacing = in.wildInt(-512, 1024);
    if (in.oneIn(3)) settings.wrapWidth = in.wildInt(20, 400);
    if (in.oneIn(4)) settings.features.emplace_back("liga=0");
    return settings;
}

CanvasRequest canvasOf(Decoder& in) {
    CanvasRequest request;
    if (in.flag()) request.width = in.between(1, 500);
    if (in.flag()) request.height = in.between(1, 200);
    request.anchor = static_cast<Anchor>(in.between(0, 8));
    request.margin = in.between(0, 20);
    request.padding = in.between(0, 20);
    return request;
}

/// A look that lets the one beneath be seen.
VFEffect topLook(Decoder& in) {
    VFEffect effects;
    const float size = in.real(0, 6);
    const int position = in.between(0, 2);
    effects.addStrokeText(size, 0xFFFFFF, 1, 0, position);
    effects.addText(0xCC3366, 1);
    return effects;
}

void paintStack(Decoder& in, const TextLayout& layout, const MarkedText& marked) {
    VFEffect below;
    below.addOuterGlowText(in.real(0, 12), 0x3366CC, 1, 0, nullptr);
    below.addText(0x102030, 1);
    VFEffect above = topLook(in);
    Layer top{&above};
    top.x = in.between(-5, 5);
    top.y = in.between(-5, 5);
    top.span = static_cast<Span>(in.between(0, 3));
    for (const ColourRange& range : marked.colours)
        top.colours.push_back({range.begin, range.end, range.colour});
    top.takesPictures = true;
    const std::vector<Layer> layers{{&below}, top};
    const CanvasRequest request = canvasOf(in);
    roomOf(request);
    const Canvas canvas = placedOn(request, layout.inkBox(), marginsOf(layers));
    const Image image = paint(layers, layout, canvas);
    demand(image.pixels.size() == size_t{4} * static_cast<size_t>(image.width * image.height),
           "a picture has another size than its pixels");
}

void read(Decoder& in, std::string_view text) {
    const std::vector<uint32_t> source = decodeUtf8(text);
    const MarkedText marked = vorelstyle::parseMarkup(source);
    demandRanges(marked, source.size());
    const TextLayout layout(fonts(), marked.text, settingsOf(in));
    demandLines(layout, marked.text.size());
    demandGlyphs(layout);
    if (layout.glyphCount() <= kMostPainted) paintStack(in, layout, marked);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const size_t choices = std::min(size, kChoices);
    Decoder in(data, choices);
    try {
        read(in, {reinterpret_cast<const char*>(data) + choices, size - choices});
    } catch (const TextError& error) {
        demandLine(error.what());
    } catch (const vorelstyle::StyleError& error) {
        demandLine(error.what());
    }
    return 0;
}
