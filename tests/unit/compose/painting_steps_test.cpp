#include "compose/painting_steps.h"

#include <gtest/gtest.h>

#include <string>

#include "composed.h"

namespace vorelcompose {
namespace {

using Kind = PaintingStep::Kind;

class PaintingStepsTest : public ::testing::Test {
  protected:
    static void expectTheWholePicture(const Composition& composition) {
        PaintingSteps steps(composition);
        while (steps.prepare())
            steps.paint();
        EXPECT_EQ(steps.picture().width, composition.canvas().width);
        EXPECT_EQ(steps.picture().pixels, composition.paint().pixels);
    }

    static std::string kindsOf(const Composition& composition) {
        PaintingSteps steps(composition);
        std::string kinds;
        while (steps.prepare()) {
            const PaintingStep& step = steps.step();
            kinds += std::to_string(step.look) + std::to_string(step.span);
            kinds += step.kind == Kind::glyphs   ? "g "
                     : step.kind == Kind::effect ? "e" + std::to_string(step.effect) + " "
                                                 : "m ";
            steps.paint();
        }
        return kinds;
    }

    Composed mComposed;
};

TEST_F(PaintingStepsTest, EveryLook_IsPaintedAsInOne) {
    for (const char* style : {"{}", kPlainLook, kCentredLook, kStackOfLooks}) {
        SCOPED_TRACE(style);
        expectTheWholePicture(mComposed.of(style, "Fi g\nab"));
        mComposed.request.opacity = 0.4F;
        expectTheWholePicture(mComposed.of(style, "Fi g\nab"));
        mComposed.request.opacity.reset();
    }
}

TEST_F(PaintingStepsTest, ColoursOfTheMarkup_ArePaintedAsInOne) {
    for (const char* style : {"{}", kCentredLook, kStackOfLooks})
        expectTheWholePicture(mComposed.of(style, "a<c #F00>b</c>c <c #00F>d</c>", true));
}

TEST_F(PaintingStepsTest, CanvasThatCutsTheTextOff_IsPaintedAsInOne) {
    mComposed.request.canvas.width = 20;
    mComposed.request.canvas.height = 19;
    for (const char* style : {kPlainLook, kStackOfLooks})
        expectTheWholePicture(mComposed.of(style));
}

TEST_F(PaintingStepsTest, OfEachSpan_AreTheGlyphsTheEffectsAndTheMerge) {
    EXPECT_EQ(kindsOf(mComposed.of("{}")), "00g 00e0 00m ");
    EXPECT_EQ(kindsOf(mComposed.of(R"({"version": 2, "looks": [{"span": "word"}, {}]})")),
              "00g 00e0 00m 01g 01e0 01m 10g 10e0 10m ");
}

TEST_F(PaintingStepsTest, Picture_HasWhatIsMerged) {
    const Composition composition = mComposed.of("{}");
    PaintingSteps steps(composition);
    const voreltext::Image clear = steps.picture();
    for (int i = 0; i < 2; ++i) {
        ASSERT_TRUE(steps.prepare());
        steps.paint();
        EXPECT_EQ(steps.picture().pixels, clear.pixels);
    }
    ASSERT_TRUE(steps.prepare());
    steps.paint();
    EXPECT_NE(steps.picture().pixels, clear.pixels);
    EXPECT_FALSE(steps.prepare());
}

}  // namespace
}  // namespace vorelcompose
