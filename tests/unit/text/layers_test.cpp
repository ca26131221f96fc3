#include "text/layers.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <limits>
#include <string_view>
#include <vector>

#include "text/overlay.h"
#include "text/utf8.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

using VFontEffect::VFEffect;
using VFontEffect::VFGradient;

constexpr int kSize = 40;

/// A text in the font of the tests.
class Sample {
  public:
    explicit Sample(std::string_view text, const TextSettings& settings = {})
        : mLayout(mFonts, decodeUtf8(text), settings) {}
    const TextLayout& layout() const { return mLayout; }

  private:
    Fonts mFonts{Font(FontFile{VOREL_TEST_FONT}, kSize)};
    TextLayout mLayout;
};

VFEffect fill(uint32_t colour) {
    VFEffect effects;
    effects.addText(colour, 1);
    return effects;
}

/// White at the top of the text box, black at its bottom, in steps of one colour each.
VFEffect ramp() {
    VFEffect effects;
    VFGradient stops[]{{0x000000, 1, 0}, {0xFFFFFF, 1, 1}};
    effects.addLinearGradientText(90, 1, 1, 2, stops);
    effects.addText(0x00FF00, 1);
    return effects;
}

VFEffect everything() {
    VFEffect effects;
    effects.addOuterShadowText(135, 6, 5, 0x203040, 0.7F);
    effects.addStrokeText(4, 0xC02020, 1, 0, 1);
    effects.addInnerShadowText(90, 3, 3, 0x000000, 0.5F);
    effects.addText(0xFFE080, 1);
    return effects;
}

Canvas around(const TextLayout& text, const std::vector<Layer>& layers) {
    return placedOn({}, text.inkBox(), marginsOf(layers));
}

Image painted(const Sample& sample, const std::vector<Layer>& layers) {
    return paint(layers, sample.layout(), around(sample.layout(), layers));
}

const uint8_t* pixelAt(const Image& image, int x, int y) {
    return &image.pixels[offsetOf(image, x, y)];
}

/// The rows of a picture from `top` on.
std::vector<uint8_t> rows(const Image& image, int top, int count) {
    const auto at = image.pixels.begin() + static_cast<std::ptrdiff_t>(offsetOf(image, 0, top));
    return {at, at + static_cast<std::ptrdiff_t>(image.width) * 4 * count};
}

TEST(Layers, OneOfTheWholeText_IsThePictureOfItsEffects) {
    const Sample sample("Type\nface");
    for (VFEffect effects : {fill(0x102030), ramp(), everything()}) {
        const std::vector<Layer> layers{{&effects}};
        const Image image = painted(sample, layers);
        const Image wanted = paint(effects, sample.layout(), 0);
        EXPECT_EQ(image.width, wanted.width);
        EXPECT_EQ(image.pixels, wanted.pixels);
    }
}

TEST(Layers, Glow_KeepsItsFaintEnd) {
    const Sample sample("Halo");
    VFEffect effects;
    effects.addOuterGlowText(30, 0xFF8000, 1, 0, nullptr);
    effects.addText(0, 1);
    const Canvas canvas =
        placedOn({{}, {}, Anchor::center, 0, 60}, sample.layout().inkBox(), marginsOf({{&effects}}));
    EXPECT_EQ(paint({{&effects}}, sample.layout(), canvas).pixels,
              paint(effects, sample.layout(), 60).pixels);
}

TEST(Layers, PaintedAgain_AreTheSamePicture) {
    const Sample sample("Again");
    VFEffect below = everything();
    VFEffect above = ramp();
    const std::vector<Layer> layers{{&below}, {&above, 2, 3, Span::glyph}};
    EXPECT_EQ(painted(sample, layers).pixels, painted(sample, layers).pixels);
}

TEST(Layers, LastLiesOnTop) {
    const Sample sample("I");
    VFEffect red = fill(0xFF0000);
    VFEffect blue = fill(0x0000FF);
    const Image image = painted(sample, {{&red}, {&blue}});
    const uint8_t* middle = pixelAt(image, image.width / 2, image.height / 2);
    EXPECT_EQ(middle[0], 0);
    EXPECT_EQ(middle[2], 255);
}

TEST(Layers, MovedOne_GrowsTheMarginsWhereItGoes) {
    VFEffect plain = fill(0);
    VFEffect shadow;
    shadow.addOuterShadowText(0, 10, 0, 0, 1);  // 10 pixels to the left
    const Margins margins = marginsOf({{&plain, 3, -4}, {&shadow, 2, 0}});
    EXPECT_EQ(margins.left, 8);
    EXPECT_EQ(margins.top, 4);
    EXPECT_EQ(margins.right, 3);
    EXPECT_EQ(margins.bottom, 0);
}

TEST(Layers, MovedOne_IsTheSamePictureElsewhere) {
    const Sample sample("Go");
    VFEffect effects = everything();
    const Canvas canvas{300, 200, 100, 100};
    const Image still = paint({{&effects}}, sample.layout(), canvas);
    const Image moved = paint({{&effects, 7, -5}}, sample.layout(), canvas);
    Image wanted{300, 200, std::vector<uint8_t>(still.pixels.size())};
    layOver(wanted, still, 7, -5);
    EXPECT_EQ(moved.pixels, wanted.pixels);
    EXPECT_NE(moved.pixels, still.pixels);
}

TEST(Layers, MovedFarAway_AreNotSeen) {
    constexpr int kMost = std::numeric_limits<int>::max();
    constexpr int kLeast = std::numeric_limits<int>::min();
    const Sample sample("I");
    VFEffect effects = everything();
    for (const int far : {kLeast, kMost}) {
        Layer layer{&effects, far, far};
        layer.takesPictures = true;
        for (const int place : {kLeast / 2, 0, kMost / 2}) {
            const Image image = paint({layer}, sample.layout(), {9, 9, place, place});
            EXPECT_EQ(image.pixels, std::vector<uint8_t>(9 * 9 * 4)) << far;
        }
        const Margins margins = marginsOf({layer});
        EXPECT_GT(far < 0 ? margins.left : margins.right, TextLayout::kMaxSide);
        EXPECT_EQ(far < 0 ? margins.right : margins.left, 0);
    }
}

TEST(Layers, SmallerCanvas_IsAPartOfThePicture) {
    const Sample sample("Cut off");
    VFEffect effects = everything();
    const std::vector<Layer> layers{{&effects, 0, 0, Span::block}, {&effects, 4, 4, Span::word}};
    const Canvas whole = around(sample.layout(), layers);
    const Image image = paint(layers, sample.layout(), whole);
    const Canvas part{whole.width / 2, whole.height / 2, whole.x - whole.width / 3, whole.y - 7};
    const Image cut = paint(layers, sample.layout(), part);
    Image wanted{part.width, part.height, std::vector<uint8_t>(cut.pixels.size())};
    layOver(wanted, image, -whole.width / 3, -7);
    EXPECT_EQ(cut.pixels, wanted.pixels);
}

TEST(Spans, EachLineHasARampOfItsOwn) {
    const Sample sample("II\nII");
    const Box ink = sample.layout().inkBox();
    const int high = sample.layout().glyph(0).box.height();
    VFEffect effects = ramp();
    const Image byLine = painted(sample, {{&effects, 0, 0, Span::line}});
    EXPECT_EQ(rows(byLine, 0, high), rows(byLine, ink.height() - high, high));
    const Image asBlock = painted(sample, {{&effects}});
    EXPECT_NE(rows(asBlock, 0, high), rows(asBlock, ink.height() - high, high));
}

/// The channel of the ramp in the middle of a glyph's lowest row that is wholly covered.
int rampAtTheFootOf(const Sample& sample, const Image& image, size_t glyph) {
    const Box& box = sample.layout().glyph(glyph).box;
    const Box& ink = sample.layout().inkBox();
    return pixelAt(image, (box.left + box.right) / 2 - ink.left, box.bottom - 2 - ink.top)[0];
}

TEST(Spans, EachWordHasARampOfItsOwn) {
    // The foot of the second word is at half of the block's height, but at the end of its own ramp.
    const Sample sample("I\xC2\xB7| |I| '");
    const size_t last = sample.layout().glyphCount() - 1;
    VFEffect effects = ramp();
    const Image asBlock = painted(sample, {{&effects}});
    const Image byWord = painted(sample, {{&effects, 0, 0, Span::word}});
    EXPECT_GT(rampAtTheFootOf(sample, asBlock, last), 100);
    EXPECT_LT(rampAtTheFootOf(sample, byWord, last), 60);
}

TEST(Spans, EachGlyphHasARampOfItsOwn) {
    const Sample sample("I'");
    VFEffect effects = ramp();
    const Image byWord = painted(sample, {{&effects, 0, 0, Span::word}});
    const Image byGlyph = painted(sample, {{&effects, 0, 0, Span::glyph}});
    EXPECT_GT(rampAtTheFootOf(sample, byWord, 1), 100);
    EXPECT_LT(rampAtTheFootOf(sample, byGlyph, 1), 60);
    EXPECT_EQ(rampAtTheFootOf(sample, byGlyph, 0), rampAtTheFootOf(sample, byWord, 0));
}

using Spans = std::vector<std::vector<size_t>>;

/// The clusters of the glyphs of each span.
Spans clustersOf(const Sample& sample, Span span) {
    Spans clusters;
    for (const std::vector<size_t>& glyphs : spansOf(sample.layout(), span)) {
        clusters.emplace_back();
        for (const size_t i : glyphs)
            clusters.back().push_back(sample.layout().glyph(i).cluster);
        std::sort(clusters.back().begin(), clusters.back().end());
    }
    return clusters;
}

TEST(Spans, WordThatALineCuts_IsTwo) {
    TextSettings narrow;
    narrow.wrapWidth = 3 * kSize;
    const Sample sample("mmmm i", narrow);
    ASSERT_EQ(sample.layout().lines().size(), 2U);
    EXPECT_EQ(clustersOf(sample, Span::word), (Spans{{0, 1, 2}, {3}, {5}}));
    EXPECT_EQ(clustersOf(sample, Span::line), (Spans{{0, 1, 2}, {3, 5}}));
    EXPECT_EQ(clustersOf(sample, Span::block), (Spans{{0, 1, 2, 3, 5}}));
}

TEST(Spans, OfTextFromTheRight_StandInReadingOrder) {
    const Sample sample("\xD7\x90\xD7\x91 \xD7\x92");
    EXPECT_GT(sample.layout().glyph(sample.layout().glyphCount() - 1).box.left,
              sample.layout().glyph(0).box.left);
    EXPECT_EQ(clustersOf(sample, Span::word), (Spans{{0, 1}, {3}}));
    EXPECT_EQ(clustersOf(sample, Span::glyph), (Spans{{0}, {1}, {3}}));
}

TEST(Spans, LaterOnes_LieOverEarlierOnes) {
    const Sample sample("II");
    VFEffect effects;
    effects.addStrokeText(20, 0x0000FF, 1, 0, 1);
    effects.addText(0xFF0000, 1);
    const Image image = painted(sample, {{&effects, 0, 0, Span::glyph}});
    const Box& ink = sample.layout().inkBox();
    const auto middleOf = [&](size_t i) {
        const Box& box = sample.layout().glyph(i).box;
        return pixelAt(image, (box.left + box.right) / 2 - ink.left + 20, ink.height() / 2 + 20);
    };
    EXPECT_EQ(middleOf(0)[2], 255) << "the stroke of the second letter covers the first";
    EXPECT_EQ(middleOf(1)[0], 255);
}

/// Half of a text in another colour: only its glyphs are taken from the other picture.
TEST(ColouredParts, ChangeTheirGlyphsAlone) {
    const Sample sample("abcd");
    VFEffect red = everything();
    VFEffect green = everything();
    green.addText(0x00FF00, 1);
    Layer layer{&red};
    layer.colours.push_back({1, 3, 0x00FF00});
    const Image image = painted(sample, {layer});
    const Image asRed = painted(sample, {{&red}});
    const Image asGreen = painted(sample, {{&green}});

    Image covered{image.width, image.height, std::vector<uint8_t>(image.pixels.size())};
    const Canvas canvas = around(sample.layout(), {layer});
    for (const size_t i : {1U, 2U}) {
        const GlyphMask mask = sample.layout().rasterise(i);
        Image glyph{mask.box.width(), mask.box.height(), {}};
        for (const uint8_t each : mask.coverage)
            glyph.pixels.insert(glyph.pixels.end(), 4, each);
        layOver(covered, glyph, mask.box.left + canvas.x, mask.box.top + canvas.y);
    }
    for (size_t at = 0; at < image.pixels.size(); at += 4) {
        const Image& wanted = covered.pixels[at] != 0 ? asGreen : asRed;
        ASSERT_TRUE(std::equal(&image.pixels[at], &image.pixels[at] + 4, &wanted.pixels[at])) << at;
    }
    EXPECT_NE(image.pixels, asRed.pixels);
}

/// A glyph of a colour font: the effects are made of its coverage, and its picture lies on them.
class PictureLayer : public ::testing::Test {
  protected:
    PictureLayer() {
        mEffects.addStrokeText(5, 0x0000FF, 1, 0, 1);
        mEffects.addText(0x00FF00, 1);
    }

    Image painted(bool takesPictures, float opacity = 1) {
        Layer layer{&mEffects};
        layer.takesPictures = takesPictures;
        layer.pictureOpacity = opacity;
        return paint({layer}, mLayout, around(mLayout, {layer}));
    }

    VFEffect mEffects;
    Fonts mFonts{Font(FontFile{vorel_test::kEmojiFont}, kSize)};
    TextLayout mLayout{mFonts, {0x1F600}};
};

TEST_F(PictureLayer, CoverageIsPaintedLikeThatOfText) {
    const Image image = painted(false);
    const uint8_t* middle = pixelAt(image, image.width / 2, image.height / 2);
    EXPECT_EQ(std::vector<int>(middle, middle + 4), (std::vector<int>{0, 255, 0, 255}));
    int top = 0;
    while (pixelAt(image, image.width / 2, top)[3] < 255)
        ++top;
    const uint8_t* rim = pixelAt(image, image.width / 2, top);
    EXPECT_EQ(std::vector<int>(rim, rim + 4), (std::vector<int>{0, 0, 255, 255}));
}

TEST_F(PictureLayer, PictureLiesOverTheFill) {
    const Image image = painted(true);
    Image wanted = painted(false);
    const GlyphMask mask = mLayout.rasterise(0);
    ASSERT_FALSE(mask.pixels.empty());
    layOver(wanted, {mask.box.width(), mask.box.height(), mask.pixels}, 5, 5);
    EXPECT_EQ(image.pixels, wanted.pixels);
    EXPECT_NE(image.pixels, painted(false).pixels);
}

TEST_F(PictureLayer, PictureFadesWithTheText) {
    EXPECT_EQ(painted(true, 0).pixels, painted(false).pixels);
    EXPECT_NE(painted(true, 0.5F).pixels, painted(true).pixels);
}

TEST(ColouredParts, OfGlyphsThatOverlap_TheLastIsSeen) {
    TextSettings close;
    close.letterSpacing = -10 * 64;
    const Sample sample("mmmm", close);
    VFEffect red = everything();
    Layer layer{&red};
    layer.colours = {{0, 1, 0x00FF00}, {1, 2, 0x0000FF}, {3, 4, 0x00FF00}};
    const Image image = painted(sample, {layer});

    VFEffect green = everything();
    green.addText(0x00FF00, 1);
    VFEffect blue = everything();
    blue.addText(0x0000FF, 1);
    const std::vector<Image> whole{painted(sample, {{&green}}), painted(sample, {{&blue}}),
                                   painted(sample, {{&red}}), painted(sample, {{&green}})};
    Image wanted = whole[2];
    const Canvas canvas = around(sample.layout(), {layer});
    ASSERT_EQ(sample.layout().glyphCount(), 4U);
    EXPECT_LT(sample.layout().glyph(1).box.left, sample.layout().glyph(0).box.right);
    for (size_t i = 0; i < 4; ++i) {
        const GlyphMask mask = sample.layout().rasterise(i);
        const auto width = static_cast<size_t>(mask.box.width());
        for (size_t at = 0; at < mask.coverage.size(); ++at) {
            if (mask.coverage[at] == 0) continue;
            const int x = mask.box.left + static_cast<int>(at % width) + canvas.x;
            const int y = mask.box.top + static_cast<int>(at / width) + canvas.y;
            std::copy_n(pixelAt(whole[i], x, y), 4, &wanted.pixels[offsetOf(wanted, x, y)]);
        }
    }
    EXPECT_EQ(image.pixels, wanted.pixels);
}

TEST(ColouredParts, InTheFillsColourAndOpacity_ChangeNothing) {
    const Sample sample("abcd");
    VFEffect effects;
    effects.setTextOpacity(0.5F);
    effects.addOuterShadowText(135, 6, 5, 0x203040, 0.7F);
    effects.addText(0xFFE080, 0.5F);
    Layer layer{&effects};
    const Image plain = painted(sample, {layer});
    layer.colours = {{0, 4, 0xFFE080}};
    layer.fillOpacity = 0.5F;
    EXPECT_EQ(painted(sample, {layer}).pixels, plain.pixels);
    layer.fillOpacity = 1;
    EXPECT_NE(painted(sample, {layer}).pixels, plain.pixels);
}

TEST(ColouredParts, WithinALigature_HaveTheColourOfItsFirstLetter) {
    const Sample sample("fi");
    ASSERT_EQ(sample.layout().glyphCount(), 1U);
    VFEffect red = fill(0xFF0000);
    VFEffect green = fill(0x00FF00);
    Layer layer{&red};
    layer.colours = {{1, 2, 0x00FF00}};
    EXPECT_EQ(painted(sample, {layer}).pixels, painted(sample, {{&red}}).pixels);
    layer.colours = {{0, 1, 0x00FF00}};
    EXPECT_EQ(painted(sample, {layer}).pixels, painted(sample, {{&green}}).pixels);
}

TEST(Layers, WithoutGlyphs_AreATransparentPicture) {
    const Sample sample(" ");
    VFEffect effects = everything();
    const Image image = paint({{&effects}}, sample.layout(), {5, 4, 0, 0});
    EXPECT_EQ(image.pixels, std::vector<uint8_t>(5 * 4 * 4));
}

}  // namespace
}  // namespace voreltext
