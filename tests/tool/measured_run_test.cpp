#include "measured_run.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "font_choice.h"
#include "memory_meter.h"
#include "style_file.h"

namespace vorelpaint {
namespace {

using vorelstyle::KeyFragment;
using vorelstyle::Look;
using vorelstyle::parseStyle;
using vorelstyle::Style;
using voreltext::decodeUtf8;
using voreltext::Font;
using voreltext::Fonts;
using voreltext::Frame;
using voreltext::GlyphMask;
using voreltext::Image;
using voreltext::TextLayout;

class MeasuredRunTest : public ::testing::Test {
  protected:
    Frame frameOf(Look& look) const { return {mText.inkBox(), voreltext::marginsOf(look.effects()), 3}; }

    std::vector<GlyphMask> glyphs() const {
        std::vector<GlyphMask> masks;
        for (size_t i = 0; i < mText.glyphCount(); ++i)
            masks.push_back(mText.rasterise(i));
        return masks;
    }

    /// The run in steps paints what the run in one paints, in the order in which the set is planned.
    void expectThePlannedPicture(const Style& style, float opacity, size_t at = 0) {
        Look look(style.looks[at], 0x336699, opacity, imagesOf(style));
        const LookPlan plan = planOf(look);
        const std::vector<int> planned = plannedOrder(look);
        Image inSteps;
        measuredRun(look, plan, frameOf(look), glyphs(), &inSteps);
        const Image inOne = paint(look.effects(), mText, 3);
        EXPECT_EQ(inSteps.width, inOne.width);
        EXPECT_EQ(inSteps.pixels, inOne.pixels);
        EXPECT_EQ(withoutPattern(typesOf(plan)), planned);
    }

    /// The order of the key after planning, which follows the set's list.
    static std::vector<int> plannedOrder(const Look& look) {
        VFontEffect::VFEffect effects(look.effects());
        effects.initEffect(1, 1);
        const std::unique_ptr<char[]> key(effects.getMapKey());
        std::vector<int> types;
        for (const KeyFragment& fragment : vorelstyle::keyFragments(key.get()))
            types.push_back(fragment.type);
        return types;
    }

    static std::vector<int> typesOf(const LookPlan& plan) {
        std::vector<int> types;
        for (const PlannedEffect& planned : plan.effects)
            types.push_back(planned.type);
        return types;
    }

    static std::vector<int> withoutPattern(std::vector<int> types) {
        types.erase(std::remove(types.begin(), types.end(), 11), types.end());
        return types;
    }

    Fonts mFonts{Font(findFont("DejaVu Sans"), 40)};
    TextLayout mText{mFonts, decodeUtf8("Fig")};
};

TEST_F(MeasuredRunTest, EveryPreset_IsPaintedAsInOneRun) {
    for (const std::string& name : presetNames()) {
        SCOPED_TRACE(name);
        const Style style = resolvedStyle(loadStyle(findPreset(name)), mFonts.main().sizePx(), 1);
        for (size_t i = 0; i < style.looks.size(); ++i) {
            expectThePlannedPicture(style, 1, i);
            expectThePlannedPicture(style, 0.5F, i);
        }
    }
}

TEST_F(MeasuredRunTest, TextAmongTheEffects_IsPaintedInItsPlace) {
    const char* json = R"({"stroke": {"size": 2, "color": "#0000FF", "position": "outside"},
                           "text": {"color": "#111111", "opacity": 0.7},
                           "innerGlow": {"size": 4, "color": "#FF0000"},
                           "outerGlow": {"size": 9, "color": "#00FF00"}})";
    expectThePlannedPicture(parseStyle(json), 1);
    expectThePlannedPicture(parseStyle(json), 0.3F);
}

TEST_F(MeasuredRunTest, Memory_IsThatOfTheLayersAndOneEffect) {
    if (!MemoryMeter::works()) GTEST_SKIP() << "a sanitizer has the allocator";
    Look opaque({}, 0, 1);
    Look translucent({}, 0, 0.5F);
    const Frame frame = frameOf(opaque);
    const auto pixels = static_cast<size_t>(frame.width()) * static_cast<size_t>(frame.height());
    const auto layersOf = [&](Look& look) {
        return measuredRun(look, planOf(look), frame, glyphs()).glyphs.bytes;
    };
    EXPECT_NEAR(static_cast<double>(layersOf(opaque)), static_cast<double>(pixels), 300);
    EXPECT_NEAR(static_cast<double>(layersOf(translucent)), static_cast<double>(5 * pixels), 300);

    Look glow(parseStyle(R"({"outerGlow": {"size": 9, "color": "#00FF00"}})").looks.front(), 0, 1);
    const MeasuredRun run = measuredRun(glow, planOf(glow), frameOf(glow), glyphs());
    ASSERT_EQ(run.effects.size(), 2U);
    EXPECT_GT(run.effects[1].bytes, 0U) << "the glow works on planes of its own";
    EXPECT_EQ(run.whole.bytes, run.glyphs.bytes + run.effects[1].bytes);
}

TEST_F(MeasuredRunTest, Median_IsTakenStepByStep) {
    std::vector<MeasuredRun> runs(3);
    for (size_t i = 0; i < runs.size(); ++i) {
        runs[i].effects.resize(1);
        runs[i].glyphs.milliseconds = static_cast<double>(i);          // 0 1 2
        runs[i].effects[0].milliseconds = static_cast<double>(2 - i);  // 2 1 0
        runs[i].merge.milliseconds = i == 0 ? 5 : 7;                   // 5 7 7
        runs[i].whole.milliseconds = i == 1 ? 100 : 9;                 // 9 100 9
    }
    const MeasuredRun median = medianOf(runs);
    EXPECT_EQ(median.glyphs.milliseconds, 1);
    EXPECT_EQ(median.effects[0].milliseconds, 1);
    EXPECT_EQ(median.merge.milliseconds, 7);
    EXPECT_EQ(median.whole.milliseconds, 9);
}

}  // namespace
}  // namespace vorelpaint
