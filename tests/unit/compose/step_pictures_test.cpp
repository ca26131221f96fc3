#include "compose/step_pictures.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <vector>

#include "compose/plan.h"
#include "composed.h"

namespace vorelcompose {
namespace {

using voreltext::Image;

LookPlan planned(const Composition& composition) {
    return planOf(composition.looks().stack().looks().front().look);
}

size_t positionOf(const LookPlan& plan, EffectPlace place) {
    const auto at = std::find_if(plan.effects.begin(), plan.effects.end(),
                                 [&](const PlannedEffect& each) { return each.place == place; });
    return static_cast<size_t>(at - plan.effects.begin());
}

/// The pictures of the effects of a plain look laid over each other, the topmost first, in real numbers.
std::vector<double> laid(const Composition& composition) {
    const Image coverage = coveragePicture(composition, 0);
    std::vector<double> whole(coverage.pixels.size());
    const LookPlan plan = planned(composition);
    for (size_t effect = 0; effect < plan.effects.size(); ++effect) {
        const Image picture = effectPicture(composition, 0, effect);
        const bool isBeneath = plan.effects[effect].place == EffectPlace::beneath;
        for (size_t i = 0; i < whole.size(); i += 4) {
            const double full = isBeneath ? 255 : coverage.pixels[i + 3];
            if (full == 0) continue;
            double rest = std::max(0.0, 1 - whole[i + 3] / full);
            if (plan.effects[effect].place == EffectPlace::text && whole[i + 3] > 0) rest *= full / 255;
            for (size_t c = 0; c < 4; ++c)
                whole[i + c] += picture.pixels[i + c] * rest;
        }
    }
    return whole;
}

class StepPictures : public ::testing::Test {
  protected:
    Composed mComposed;
};

TEST_F(StepPictures, OfAPlainLook_MakeTheWhole) {
    // Each of the five pictures is cut to whole numbers when it is painted and when it is clipped.
    constexpr double kRounding = 2 * 5;
    const Composition composition = mComposed.of(kPlainLook);
    ASSERT_FALSE(planned(composition).layered);
    ASSERT_EQ(planned(composition).effects.size(), 5U);
    const std::vector<double> inSteps = laid(composition);
    const Image whole = composition.paint();
    double farthest = 0;
    for (size_t i = 0; i < inSteps.size(); ++i)
        farthest = std::max(farthest, std::fabs(inSteps[i] - whole.pixels[i]));
    EXPECT_LE(farthest, kRounding);
}

TEST_F(StepPictures, OnTheText_LieWithinTheGlyphs) {
    for (const float opacity : {1.0F, 0.5F}) {
        mComposed.request.opacity = opacity;
        const Composition composition = mComposed.of(kPlainLook);
        const Image coverage = coveragePicture(composition, 0);
        const LookPlan plan = planned(composition);
        for (size_t effect = 0; effect < plan.effects.size(); ++effect) {
            if (plan.effects[effect].place != EffectPlace::on) continue;
            const Image picture = effectPicture(composition, 0, effect);
            int painted = 0;
            for (size_t i = 3; i < picture.pixels.size(); i += 4) {
                EXPECT_LE(picture.pixels[i], coverage.pixels[i]);
                painted += picture.pixels[i] != 0;
            }
            EXPECT_GT(painted, 0);
        }
    }
}

TEST_F(StepPictures, OutsideTranslucentText_AreCutOutOfTheGlyphs) {
    mComposed.request.opacity = 0.5F;
    const Composition composition = mComposed.of(kPlainLook);
    const size_t outside = positionOf(planned(composition), EffectPlace::outside);
    const Image coverage = coveragePicture(composition, 0);
    const Image picture = effectPicture(composition, 0, outside);
    int painted = 0;
    for (size_t i = 3; i < picture.pixels.size(); i += 4) {
        if (coverage.pixels[i] == 255) {
            EXPECT_EQ(picture.pixels[i], 0);
        }
        painted += picture.pixels[i] != 0;
    }
    EXPECT_GT(painted, 0);
}

TEST_F(StepPictures, BeneathOpaqueText_RunOnUnderTheGlyphs) {
    const Composition composition = mComposed.of(kPlainLook);
    const size_t stroke = positionOf(planned(composition), EffectPlace::beneath);
    const Image coverage = coveragePicture(composition, 0);
    const Image picture = effectPicture(composition, 0, stroke);
    for (size_t i = 3; i < picture.pixels.size(); i += 4) {
        if (coverage.pixels[i] == 255) {
            EXPECT_EQ(picture.pixels[i], 255);
        }
    }
}

TEST_F(StepPictures, OfAFillAlone_AreTheWhole) {
    for (const char* style :
         {R"({"color": "#C04010"})",
          R"({"version": 2, "looks": [{"span": "glyph", "offset": {"x": 4, "y": -3}}]})"}) {
        const Composition composition = mComposed.of(style, "a<c #F00>b</c>", true);
        EXPECT_EQ(effectPicture(composition, 0, 0).pixels, composition.paint().pixels);
    }
}

TEST_F(StepPictures, OfALook_LieOneOverTheOther) {
    const Composition composition =
        mComposed.of(R"({"version": 2, "looks": [{"offset": {"x": 5, "y": 5}}, {"color": "#FFF"}]})");
    Image whole = lookPicture(composition, 0);
    layOver(whole, lookPicture(composition, 1), 0, 0);
    EXPECT_EQ(whole.pixels, composition.paint().pixels);
}

TEST_F(StepPictures, OfAFontWithoutColours_AreClear) {
    const Image picture = fontPicture(mComposed.of(kPlainLook), 0);
    EXPECT_EQ(picture.pixels, std::vector<uint8_t>(picture.pixels.size(), 0));
}

}  // namespace
}  // namespace vorelcompose
