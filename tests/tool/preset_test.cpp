#include <gtest/gtest.h>

#include <set>
#include <string>
#include <utility>
#include <vector>

#include "painting.h"
#include "program.h"
#include "style_file.h"

namespace vorelpaint {
namespace {

using vorel_test::Outcome;
using vorel_test::runVorelpaint;
using vorel_test::TempDir;
using vorelstyle::Effect;
using vorelstyle::Length;
using vorelstyle::LookStyle;
using vorelstyle::Stack;
using vorelstyle::Stroke;
using vorelstyle::Style;
using voreltext::Image;

Style preset(const std::string& name) {
    return loadStyle(findPreset(name));
}

void failOn(const std::string& note) {
    ADD_FAILURE() << note;
}

/// A capital and a letter with a counter, amid room for any preset's effects.
Image painted(Style style, int size) {
    Options options;
    options.text = "Re";
    options.fonts = {"DejaVu Sans:bold"};
    options.size = size;
    options.canvas.width = 3 * size;
    options.canvas.height = 2 * size;
    options.inlineStyle = std::move(style);
    const Composition composition = composed(options);
    composition.notes().giveTo(failOn);
    return composition.paint();
}

/// Whether the style paints other pixels than the one that lacks a part of it.
bool differ(const Style& style, const Style& lacking, int size) {
    return painted(style, size).pixels != painted(lacking, size).pixels;
}

/// The sizes at which every look must be seen, and every effect: smaller dots and grains merge.
constexpr int kLookSizes[] = {24, 48, 96, 160};
constexpr int kEffectSizes[] = {48, 96, 160};

/// Collects the lengths of a look that are neither shares of the font's size nor 0.
class FixedLengths {
  public:
    explicit FixedLengths(const LookStyle& look) {
        add("offset", look.offsetX);
        add("offset", look.offsetY);
        for (const Effect& effect : look.effects)
            std::visit(*this, effect);
    }

    void operator()(const vorelstyle::Shadow& e) { add("distance", e.distance), add("size", e.size); }
    void operator()(const vorelstyle::Glow& e) { add("size", e.size); }
    void operator()(const vorelstyle::Relief& e) { add("size", e.size); }
    void operator()(const Stroke& e) { add("size", e.size); }
    void operator()(const vorelstyle::Pattern& e) { add("width", e.width.value_or(Length{e.scale})); }
    void operator()(const vorelstyle::LinearGradient&) {}
    void operator()(const vorelstyle::RadialGradient&) {}
    void operator()(const vorelstyle::TextFill&) {}

    const std::vector<std::string>& names() const { return mNames; }

  private:
    void add(const char* name, const Length& length) {
        if (length.value != 0 && length.unit == Length::Unit::pixels) mNames.emplace_back(name);
    }

    std::vector<std::string> mNames;
};

TEST(Presets, TogetherShowEveryEffectAndStrokePosition) {
    std::set<std::string> effects;
    std::set<int> positions;
    for (const std::string& name : presetNames()) {
        const Style style = preset(name);
        for (const LookStyle& look : style.looks) {
            for (const Effect& effect : look.effects) {
                effects.emplace(effectName(effect));
                if (const auto* stroke = std::get_if<Stroke>(&effect))
                    positions.insert(stroke->position);
            }
        }
    }
    const std::set<std::string> painted{"outerShadow", "innerShadow",    "outerGlow",
                                        "innerGlow",   "linearGradient", "radialGradient",
                                        "stroke",      "pattern",        "text"};
    EXPECT_EQ(effects, painted);
    EXPECT_EQ(positions, (std::set<int>{0, 1, 2}));
}

TEST(Presets, EachPaintsWithoutAWarning) {
    const TempDir dir;
    ASSERT_GE(presetNames().size(), 12U);
    for (const std::string& name : presetNames()) {
        const Outcome outcome =
            runVorelpaint({"--preset", name, "--size", "24", "-o", dir.file(name + ".png"), "Ag"});
        EXPECT_EQ(outcome.exitCode, 0) << name;
        EXPECT_EQ(outcome.err, "") << name;
    }
    EXPECT_EQ(dir.list().size(), presetNames().size());
}

TEST(Presets, ListTellsWhatEachShows) {
    const std::string list = runVorelpaint({"--list-presets"}).out;
    for (const std::string& name : presetNames()) {
        const std::string description = preset(name).description;
        EXPECT_FALSE(description.empty()) << name;
        EXPECT_NE(list.find(description + "\n"), std::string::npos) << name;
    }
}

TEST(Presets, Lengths_FollowTheFontSize) {
    for (const std::string& name : presetNames()) {
        for (const LookStyle& look : preset(name).looks) {
            const FixedLengths fixed(look);
            EXPECT_EQ(fixed.names(), std::vector<std::string>{}) << name;
        }
    }
}

TEST(Presets, FromSixteenToFourHundredPixels_NoLimitIsMet) {
    for (const std::string& name : presetNames()) {
        const auto note = [&](const std::string& line) { ADD_FAILURE() << name << ": " << line; };
        for (const int size : {16, 24, 48, 96, 160, 400}) {
            const Style style = resolvedStyle(preset(name), size, 1, note);
            const Stack stack(style, {}, {}, imagesOf(style));
            EXPECT_EQ(stack.notes(), std::vector<std::string>{}) << name << " at " << size;
        }
    }
}

TEST(Presets, EveryLook_IsSeen) {
    for (const std::string& name : presetNames()) {
        const Style style = preset(name);
        for (size_t i = 0; style.looks.size() > 1 && i < style.looks.size(); ++i) {
            Style lacking = style;
            lacking.looks.erase(lacking.looks.begin() + static_cast<std::ptrdiff_t>(i));
            for (const int size : kLookSizes)
                EXPECT_TRUE(differ(style, lacking, size)) << name << ", look " << i << " at " << size;
        }
    }
}

TEST(Presets, EveryEffect_IsSeen) {
    for (const std::string& name : presetNames()) {
        const Style style = preset(name);
        for (size_t i = 0; i < style.looks.size(); ++i) {
            for (size_t at = 0; at < style.looks[i].effects.size(); ++at) {
                Style lacking = style;
                std::vector<Effect>& effects = lacking.looks[i].effects;
                effects.erase(effects.begin() + static_cast<std::ptrdiff_t>(at));
                for (const int size : kEffectSizes) {
                    EXPECT_TRUE(differ(style, lacking, size))
                        << name << ", look " << i << " at " << size << ": "
                        << effectName(style.looks[i].effects[at]);
                }
            }
        }
    }
}

TEST(Presets, ThoseThatShowStacks_AreStacks) {
    for (const char* name : {"varsity", "neon-sign", "retro-3d", "comic-double", "embossed", "chrome",
                             "graffiti", "lower-third"}) {
        EXPECT_GT(preset(name).looks.size(), 1U) << name;
    }
}

}  // namespace
}  // namespace vorelpaint
