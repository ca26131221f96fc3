#include <gtest/gtest.h>
#include <voreleffect/VFVersion.h>
#include <voreleffect/look.h>

#include <algorithm>
#include <climits>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <memory>
#include <string>
#include <typeinfo>
#include <utility>
#include <vector>

#include "tests/support/compare.h"
#include "tests/support/float_states.h"
#include "tests/support/thinned.h"
#include "tests/unit/look/looks_by_hand.h"

// The modern face paints what the classes paint when they are called by hand, and holds what its header
// promises.

namespace {

using namespace VFontEffect;
using namespace vorel_test;

constexpr float kNan = std::numeric_limits<float>::quiet_NaN();

::testing::AssertionResult samePage(const Page& expected, const Page& actual) {
    return sameBytes(expected.bytes.data(), actual.bytes.data(), expected.width, expected.height, 4);
}

Text squareText(int x = 0, int y = 0, int side = 12) {
    Text text;
    text.add(x, y, side, side, std::vector<unsigned char>(static_cast<size_t>(side * side), 255));
    return text;
}

std::string designedKey(const VFEffect& set) {
    VFEffect copy(set);
    const std::unique_ptr<char[]> key(copy.getMapKey());
    return key.get();
}

/// A look with every effect.
Look everything() {
    static const std::vector<unsigned char> kPixels(2 * 2 * 4, 200);
    const std::vector<Stop> ramp = {{rgb(0x5B2A86), 1, 0}, {rgb(0xFFB03A), 0.5F, 1}};
    return Look()
        .fill(rgb(0x3366CC))
        .add(OuterShadow(rgb(0)).angle(120).distance(5).size(4).opacity(0.6F))
        .add(InnerShadow(rgb(0x400000)).angle(300).distance(2).size(3))
        .add(OuterGlow(5, rgb(0xFFAA00)).opacity(0.8F).stops(ramp))
        .add(InnerGlow(3, rgb(0xFFFFFF)).opacity(0.4F))
        .add(LinearGradient(ramp).angle(30).opacity(0.5F))
        .add(RadialGradient(ramp).scale(0.7F).opacity(0.3F))
        .add(Stroke(3, rgb(0x00A040)).opacity(0.6F))
        .add(Pattern({kPixels.data(), 2, 2}).scale(1.5F).opacity(0.5F));
}

// --- Values -------------------------------------------------------------------------------------

TEST(Look, Colours_AreBroughtIntoTheirRange) {
    EXPECT_EQ(rgb(0xAB123456).value, 0x123456U);
    EXPECT_EQ(rgb(0x12, 0x34, 0x56).value, 0x123456U);
    EXPECT_EQ(rgb(-1, 300, 7).value, 0x00FF07U);
}

TEST(Look, Effects_StartWithTheNumbersThatTheHeaderTells) {
    const OuterShadow shadow(rgb(1));
    const OuterShadow told = shadow.angle(135).distance(4).size(4).opacity(1);
    EXPECT_EQ(Look().add(shadow), Look().add(told));
    EXPECT_EQ(Look().add(Stroke(2, rgb(1))),
              Look().add(Stroke(2, rgb(1)).position(Position::outside).opacity(1)));
    const std::vector<Stop> ramp = {{rgb(1), 1, 0}, {rgb(2)}};
    EXPECT_EQ(Look().add(LinearGradient(ramp)),
              Look().add(LinearGradient(ramp).angle(0).scale(1).opacity(1)));
    EXPECT_EQ(Look().add(RadialGradient(ramp)), Look().add(RadialGradient(ramp).scale(1).opacity(1)));
}

TEST(Look, AtTheStart_IsFilledInBlack) {
    Page page(12, 12);
    ASSERT_TRUE(paint(Look(), squareText().glyphs(), page.view()));
    const unsigned char black[] = {0, 0, 0, 255};
    EXPECT_EQ(0, std::memcmp(page.at(6, 6), black, 4));
    EXPECT_EQ(Look(), Look().fill(rgb(0)));
}

TEST(Look, CallsOfAnEffect_LeaveItAsItWas) {
    const Stroke thin(1, rgb(1));
    const Stroke faint = thin.opacity(0.5F);
    EXPECT_EQ(Look().add(thin), Look().add(Stroke(1, rgb(1))));
    EXPECT_NE(Look().add(thin), Look().add(faint));
}

TEST(Look, CopiesAndMoves_AreEqualAndIndependent) {
    Look original = everything();
    Look copy = original;
    EXPECT_EQ(copy, original);
    copy.fill(rgb(0xFF0000));
    EXPECT_NE(copy, original);
    const std::string key = original.key();
    const Look moved = std::move(original);
    EXPECT_EQ(moved.key(), key);
    copy = moved;
    EXPECT_EQ(copy.key(), key);
}

TEST(Look, EffectsThatWereMovedFrom_AreAsTheyWere) {
    const unsigned char pixels[] = {1, 2, 3, 255, 200, 100, 50, 255};
    Pattern pattern({pixels, 2, 1});
    RadialGradient ramp({{rgb(0)}, {rgb(0xFFFFFF), 1, 1}});
    const Look before = Look().add(pattern).add(ramp);
    const Look after = Look().add(Pattern(std::move(pattern))).add(RadialGradient(std::move(ramp)));
    EXPECT_EQ(after, before);
    EXPECT_EQ(Look().add(pattern).add(ramp), before);  // NOLINT: that is what is tested
}

/// Two libraries of one process may have look.h of different versions: what they have in common by name
/// would be taken from one of them.
TEST(Look, Names_HaveTheVersionInThem) {
    std::string version = VOREL_VERSION_STRING;
    std::replace(version.begin(), version.end(), '.', '_');
    for (const std::type_info* type :
         {&typeid(Look), &typeid(Painter), &typeid(Glyph), &typeid(look_internal::WideBox)})
        EXPECT_NE(std::string(type->name()).find("look_" + version), std::string::npos) << type->name();
}

// --- Pictures against the classes called by hand ----------------------------------------------------

/// What the face lays over a page, beside what the classes do by hand.
void expectSamePictures(const std::vector<const TwoLooks*>& stack, const Text& text, Page page, int x,
                        int y, PixelOrder order) {
    std::vector<Look> looks;
    std::vector<const VFEffect*> sets;
    for (const TwoLooks* look : stack) {
        looks.push_back(look->look);
        sets.push_back(&look->set);
    }
    Page expected = page;
    paintByHand(sets, text.glyphs(), expected, x, y, order);
    PictureView view = page.view();
    view.order = order;
    ASSERT_TRUE(paint(looks, text.glyphs(), view, x, y));
    EXPECT_TRUE(samePage(expected, page));
}

TEST(LookPictures, RandomLooksOnRandomPages_AreThoseOfTheClasses) {
    for (int seed = 0; seed < thinned(4000); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(static_cast<uint64_t>(seed));
        const TwoLooks look = randomLook(random);
        const Text text = randomText(random);
        const Page page = randomPage(random, random.between(1, 70), random.between(1, 60));
        const PixelOrder order = random.chance(50) ? PixelOrder::rgba : PixelOrder::bgra;
        expectSamePictures({&look}, text, page, random.between(-30, 50), random.between(-30, 40), order);
        if (HasFailure()) break;
    }
}

TEST(LookPictures, RandomStacks_AreThoseOfTheClassesLaidOneOverTheOther) {
    for (int seed = 0; seed < thinned(1000); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(static_cast<uint64_t>(seed) + 100'000);
        const TwoLooks a = randomLook(random);
        const TwoLooks b = randomLook(random);
        const TwoLooks c = randomLook(random);
        const Text text = randomText(random);
        const Page page = randomPage(random, 60, 50);
        expectSamePictures({&a, &b, &c}, text, page, random.between(-10, 30), random.between(-10, 30),
                           PixelOrder::rgba);
        if (HasFailure()) break;
    }
}

TEST(LookPictures, OfTheirOwn_HoldAllThatIsPaintedAndNoMore) {
    for (int seed = 0; seed < thinned(600); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(static_cast<uint64_t>(seed) + 200'000);
        const TwoLooks a = randomLook(random);
        const TwoLooks b = randomLook(random);
        const Text text = randomText(random);
        const Box ink = boxOf(text.glyphs());
        const Margins margins = Painter({a.look, b.look}).margins();
        auto picture = paint({a.look, b.look}, text.glyphs());
        ASSERT_TRUE(picture);
        EXPECT_EQ(picture->left(), ink.left - margins.left);
        EXPECT_EQ(picture->top(), ink.top - margins.top);
        EXPECT_EQ(picture->width(), ink.right - ink.left + margins.left + margins.right);
        EXPECT_EQ(picture->height(), ink.bottom - ink.top + margins.top + margins.bottom);
        Page expected(120, 110);
        Page actual = expected;
        paintByHand({&a.set, &b.set}, text.glyphs(), expected, 45, 45);
        ASSERT_TRUE(picture->layOver(actual.view(), 45, 45));
        EXPECT_TRUE(samePage(expected, actual));
        if (HasFailure()) break;
    }
}

TEST(LookPictures, OfTheirOwnOverOtherPixels_DifferByTwoAtMostFromPaintingTwoLooksThere) {
    // Rounding to nearest is off by half at most, of a value that is scaled down by less than 1. Painted
    // onto the page two looks round twice; as a picture the upper one's rounding is in channels and
    // alpha, and laying it over rounds once more: 1 and 1.5 values, together 2 whole ones.
    int largest = 0;
    for (int seed = 0; seed < thinned(300); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(static_cast<uint64_t>(seed) + 250'000);
        const std::vector<Look> looks = {randomLook(random).look, randomLook(random).look};
        const Text text = randomText(random);
        Page painted(60, 50);
        for (size_t i = 0; i < painted.bytes.size(); i += 4) {
            for (size_t channel = 0; channel < 3; ++channel)
                painted.bytes[i + channel] = random.byte();
            painted.bytes[i + 3] = 255;
        }
        Page laid = painted;
        ASSERT_TRUE(paint(looks, text.glyphs(), painted.view(), 12, 12));
        const auto picture = paint(looks, text.glyphs());
        ASSERT_TRUE(picture);
        ASSERT_TRUE(picture->layOver(laid.view(), 12, 12));
        for (size_t i = 0; i < painted.bytes.size(); ++i)
            largest = std::max(largest, std::abs(painted.bytes[i] - laid.bytes[i]));
        const auto alone = paint(looks[0], text.glyphs());
        ASSERT_TRUE(alone);
        Page other = laid;
        ASSERT_TRUE(paint(looks[0], text.glyphs(), laid.view(), 12, 12));
        ASSERT_TRUE(alone->layOver(other.view(), 12, 12));
        ASSERT_TRUE(samePage(laid, other)) << "of one look";
    }
    EXPECT_GE(largest, 1);
    EXPECT_LE(largest, 2);
}

/// The longest reaches that there are.
TEST(LookPictures, OfTheLargestEffects_AreNotCutOff) {
    VFEffect set;
    set.addOuterShadowText(200, 100, 100, 0x102030, 1);
    set.addOuterGlowText(100, 0xFFAA00, 1, 0, nullptr);
    set.addStrokeText(100, 0x00FF00, 0.5F, 0, 1);
    set.addText(0, 1);
    const Look look = Look()
                          .add(OuterShadow(rgb(0x102030)).angle(200).distance(100).size(100))
                          .add(OuterGlow(100, rgb(0xFFAA00)))
                          .add(Stroke(100, rgb(0x00FF00)).opacity(0.5F));
    constexpr int kRoom = 320;
    const Text text = squareText();
    Page expected(12 + 2 * kRoom, 12 + 2 * kRoom);
    Page actual = expected;
    paintByHand({&set}, text.glyphs(), expected, kRoom, kRoom, PixelOrder::rgba, kRoom);
    ASSERT_TRUE(paint(look, text.glyphs(), actual.view(), kRoom, kRoom));
    EXPECT_TRUE(samePage(expected, actual));
}

TEST(LookPictures, PaintedTwice_AreTheSame) {
    for (int seed = 0; seed < thinned(200); ++seed) {
        Random random(static_cast<uint64_t>(seed) + 300'000);
        const TwoLooks two = randomLook(random);
        const Text text = randomText(random);
        const std::string key = two.look.key();
        Painter painter(two.look);
        Page pages[] = {Page(50, 40), Page(50, 40), Page(50, 40)};
        painter.paint(text.glyphs(), pages[0].view(), 8, 8);
        painter.paint(text.glyphs(), pages[1].view(), 8, 8);
        paint(two.look, text.glyphs(), pages[2].view(), 8, 8);
        ASSERT_TRUE(samePage(pages[0], pages[1])) << seed;
        ASSERT_TRUE(samePage(pages[0], pages[2])) << seed;
        ASSERT_EQ(key, two.look.key()) << seed;
    }
}

TEST(LookPictures, OfOnePainter_DoNotDependOnWhatItPaintedBefore) {
    Random random(7);
    const TwoLooks a = randomLook(random);
    const TwoLooks b = randomLook(random);
    Painter used({a.look, b.look});
    for (int round = 0; round < thinned(200); ++round) {
        const Text text = randomText(random, random.between(1, 6));
        Page expected = randomPage(random, 60, 50);
        Page actual = expected;
        const int x = random.between(-40, 70);
        ASSERT_EQ(paint({a.look, b.look}, text.glyphs(), expected.view(), x, 9).has_value(), true);
        ASSERT_TRUE(used.paint(text.glyphs(), actual.view(), x, 9));
        ASSERT_TRUE(samePage(expected, actual)) << round;
        if (!random.chance(20)) continue;
        const auto picture = used.paint(text.glyphs());
        const auto fresh = paint({a.look, b.look}, text.glyphs());
        ASSERT_EQ(0, std::memcmp(picture->data(), fresh->data(),
                                 static_cast<size_t>(picture->stride() * picture->height())));
    }
}

TEST(LookPictures, OfAPainterThatWasMovedFrom_AreEmpty) {
    Painter original(everything());
    const Text text = squareText(9, 9);
    Page expected(30, 30);
    ASSERT_TRUE(original.paint(text.glyphs(), expected.view()));
    Painter moved = std::move(original);
    Page page(30, 30);
    ASSERT_TRUE(moved.paint(text.glyphs(), page.view()));
    EXPECT_TRUE(samePage(expected, page));
    page = Page(30, 30);
    const auto touched = original.paint(text.glyphs(), page.view());  // NOLINT: that is what is tested
    ASSERT_TRUE(touched);
    EXPECT_TRUE(touched->isEmpty());
    EXPECT_TRUE(original.paint(text.glyphs())->isEmpty());
    EXPECT_TRUE(samePage(Page(30, 30), page));
}

TEST(LookPictures, OrderOfAdding_DecidesWhatLiesOnTop) {
    const OuterShadow shadow = OuterShadow(rgb(0xFF0000)).angle(180).distance(6).size(0);
    const Stroke stroke(6, rgb(0x0000FF));
    Page page(40, 40);
    paint(Look().add(shadow).add(stroke), squareText(14, 14).glyphs(), page.view());
    EXPECT_EQ(page.at(28, 20)[2], 255) << "the stroke covers the shadow";
    page = Page(40, 40);
    paint(Look().add(stroke).add(shadow), squareText(14, 14).glyphs(), page.view());
    EXPECT_EQ(page.at(28, 20)[0], 255) << "the shadow covers the stroke";
}

TEST(LookPictures, EffectAddedAgain_IsReplacedAtItsPlace) {
    const Look once = Look().add(Stroke(2, rgb(0xFF))).add(OuterShadow(rgb(0)));
    const Look twice = Look()
                           .add(Stroke(9, rgb(0xAA)).opacity(0.1F))
                           .add(OuterShadow(rgb(0)))
                           .add(Stroke(2, rgb(0xFF)));
    EXPECT_EQ(once, twice);
    const unsigned char pixels[] = {1, 2, 3, 255, 200, 100, 50, 255};
    const Pattern old({pixels, 1, 1});
    const Pattern current({pixels, 2, 1});
    const Stroke inside = Stroke(1, rgb(1)).position(Position::inside);
    EXPECT_EQ(Look().add(current).add(inside), Look().add(old).add(inside).add(current));
}

TEST(LookPictures, OpacityOfTheText_CutsOutAndThatOfTheFillDoesNot) {
    const OuterShadow shadow = OuterShadow(rgb(0xFF0000)).distance(0).size(0);
    Page page(12, 12);
    paint(Look().fill(rgb(0), 0).add(shadow), squareText().glyphs(), page.view());
    EXPECT_EQ(page.at(6, 6)[0], 255) << "the shadow is seen through the fill";
    for (const Look& cut : {Look().textOpacity(0).add(shadow), Look().noFill().add(shadow)}) {
        page = Page(12, 12);
        paint(cut, squareText().glyphs(), page.view());
        EXPECT_EQ(page.at(6, 6)[3], 0) << "the shadow is cut out";
    }
}

TEST(LookPictures, OpacityOfTheText_MayBeToldBeforeOrAfterTheFill) {
    const Look before = Look().textOpacity(0.3F).fill(rgb(0xFF8000), 0.7F);
    const Look after = Look().fill(rgb(0xFF8000), 0.7F).textOpacity(0.3F);
    EXPECT_EQ(before.key(), after.key());
    VFEffect set;
    set.setTextOpacity(0.3F);
    set.addText(0xFF8000, 0.7F * 0.3F);
    Page expected(12, 12);
    paintByHand({&set}, squareText().glyphs(), expected, 0, 0);
    for (const Look& look : {before, after}) {
        Page page(12, 12);
        paint(look, squareText().glyphs(), page.view());
        EXPECT_TRUE(samePage(expected, page));
    }
}

/// 0.4 times 0.75 lies on the edge between two alphas: rounded up it is 77, rounded down 76.
TEST(LookPictures, InEveryFloatState_AreTheSameAndSoAreTheKeys) {
    Look look = everything();
    look.fill(rgb(0x80FF40), 0.4F).textOpacity(0.75F);
    const Text text = squareText(12, 12);
    Page expected(40, 40);
    paint(look, text.glyphs(), expected.view());
    const std::string key = look.key();
    for (const FloatState& state : floatStates()) {
        Page page(40, 40);
        std::string again;
        {
            const InFloatState callers(state);
            Look told = everything();
            told.fill(rgb(0x80FF40), 0.4F).textOpacity(0.75F);
            paint(told, text.glyphs(), page.view());
            again = told.key();
        }
        EXPECT_TRUE(samePage(expected, page)) << state.name;
        EXPECT_EQ(key, again) << state.name;
    }
}

/// As that of the style files is, which is a product of two floats.
TEST(LookPictures, OpacityOfFillAndText_IsTheirProduct) {
    Random random(51);
    for (int i = 0; i < thinned(20'000); ++i) {
        const float a = random.real(0, 1);
        const float b = random.chance(20) ? 1.0F : random.real(0, 1);
        ASSERT_EQ(look_internal::product(a, b), a * b) << a << " " << b;
    }
    EXPECT_EQ(look_internal::product(0.75F, 0.4F), 0.75F * 0.4F);
    EXPECT_EQ(look_internal::product(1e-20F, 1e-10F), 1e-20F * 1e-10F);
    EXPECT_EQ(look_internal::product(1e-30F, 1e-30F), 0.0F);
    EXPECT_EQ(look_internal::product(0, 0.5F), 0.0F);
    EXPECT_EQ(look_internal::product(0, 0), 0.0F);
    EXPECT_EQ(look_internal::product(1, 1), 1.0F);
}

// --- Margins ----------------------------------------------------------------------------------------

TEST(LookMargins, AreTheOffsetsOfTheClassesAndTheFaintEndOfAGlow) {
    for (int seed = 0; seed < thinned(300); ++seed) {
        Random random(static_cast<uint64_t>(seed) + 400'000);
        TwoLooks two = randomLook(random);
        VFECore* const glow = two.set.getEffect(3);
        const int end = glow == nullptr ? 0 : 2 * (glow->getOffset() + 1);
        const Margins margins = two.look.margins();
        ASSERT_EQ(margins.left, std::max(end, two.set.getLeftOffset())) << seed;
        ASSERT_EQ(margins.top, std::max(end, two.set.getTopOffset())) << seed;
        ASSERT_EQ(margins.right, std::max(end, two.set.getRightOffset())) << seed;
        ASSERT_EQ(margins.bottom, std::max(end, two.set.getBottomOffset())) << seed;
    }
}

// --- Keys -------------------------------------------------------------------------------------------

TEST(LookKey, BeginsWithThatOfTheClassesBeforeTheirFirstRun) {
    for (int seed = 0; seed < thinned(300); ++seed) {
        Random random(static_cast<uint64_t>(seed) + 500'000);
        const TwoLooks two = randomLook(random);
        const std::string designed = designedKey(two.set);
        const std::string key = two.look.key();
        ASSERT_EQ(key.compare(0, designed.size(), designed), 0) << seed;
        ASSERT_EQ(key.find('\0'), std::string::npos) << seed;
    }
}

TEST(LookKey, OfShadowsStrokeAndFill_IsThatOfTheClasses) {
    VFEffect set;
    set.addOuterShadowText(135, 6, 8, 0, 0.6F);
    set.addStrokeText(4, 0xFFFFFF, 1, 0, 1);
    const std::unique_ptr<char[]> key(set.getMapKey(0x3366CC));
    EXPECT_EQ(Look()
                  .fill(rgb(0x3366CC))
                  .add(OuterShadow(rgb(0)).angle(135).distance(6).size(8).opacity(0.6F))
                  .add(Stroke(4, rgb(0xFFFFFF)))
                  .key(),
              key.get());
}

TEST(LookKey, OfEqualPatterns_IsTheSameWhereverTheirPixelsLie) {
    Random random(11);
    Page page = randomPage(random, 5, 4);
    Page wide(9, 4);
    for (int y = 0; y < 4; ++y)
        std::copy_n(page.at(0, y), 20, wide.at(0, y));
    const Look packedRows = Look().add(Pattern({page.bytes.data(), 5, 4}));
    const Look apart = Look().add(Pattern({wide.bytes.data(), 5, 4, 36}));
    EXPECT_EQ(packedRows, apart);
    Page expected(20, 20);
    Page actual(20, 20);
    paint(packedRows, squareText().glyphs(), expected.view());
    paint(apart, squareText().glyphs(), actual.view());
    EXPECT_TRUE(samePage(expected, actual));
}

TEST(LookKey, TellsEveryBitOfAPattern) {
    Random random(12);
    Page page = randomPage(random, 5, 4);
    const auto keyOf = [](Page& pixels) {
        return Look().add(Pattern({pixels.bytes.data(), pixels.width, pixels.height})).key();
    };
    const std::string whole = keyOf(page);
    for (size_t bit = 0; bit < page.bytes.size() * 8; ++bit) {
        const auto mask = static_cast<unsigned char>(1 << bit % 8);
        page.bytes[bit / 8] = static_cast<unsigned char>(page.bytes[bit / 8] ^ mask);
        ASSERT_NE(keyOf(page), whole) << bit;
        page.bytes[bit / 8] = static_cast<unsigned char>(page.bytes[bit / 8] ^ mask);
    }
    EXPECT_EQ(keyOf(page), whole);
}

TEST(LookKey, TellsPatternsApartByShapeNumbersAndPlace) {
    const std::vector<unsigned char> bytes(4 * 6, 90);
    const Pattern flat({bytes.data(), 6, 1});
    const LinearGradient ramp({{rgb(0)}, {rgb(0xFFFFFF), 1, 1}});
    const Stroke inside = Stroke(1, rgb(1)).position(Position::inside);
    const Look looks[] = {Look(),
                          Look().add(flat),
                          Look().add(Pattern({bytes.data(), 1, 6})),
                          Look().add(Pattern({bytes.data(), 3, 2})),
                          Look().add(flat.scale(2)),
                          Look().add(flat.opacity(0.5F)),
                          Look().add(ramp),
                          Look().add(flat).add(ramp),
                          Look().add(ramp).add(flat),
                          Look().add(flat).add(inside),
                          Look().add(inside).add(flat)};
    for (const Look& a : looks)
        for (const Look& b : looks)
            EXPECT_EQ(a == b, &a == &b);
}

/// What the key of the classes cuts: 0.53 and 0.59 become 0.52 and 0.58 in it, and a scale a hundredth.
TEST(LookKey, TellsStopsAndScalesApartThatTheClassesDoNot) {
    const auto withStop = [](float place) {
        return Look().add(LinearGradient({{rgb(0)}, {rgb(0xFFFFFF), 1, place}}));
    };
    for (int i = 0; i < 100; ++i) {
        const float place = (static_cast<float>(i) + 0.5F) / 100;
        ASSERT_NE(withStop(place), withStop(place + 0.01F)) << i;
    }
    const RadialGradient ramp({{rgb(0)}, {rgb(0xFFFFFF), 1, 1}});
    EXPECT_NE(Look().add(ramp.scale(0.5F)), Look().add(ramp.scale(0.501F)));
    EXPECT_NE(Look().fill(rgb(9), 0.5F), Look().fill(rgb(9)).textOpacity(0.5F));
}

/// Of looks whose numbers are so coarse that many are drawn twice.
TEST(LookKey, Equal_MeansEqualPictures) {
    Random random(13);
    const Text text = squareText(0, 0, 9);
    std::vector<std::pair<std::string, std::vector<unsigned char>>> seen;
    int equal = 0;
    for (int i = 0; i < thinned(1200); ++i) {
        Look look;
        look.fill(rgb(static_cast<unsigned>(random.between(0, 1))), random.chance(50) ? 1.0F : 0.5F);
        look.textOpacity(random.chance(50) ? 1.0F : 0.5F);
        for (int effects = random.between(0, 2); effects > 0; --effects) {
            const auto step = static_cast<float>(random.between(0, 2));
            const std::vector<Stop> ramp = {{rgb(0xFF0000), 1, 0.5F},
                                            {rgb(0xFF), 1, 0.57F + step / 100}};
            if (random.chance(50)) {
                look.add(LinearGradient(ramp));
            } else if (random.chance(50)) {
                look.add(OuterGlow(step, rgb(0xFF00)).stops(ramp));
            } else {
                look.add(OuterShadow(rgb(0xFF)).distance(step).size(step));
            }
        }
        const auto picture = paint(look, text.glyphs());
        std::vector<unsigned char> bytes(picture->data(),
                                         picture->data() + picture->stride() * picture->height());
        bytes.push_back(static_cast<unsigned char>(picture->width()));
        const std::string key = look.key();
        for (const auto& [otherKey, otherBytes] : seen) {
            if (otherKey != key) continue;
            ++equal;
            ASSERT_EQ(bytes, otherBytes) << i;
        }
        seen.emplace_back(key, std::move(bytes));
    }
    EXPECT_GT(equal, 50);
}

// --- Views ------------------------------------------------------------------------------------------

TEST(LookViews, RowsThatLieApart_KeepWhatIsBetweenThem) {
    Random random(21);
    for (const PixelOrder order : {PixelOrder::rgba, PixelOrder::bgra}) {
        const Page before = randomPage(random, 60, 50);
        Page whole = before;
        const PictureView part = {whole.at(7, 5), 40, 30, 60 * 4, order};
        Page expected(40, 30);
        for (int y = 0; y < 30; ++y)
            std::copy_n(before.at(7, 5 + y), 160, expected.at(0, y));
        PictureView packedView = expected.view();
        packedView.order = order;
        ASSERT_TRUE(paint(everything(), squareText(-3, 20).glyphs(), packedView));
        ASSERT_TRUE(paint(everything(), squareText(-3, 20).glyphs(), part));
        for (int y = 0; y < 50; ++y) {
            for (int x = 0; x < 60; ++x) {
                const bool inside = x >= 7 && x < 47 && y >= 5 && y < 35;
                const unsigned char* wanted = inside ? expected.at(x - 7, y - 5) : before.at(x, y);
                ASSERT_EQ(0, std::memcmp(wanted, whole.at(x, y), 4)) << x << ", " << y;
            }
        }
    }
}

TEST(LookViews, OddAddressesAndStrides_ArePaintedAlike) {
    Page expected(30, 30);
    ASSERT_TRUE(paint(everything(), squareText(9, 9).glyphs(), expected.view()));
    std::vector<unsigned char> bytes(1 + 30 * 123);
    ASSERT_TRUE(paint(everything(), squareText(9, 9).glyphs(), {bytes.data() + 1, 30, 30, 123}));
    for (int y = 0; y < 30; ++y)
        EXPECT_EQ(0, std::memcmp(expected.at(0, y), &bytes[static_cast<size_t>(1 + y * 123)], 120));
}

TEST(LookViews, TouchedBox_IsThatOfTheMarginsWithinTheView) {
    const Look look = Look().add(Stroke(3, rgb(0xFF)));
    const Margins margins = look.margins();
    Page page(50, 40);
    auto touched = paint(look, squareText(20, 20, 6).glyphs(), page.view());
    ASSERT_TRUE(touched);
    EXPECT_EQ(touched->left, 20 - margins.left);
    EXPECT_EQ(touched->top, 20 - margins.top);
    EXPECT_EQ(touched->right, 26 + margins.right);
    EXPECT_EQ(touched->bottom, 26 + margins.bottom);
    touched = paint(look, squareText(48, -2, 6).glyphs(), page.view());
    ASSERT_TRUE(touched);
    EXPECT_EQ(touched->top, 0);
    EXPECT_EQ(touched->right, 50);
    // A single column of the layer is seen.
    touched = paint(look, squareText(49 + margins.left, 20, 6).glyphs(), page.view());
    ASSERT_TRUE(touched);
    EXPECT_EQ(touched->left, 49);
    EXPECT_EQ(touched->right, 50);
}

TEST(LookViews, TouchedBox_HoldsEveryPixelThatChanges) {
    for (int seed = 0; seed < thinned(400); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(static_cast<uint64_t>(seed) + 300'000);
        const TwoLooks a = randomLook(random);
        const TwoLooks b = randomLook(random);
        const Text text = randomText(random);
        Page page = randomPage(random, random.between(1, 40), random.between(1, 40));
        const Page before = page;
        const int x = random.between(-60, 60);
        const int y = random.between(-60, 60);
        const auto touched = paint({a.look, b.look}, text.glyphs(), page.view(), x, y);
        ASSERT_TRUE(touched);
        for (int row = 0; row < page.height; ++row) {
            for (int column = 0; column < page.width; ++column) {
                const bool isTouched = column >= touched->left && column < touched->right &&
                                       row >= touched->top && row < touched->bottom;
                ASSERT_TRUE(isTouched ||
                            std::memcmp(before.at(column, row), page.at(column, row), 4) == 0)
                    << column << ", " << row;
            }
        }
    }
}

TEST(LookViews, GlyphsElsewhere_AreNothingToPaint) {
    const int places[] = {INT_MIN, INT_MIN + 1, -1'000'000, 1'000'000, INT_MAX - 1, INT_MAX};
    Page page(20, 20);
    const Page before = page;
    Painter painter(everything());
    for (const int far : places) {
        for (const auto& [x, y] : {std::pair{far, 0}, {0, far}, {far, far}}) {
            for (const int shift : {0, INT_MIN, INT_MAX}) {
                // Two that add up to the page are painted.
                if (int64_t{far} + shift > -100 && int64_t{far} + shift < 100) continue;
                const auto touched = painter.paint(squareText(x, y).glyphs(), page.view(),
                                                   x == far ? shift : 0, y == far ? shift : 0);
                ASSERT_TRUE(touched) << x << ", " << y << ", " << shift;
                EXPECT_TRUE(touched->isEmpty());
                EXPECT_EQ(painter.failure(), Failure::none);
            }
        }
    }
    EXPECT_TRUE(samePage(before, page));
}

TEST(LookViews, FarPlacesThatCancelOut_ArePaintedOnThePage) {
    Page expected(30, 30);
    Page actual(30, 30);
    paint(everything(), squareText(9, 9).glyphs(), expected.view());
    const auto touched = paint(everything(), squareText(INT_MIN + 19, INT_MAX - 1).glyphs(),
                               actual.view(), INT_MAX - 9, -INT_MAX + 10);
    ASSERT_TRUE(touched);
    EXPECT_TRUE(samePage(expected, actual));
}

TEST(LookViews, OriginOfAPicture_FitsItsNumbersOrThereIsNone) {
    Painter painter(everything());
    EXPECT_FALSE(painter.paint(squareText(INT_MIN, 0).glyphs()));
    EXPECT_EQ(painter.failure(), Failure::tooLarge);
    const auto picture = painter.paint(squareText(INT_MAX, INT_MAX).glyphs());
    ASSERT_TRUE(picture);
    EXPECT_EQ(picture->left(), INT_MAX - painter.margins().left);
}

// --- What is refused, and what is nothing ------------------------------------------------------------

void expectRefused(Failure why, const std::vector<Glyph>& glyphs, PictureView view, const Page& page) {
    const Page before = page;
    Painter painter(everything());
    EXPECT_FALSE(painter.paint(glyphs, view));
    EXPECT_EQ(painter.failure(), why);
    EXPECT_TRUE(samePage(before, page));
}

TEST(LookRefusals, BadViews_AreNotPaintedOn) {
    Page page(20, 20);
    const std::vector<Glyph> glyphs = squareText().glyphs();
    const Text kept = squareText();
    for (const PictureView& view : {PictureView{nullptr, 20, 20},
                                    {page.bytes.data(), -1, 20},
                                    {page.bytes.data(), 20, -1},
                                    {page.bytes.data(), 20, 20, 79},
                                    {page.bytes.data(), 20, 20, -80}})
        expectRefused(Failure::badArgument, kept.glyphs(), view, page);
}

TEST(LookRefusals, BadGlyphs_AreNotPainted) {
    Page page(20, 20);
    const std::vector<unsigned char> coverage(70'000, 255);
    const unsigned char* const data = coverage.data();
    for (const Glyph& bad : {Glyph{0, 0, nullptr, 3, 3},
                             {0, 0, data, -1, 3},
                             {0, 0, data, 3, -1},
                             {0, 0, data, 3, 3, 2},
                             {0, 0, data, 3, 3, -3}})
        expectRefused(Failure::badArgument, {{0, 0, data, 2, 2}, bad}, page.view(), page);
    expectRefused(Failure::tooLarge, {{0, 0, data, 65'536, 1}}, page.view(), page);
    expectRefused(Failure::tooLarge, {{0, 0, data, 1, 65'536}}, page.view(), page);
}

TEST(LookRefusals, LayersOfMoreThan31Bits_AreNotPainted) {
    Page page(20, 20);
    const unsigned char cell = 255;
    expectRefused(Failure::tooLarge, {{0, 0, &cell, 1, 1}, {30'000, 30'000, &cell, 1, 1}}, page.view(),
                  page);
    expectRefused(Failure::tooLarge, {{INT_MIN, 0, &cell, 1, 1}, {INT_MAX, 0, &cell, 1, 1}}, page.view(),
                  page);
    expectRefused(Failure::tooLarge, {{INT_MIN, INT_MIN, &cell, 1, 1}, {INT_MAX, INT_MAX, &cell, 1, 1}},
                  page.view(), page);
}

TEST(LookRefusals, NothingToPaint_IsAnEmptyBox) {
    Page page(20, 20);
    const Text text = squareText();
    Painter painter(everything());
    const auto isNothing = [](const std::optional<Box>& touched) {
        return touched && touched->isEmpty();
    };
    EXPECT_TRUE(isNothing(painter.paint(std::vector<Glyph>{}, page.view())));
    EXPECT_TRUE(isNothing(painter.paint({nullptr, 5}, page.view())));
    EXPECT_TRUE(isNothing(painter.paint({{0, 0, nullptr, 0, 9}, {0, 0, nullptr, 9, 0}}, page.view())));
    EXPECT_TRUE(isNothing(painter.paint(text.glyphs(), {nullptr, 0, 20})));
    EXPECT_TRUE(isNothing(painter.paint(text.glyphs(), {nullptr, 20, 0})));
    EXPECT_TRUE(isNothing(paint(std::vector<Look>{}, text.glyphs(), page.view())));
    EXPECT_TRUE(samePage(Page(20, 20), page));
    auto picture = painter.paint(std::vector<Glyph>{});
    ASSERT_TRUE(picture);
    EXPECT_TRUE(picture->isEmpty());
    EXPECT_TRUE(isNothing(picture->layOver(page.view(), 0, 0)));
    EXPECT_FALSE(picture->layOver({nullptr, 1, 1}, 0, 0));
}

TEST(LookRefusals, GlyphsWithoutPixels_DoNotGrowTheBoxOfTheText) {
    const Look ramp = Look().add(LinearGradient({{rgb(0)}, {rgb(0xFFFFFF), 1, 1}}));
    Page expected(40, 20);
    Page actual(40, 20);
    const Text text = squareText();
    paint(ramp, text.glyphs(), expected.view());
    paint(ramp, {text.glyphs()[0], {39, 0, nullptr, 0, 20}}, actual.view());
    EXPECT_TRUE(samePage(expected, actual));
}

TEST(LookRefusals, NumbersThatAreNone_AreTakenAsTheClassesTakeThem) {
    VFEffect set;
    set.addOuterShadowText(kNan, kNan, kNan, 0xFF, kNan);
    set.addStrokeText(kNan, 0xFF, kNan, 0, 1);
    set.setTextOpacity(kNan);
    set.addText(0xFF, kNan);
    const Look look =
        Look()
            .add(OuterShadow(rgb(0xFF)).angle(kNan).distance(kNan).size(kNan).opacity(kNan))
            .add(Stroke(kNan, rgb(0xFF)).opacity(kNan))
            .fill(rgb(0xFF), kNan)
            .textOpacity(kNan);
    EXPECT_EQ(look.key().compare(0, designedKey(set).size(), designedKey(set)), 0);
    Page page(20, 20);
    EXPECT_TRUE(paint(look, squareText().glyphs(), page.view()));
    EXPECT_TRUE(samePage(Page(20, 20), page));
}

TEST(LookRefusals, PatternsThatCannotBeRead_PaintNothing) {
    const std::vector<unsigned char> bytes(64, 255);
    Page expected(20, 20);
    paint(Look(), squareText().glyphs(), expected.view());
    for (const PixelView& view : {PixelView{nullptr, 2, 2},
                                  {bytes.data(), 0, 2},
                                  {bytes.data(), -1, 2},
                                  {bytes.data(), 2, 2, 7},
                                  {bytes.data(), 2, 2, -8},
                                  {bytes.data(), 1 << 16, 1 << 16}}) {
        const Look look = Look().add(Pattern(view));
        Page page(20, 20);
        EXPECT_TRUE(paint(look, squareText().glyphs(), page.view()));
        EXPECT_TRUE(samePage(expected, page));
    }
}

TEST(LookRefusals, MoreThan256Stops_AreTheFirst256) {
    std::vector<Stop> many;
    for (int i = 0; i < 300; ++i)
        many.push_back({rgb(static_cast<unsigned>(i)), 1, static_cast<float>(i) / 300});
    const std::vector<Stop> first(many.begin(), many.begin() + 256);
    EXPECT_EQ(Look().add(LinearGradient(many)), Look().add(LinearGradient(first)));
}

// --- Owned pictures -----------------------------------------------------------------------------------

TEST(Pictures, CopiesOwnTheirPixelsAndMovedOnesAreEmpty) {
    auto picture = paint(everything(), squareText().glyphs());
    ASSERT_TRUE(picture);
    Picture copy = *picture;
    ASSERT_NE(copy.data(), picture->data());
    const auto bytes = static_cast<size_t>(copy.stride() * copy.height());
    EXPECT_EQ(0, std::memcmp(copy.data(), picture->data(), bytes));
    EXPECT_EQ(copy.left(), picture->left());
    const unsigned char* const pixels = copy.data();
    const Picture moved = std::move(copy);
    EXPECT_EQ(moved.data(), pixels);
    EXPECT_TRUE(copy.isEmpty());  // NOLINT: that is what is tested
    EXPECT_EQ(copy.width(), 0);
    copy = moved;
    EXPECT_EQ(0, std::memcmp(copy.data(), moved.data(), bytes));
    const Picture none;
    EXPECT_TRUE(Picture(none).isEmpty());
}

TEST(Pictures, LaidOverAView_AreWhatIsPaintedThere) {
    for (const PixelOrder order : {PixelOrder::rgba, PixelOrder::bgra}) {
        Random random(31);
        Page expected = randomPage(random, 30, 25);
        Page actual = expected;
        PictureView onto[] = {expected.view(), actual.view()};
        for (PictureView& view : onto)
            view.order = order;
        const Text text = squareText(3, 4);
        const auto touched = paint(everything(), text.glyphs(), onto[0], -5, 6);
        const auto laid = paint(everything(), text.glyphs())->layOver(onto[1], -5, 6);
        ASSERT_TRUE(touched && laid);
        EXPECT_EQ(touched->left, laid->left);
        EXPECT_EQ(touched->bottom, laid->bottom);
        EXPECT_TRUE(samePage(expected, actual));
    }
}

// --- The rule of laying over
// ---------------------------------------------------------------------------

TEST(LayOver, EveryChannelAndEveryAlpha_FollowsTheRule) {
    for (unsigned alpha = 0; alpha < 256; ++alpha) {
        for (unsigned under = 0; under < 256; ++under) {
            for (const unsigned over : {0U, alpha / 2, alpha, 255U}) {
                const unsigned char source[] = {static_cast<unsigned char>(over), 0,
                                                static_cast<unsigned char>(over),
                                                static_cast<unsigned char>(alpha)};
                unsigned char pixel[] = {static_cast<unsigned char>(under),
                                         static_cast<unsigned char>(255 - under), 255,
                                         static_cast<unsigned char>(under)};
                const unsigned char expected[] = {
                    channelOver(source[0], pixel[0], alpha), channelOver(source[1], pixel[1], alpha),
                    channelOver(source[2], pixel[2], alpha), channelOver(source[3], pixel[3], alpha)};
                look_internal::layRowOver<PixelOrder::rgba>(pixel, source, 1);
                ASSERT_EQ(0, std::memcmp(expected, pixel, 4)) << alpha << " " << under << " " << over;
            }
        }
    }
}

TEST(LayOver, RandomRows_FollowTheRuleInBothOrders) {
    Random random(41);
    for (int round = 0; round < thinned(4000); ++round) {
        const int width = random.between(1, 67);
        Page over = randomPage(random, width, 1);
        for (int x = 0; x < width; ++x) {
            if (random.chance(30)) over.at(x, 0)[3] = random.chance(50) ? 0 : 255;
            if (random.chance(20)) std::memset(over.at(x, 0), 0, 4);
        }
        Page page = randomPage(random, width, 1);
        if (random.chance(20)) page = Page(width, 1);
        Page rgba = page;
        Page bgra = page;
        Page expected[] = {page, page};
        layByHand(expected[0], over, 0, 0, PixelOrder::rgba);
        layByHand(expected[1], over, 0, 0, PixelOrder::bgra);
        look_internal::layRowOver<PixelOrder::rgba>(rgba.bytes.data(), over.bytes.data(), width);
        look_internal::layRowOver<PixelOrder::bgra>(bgra.bytes.data(), over.bytes.data(), width);
        ASSERT_TRUE(samePage(expected[0], rgba)) << round;
        ASSERT_TRUE(samePage(expected[1], bgra)) << round;
    }
}

}  // namespace
