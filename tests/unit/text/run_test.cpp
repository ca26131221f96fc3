#include "text/run.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "text/error.h"
#include "text/utf8.h"

namespace voreltext {
namespace {

using VFontEffect::VFEffect;

TEST(Margins, AreTheReachOfTheEffects) {
    VFEffect shadow;
    shadow.addOuterShadowText(0, 10, 10, 0x000000, 1);
    const Margins margins = marginsOf(shadow);
    EXPECT_EQ(margins.left, 20);
    EXPECT_EQ(margins.top, 10);
    EXPECT_EQ(margins.right, 0);
    EXPECT_EQ(margins.bottom, 10);
}

TEST(Paint, FillAlone_IsTheCoverageInItsColour) {
    Fonts fonts{Font(FontFile{VOREL_TEST_FONT}, 40)};
    const TextLayout text(fonts, decodeUtf8("I"));
    VFEffect effects;
    effects.addText(0xFF0000, 1);
    const Image picture = paint(effects, text, 2);
    const GlyphMask glyph = text.rasterise(0);
    ASSERT_EQ(picture.width, glyph.box.width() + 4);
    ASSERT_EQ(picture.height, glyph.box.height() + 4);
    ASSERT_EQ(picture.pixels.size(), static_cast<size_t>(picture.width * picture.height * 4));
    const auto pixelAt = [&](int x, int y) {
        return &picture.pixels[static_cast<size_t>((y * picture.width + x) * 4)];
    };
    for (int y = 0; y < glyph.box.height(); ++y) {
        for (int x = 0; x < glyph.box.width(); ++x) {
            const uint8_t coverage = glyph.coverage[static_cast<size_t>(y * glyph.box.width() + x)];
            EXPECT_EQ(pixelAt(x + 2, y + 2)[3], coverage) << x << ' ' << y;
        }
    }
    EXPECT_EQ(pixelAt(0, 0)[3], 0);
    const int middle = picture.width / 2;
    EXPECT_EQ(pixelAt(middle, picture.height / 2)[0], 255);
    EXPECT_EQ(pixelAt(middle, picture.height / 2)[1], 0);
}

TEST(Paint, PictureBeyondTheLimit_IsRefused) {
    EXPECT_NO_THROW(checkSize(TextLayout::kMaxSide, 2048));
    EXPECT_THROW(checkSize(TextLayout::kMaxSide, 2049), TextError);
    EXPECT_THROW(checkSize(TextLayout::kMaxSide + 1, 1), TextError);
    EXPECT_THROW(checkSize(1, TextLayout::kMaxSide + 1), TextError);
    EXPECT_THROW(checkSize(-1, 1), TextError);
    EXPECT_THROW(checkSize(1, -1), TextError);
}

}  // namespace
}  // namespace voreltext
