#include <gtest/gtest.h>
#include <voreleffect/VFEffect.h>

#include <algorithm>
#include <array>
#include <climits>
#include <cstring>
#include <vector>

#include "tests/support/compare.h"
#include "tests/support/engine.h"
#include "tests/support/random.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

using Sides = std::vector<int>;

/// A run of one solid glyph, ready for post-processing.
struct StartedRun {
    StartedRun(VFEffect& look, int width, int height, uint8_t coverage = 255)
        : set(look),
          glyph(width, height, coverage),
          picture(static_cast<unsigned>(width), static_cast<unsigned>(height), 4) {
        set.initEffect(width, height);
        set.setDstBitmap(&picture);
        set.renderEffectLayer(0, 0, &glyph.glyph);
    }

    VFEffect& set;
    SolidGlyph glyph;
    VFBitmap picture;
};

// --- Glyphs into the mask ---------------------------------------------------------------------

TEST(RenderGlyph, CopiesTheCoverageClippedToTheMask) {
    VFEffect set;
    set.initEffect(4, 3);
    uint8_t coverage[] = {1, 2, 3, 4, 5, 6};
    VFGlyph glyph = {coverage, 3, 2};
    set.renderEffectLayer(-1, -1, &glyph);
    set.renderEffectLayer(2, 1, &glyph);
    EXPECT_EQ(bytesOf(*set.getSrcBitmap()), (std::vector<uint8_t>{5, 6, 0, 0,  //
                                                                  0, 0, 1, 2,  //
                                                                  0, 0, 4, 5}));
}

TEST(RenderGlyph, Overlap_KeepsTheLargerCoverage) {
    VFEffect set;
    set.initEffect(3, 1);
    uint8_t first[] = {10, 200, 30};
    uint8_t second[] = {20, 100, 30};
    VFGlyph glyph = {first, 3, 1};
    set.renderEffectLayer(0, 0, &glyph);
    glyph.mBuffer = second;
    set.renderEffectLayer(0, 0, &glyph);
    EXPECT_EQ(bytesOf(*set.getSrcBitmap()), (std::vector<uint8_t>{20, 200, 30}));
}

TEST(RenderGlyph, TellsEveryCore) {
    VFEffect set;
    FakeCore* first = insertCore(set, kText);
    FakeCore* second = insertCore(set, 42);
    VFBitmap picture(4, 4, 4);
    SolidGlyph glyph(2, 2);
    set.initEffect(4, 4);
    set.setDstBitmap(&picture);
    set.renderEffectLayer(-7, 3, &glyph.glyph);
    for (const FakeCore* core : {first, second}) {
        ASSERT_EQ(core->renders.size(), 1U);
        EXPECT_EQ(core->renders[0].x, -7);
        EXPECT_EQ(core->renders[0].y, 3);
        EXPECT_EQ(core->renders[0].glyph, &glyph.glyph);
        EXPECT_EQ(core->renders[0].dstBitmap, &picture);
    }
}

TEST(RenderGlyph, NullGlyphOrNoMask_StillTellsEveryCore) {
    VFEffect set;
    FakeCore* core = insertCore(set, kText);
    SolidGlyph glyph(2, 2);
    set.renderEffectLayer(1, 2, &glyph.glyph);
    set.initEffect(4, 4);
    set.renderEffectLayer(3, 4, nullptr);
    ASSERT_EQ(core->renders.size(), 2U);
    EXPECT_EQ(core->renders[0].glyph, &glyph.glyph);
    EXPECT_EQ(core->renders[0].dstBitmap, nullptr);
    EXPECT_EQ(core->renders[1].x, 3);
    EXPECT_EQ(core->renders[1].glyph, nullptr);
    EXPECT_EQ(bytesOf(*set.getSrcBitmap()), std::vector<uint8_t>(16, 0));
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, 0, 0, 0}));
}

// --- The text box -----------------------------------------------------------------------------

TEST(TextBox, GrowsGlyphByGlyphAndStartsAnewAfterPostProcessing) {
    VFEffect set;
    SolidGlyph glyph(10, 10);
    set.initEffect(100, 100);
    set.renderEffectLayer(0, 0, &glyph.glyph);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, 0, 10, 10}));
    set.renderEffectLayer(8, 2, &glyph.glyph);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, 0, 18, 12}));
    set.doEffectPostProcessing();
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, 0, 18, 12}));
    set.renderEffectLayer(50, 50, &glyph.glyph);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{50, 50, 60, 60}));
}

TEST(TextBox, FirstGlyphAwayFromTheOrigin_DoesNotIncludeTheOrigin) {
    VFEffect set;
    SolidGlyph glyph(3, 4);
    set.initEffect(100, 100);
    set.renderEffectLayer(-5, 60, &glyph.glyph);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{-5, 60, -2, 64}));
}

TEST(TextBox, GrowsByGlyphsWithoutExtentOrBuffer) {
    VFEffect set;
    SolidGlyph solid(2, 2);
    VFGlyph narrow = {solid.pixels.data(), 0, 5};
    VFGlyph flat = {solid.pixels.data(), 5, 0};
    VFGlyph hollow = {nullptr, 3, 3};
    set.initEffect(100, 100);
    set.renderEffectLayer(10, 10, &narrow);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{10, 10, 10, 15}));
    set.renderEffectLayer(30, 20, &flat);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{10, 10, 35, 20}));
    set.renderEffectLayer(40, 40, &hollow);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{10, 10, 43, 43}));
    EXPECT_EQ(bytesOf(*set.getSrcBitmap()), std::vector<uint8_t>(10000, 0));
}

TEST(TextBox, PostProcessing_ClampsItToTheMask) {
    struct Case {
        int x, y;
        Sides clamped;
        bool painted;
    };
    const Case cases[] = {{-5, -3, {0, 0, 5, 7}, true},
                          {95, 98, {95, 98, 100, 100}, true},
                          {20, 30, {20, 30, 30, 40}, true},
                          {120, 10, {100, 10, 100, 20}, false},
                          {10, 120, {10, 100, 20, 100}, false},
                          {-50, -60, {0, 0, 0, 0}, false},
                          {100, 0, {100, 0, 100, 10}, false},
                          {-10, 0, {0, 0, 0, 10}, false},
                          {99, 99, {99, 99, 100, 100}, true},
                          {INT_MIN, INT_MIN, {0, 0, 0, 0}, false},
                          {INT_MAX, INT_MAX, {100, 100, 100, 100}, false},
                          {INT_MIN, 5, {0, 5, 0, 15}, false},
                          {5, INT_MAX, {5, 100, 15, 100}, false}};
    for (const Case& with : cases) {
        VFEffect set;
        FakeCore* core = insertCore(set, kText);
        VFBitmap picture(100, 100, 4);
        SolidGlyph glyph(10, 10);
        set.initEffect(100, 100);
        set.setDstBitmap(&picture);
        set.renderEffectLayer(with.x, with.y, &glyph.glyph);
        set.doEffectPostProcessing();
        EXPECT_EQ(sidesOf(*set.getTextRect()), with.clamped) << with.x << " " << with.y;
        ASSERT_EQ(core->paints.size(), with.painted ? 1U : 0U) << with.x << " " << with.y;
        for (const VFRect& box : core->boxes)
            EXPECT_EQ(sidesOf(box), with.clamped);
        set.compositeLayers(&picture);
        EXPECT_EQ(sidesOf(*set.getTextRect()), with.clamped);
    }
}

TEST(TextBox, SidesOfAGlyph_HaveAll16Bits) {
    VFEffect set;
    SolidGlyph tall(1, 65535);
    SolidGlyph wide(32768, 1);
    set.initEffect(4, 4);
    set.renderEffectLayer(0, -40000, &tall.glyph);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, -40000, 1, 25535}));
    set.renderEffectLayer(2, 0, &wide.glyph);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, -40000, 32770, 25535}));
}

TEST(TextBox, GlyphsAtTheEndsOfTheRange_SpanTheWholeMask) {
    VFEffect set;
    SolidGlyph glyph(65535, 1);
    set.initEffect(100, 50);
    set.renderEffectLayer(INT_MIN, INT_MIN, &glyph.glyph);
    set.renderEffectLayer(INT_MAX, INT_MAX, &glyph.glyph);
    set.doEffectPostProcessing();
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, 0, 100, 50}));
}

TEST(TextBox, RunWithoutGlyphs_UsesThePreviousBoxClamped) {
    VFEffect set;
    FakeCore* core = insertCore(set, kText);
    StartedRun first(set, 20, 10);
    set.doEffectPostProcessing();
    set.compositeLayers(&first.picture);

    set.initEffect(5, 8);
    set.doEffectPostProcessing();
    ASSERT_EQ(core->boxes.size(), 2U);
    EXPECT_EQ(sidesOf(core->boxes[0]), (Sides{0, 0, 20, 10}));
    EXPECT_EQ(sidesOf(core->boxes[1]), (Sides{0, 0, 5, 8}));
}

TEST(TextBox, PostProcessingWithoutAMask_OnlyReArmsIt) {
    VFEffect set;
    FakeCore* core = insertCore(set, kText);
    VFBitmap picture(4, 4, 4);
    SolidGlyph glyph(2, 2);
    set.initEffect(4, 4);
    set.renderEffectLayer(3, 3, &glyph.glyph);
    set.compositeLayers(&picture);

    set.doEffectPostProcessing();
    EXPECT_TRUE(core->paints.empty());
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{3, 3, 5, 5}));  // not clamped: there is no mask
    set.initEffect(4, 4);
    set.renderEffectLayer(0, 0, &glyph.glyph);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, 0, 2, 2}));
}

TEST(TextBox, OnlyPostProcessingReArmsIt) {
    VFEffect set;
    VFBitmap picture(9, 9, 4);
    SolidGlyph glyph(2, 2);
    set.initEffect(9, 9);
    set.renderEffectLayer(6, 6, &glyph.glyph);
    set.compositeLayers(&picture);
    set.initEffect(9, 9);
    set.renderEffectLayer(0, 0, &glyph.glyph);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, 0, 8, 8}));
}

TEST(TextBox, RunWithoutGlyphs_PaintsOverTheBoxOfTheLastRun) {
    VFEffect set;
    FakeCore* core = insertCore(set, kText);
    VFBitmap picture(9, 9, 4);
    SolidGlyph glyph(2, 3);
    set.initEffect(9, 9);
    set.renderEffectLayer(4, 5, &glyph.glyph);
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    set.initEffect(9, 9);
    set.doEffectPostProcessing();
    ASSERT_EQ(core->paints.size(), 2U);
    EXPECT_EQ(sidesOf(*core->paints[1].textRect), (Sides{4, 5, 6, 8}));
}

/// A run without glyphs, after one with a glyph of 2 x 3 pixels at (4, 5).
std::vector<uint8_t> secondRunWithoutGlyphs(VFEffect& set) {
    VFBitmap picture(9, 9, 4);
    SolidGlyph glyph(2, 3);
    set.initEffect(9, 9);
    set.renderEffectLayer(4, 5, &glyph.glyph);
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    set.initEffect(9, 9);
    set.setDstBitmap(&picture);
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    return bytesOf(picture);
}

TEST(TextBox, RunWithoutGlyphs_IsFilledByWhatLiesInsideTheTextUnlessTheFillClips) {
    using AddCall = void (*)(VFEffect&);
    const AddCall inside[] = {
        [](VFEffect& set) { set.addStrokeText(1, 0xFFFFFF, 1, 0, 2); },
        [](VFEffect& set) { set.addInnerShadowText(0, 0, 1, 0xFFFFFF, 1); },
        [](VFEffect& set) { set.addInnerGlowText(1, 0xFFFFFF, 1, 0, nullptr); },
    };
    for (const AddCall add : inside) {
        VFEffect set;
        add(set);
        const std::vector<uint8_t> bytes = secondRunWithoutGlyphs(set);
        for (size_t y = 5; y < 8; ++y) {
            for (size_t x = 4; x < 6; ++x)
                EXPECT_NE(bytes[(y * 9 + x) * 4 + 3], 0) << x << ", " << y;
        }
        set.addText(0xFFFFFF, 1);
        EXPECT_EQ(secondRunWithoutGlyphs(set), std::vector<uint8_t>(9 * 9 * 4, 0));
    }
}

// --- Post-processing --------------------------------------------------------------------------

TEST(PostProcessing, OutsideLayeredMode_GivesEveryCoreTheDestination) {
    VFEffect set;
    VFStrokeProperty outside(1, 0, 1, 0, 1);
    VFBevelProperty bevel(0, 0, 0, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
    std::vector<FakeCore*> cores;
    for (const int type : {kOuterShadow, kInnerGlow, kText, kPattern, kNone, 42}) {
        cores.push_back(insertCore(set, type));
    }
    cores.push_back(insertCore(set, kStroke, &outside));
    cores.push_back(insertCore(set, kBevel, &bevel));
    StartedRun run(set, 6, 5);
    set.doEffectPostProcessing();
    for (const FakeCore* core : cores) {
        ASSERT_EQ(core->paints.size(), 1U);
        EXPECT_EQ(core->paints[0].dstBitmap, &run.picture);
        EXPECT_EQ(core->paints[0].srcBitmap, set.getSrcBitmap());
        EXPECT_EQ(core->paints[0].textRect, set.getTextRect());
        EXPECT_EQ(core->paints[0].useOuterLayer, 0);
        EXPECT_EQ(core->paints[0].subDstBitmap, nullptr);
    }
}

TEST(PostProcessing, RunsTheCoresInPaintOrderOncePerCall) {
    VFEffect set;
    std::vector<int> sequence;
    for (const int type : {kOuterShadow, kInnerShadow, kText, kInnerGlow, kNone}) {
        insertCore(set, type)->sequence = &sequence;
    }
    StartedRun run(set, 4, 4);
    const std::vector<int> order = {kInnerGlow, kInnerShadow, kText, kNone, kOuterShadow};
    set.doEffectPostProcessing();
    EXPECT_EQ(sequence, order);
    set.doEffectPostProcessing();
    EXPECT_EQ(sequence.size(), 10U);
}

TEST(PostProcessing, WithoutADestination_StillCallsTheCores) {
    for (const float opacity : {1.0F, 0.5F}) {
        VFEffect set;
        set.setTextOpacity(opacity);
        FakeCore* core = insertCore(set, kText);
        SolidGlyph glyph(2, 2);
        set.initEffect(4, 4);
        set.renderEffectLayer(0, 0, &glyph.glyph);
        set.doEffectPostProcessing();
        ASSERT_EQ(core->paints.size(), 1U);
        EXPECT_EQ(core->paints[0].dstBitmap, nullptr);
    }
}

enum Target { kDestination, kOuter, kBoth };

/// Where a core of that type and record is sent in layered mode.
void expectRoute(int type, VFProperty* property, Target target) {
    VFEffect set;
    set.setTextOpacity(0.5F);
    FakeCore* core = insertCore(set, type, property);
    // Painted later, after a core with a second target: its own second target is null again.
    FakeCore* text = insertCore(set, kText);
    StartedRun run(set, 6, 5);
    set.doEffectPostProcessing();

    ASSERT_EQ(core->paints.size(), 1U);
    const auto& params = core->paints[0];
    EXPECT_EQ(params.useOuterLayer, 1);
    EXPECT_EQ(params.srcBitmap, set.getSrcBitmap());
    EXPECT_EQ(params.subDstBitmap, target == kBoth ? &run.picture : nullptr) << type;
    if (target == kDestination) {
        EXPECT_EQ(params.dstBitmap, &run.picture) << type;
    } else {
        ASSERT_NE(params.dstBitmap, nullptr) << type;
        EXPECT_NE(params.dstBitmap, &run.picture) << type;
        EXPECT_EQ(params.dstBitmap->mBytesPerPixel, 4U);
        EXPECT_EQ(params.dstBitmap->mWidth, 6U);
        EXPECT_EQ(params.dstBitmap->mHeight, 5U);
    }
    ASSERT_EQ(text->paints.size(), 1U);
    EXPECT_EQ(text->paints[0].dstBitmap, &run.picture);
    EXPECT_EQ(text->paints[0].subDstBitmap, nullptr);
}

TEST(Routing, ShadowGlowAndTheBaseDefault_PaintTheOuterLayer) {
    for (const int type : {kOuterShadow, kOuterGlow, kNone})
        expectRoute(type, nullptr, kOuter);
}

TEST(Routing, EffectsInsideTheGlyphAndUnknownTypes_PaintTheDestination) {
    for (const int type : {kInnerShadow, kInnerGlow, kLinearGradient, kRadialGradient, kPattern, kText,
                           0, 14, -1, INT_MIN, INT_MAX}) {
        expectRoute(type, nullptr, kDestination);
    }
}

TEST(Routing, Bevel_PaintsTheDestinationWithStyleOneOnly) {
    for (const int style : {0, 1, 2, -1}) {
        VFBevelProperty property(style, 0, 0, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
        expectRoute(kBevel, &property, style == 1 ? kDestination : kOuter);
    }
}

TEST(Routing, Emboss_PaintsBoth) {
    expectRoute(kEmboss, nullptr, kBoth);
}

// Unlike isUnderEffect, which counts every position but 0 and 1 as inside.
TEST(Routing, Stroke_PaintsTheDestinationAtPositionTwoOnly) {
    const std::pair<int, Target> positions[] = {{0, kBoth},       {1, kOuter},  {2, kDestination},
                                                {3, kOuter},      {-1, kOuter}, {INT_MIN, kOuter},
                                                {INT_MAX, kOuter}};
    for (const int type : {kStroke, kReserved}) {
        for (const auto& [position, target] : positions) {
            VFStrokeProperty property(1, 0, 1, 0, position);
            expectRoute(type, &property, target);
        }
    }
}

TEST(Routing, UnknownStrokePosition_PaintsInsideButIntoTheOuterLayer) {
    VFEffect set;
    set.setTextOpacity(0.5F);
    set.addStrokeText(2, 0xFFFFFF, 1, 0, 3);
    EXPECT_FALSE(set.isUnderEffect(set.getEffect(kStroke)));
    StartedRun run(set, 9, 9);
    set.doEffectPostProcessing();
    EXPECT_EQ(bytesOf(run.picture), std::vector<uint8_t>(9 * 9 * 4, 0));

    set.addStrokeText(2, 0xFFFFFF, 1, 0, 2);
    set.doEffectPostProcessing();
    EXPECT_NE(bytesOf(run.picture), std::vector<uint8_t>(9 * 9 * 4, 0));
}

// --- The end of a run -------------------------------------------------------------------------

TEST(CompositeLayers, MixesOuterLayerAndPictureByCoverage) {
    VFEffect set;
    set.setTextOpacity(0.5F);
    insertCore(set, kNone)->onPaint = [](const VFECore::ParamPostProcessing& params) {
        fillBytes(*params.dstBitmap, 200);
    };
    VFBitmap picture(3, 1, 4);
    fillBytes(picture, 100);
    uint8_t coverage[] = {0, 128, 255};
    VFGlyph glyph = {coverage, 3, 1};
    set.initEffect(3, 1);
    set.setDstBitmap(&picture);
    set.renderEffectLayer(0, 0, &glyph);
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    EXPECT_EQ(bytesOf(picture),
              (std::vector<uint8_t>{200, 200, 200, 200, 149, 149, 149, 149, 100, 100, 100, 100}));
}

TEST(CompositeLayers, EverySize_MatchesTheFormulaPerByte) {
    Random random(24);
    for (unsigned width = 1; width <= 67; ++width) {
        const unsigned height = width % 5 + 1;
        VFBitmap outer(width, height, 4);
        VFBitmap picture(width, height, 4);
        std::vector<uint8_t> coverage(size_t{width} * height);
        for (size_t i = 0; i < coverage.size() * 4; ++i) {
            outer.mData[i] = random.byte();
            picture.mData[i] = random.byte();
        }
        for (uint8_t& m : coverage)
            m = random.chance(50) ? random.byte() : random.chance(50) ? 0 : 255;

        std::vector<uint8_t> expected = bytesOf(picture);
        for (size_t i = 0; i < expected.size(); ++i) {
            const int m = coverage[i / 4];
            const int mixed = ((outer.mData[i] + 1) * (255 - m) >> 8) + ((expected[i] + 1) * m >> 8);
            expected[i] = static_cast<uint8_t>(std::min(255, mixed));
        }

        VFEffect set;
        set.setTextOpacity(0.5F);
        insertCore(set, kNone)->onPaint = [&](const VFECore::ParamPostProcessing& params) {
            std::memcpy(params.dstBitmap->mData, outer.mData, expected.size());
        };
        VFGlyph glyph = {coverage.data(), static_cast<unsigned short>(width),
                         static_cast<unsigned short>(height)};
        set.initEffect(static_cast<int>(width), static_cast<int>(height));
        set.setDstBitmap(&picture);
        set.renderEffectLayer(0, 0, &glyph);
        set.doEffectPostProcessing();
        set.compositeLayers(&picture);
        EXPECT_TRUE(sameBytes(expected.data(), picture.mData, static_cast<int>(width),
                              static_cast<int>(height), 4));
    }
}

TEST(CompositeLayers, OutsideLayeredMode_LeavesThePictureAndEndsTheRun) {
    VFEffect set;
    StartedRun run(set, 4, 4, 0);  // a merge would erase the picture
    fillBytes(run.picture, 77);
    set.compositeLayers(&run.picture);
    EXPECT_EQ(bytesOf(run.picture), std::vector<uint8_t>(64, 77));
    EXPECT_EQ(set.getSrcBitmap(), nullptr);
    EXPECT_EQ(set.getDstBitmap(), nullptr);
}

TEST(CompositeLayers, OuterLayerOfAnAbandonedLayeredRun_IsNotMerged) {
    VFEffect set;
    set.setTextOpacity(0.5F);
    set.initEffect(4, 4);
    set.clearTextOpacity();
    StartedRun run(set, 4, 4, 0);  // a merge would erase the picture
    fillBytes(run.picture, 77);
    set.compositeLayers(&run.picture);
    EXPECT_EQ(bytesOf(run.picture), std::vector<uint8_t>(64, 77));
}

TEST(CompositeLayers, Refused_LeavesThePictureAndEndsTheRun) {
    // 20 x 20 layers; the third picture has as many pixels in another shape.
    for (const auto& [width, height, bytes] : {std::array<unsigned, 3>{10, 10, 4},
                                               {30, 30, 4},
                                               {40, 10, 4},
                                               {20, 19, 4},
                                               {20, 20, 1},
                                               {0, 0, 4}}) {
        VFEffect set;
        set.setTextOpacity(0.5F);
        StartedRun run(set, 20, 20, 0);  // a merge would erase the picture
        VFBitmap other(width, height, bytes);
        fillBytes(other, 77);
        set.doEffectPostProcessing();
        set.compositeLayers(&other);
        EXPECT_EQ(bytesOf(other), std::vector<uint8_t>(size_t{width} * height * bytes, 77));
        EXPECT_EQ(set.getSrcBitmap(), nullptr);
        EXPECT_EQ(set.getDstBitmap(), nullptr);
        EXPECT_FALSE(isLayered(set));
    }
}

/// The caller may put a mask of another size in the place of the run's.
TEST(CompositeLayers, MaskOfAnotherSize_LeavesThePicture) {
    for (const unsigned side : {19U, 21U}) {
        for (const unsigned picture : {20U, side}) {
            VFEffect set;
            set.setTextOpacity(0.5F);
            StartedRun run(set, 20, 20, 0);  // a merge would erase the picture
            VFBitmap other(picture, picture, 4);
            fillBytes(other, 77);
            set.doEffectPostProcessing();
            delete set.getSrcBitmap();
            set.setSrcBitmap(new VFBitmap(side, side, 1));
            set.compositeLayers(&other);
            EXPECT_EQ(bytesOf(other), std::vector<uint8_t>(size_t{picture} * picture * 4, 77));
        }
    }
}

TEST(CompositeLayers, NullPicture_EndsTheRun) {
    for (const float opacity : {1.0F, 0.5F}) {
        VFEffect set;
        set.setTextOpacity(opacity);
        StartedRun run(set, 4, 4);
        set.compositeLayers(nullptr);
        EXPECT_EQ(set.getSrcBitmap(), nullptr);
        EXPECT_EQ(set.getDstBitmap(), nullptr);
        EXPECT_FALSE(isLayered(set));
    }
}

TEST(CompositeLayers, MissingLayers_LeaveThePicture) {
    VFEffect set;
    set.setTextOpacity(0.5F);
    StartedRun run(set, 4, 4, 0);  // a merge would erase the picture
    fillBytes(run.picture, 77);
    set.releaseBitmap();
    set.compositeLayers(&run.picture);
    EXPECT_EQ(bytesOf(run.picture), std::vector<uint8_t>(64, 77));
    EXPECT_FALSE(isLayered(set));
}

TEST(CompositeLayers, WithoutARun_LeavesThePicture) {
    VFEffect set;
    VFBitmap picture(4, 4, 4);
    fillBytes(picture, 77);
    set.compositeLayers(&picture);
    EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(64, 77));
}

TEST(Runs, FollowEachOtherOnOneSet) {
    VFEffect set;
    delete[] set.getMapKey(0x3366CC);
    for (const int size : {8, 3, 12}) {
        StartedRun run(set, size, size);
        set.doEffectPostProcessing();
        set.compositeLayers(&run.picture);
        const uint8_t pixel[] = {0x33, 0x66, 0xCC, 0xFF};
        EXPECT_TRUE(sameBytes(pixel, run.picture.mData + (size * size - 1) * 4, 1, 1, 4));
        EXPECT_EQ(sidesOf(*set.getTextRect()), (Sides{0, 0, size, size}));
    }
}

/// A run on layers of 80 x 80 pixels, painted into a destination of a side of its own. Effects of both
/// sides of the edge.
VFBitmap paintedOnLayersOf80(unsigned side, float textOpacity) {
    VFEffect set;
    set.addOuterShadowText(135, 6, 8, 0xFF0000, 1);
    set.addStrokeText(4, 0x00FF00, 1, 0, 1);
    set.addInnerShadowText(135, 3, 2, 0x0000FF, 1);
    set.setTextOpacity(textOpacity);
    set.addText(0x808080, textOpacity);
    VFBitmap picture(side, side, 4);
    SolidGlyph glyph(40, 40);
    set.initEffect(80, 80);
    set.setDstBitmap(&picture);
    set.renderEffectLayer(20, 20, &glyph.glyph);
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    return picture;
}

const uint8_t* pixelOf(const VFBitmap& picture, unsigned x, unsigned y) {
    return picture.mData + (size_t{y} * picture.mWidth + x) * 4;
}

TEST(Runs, DestinationOfAnotherSize_TakesWhatFits) {
    const VFBitmap whole = paintedOnLayersOf80(80, 1);
    const VFBitmap small = paintedOnLayersOf80(60, 1);
    const VFBitmap large = paintedOnLayersOf80(100, 1);
    for (unsigned y = 0; y < 100; ++y) {
        for (unsigned x = 0; x < 100; ++x) {
            const bool inLayers = x < 80 && y < 80;
            const uint8_t none[4] = {};
            const uint8_t* const wanted = inLayers ? pixelOf(whole, x, y) : none;
            ASSERT_EQ(0, std::memcmp(wanted, pixelOf(large, x, y), 4)) << x << ", " << y;
            if (x >= 60 || y >= 60) continue;
            ASSERT_EQ(0, std::memcmp(wanted, pixelOf(small, x, y), 4)) << x << ", " << y;
        }
    }
}

/// Nothing outside the glyph, whose box is 20 to 60 on either axis.
TEST(Runs, DestinationOfAnotherSizeInLayeredMode_TakesWhatLiesInsideTheGlyphsAlone) {
    const VFBitmap whole = paintedOnLayersOf80(80, 0.5F);
    for (const unsigned side : {60U, 100U}) {
        const VFBitmap other = paintedOnLayersOf80(side, 0.5F);
        for (unsigned y = 0; y < side; ++y) {
            for (unsigned x = 0; x < side; ++x) {
                const bool inside = x >= 20 && x < 60 && y >= 20 && y < 60;
                const uint8_t none[4] = {};
                const uint8_t* const wanted = inside ? pixelOf(whole, x, y) : none;
                ASSERT_EQ(0, std::memcmp(wanted, pixelOf(other, x, y), 4)) << x << ", " << y;
            }
        }
    }
}

TEST(Runs, DestinationOfAnotherFormat_StaysAsItIs) {
    for (const unsigned bytesPerPixel : {1U, 2U, 3U}) {
        for (const float textOpacity : {1.0F, 0.5F}) {
            VFEffect set;
            set.addOuterShadowText(135, 6, 8, 0xFF0000, 1);
            set.addInnerShadowText(135, 3, 2, 0x0000FF, 1);
            set.setTextOpacity(textOpacity);
            set.addText(0x808080, textOpacity);
            VFBitmap picture(30, 30, bytesPerPixel);
            fillBytes(picture, 77);
            const std::vector<uint8_t> before = bytesOf(picture);
            SolidGlyph glyph(10, 10);
            set.initEffect(30, 30);
            set.setDstBitmap(&picture);
            set.renderEffectLayer(10, 10, &glyph.glyph);
            set.doEffectPostProcessing();
            set.compositeLayers(&picture);
            EXPECT_EQ(bytesOf(picture), before) << bytesPerPixel << " " << textOpacity;
        }
    }
}

TEST(Runs, CallsOutOfOrder_PaintNothing) {
    SolidGlyph glyph(3, 3);
    VFBitmap picture(9, 9, 4);
    const std::vector<uint8_t> clear = bytesOf(picture);
    VFEffect set;
    set.addStrokeText(1, 0xFFFFFF, 1, 0, 1);
    set.addText(0xFF, 1);

    set.setDstBitmap(&picture);  // initEffect forgets it
    set.initEffect(9, 9);
    set.renderEffectLayer(3, 3, &glyph.glyph);
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    EXPECT_EQ(bytesOf(picture), clear);

    set.renderEffectLayer(3, 3, &glyph.glyph);  // no mask to draw into yet
    set.initEffect(9, 9);
    set.setDstBitmap(&picture);
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    EXPECT_EQ(bytesOf(picture), clear);

    set.initEffect(9, 9);
    set.setDstBitmap(&picture);
    set.renderEffectLayer(3, 3, &glyph.glyph);
    set.compositeLayers(&picture);  // ends the run
    set.doEffectPostProcessing();
    EXPECT_EQ(bytesOf(picture), clear);
}

TEST(Runs, DestinationSmallerOrLargerThanTheLayers_Survives) {
    for (const float opacity : {1.0F, 0.5F}) {
        for (const unsigned size : {1U, 19U, 50U}) {
            VFEffect set;
            set.setTextOpacity(opacity);
            set.addOuterShadowText(30, 3, 3, 0, 1);
            set.addStrokeText(2, 0, 1, 0, 0);
            set.addInnerGlowText(3, 0xFFFFFF, 1, 0, nullptr);
            delete[] set.getMapKey(0xFFFFFF);
            StartedRun run(set, 20, 20);
            VFBitmap other(size, size, 4);
            set.setDstBitmap(&other);
            set.doEffectPostProcessing();
            EXPECT_NE(bytesOf(other), std::vector<uint8_t>(size_t{size} * size * 4, 0));
            const std::vector<uint8_t> before = bytesOf(other);
            set.compositeLayers(&other);
            EXPECT_EQ(bytesOf(other), before);
        }
    }
}

}  // namespace
