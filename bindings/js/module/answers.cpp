#include "answers.h"

#include <utility>

#include "json_writer.h"
#include "unicode/utf8.h"

namespace vorelscript {
namespace {

using vorelcompose::Composition;
using voreltext::Box;

void writeSides(JsonWriter& json, const char* key, int left, int top, int right, int bottom) {
    json.key(key).beginArray().value(left).value(top).value(right).value(bottom).endArray();
}

/// Moved by (x, y).
void writeBox(JsonWriter& json, const char* key, const Box& box, int x = 0, int y = 0) {
    writeSides(json, key, box.left + x, box.top + y, box.right + x, box.bottom + y);
}

/// What a picture and a layout tell alike.
void writeText(JsonWriter& json, const Composition& of) {
    const voreltext::TextLayout& layout = of.text().layout();
    std::vector<std::string> missing;
    for (const voreltext::MissingCharacter& each : layout.missing())
        missing.push_back(vorelunicode::encoded(each.code));
    std::vector<std::string> notes;
    of.notes().giveTo([&](const std::string& note) { notes.push_back(note); });
    json.entry("size", of.text().size())
        .entry("fonts", layout.fontsUsed())
        .entry("missing", missing)
        .entry("notes", notes);
}

void writeLines(JsonWriter& json, const voreltext::TextLayout& layout) {
    json.key("lines").beginArray();
    for (const voreltext::Line& line : layout.lines()) {
        json.beginObject().entry("baseline", line.baseline);
        writeBox(json, "box", line.box);
        json.endObject();
    }
    json.endArray();
}

void writeGlyph(JsonWriter& json, const voreltext::Glyph& glyph, const voreltext::GlyphMask& mask,
                size_t at) {
    json.beginObject()
        .entry("x", mask.box.left)
        .entry("y", mask.box.top)
        .entry("width", mask.box.width())
        .entry("height", mask.box.height())
        .entry("at", at)
        .entry("line", glyph.line)
        .entry("word", glyph.word)
        .entry("cluster", glyph.cluster)
        .endObject();
}

void writeMargins(JsonWriter& json, const voreltext::Margins& margins) {
    writeSides(json, "margins", margins.left, margins.top, margins.right, margins.bottom);
}

void writePlan(JsonWriter& json, const vorelcompose::StackedPlan& plan) {
    json.beginObject()
        .entry("layered", plan.look.layered)
        .entry("reason", plan.look.reason)
        .entry("place", plan.place)
        .entry("placeReason", plan.reason);
    json.key("order").beginArray();
    for (const vorelcompose::PlannedEffect& effect : plan.look.effects) {
        json.beginObject()
            .entry("effect", vorelstyle::effectName(effect.type))
            .entry("place", placeName(effect.place))
            .entry("reason", effect.reason)
            .endObject();
    }
    json.endArray().endObject();
}

void writeKey(JsonWriter& json, const std::string& key) {
    json.key("key").beginArray();
    for (const vorelstyle::KeyFragment& fragment : vorelstyle::keyFragments(key)) {
        json.beginObject().entry("name", fragment.name).entry("meaning", fragment.meaning).endObject();
    }
    json.endArray().entry("keyBytes", vorelstyle::hexadecimal(key));
}

}  // namespace

Answer pictureAnswer(const Composition& composition, bool isPremultiplied,
                     const vorelcompose::Background& background) {
    voreltext::Image image = composition.paint();
    if (!isPremultiplied) layOn(image, background);
    const voreltext::Canvas& canvas = composition.canvas();
    const voreltext::TextLayout& layout = composition.text().layout();
    JsonWriter json;
    json.beginObject()
        .entry("width", image.width)
        .entry("height", image.height)
        .entry("premultiplied", isPremultiplied)
        .entry("x", canvas.x)
        .entry("y", canvas.y)
        .entry("baseline", layout.lines().front().baseline + canvas.y);
    writeBox(json, "ink", layout.inkBox(), canvas.x, canvas.y);
    writeBox(json, "box", composition.text().box(), canvas.x, canvas.y);
    writeMargins(json, composition.margins());
    json.entry("key", vorelstyle::hexadecimal(composition.looks().stack().key()));
    writeText(json, composition);
    json.endObject();
    return {json.text(), std::move(image.pixels)};
}

Answer layoutAnswer(const Composition& composition) {
    const voreltext::TextLayout& layout = composition.text().layout();
    std::vector<uint8_t> bytes;
    JsonWriter json;
    json.beginObject().key("glyphs").beginArray();
    for (size_t i = 0; i < layout.glyphCount(); ++i) {
        const voreltext::GlyphMask mask = layout.rasterise(i);
        writeGlyph(json, layout.glyph(i), mask, bytes.size());
        bytes.insert(bytes.end(), mask.coverage.begin(), mask.coverage.end());
    }
    json.endArray();
    writeLines(json, layout);
    writeBox(json, "ink", layout.inkBox());
    writeBox(json, "box", composition.text().box());
    writeText(json, composition);
    json.endObject();
    return {json.text(), std::move(bytes)};
}

Answer planAnswer(const vorelcompose::LayerSet& looks) {
    JsonWriter json;
    json.beginObject();
    writeMargins(json, marginsOf(looks.layers()));
    json.key("looks").beginArray();
    for (const vorelcompose::StackedPlan& plan : vorelcompose::plansOf(looks.stack()))
        writePlan(json, plan);
    json.endArray();
    writeKey(json, looks.stack().key());
    json.endObject();
    return {json.text(), {}};
}

Answer imageAnswer(voreltext::Image image) {
    JsonWriter json;
    json.beginObject().entry("width", image.width).entry("height", image.height).endObject();
    return {json.text(), std::move(image.pixels)};
}

}  // namespace vorelscript
