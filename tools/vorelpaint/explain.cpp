#include "explain.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <ostream>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "measured_run.h"
#include "memory_meter.h"
#include "progress.h"
#include "wrap.h"

namespace vorelpaint {
namespace {

using vorelstyle::Effect;
using vorelstyle::effectName;
using vorelstyle::KeyFragment;
using vorelstyle::Look;
using vorelstyle::printable;
using vorelstyle::Stroke;
using vorelstyle::Style;
using voreltext::Frame;
using voreltext::GlyphMask;
using voreltext::Margins;
using voreltext::marginsOf;
using voreltext::TextLayout;
using Clock = std::chrono::steady_clock;

constexpr const char* kOrderHeading = "\nOrder of painting, the topmost effect first:\n\n";
constexpr size_t kLineWidth = 100;
constexpr size_t kFewestRuns = 5;
constexpr size_t kMostRuns = 50;
constexpr std::chrono::milliseconds kMeasuringTime{500};

/// Rows of words in aligned columns: the first two to the left, the others to the right.
class Table {
  public:
    explicit Table(std::vector<std::string> headings) { add(std::move(headings)); }

    void add(std::vector<std::string> row) {
        mWidths.resize(std::max(mWidths.size(), row.size()));
        for (size_t i = 0; i < row.size(); ++i)
            mWidths[i] = std::max(mWidths[i], row[i].size());
        mRows.push_back(std::move(row));
    }

    void print(std::ostream& out) const {
        for (const std::vector<std::string>& row : mRows) {
            std::string line;
            for (size_t i = 0; i < row.size(); ++i) {
                const std::string space(mWidths[i] - row[i].size(), ' ');
                line += "  " + (i < kLeftColumns ? row[i] + space : space + row[i]);
            }
            line.erase(line.find_last_not_of(' ') + 1);
            out << line << '\n';
        }
    }

  private:
    static constexpr size_t kLeftColumns = 2;

    std::vector<std::vector<std::string>> mRows;
    std::vector<size_t> mWidths;
};

std::string inUnits(double value, int decimals, const char* unit) {
    char text[48];
    std::snprintf(text, sizeof text, "%.*f %s", decimals, value, unit);
    return text;
}

std::string timeText(const Cost& cost) {
    return inUnits(cost.milliseconds, 3, "ms");
}

std::string memoryText(size_t bytes) {
    if (!MemoryMeter::works()) return "not counted";
    constexpr double kKilo = 1024;
    const auto size = static_cast<double>(bytes);
    return size < kKilo * kKilo ? inUnits(size / kKilo, 1, "KiB")
                                : inUnits(size / kKilo / kKilo, 1, "MiB");
}

std::string entry(const char* name, const std::string& value) {
    const std::string label = name;
    return label + std::string(12 - label.size(), ' ') + value + "\n";
}

std::string inQuotes(const std::string& name) {
    return "'" + printable(name) + "'";
}

std::string styleText(const Options& options, const Style& style) {
    if (options.preset)
        return "preset " + printable(*options.preset) + ": " + printable(style.description);
    if (options.style) return "file " + inQuotes(*options.style);
    return "none";
}

std::string marginsText(const Margins& margins) {
    return "left " + std::to_string(margins.left) + ", top " + std::to_string(margins.top) + ", right " +
           std::to_string(margins.right) + ", bottom " + std::to_string(margins.bottom) + " pixels";
}

std::string sizeText(int width, int height) {
    return std::to_string(width) + " x " + std::to_string(height) + " pixels";
}

std::string layersText(const Look& look, const Plan& plan) {
    if (!plan.layered) return "one: the text is opaque, and no stroke is centred";
    VFontEffect::VFEffect effects(look.effects());
    const std::string reason =
        effects.getTextOpacity() < 1.0F ? "the text is translucent" : "a stroke is centred on the edge";
    return "two: " + reason + ", so the paint outside the glyphs has a layer of its own";
}

bool isCentredStroke(const Style& style, int type) {
    const std::vector<Effect>& effects = style.looks.front().effects;
    return type == vorelstyle::kStrokeType &&
           std::any_of(effects.begin(), effects.end(), [](const Effect& effect) {
               const auto* stroke = std::get_if<Stroke>(&effect);
               return stroke != nullptr && stroke->position == 0;
           });
}

std::string placeText(const Style& style, const Plan& plan, size_t at) {
    const int type = plan.order[at];
    if (type == vorelstyle::kTextType) return "the text";
    if (isCentredStroke(style, type)) return "across the edge";
    if (plan.under[at]) return plan.layered ? "outside the text" : "beneath the text";
    return "on the text";
}

void printOrder(std::ostream& out, const Style& style, const Plan& plan) {
    out << kOrderHeading;
    Table table({"effect", "place"});
    for (size_t i = 0; i < plan.order.size(); ++i)
        table.add({std::string(effectName(plan.order[i])), placeText(style, plan, i)});
    table.print(out);
}

void printCosts(std::ostream& out, const Style& style, const Plan& plan, const MeasuredRun& run) {
    out << kOrderHeading;
    Table table({"step", "place", "time", "memory"});
    const auto add = [&](const std::string& step, const std::string& place, const Cost& cost) {
        table.add({step, place, timeText(cost), memoryText(cost.bytes)});
    };
    add("glyphs", "the mask", run.glyphs);
    for (size_t i = 0; i < plan.order.size(); ++i)
        add(std::string(effectName(plan.order[i])), placeText(style, plan, i), run.effects[i]);
    add("merge", "the picture", run.merge);
    add("whole run", "", run.whole);
    table.print(out);
    out << '\n'
        << wrapped(
               "Times are medians. The memory of the whole run is the most at one time, that of the "
               "layers with that of one effect; the picture's own comes on top.",
               kLineWidth, 0)
        << '\n';
}

void printKeyPart(std::ostream& out, const std::string& name, const std::string& meaning) {
    constexpr size_t kIndent = 18;
    std::string lines = wrapped(meaning, kLineWidth, kIndent);
    out << lines.replace(2, name.size(), name) << '\n';
}

void printKey(std::ostream& out, const Look& look) {
    out << "\nCache key of " << look.key().size() << " bytes, before the first run:\n\n";
    for (const KeyFragment& fragment : vorelstyle::keyFragments(look.key()))
        printKeyPart(out, std::string(fragment.name), fragment.meaning);
    const std::vector<int>& added = look.added();
    if (std::find(added.begin(), added.end(), vorelstyle::kPatternType) != added.end()) {
        printKeyPart(out, "pattern", "leaves no trace: tell patterns apart by a key of your own");
    }
}

std::vector<GlyphMask> masksOf(const TextLayout& text) {
    std::vector<GlyphMask> masks;
    for (size_t i = 0; i < text.glyphCount(); ++i)
        masks.push_back(text.rasterise(i));
    return masks;
}

MeasuredRun measure(const Look& look, const Plan& plan, const Frame& frame,
                    const std::vector<GlyphMask>& glyphs) {
    Progress progress("runs measured", 0);
    const Clock::time_point end = Clock::now() + kMeasuringTime;
    std::vector<MeasuredRun> runs;
    while (runs.size() < kFewestRuns || (runs.size() < kMostRuns && Clock::now() < end)) {
        runs.push_back(measuredRun(look, plan, frame, glyphs));
        progress.advance();
    }
    return medianOf(std::move(runs));
}

std::string textText(const Options& options, const TextLayout& text) {
    return std::to_string(text.glyphCount()) + (text.glyphCount() == 1 ? " glyph" : " glyphs") + " of " +
           std::to_string(options.size) + " pixels in " + inQuotes(options.font);
}

void printHead(std::ostream& out, const Options& options, const Style& style, Look& look,
               const Plan& plan) {
    out << entry("style", styleText(options, style))
        << entry("margins", marginsText(marginsOf(look.effects())))
        << entry("layers", layersText(look, plan));
}

}  // namespace

void explain(std::ostream& out, const Options& options, const Style& style, Look& look,
             const TextLayout* text) {
    const Plan plan = planOf(look);
    printHead(out, options, style, look, plan);
    if (text == nullptr) {
        printOrder(out, style, plan);
    } else {
        const Frame frame{text->inkBox(), marginsOf(look.effects()), options.padding};
        out << entry("text", textText(options, *text))
            << entry("ink", sizeText(frame.ink.width(), frame.ink.height()))
            << entry("picture", sizeText(frame.width(), frame.height()));
        printCosts(out, style, plan, measure(look, plan, frame, masksOf(*text)));
    }
    printKey(out, look);
}

}  // namespace vorelpaint
