#include "explain.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <string>
#include <utility>
#include <vector>

#include "measured_run.h"
#include "memory_meter.h"
#include "progress.h"
#include "wrap.h"

namespace vorelpaint {
namespace {

using vorelstyle::effectName;
using vorelstyle::KeyFragment;
using vorelstyle::Look;
using vorelstyle::printable;
using vorelstyle::Stack;
using vorelstyle::StackedLook;
using vorelstyle::Style;
using voreltext::Canvas;
using voreltext::Frame;
using voreltext::Margins;
using voreltext::marginsOf;
using voreltext::TextLayout;
using Clock = std::chrono::steady_clock;

constexpr size_t kLineWidth = 100;
constexpr size_t kFewestRuns = 5;
constexpr size_t kMostRuns = 50;
constexpr std::chrono::milliseconds kMeasuringTime{500};
constexpr const char* kCostsNote =
    "Times are medians. The memory of the whole run is the most at one time, that of the layers with "
    "that of "
    "one effect; the picture's own comes on top.";

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

    std::string text() const {
        std::string lines;
        for (const std::vector<std::string>& row : mRows) {
            std::string line;
            for (size_t i = 0; i < row.size(); ++i) {
                const std::string space(mWidths[i] - row[i].size(), ' ');
                line += "  " + (i < kLeftColumns ? row[i] + space : space + row[i]);
            }
            line.erase(line.find_last_not_of(' ') + 1);
            lines += line + "\n";
        }
        return lines;
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

std::string printableInQuotes(const std::string& name) {
    return "'" + printable(name) + "'";
}

std::string styleText(const Options& options, const Style& style) {
    if (options.preset)
        return "preset " + printable(*options.preset) + ": " + printable(style.description);
    if (options.style) return "file " + printableInQuotes(*options.style);
    return "none";
}

std::string marginsText(const Margins& margins) {
    return "left " + std::to_string(margins.left) + ", top " + std::to_string(margins.top) + ", right " +
           std::to_string(margins.right) + ", bottom " + std::to_string(margins.bottom) + " pixels";
}

std::string sizeText(int width, int height) {
    return std::to_string(width) + " x " + std::to_string(height) + " pixels";
}

std::string layersText(const LookPlan& plan) {
    if (!plan.layered) return "one: " + plan.reason;
    return "two: " + plan.reason + ", so the paint outside the glyphs has a layer of its own";
}

/// "Order of painting", and of which look where there are several.
std::string orderHeading(const std::vector<StackedPlan>& plans, size_t at) {
    const size_t count = plans.size();
    if (count == 1) return "\nOrder of painting, the topmost effect first:\n\n";
    return "\nLook " + std::to_string(at + 1) + " of " + std::to_string(count) +
           (at + 1 == count ? ", the topmost: "
            : at == 0       ? ", the lowest: "
                            : ": ") +
           plans[at].place + ". Order of painting, the topmost effect first:\n\n";
}

std::string orderTable(const LookPlan& plan) {
    Table table({"effect", "place"});
    for (const PlannedEffect& effect : plan.effects)
        table.add({std::string(effectName(effect.type)), std::string(placeName(effect.place))});
    return table.text();
}

std::string costTable(const LookPlan& plan, const MeasuredRun& run) {
    Table table({"step", "place", "time", "memory"});
    const auto add = [&](const std::string& step, const std::string& place, const Cost& cost) {
        table.add({step, place, timeText(cost), memoryText(cost.bytes)});
    };
    add("glyphs", "the mask", run.glyphs);
    for (size_t i = 0; i < plan.effects.size(); ++i) {
        const PlannedEffect& effect = plan.effects[i];
        add(std::string(effectName(effect.type)), std::string(placeName(effect.place)), run.effects[i]);
    }
    add("merge", "the picture", run.merge);
    add("whole run", "", run.whole);
    return table.text();
}

std::string keyPart(const std::string& name, const std::string& meaning) {
    constexpr size_t kIndent = 18;
    std::string lines = wrapped(meaning, kLineWidth, kIndent);
    return lines.replace(2, name.size(), name) + "\n";
}

std::string keyText(const Stack& stack) {
    std::string text =
        "\nCache key of " + std::to_string(stack.key().size()) + " bytes, before the first run:\n\n";
    for (const KeyFragment& fragment : vorelstyle::keyFragments(stack.key()))
        text += keyPart(std::string(fragment.name), fragment.meaning);
    const bool hasPattern =
        std::any_of(stack.looks().begin(), stack.looks().end(), [](const StackedLook& each) {
            const std::vector<int>& added = each.look.added();
            return std::find(added.begin(), added.end(), vorelstyle::kPatternType) != added.end();
        });
    if (!hasPattern) return text;
    return text + keyPart("pattern", "leaves no trace: tell patterns apart by a key of your own");
}

/// The runs of a look: one for each of its spans.
std::vector<RunOfGlyphs> runsOf(const TextLayout& text, const voreltext::Layer& layer) {
    VFontEffect::VFEffect effects(*layer.effects);
    const Margins margins = marginsOf(effects);
    std::vector<RunOfGlyphs> runs;
    for (const std::vector<size_t>& glyphs : spansOf(text, layer.span)) {
        RunOfGlyphs run{{text.glyph(glyphs.front()).box, margins, 0}, {}};
        for (const size_t i : glyphs) {
            run.frame.ink.grow(text.glyph(i).box);
            run.masks.push_back(text.rasterise(i));
        }
        runs.push_back(std::move(run));
    }
    return runs;
}

MeasuredRun measure(const Look& look, const LookPlan& plan, const std::vector<RunOfGlyphs>& glyphs) {
    Progress progress("runs measured", 0);
    const Clock::time_point end = Clock::now() + kMeasuringTime;
    std::vector<MeasuredRun> runs;
    while (runs.size() < kFewestRuns || (runs.size() < kMostRuns && Clock::now() < end)) {
        runs.push_back(measuredRuns(look, plan, glyphs));
        progress.advance();
    }
    return medianOf(std::move(runs));
}

std::string textText(const Composition& composition) {
    const size_t count = composition.text().layout().glyphCount();
    return std::to_string(count) + (count == 1 ? " glyph" : " glyphs") + " of " +
           std::to_string(composition.text().size()) + " pixels in " +
           std::to_string(composition.text().layout().lines().size()) +
           (composition.text().layout().lines().size() == 1 ? " line" : " lines");
}

std::string looksText(const Stack& stack) {
    const std::vector<StackedLook>& looks = stack.looks();
    if (looks.size() > 1) return entry("looks", std::to_string(looks.size()) + ", the last on top");
    return entry("layers", layersText(planOf(looks.front().look)));
}

std::string headText(const Options& options, const LayerSet& looks, const Margins& margins) {
    return entry("style", styleText(options, looks.style())) + entry("margins", marginsText(margins)) +
           looksText(looks.stack());
}

std::string fontsText(const TextLayout& text) {
    std::string names;
    for (const std::string& name : text.fontsUsed())
        names += (names.empty() ? "" : ", ") + printableInQuotes(name);
    return names;
}

/// What is told of each look, the topmost first; `table` tells how it is painted.
template <typename MakeTable>
std::string looksExplained(const Stack& stack, MakeTable table) {
    const std::vector<StackedPlan> plans = plansOf(stack);
    std::string text;
    for (size_t at = plans.size(); at-- > 0;) {
        const LookPlan& plan = plans[at].look;
        text += orderHeading(plans, at) + table(at, plan);
        if (plans.size() > 1) text += "\n  Layers: " + layersText(plan) + "\n";
    }
    return text;
}

}  // namespace

std::string explanationOf(const Options& options, const LayerSet& looks) {
    return headText(options, looks, marginsOf(looks.layers())) +
           looksExplained(looks.stack(),
                          [](size_t /*at*/, const LookPlan& plan) { return orderTable(plan); }) +
           keyText(looks.stack());
}

std::string explanationOf(const Options& options, const Composition& composition) {
    const LayerSet& looks = composition.looks();
    const TextLayout& text = composition.text().layout();
    const Canvas& canvas = composition.canvas();
    return headText(options, looks, composition.margins()) + entry("text", textText(composition)) +
           entry("fonts", fontsText(text)) +
           entry("ink", sizeText(text.inkBox().width(), text.inkBox().height())) +
           entry("picture", sizeText(canvas.width, canvas.height)) +
           looksExplained(looks.stack(),
                          [&](size_t at, const LookPlan& plan) {
                              const Look& look = looks.stack().looks()[at].look;
                              const auto runs = runsOf(text, looks.layers()[at]);
                              return costTable(plan, measure(look, plan, runs));
                          }) +
           "\n" + wrapped(kCostsNote, kLineWidth, 0) + "\n" + keyText(looks.stack());
}

}  // namespace vorelpaint
