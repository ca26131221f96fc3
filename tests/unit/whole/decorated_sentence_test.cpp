#include <gtest/gtest.h>

#include "tests/support/both_sets.h"
#include "tests/support/compare.h"
#include "tests/support/mask_gallery.h"

/// A real sentence with every effect at once, against the literal engine.
namespace vorel_test {
namespace {

template <class Set>
literal::Picture decorated(float textOpacity, int strokePosition) {
    Kit<Set> kit;
    Set set;
    set.setTextOpacity(textOpacity);
    set.addOuterShadowText(120, 6, 5, 0x000000, 0.6F);
    set.addOuterGlowText(7, 0, 0.8F, 3, kit.stops);
    set.addStrokeText(3, 0xFFFFFF, 1, 0, strokePosition);
    set.addRadialGradientText(1.5F, 0.4F, 3, kit.stops);
    set.addLinearGradientText(60, 1, 0.5F, 3, kit.stops);
    set.addPatternText(&kit.tile, 2.5F, 0.3F);
    set.addInnerGlowText(2, 0xFFFFFF, 0.5F, 0, nullptr);
    set.addInnerShadowText(300, 2, 1, 0x400000, 0.8F);
    const literal::Mask& line = glyphLine();
    return paintedRun(set, line, {line.width + 40, line.height + 40, 20, 20});
}

TEST(DecoratedSentence, WithEveryEffect_IsTheLiteralPicture) {
    ASSERT_GT(glyphLine().width, 100);
    for (const float textOpacity : {1.0F, 0.5F}) {
        for (const int position : {0, 1, 2}) {
            SCOPED_TRACE(::testing::Message() << "opacity " << textOpacity << " stroke " << position);
            const literal::Picture expected = decorated<literal::Engine>(textOpacity, position);
            const literal::Picture actual = decorated<VFontEffect::VFEffect>(textOpacity, position);
            EXPECT_TRUE(sameBytes(expected.bytes.data(), actual.bytes.data(), expected.width,
                                  expected.height, 4));
        }
    }
}

}  // namespace
}  // namespace vorel_test
