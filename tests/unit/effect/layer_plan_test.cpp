#include <gtest/gtest.h>
#include <voreleffect/VFEffect.h>

#include <algorithm>
#include <climits>

#include "tests/support/engine.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

// --- Kinds of effects, and the paint order told plainly ----------------------------------------

struct Kind {
    char letter;  ///< of the cache key; '-' where the kind leaves no trace in it
    int type;
    bool under;   ///< painted beneath the text outside layered mode
    bool centre;  ///< selects layered mode
    void (*add)(VFEffect&);
};

void addStroke(VFEffect& set, int position) {
    set.addStrokeText(2, 0, 1, 0, position);
}

const Kind kKinds[] = {
    {'S', kOuterShadow, true, false, [](VFEffect& set) { set.addOuterShadowText(0, 1, 1, 0, 1); }},
    {'I', kInnerShadow, false, false, [](VFEffect& set) { set.addInnerShadowText(0, 1, 1, 0, 1); }},
    {'G', kOuterGlow, true, false, [](VFEffect& set) { set.addOuterGlowText(1, 0, 1, 0, nullptr); }},
    {'N', kInnerGlow, false, false, [](VFEffect& set) { set.addInnerGlowText(1, 0, 1, 0, nullptr); }},
    {'L', kLinearGradient, false, false,
     [](VFEffect& set) { set.addLinearGradientText(0, 1, 1, 0, nullptr); }},
    {'D', kRadialGradient, false, false,
     [](VFEffect& set) { set.addRadialGradientText(1, 1, 0, nullptr); }},
    {'K', kStroke, false, true, [](VFEffect& set) { addStroke(set, 0); }},
    {'K', kStroke, true, false, [](VFEffect& set) { addStroke(set, 1); }},
    {'K', kStroke, false, false, [](VFEffect& set) { addStroke(set, 2); }},
    {'-', kPattern, false, false, [](VFEffect& set) { set.addPatternText(nullptr, 1, 1); }},
    {'T', kText, false, false, [](VFEffect& set) { set.addText(0, 1); }},
};

using Kinds = std::vector<const Kind*>;

Kinds planned(Kinds list, bool layered) {
    const auto isText = [](const Kind* kind) { return kind->type == kText; };
    if (layered) {
        std::reverse(list.begin(), list.end());
        std::stable_partition(list.begin(), list.end(), [&](const Kind* kind) { return !isText(kind); });
        return list;
    }
    Kinds over;
    Kinds under;
    for (const Kind* kind : list) {
        if (isText(kind)) {
            over.push_back(kind);
        } else {
            Kinds& group = kind->under ? under : over;
            group.insert(group.begin(), kind);
        }
    }
    over.insert(over.end(), under.begin(), under.end());
    return over;
}

std::string lettersOf(const Kinds& kinds) {
    std::string letters;
    for (const Kind* kind : kinds) {
        if (kind->letter != '-') letters += kind->letter;
    }
    return letters;
}

/// Adding a bevel leaves the list as it is and re-arms the ordering.
void reArm(VFEffect& set) {
    set.addBevelText(0, 0, 0, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
}

void expectOrdersOfTwoRuns(const Kinds& added, float textOpacity) {
    VFEffect set;
    set.setTextOpacity(textOpacity);
    bool layered = textOpacity < 1;
    for (const Kind* kind : added) {
        kind->add(set);
        layered = layered || kind->centre;
    }
    ASSERT_EQ(orderOf(set), lettersOf(added));

    const Kinds first = planned(added, layered);
    ASSERT_EQ(planAndOrder(set), lettersOf(first)) << lettersOf(added) << " at " << textOpacity;
    ASSERT_EQ(isLayered(set), layered);
    ASSERT_EQ(planAndOrder(set), lettersOf(first)) << "planned again without a change";
    reArm(set);
    ASSERT_EQ(planAndOrder(set), lettersOf(planned(first, layered)))
        << lettersOf(added) << ", second run";
}

/// Every way to add `count` kinds of different types.
template <class Check>
void forEachChoice(size_t count, Check check, const Kinds& chosen = {}) {
    if (chosen.size() == count) return check(chosen);
    for (const Kind& kind : kKinds) {
        const bool taken = std::any_of(chosen.begin(), chosen.end(),
                                       [&](const Kind* other) { return other->type == kind.type; });
        if (taken) continue;
        Kinds longer = chosen;
        longer.push_back(&kind);
        forEachChoice(count, check, longer);
    }
}

// --- Paint order ------------------------------------------------------------------------------

TEST(PaintOrder, UnderEffects_FollowTheTextNewestFirst) {
    VFEffect set;
    set.addOuterShadowText(0, 1, 1, 0, 1);
    addStroke(set, 1);
    set.addText(0, 1);
    EXPECT_EQ(orderOf(set), "SKT");
    EXPECT_EQ(planAndOrder(set), "TKS");
}

TEST(PaintOrder, OverEffects_PrecedeTheTextNewestFirst) {
    VFEffect set;
    set.addInnerShadowText(0, 1, 1, 0, 1);
    set.addLinearGradientText(0, 1, 1, 0, nullptr);
    set.addText(0, 1);
    EXPECT_EQ(planAndOrder(set), "LIT");
}

TEST(PaintOrder, Layered_RunsNewestFirstWithTheTextLast) {
    VFEffect set;
    set.setTextOpacity(0.5F);
    set.addOuterShadowText(0, 1, 1, 0, 1);
    set.addText(0, 1);
    set.addInnerShadowText(0, 1, 1, 0, 1);
    addStroke(set, 1);
    EXPECT_EQ(planAndOrder(set), "KIST");
}

TEST(PaintOrder, TextAlone_StaysWhereItIs) {
    VFEffect set;
    set.addText(0, 1);
    set.setTextOpacity(0.5F);
    EXPECT_EQ(planAndOrder(set), "T");
    EXPECT_TRUE(isLayered(set));
}

TEST(PaintOrder, AddingTheSameTextAgain_ReversesBothGroups) {
    VFEffect set;
    set.addOuterShadowText(0, 1, 1, 0, 1);
    set.addInnerShadowText(0, 1, 1, 0, 1);
    addStroke(set, 1);
    set.addLinearGradientText(0, 1, 1, 0, nullptr);
    set.addText(0x123456, 1);
    EXPECT_EQ(planAndOrder(set), "LITKS");
    set.addText(0x123456, 1);
    EXPECT_EQ(planAndOrder(set), "ILTSK");
    set.addText(0x123456, 1);
    EXPECT_EQ(planAndOrder(set), "LITKS");
}

/// Callers' own cores make lists of any length; 16 are as few as some sorts keep in order by chance.
TEST(PaintOrder, LongLists_KeepTheOrderOfEachGroup) {
    VFEffect set;
    constexpr int kCores = 60;
    std::vector<FakeCore*> cores;
    for (int i = 0; i < kCores; ++i)
        cores.push_back(insertCore(set, i % 3 == 0 ? kOuterShadow : kInnerShadow));
    set.addText(0, 1);
    std::vector<VFECore*> expected;
    for (int i = kCores - 1; i >= 0; --i) {
        if (i % 3 != 0) expected.push_back(cores[static_cast<size_t>(i)]);
    }
    expected.push_back(set.getEffect(kText));
    for (int i = kCores - 1; i >= 0; --i) {
        if (i % 3 == 0) expected.push_back(cores[static_cast<size_t>(i)]);
    }
    set.initEffect(4, 4);
    EXPECT_EQ(effectsOf(set), expected);
}

TEST(PaintOrder, PatternIsPlacedAmongTheOverEffects) {
    VFEffect set;
    set.addPatternText(nullptr, 1, 1);
    set.addInnerShadowText(0, 1, 1, 0, 1);
    set.addText(0, 1);
    set.initEffect(4, 4);
    std::vector<int> types;
    for (VFECore* core : effectsOf(set))
        types.push_back(core->getStyle());
    EXPECT_EQ(types, (std::vector<int>{kInnerShadow, kPattern, kText}));
}

TEST(PaintOrder, AllPairs) {
    for (const float textOpacity : {1.0F, 0.5F}) {
        forEachChoice(2, [&](const Kinds& added) { expectOrdersOfTwoRuns(added, textOpacity); });
    }
}

TEST(PaintOrder, AllTriples) {
    for (const float textOpacity : {1.0F, 0.5F}) {
        forEachChoice(3, [&](const Kinds& added) { expectOrdersOfTwoRuns(added, textOpacity); });
    }
}

TEST(PaintOrder, EverythingAtOnce) {
    for (const float textOpacity : {1.0F, 0.5F}) {
        for (const size_t stroke : {6U, 7U, 8U}) {
            Kinds added;
            for (size_t i = 0; i < std::size(kKinds); ++i) {
                if (kKinds[i].type != kStroke || i == stroke) added.push_back(&kKinds[i]);
            }
            do {
                expectOrdersOfTwoRuns(added, textOpacity);
                std::rotate(added.begin(), added.begin() + 1, added.end());
            } while (added.front() != &kKinds[0]);
        }
    }
}

TEST(PaintOrder, SwitchingToLayeredMode_ReversesTheListAsItStands) {
    VFEffect set;
    set.addOuterShadowText(0, 1, 1, 0, 1);
    set.addInnerShadowText(0, 1, 1, 0, 1);
    set.addText(0, 1);
    ASSERT_EQ(planAndOrder(set), "ITS");
    set.setTextOpacity(0.5F);
    EXPECT_EQ(planAndOrder(set), "SIT");
}

TEST(PaintOrder, LayeredModeByCentreStroke_EndsWhenTheStrokeIsMovedOutside) {
    VFEffect set;
    addStroke(set, 0);
    set.addOuterShadowText(0, 1, 1, 0, 1);
    set.addText(0, 1);
    ASSERT_EQ(planAndOrder(set), "SKT");
    addStroke(set, 1);
    EXPECT_EQ(planAndOrder(set), "TKS");
    EXPECT_FALSE(isLayered(set));
}

TEST(PaintOrder, FakeKindsFollowTheUnderRule) {
    VFEffect set;
    VFBevelProperty bevel(0, 0, 0, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
    VFStrokeProperty outside(1, 0, 1, 0, 1);
    for (const int type : {kNone, kText, 42})
        insertCore(set, type);
    insertCore(set, kBevel, &bevel);
    insertCore(set, kReserved, &outside);
    set.initEffect(4, 4);
    std::vector<int> types;
    for (VFECore* core : effectsOf(set))
        types.push_back(core->getStyle());
    EXPECT_EQ(types, (std::vector<int>{42, kText, kReserved, kBevel, kNone}));
}

// --- Layered mode -----------------------------------------------------------------------------

TEST(LayeredMode, TextOpacityBelowOne_SelectsIt) {
    for (const float opacity : {0.0F, 0.5F, 0.99999F, kNan}) {
        VFEffect set;
        set.addText(0, 1);
        set.setTextOpacity(opacity);
        EXPECT_FALSE(isLayered(set)) << "decided by initEffect";
        set.initEffect(4, 4);
        EXPECT_TRUE(isLayered(set)) << opacity;
        set.clearTextOpacity();
        EXPECT_TRUE(isLayered(set));
        set.initEffect(4, 4);
        EXPECT_FALSE(isLayered(set));
    }
}

TEST(LayeredMode, CentreStroke_SelectsItAtFullTextOpacity) {
    for (const int position : {0, 1, 2, 3, -1, INT_MIN}) {
        VFEffect set;
        set.addText(0, 1);
        addStroke(set, position);
        set.initEffect(4, 4);
        EXPECT_EQ(isLayered(set), position == 0) << position;
    }
}

TEST(LayeredMode, EmbossAndReservedCentreStroke_SelectIt) {
    VFStrokeProperty centre(1, 0, 1, 0, 0);
    VFStrokeProperty outside(1, 0, 1, 0, 1);
    VFBevelProperty bevel(0, 0, 0, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
    struct Case {
        int type;
        VFProperty* property;
        bool layered;
    };
    for (const Case& with :
         {Case{kEmboss, nullptr, true}, Case{kReserved, &centre, true}, Case{kReserved, &outside, false},
          Case{kBevel, &bevel, false}, Case{kNone, nullptr, false}, Case{42, nullptr, false}}) {
        VFEffect set;
        insertCore(set, kText);
        insertCore(set, with.type, with.property);
        set.initEffect(4, 4);
        EXPECT_EQ(isLayered(set), with.layered) << with.type;
    }
}

TEST(LayeredMode, StrokeWithoutARecord_DoesNotSelectIt) {
    VFEffect set;
    set.addEffect(kStroke, nullptr);
    set.initEffect(4, 4);
    EXPECT_FALSE(isLayered(set));
}

TEST(LayeredMode, EndsWithTheRun) {
    VFEffect set;
    VFBitmap picture(4, 4, 4);
    set.setTextOpacity(0.5F);
    set.initEffect(4, 4);
    ASSERT_TRUE(isLayered(set));
    set.compositeLayers(&picture);
    EXPECT_FALSE(isLayered(set));
}

// --- What initEffect makes --------------------------------------------------------------------

TEST(InitEffect, MakesAZeroedMaskAndClearsTheDestination) {
    VFEffect set;
    VFBitmap picture(7, 3, 4);
    set.setDstBitmap(&picture);
    set.initEffect(7, 3);
    ASSERT_NE(set.getSrcBitmap(), nullptr);
    EXPECT_EQ(set.getSrcBitmap()->mWidth, 7U);
    EXPECT_EQ(set.getSrcBitmap()->mHeight, 3U);
    EXPECT_EQ(set.getSrcBitmap()->mBytesPerPixel, 1U);
    EXPECT_EQ(bytesOf(*set.getSrcBitmap()), std::vector<uint8_t>(21, 0));
    EXPECT_EQ(set.getDstBitmap(), nullptr);
}

TEST(InitEffect, MakesAZeroedOuterLayerInLayeredMode) {
    VFEffect set;
    VFBitmap picture(7, 3, 4);
    SolidGlyph glyph(2, 2);
    set.setTextOpacity(0.5F);
    FakeCore* under = insertCore(set, kNone);
    std::vector<uint8_t> layer;
    under->onPaint = [&](const VFECore::ParamPostProcessing& params) {
        layer = bytesOf(*params.dstBitmap);
    };
    set.initEffect(7, 3);
    set.setDstBitmap(&picture);
    set.renderEffectLayer(0, 0, &glyph.glyph);
    set.doEffectPostProcessing();
    ASSERT_EQ(under->paints.size(), 1U);
    EXPECT_NE(under->paints[0].dstBitmap, &picture);
    EXPECT_EQ(under->paints[0].dstBitmap->mWidth, 7U);
    EXPECT_EQ(layer, std::vector<uint8_t>(7 * 3 * 4, 0));
}

TEST(InitEffect, TellsEveryCoreTheRun) {
    VFEffect set;
    FakeCore* shadow = insertCore(set, kOuterShadow);
    FakeCore* glow = insertCore(set, kInnerGlow);
    set.initEffect(7, 3);
    set.setTextOpacity(0.5F);
    set.initEffect(5, 6);
    for (FakeCore* core : {shadow, glow}) {
        ASSERT_EQ(core->inits.size(), 2U);
        EXPECT_EQ(core->inits[0].width, 7);
        EXPECT_EQ(core->inits[0].height, 3);
        EXPECT_EQ(core->inits[0].useOuterLayer, 0);
        EXPECT_EQ(core->inits[1].width, 5);
        EXPECT_EQ(core->inits[1].height, 6);
        EXPECT_EQ(core->inits[1].useOuterLayer, 1);
    }
}

TEST(InitEffect, Again_LosesTheGlyphs) {
    VFEffect set;
    SolidGlyph glyph(2, 2);
    set.initEffect(4, 4);
    set.renderEffectLayer(0, 0, &glyph.glyph);
    ASSERT_EQ(set.getSrcBitmap()->mData[0], 255);
    set.initEffect(4, 4);
    EXPECT_EQ(bytesOf(*set.getSrcBitmap()), std::vector<uint8_t>(16, 0));
}

TEST(InitEffect, NegativeSizes_CountAsZero) {
    const std::pair<int, int> sizes[] = {{-5, 3}, {5, -3}, {-1, -1}, {INT_MIN, INT_MIN}, {0, 0}, {0, 9}};
    for (const float opacity : {1.0F, 0.5F}) {
        for (const auto& [width, height] : sizes) {
            VFEffect set;
            VFBitmap picture(4, 4, 4);
            fillBytes(picture, 99);
            SolidGlyph glyph(2, 2);
            set.setTextOpacity(opacity);
            set.addText(0, opacity);
            set.initEffect(width, height);
            ASSERT_NE(set.getSrcBitmap(), nullptr);
            EXPECT_EQ(set.getSrcBitmap()->mWidth, static_cast<unsigned>(std::max(width, 0)));
            EXPECT_EQ(set.getSrcBitmap()->mHeight, static_cast<unsigned>(std::max(height, 0)));
            set.setDstBitmap(&picture);
            set.renderEffectLayer(0, 0, &glyph.glyph);
            set.doEffectPostProcessing();
            set.compositeLayers(&picture);
            EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(64, 99));
        }
    }
}

TEST(InitEffect, AbsurdSizes_SurviveAndDrawNothing) {
    const std::pair<int, int> sizes[] = {
        {70000, 70000}, {INT_MAX, INT_MAX}, {INT_MAX, 3}, {65536, 65536}};
    for (const float opacity : {1.0F, 0.5F}) {
        for (const auto& [width, height] : sizes) {
            VFEffect set;
            VFBitmap picture(4, 4, 4);
            fillBytes(picture, 99);
            SolidGlyph glyph(2, 2);
            set.setTextOpacity(opacity);
            for (const Kind& kind : kKinds)
                kind.add(set);
            set.initEffect(width, height);
            ASSERT_NE(set.getSrcBitmap(), nullptr);
            EXPECT_EQ(set.getSrcBitmap()->mData, nullptr) << "a layer of as many bytes has no pixels";
            set.setDstBitmap(&picture);
            set.renderEffectLayer(1, 1, &glyph.glyph);
            set.doEffectPostProcessing();
            set.compositeLayers(&picture);
            EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(64, 99)) << width << " " << height;
            EXPECT_EQ(set.getSrcBitmap(), nullptr);
        }
    }
}

// --- Under the text or not --------------------------------------------------------------------

/// The rule's answer outside and in layered mode.
void expectUnder(int type, VFProperty* property, bool plain, bool layered) {
    FakeCore core(type, property);
    VFEffect set;
    EXPECT_EQ(set.isUnderEffect(&core), plain) << type;
    set.setTextOpacity(0.5F);
    set.initEffect(1, 1);
    EXPECT_EQ(set.isUnderEffect(&core), layered) << type << " in layered mode";
}

TEST(UnderEffect, ShadowGlowAndTheBaseDefault_AreUnder) {
    for (const int type : {kOuterShadow, kOuterGlow, kNone})
        expectUnder(type, nullptr, true, true);
}

TEST(UnderEffect, Emboss_IsUnderOutsideLayeredModeOnly) {
    expectUnder(kEmboss, nullptr, true, false);
}

TEST(UnderEffect, Strokes_FollowTheirPosition) {
    for (const int type : {kStroke, kReserved}) {
        for (const int position : {0, 1, 2, 3, -1, INT_MIN, INT_MAX}) {
            VFStrokeProperty property(1, 0, 1, 0, position);
            expectUnder(type, &property, position == 0 || position == 1, position == 1);
        }
    }
}

TEST(UnderEffect, Bevel_IsUnderUnlessItsStyleIsOne) {
    for (const int style : {0, 1, 2, -1, 3}) {
        VFBevelProperty property(style, 0, 0, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
        expectUnder(kBevel, &property, style != 1, style != 1);
    }
}

TEST(UnderEffect, EverythingElse_IsNot) {
    for (const int type : {kInnerShadow, kInnerGlow, kLinearGradient, kRadialGradient, kPattern, kText,
                           0, 14, -1, INT_MIN, INT_MAX}) {
        expectUnder(type, nullptr, false, false);
    }
}

TEST(UnderEffect, RealCores_FollowTheSameRule) {
    for (const Kind& kind : kKinds) {
        VFEffect set;
        kind.add(set);
        EXPECT_EQ(set.isUnderEffect(set.getEffect(kind.type)), kind.under || kind.centre) << kind.type;
    }
}

// --- Offsets ----------------------------------------------------------------------------------

std::vector<int> offsetsOf(VFEffect& set) {
    return {set.getLeftOffset(), set.getTopOffset(), set.getRightOffset(), set.getBottomOffset()};
}

const std::vector<int> kNoOffsets = {0, 0, 0, 0};

TEST(Offsets, EmptySet_NeedsNone) {
    VFEffect set;
    EXPECT_EQ(offsetsOf(set), kNoOffsets);
}

TEST(Offsets, EffectsInsideTheGlyph_NeedNone) {
    VFEffect set;
    VFBitmap pattern(2, 2, 4);
    set.addText(0, 1);
    set.addLinearGradientText(0, 2, 1, 0, nullptr);
    set.addRadialGradientText(2, 1, 0, nullptr);
    set.addPatternText(&pattern, 10, 1);
    set.addInnerShadowText(30, 100, 100, 0, 1);
    addStroke(set, 2);
    EXPECT_EQ(offsetsOf(set), kNoOffsets);
}

TEST(Offsets, Stroke_ReachesByItsPosition) {
    const std::pair<int, int> reaches[] = {{1, 7}, {0, 4}, {2, 0}, {3, 0}, {-1, 0}};
    for (const auto& [position, reach] : reaches) {
        VFEffect set;
        set.addStrokeText(7, 0, 1, 0, position);
        EXPECT_EQ(offsetsOf(set), std::vector<int>(4, reach)) << position;
    }
}

TEST(Offsets, Glows_ReachTheirSize) {
    VFEffect outer;
    outer.addOuterGlowText(12, 0, 1, 0, nullptr);
    EXPECT_EQ(offsetsOf(outer), std::vector<int>(4, 12));
    VFEffect inner;
    inner.addInnerGlowText(5, 0, 1, 0, nullptr);
    EXPECT_EQ(offsetsOf(inner), std::vector<int>(4, 5));
}

TEST(Offsets, Shadow_ReachesAwayFromTheLight) {
    VFEffect set;
    set.addOuterShadowText(0, 10, 10, 0, 1);
    EXPECT_EQ(offsetsOf(set), (std::vector<int>{20, 10, 0, 10}));
    set.addOuterShadowText(90, 10, 3, 0, 1);
    EXPECT_EQ(offsetsOf(set), (std::vector<int>{3, 0, 3, 13}));
    set.addOuterShadowText(180, 10, 3, 0, 1);
    EXPECT_EQ(offsetsOf(set), (std::vector<int>{0, 3, 13, 3}));
}

TEST(Offsets, EachSide_TakesTheLargest) {
    VFEffect set;
    set.addOuterShadowText(0, 10, 10, 0, 1);
    set.addStrokeText(12, 0, 1, 0, 1);
    set.addOuterGlowText(4, 0, 1, 0, nullptr);
    set.addText(0, 1);
    EXPECT_EQ(offsetsOf(set), (std::vector<int>{20, 12, 12, 12}));
}

TEST(Offsets, EachSide_AsksItsOwnQueryAndIsNeverNegative) {
    VFEffect set;
    insertCore(set, kNone)->offsets = VFRect(-1, -2, -3, -4);
    EXPECT_EQ(offsetsOf(set), kNoOffsets);
    insertCore(set, kNone)->offsets = VFRect(1, 2, 3, 4);
    insertCore(set, kNone)->offsets = VFRect(4, 3, 2, 1);
    EXPECT_EQ(offsetsOf(set), (std::vector<int>{4, 3, 3, 4}));
}

TEST(Offsets, CoresWithoutRecords_NeedNone) {
    VFEffect set;
    for (const int type : kCoreTypes)
        set.addEffect(type, nullptr);
    EXPECT_EQ(offsetsOf(set), kNoOffsets);
}

}  // namespace
