#include <gtest/gtest.h>

#include <set>
#include <string>

#include "program.h"
#include "style_file.h"

namespace vorelpaint {
namespace {

using vorel_test::Outcome;
using vorel_test::runVorelpaint;
using vorel_test::TempDir;
using vorelstyle::Effect;
using vorelstyle::LookStyle;
using vorelstyle::Stroke;
using vorelstyle::Style;

TEST(Presets, TogetherShowEveryEffectAndStrokePosition) {
    std::set<std::string> effects;
    std::set<int> positions;
    for (const std::string& name : presetNames()) {
        const Style style = loadStyle(findPreset(name));
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
        const std::string description = loadStyle(findPreset(name)).description;
        EXPECT_FALSE(description.empty()) << name;
        EXPECT_NE(list.find(description + "\n"), std::string::npos) << name;
    }
}

}  // namespace
}  // namespace vorelpaint
