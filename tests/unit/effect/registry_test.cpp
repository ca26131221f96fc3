#include <gtest/gtest.h>
#include <voreleffect/VFEffect.h>

#include <memory>

#include "tests/support/engine.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

std::vector<int> typesOf(VFEffect& set) {
    std::vector<int> types;
    for (VFECore* core : effectsOf(set))
        types.push_back(core->getStyle());
    return types;
}

std::vector<int> idsOf(VFEffect& set) {
    std::vector<int> ids;
    for (VFECore* core : effectsOf(set))
        ids.push_back(core->getId());
    return ids;
}

/// Two under-effects, planned: the order is "KS" until something re-arms the ordering.
void planShadowAndStroke(VFEffect& set) {
    set.addOuterShadowText(0, 1, 1, 0, 1);
    set.addStrokeText(1, 0, 1, 0, 1);
    ASSERT_EQ(planAndOrder(set), "KS");
}

bool orderIsReArmed(VFEffect& set) {
    const std::string before = orderOf(set);
    return planAndOrder(set) != before;
}

TEST(EffectSet, Fresh_HasNothing) {
    VFEffect set;
    EXPECT_FALSE(set.hasEffects());
    EXPECT_EQ(set.getTextOpacity(), 1.0F);
    EXPECT_EQ(set.getSrcBitmap(), nullptr);
    EXPECT_EQ(set.getDstBitmap(), nullptr);
    EXPECT_EQ(sidesOf(*set.getTextRect()), (std::vector<int>{0, 0, 0, 0}));
    EXPECT_EQ(textAlphaOf(set), 255);
    EXPECT_EQ(textColorOf(set), 0xFF000000U);
    EXPECT_EQ(set.getNewEffectId(), 0);
    for (int type = -1; type <= 14; ++type)
        EXPECT_EQ(set.getEffect(type), nullptr);
}

TEST(EffectSet, ConstructorArgument_IsIgnored) {
    int anything = 5;
    VFEffect set(static_cast<void*>(&anything));
    EXPECT_FALSE(set.hasEffects());
    EXPECT_EQ(set.getTextOpacity(), 1.0F);
    EXPECT_EQ(set.addText(0, 1), 0U);
    EXPECT_EQ(anything, 5);
}

TEST(EffectSet, MadeFromAPointerToASet_IsNoCopy) {
    VFEffect set;
    set.addText(0xFF, 1);
    VFEffect other(&set);
    EXPECT_FALSE(other.hasEffects());
    EXPECT_TRUE(VFEffect(set).hasEffects());
}

TEST(Registry, CreateEffect_MakesTheCoreOfItsTypeOutsideTheList) {
    VFEffect set;
    for (const int type : kCoreTypes) {
        VFECore* core = set.createEffect(40 + type, type, nullptr);
        ASSERT_NE(core, nullptr) << type;
        EXPECT_EQ(core->getStyle(), type);
        EXPECT_EQ(core->getId(), 40 + type);
        EXPECT_EQ(core->getProperty(), nullptr);
        EXPECT_EQ(core->getOpacity(), 1.0F);
        set.releaseEffect(core);
    }
    EXPECT_FALSE(set.hasEffects());
    EXPECT_EQ(set.getNewEffectId(), 0);
}

TEST(Registry, CreateEffectWithoutCore_IsNullAndLeavesTheCounter) {
    VFEffect set;
    for (const int type : {0, 5, 6, 9, 13, 14, 100, -1, INT32_MIN, INT32_MAX}) {
        EXPECT_EQ(set.createEffect(-1, type, nullptr), nullptr) << type;
        EXPECT_EQ(set.addEffect(type, nullptr), -1) << type;
    }
    EXPECT_FALSE(set.hasEffects());
    EXPECT_EQ(set.getNewEffectId(), 0);
}

TEST(Registry, CreateEffect_IgnoresItsThirdArgument) {
    VFEffect set;
    VFText existing;
    VFECore* core = set.createEffect(-1, kStroke, &existing);
    EXPECT_NE(core, &existing);
    EXPECT_EQ(core->getStyle(), kStroke);
    set.releaseEffect(core);
}

TEST(Registry, NegativeId_TakesTheCounter) {
    VFEffect set;
    for (const int id : {-1, -2, INT32_MIN}) {
        VFECore* core = set.createEffect(id, kText, nullptr);
        EXPECT_EQ(core->getId(), nextEffectIdOf(set) - 1);
        set.releaseEffect(core);
    }
    EXPECT_EQ(set.getNewEffectId(), 3);
}

TEST(Registry, NegativeCounter_CountsAsZero) {
    VFEffect set;
    nextEffectIdOf(set) = -5;
    EXPECT_EQ(set.getNewEffectId(), 0);
    EXPECT_EQ(set.getNewEffectId(), 1);

    nextEffectIdOf(set) = -5;
    EXPECT_EQ(set.addEffect(kText, nullptr), 0);
    EXPECT_EQ(set.getNewEffectId(), 1);
}

TEST(Registry, FirstThreeCores_GetIds0To2AndIdsAreNotReused) {
    VFEffect set;
    EXPECT_EQ(set.addText(0, 1), 0U);
    EXPECT_EQ(set.addStrokeText(1, 0, 1, 0, 1), 1U);
    EXPECT_EQ(set.addOuterShadowText(0, 0, 1, 0, 1), 2U);
    EXPECT_TRUE(set.removeEffect(1));
    EXPECT_EQ(set.addInnerShadowText(0, 0, 1, 0, 1), 3U);
    EXPECT_EQ(idsOf(set), (std::vector<int>{0, 2, 3}));
}

TEST(Registry, IdCounter_StaysAtTheLargestId) {
    VFEffect set;
    nextEffectIdOf(set) = INT32_MAX - 1;
    EXPECT_EQ(set.getNewEffectId(), INT32_MAX - 1);
    EXPECT_EQ(set.getNewEffectId(), INT32_MAX);
    EXPECT_EQ(set.getNewEffectId(), INT32_MAX);
    EXPECT_EQ(set.addText(0, 1), static_cast<unsigned>(INT32_MAX));
}

TEST(Registry, AddingTwice_UpdatesTheCoreInItsPlace) {
    VFEffect set;
    const unsigned id = set.addText(0xFF111111, 1);
    set.addStrokeText(1, 0, 1, 0, 1);
    VFECore* core = set.getEffect(kText);
    EXPECT_EQ(set.addText(0xFF222222, 1), id);
    EXPECT_EQ(set.getEffect(kText), core);
    EXPECT_EQ(core->getProperty()->mColor, 0xFF222222U);
    EXPECT_EQ(typesOf(set), (std::vector<int>{kText, kStroke}));
    EXPECT_EQ(set.getNewEffectId(), 2);
}

TEST(Registry, OwnId_IsUsedAndLeavesTheCounter) {
    VFEffect set;
    VFStrokeProperty stroke(1, 2, 1, 0, 1);
    EXPECT_EQ(set.addEffect(7, kStroke, &stroke), 7);
    EXPECT_EQ(set.getEffect(kStroke)->getId(), 7);
    EXPECT_EQ(set.getNewEffectId(), 0);
}

TEST(Registry, OwnIdForAnExistingType_IsIgnored) {
    VFEffect set;
    VFStrokeProperty thin(1, 2, 1, 0, 1);
    VFStrokeProperty thick(9, 2, 1, 0, 1);
    set.addEffect(7, kStroke, &thin);
    EXPECT_EQ(set.addEffect(8, kStroke, &thick), 7);
    EXPECT_EQ(recordOf<VFStrokeProperty>(set, kStroke).mSize, 9.0F);
}

TEST(Registry, DuplicateIds_ArePossibleAndTheFirstIsRemoved) {
    VFEffect set;
    EXPECT_EQ(set.addEffect(0, kStroke, nullptr), 0);
    EXPECT_EQ(set.addEffect(kText, nullptr), 0);
    EXPECT_TRUE(set.removeEffect(0));
    EXPECT_EQ(typesOf(set), (std::vector<int>{kText}));
    EXPECT_TRUE(set.removeEffect(0));
    EXPECT_FALSE(set.removeEffect(0));
}

TEST(Registry, AddEffect_CopiesTheRecordOfTheCaller) {
    VFEffect set;
    VFTextProperty record(0x11223344, 0.5F);
    EXPECT_EQ(set.addEffect(kText, &record), 0);
    record.mColor = 0;
    EXPECT_EQ(set.getEffect(kText)->getProperty()->mColor, 0x11223344U);
}

TEST(Registry, NullRecord_AppendsACoreWithoutARecord) {
    VFEffect set;
    int id = 0;
    for (const int type : kCoreTypes) {
        EXPECT_EQ(set.addEffect(type, nullptr), id++);
        EXPECT_EQ(set.getEffect(type)->getProperty(), nullptr);
    }
    EXPECT_EQ(typesOf(set), std::vector<int>(std::begin(kCoreTypes), std::end(kCoreTypes)));
}

TEST(Registry, NullRecordForAnExistingCore_KeepsItsRecord) {
    VFEffect set;
    set.addText(0xFF112233, 1);
    EXPECT_EQ(set.addEffect(kText, nullptr), 0);
    EXPECT_EQ(set.getEffect(kText)->getProperty()->mColor, 0xFF112233U);
}

TEST(Registry, TypeWithoutCore_LeavesTheListButReArmsTheOrder) {
    VFBevelProperty bevel(0, 0, 0, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
    for (const int type : {kBevel, kEmboss, kReserved, kNone, 0, 99}) {
        VFEffect set;
        planShadowAndStroke(set);
        EXPECT_EQ(set.addEffect(-1, type, &bevel), -1);
        EXPECT_EQ(orderOf(set), "KS");
        EXPECT_EQ(planAndOrder(set), "SK");
    }
}

TEST(Registry, GetEffect_TakesATypeNotAnId) {
    VFEffect set;
    set.addEffect(kText, kStroke, nullptr);
    EXPECT_EQ(set.getEffect(kText), nullptr);
    EXPECT_EQ(set.getEffect(kStroke)->getId(), kText);
}

TEST(Registry, RemoveEffect_DestroysTheCoreAndKeepsTheOthersInOrder) {
    VFEffect set;
    int destroyed = 0;
    set.addText(0, 1);
    FakeCore* fake = insertCore(set, kNone);
    fake->setId(50);
    fake->destroyed = &destroyed;
    set.addStrokeText(1, 0, 1, 0, 1);
    EXPECT_FALSE(set.removeEffect(49));
    EXPECT_EQ(destroyed, 0);
    EXPECT_TRUE(set.removeEffect(50));
    EXPECT_EQ(destroyed, 1);
    EXPECT_EQ(typesOf(set), (std::vector<int>{kText, kStroke}));
}

TEST(Registry, RemoveEffect_OfAnUnknownIdIsFalse) {
    VFEffect set;
    EXPECT_FALSE(set.removeEffect(0));
    set.addText(0, 1);
    for (const int id : {1, -1, INT32_MIN, INT32_MAX})
        EXPECT_FALSE(set.removeEffect(id));
    EXPECT_TRUE(set.removeEffect(0));
    EXPECT_FALSE(set.hasEffects());
}

TEST(Registry, RemoveEffect_KeepsThePaintOrder) {
    VFEffect set;
    planShadowAndStroke(set);
    const auto glow = static_cast<int>(set.addOuterGlowText(1, 0, 1, 0, nullptr));
    ASSERT_EQ(planAndOrder(set), "GSK");
    EXPECT_TRUE(set.removeEffect(glow));
    EXPECT_EQ(planAndOrder(set), "SK");
}

TEST(Registry, ReleasingTheSetOrAllEffects_DestroysEveryCoreOnce) {
    for (const bool clean : {false, true}) {
        int destroyed = 0;
        {
            VFEffect set;
            for (const int type : {kText, kNone, 99})
                insertCore(set, type)->destroyed = &destroyed;
            clean ? set.cleanAllEffect() : set.releaseEffect();
            EXPECT_EQ(destroyed, 3);
            EXPECT_FALSE(set.hasEffects());
            insertCore(set, kText)->destroyed = &destroyed;
        }
        EXPECT_EQ(destroyed, 4);
    }
}

TEST(Registry, ReleaseEffect_StartsIdsAgainAndKeepsTheRest) {
    VFEffect set;
    VFBitmap picture(4, 4, 4);
    planShadowAndStroke(set);
    set.setDstBitmap(&picture);
    set.setTextOpacity(0.5F);
    VFBitmap* mask = set.getSrcBitmap();
    set.releaseEffect();
    EXPECT_EQ(set.getSrcBitmap(), mask);
    EXPECT_EQ(set.getDstBitmap(), &picture);
    EXPECT_EQ(set.getTextOpacity(), 0.5F);
    EXPECT_TRUE(set.hasEffects());
    EXPECT_EQ(set.addText(0, 1), 0U);
}

TEST(Registry, ReleaseEffect_KeepsTheOrderFlag) {
    VFEffect set;
    planShadowAndStroke(set);
    set.releaseEffect();
    // Cores put in without an add-call do not re-arm the ordering, so they stay as they are.
    insertCore(set, kOuterShadow);
    insertCore(set, kOuterGlow);
    set.initEffect(4, 4);
    EXPECT_EQ(typesOf(set), (std::vector<int>{kOuterShadow, kOuterGlow}));
}

TEST(Registry, ReleaseBitmap_DropsTheRun) {
    VFEffect set;
    VFBitmap picture(4, 4, 4);
    set.setTextOpacity(0.5F);
    set.initEffect(4, 4);
    set.setDstBitmap(&picture);
    set.releaseBitmap();
    EXPECT_EQ(set.getSrcBitmap(), nullptr);
    EXPECT_EQ(set.getDstBitmap(), nullptr);
    set.releaseBitmap();
    EXPECT_EQ(set.getSrcBitmap(), nullptr);
}

TEST(Registry, CleanLayers_DoesNothing) {
    VFEffect set;
    VFBitmap picture(4, 4, 4);
    set.addText(0, 1);
    set.initEffect(4, 4);
    set.setDstBitmap(&picture);
    VFBitmap* mask = set.getSrcBitmap();
    set.cleanLayers();
    EXPECT_EQ(set.getSrcBitmap(), mask);
    EXPECT_EQ(set.getDstBitmap(), &picture);
    EXPECT_NE(set.getEffect(kText), nullptr);
}

TEST(Registry, SrcBitmap_IsReplacedWithoutDestroyingThePreviousOne) {
    VFEffect set;
    set.initEffect(4, 4);
    const std::unique_ptr<VFBitmap> previous(set.getSrcBitmap());
    auto* mask = new VFBitmap(8, 8, 1);  // from here on the set's
    set.setSrcBitmap(mask);
    EXPECT_EQ(set.getSrcBitmap(), mask);
    EXPECT_EQ(previous->mWidth, 4U);

    SolidGlyph glyph(2, 2, 9);
    set.renderEffectLayer(6, 6, &glyph.glyph);
    EXPECT_EQ(mask->mData[6 * 8 + 6], 9);
}

TEST(TextOpacity, BelowOne_CountsAsAnEffect) {
    VFEffect set;
    EXPECT_FALSE(set.hasEffects());
    set.setTextOpacity(0.5F);
    EXPECT_TRUE(set.hasEffects());
    EXPECT_EQ(set.getEffect(kText), nullptr);
    set.clearTextOpacity();
    EXPECT_FALSE(set.hasEffects());
}

TEST(TextOpacity, IsClampedTo0And1) {
    const std::pair<float, float> opacities[] = {{2, 1},     {-1, 0},    {0.25F, 0.25F}, {1, 1},
                                                 {0, 0},     {-0.0F, 0}, {kInfinity, 1}, {-kInfinity, 0},
                                                 {1e30F, 1}, {kNan, 0}};
    for (const auto& [given, kept] : opacities) {
        VFEffect set;
        set.setTextOpacity(given);
        EXPECT_EQ(set.getTextOpacity(), kept) << given;
    }
}

TEST(TextOpacity, NewValue_ReArmsTheOrder) {
    VFEffect set;
    planShadowAndStroke(set);
    set.setTextOpacity(0.5F);
    EXPECT_TRUE(orderIsReArmed(set));
    set.setTextOpacity(0.5F);
    EXPECT_FALSE(orderIsReArmed(set));
    set.setTextOpacity(0.25F);
    EXPECT_TRUE(orderIsReArmed(set));
}

TEST(TextOpacity, IsComparedBeforeItIsClamped) {
    VFEffect set;
    planShadowAndStroke(set);
    set.setTextOpacity(1);
    EXPECT_FALSE(orderIsReArmed(set));
    set.setTextOpacity(2);  // stores the 1 that is there, but differs from it
    EXPECT_EQ(set.getTextOpacity(), 1.0F);
    EXPECT_TRUE(orderIsReArmed(set));
    set.setTextOpacity(kNan);
    EXPECT_TRUE(orderIsReArmed(set));
    set.setTextOpacity(kNan);
    EXPECT_TRUE(orderIsReArmed(set));
}

TEST(TextOpacity, Clearing_KeepsTheOrder) {
    VFEffect set;
    planShadowAndStroke(set);
    set.setTextOpacity(0.5F);
    ASSERT_EQ(planAndOrder(set), "SK");
    set.clearTextOpacity();
    EXPECT_EQ(set.getTextOpacity(), 1.0F);
    EXPECT_EQ(planAndOrder(set), "SK");
}

// --- Copies -----------------------------------------------------------------------------------

/// Every kind of core, with stop arrays and a bitmap behind the records.
void addEverything(VFEffect& set) {
    VFGradient stops[] = {{0x112233, 1, 0}, {0x445566, 0.5F, 1}};
    VFBitmap pattern(2, 2, 4);
    fillBytes(pattern, 9);
    set.addPatternText(&pattern, 1, 1);
    set.addRadialGradientText(1, 1, 2, stops);
    set.addLinearGradientText(30, 1, 1, 2, stops);
    set.addInnerGlowText(3, 0x123456, 1, 2, stops);
    set.addOuterGlowText(4, 0x123456, 1, 2, stops);
    set.addInnerShadowText(30, 2, 3, 0x123456, 1);
    set.addOuterShadowText(30, 2, 3, 0x123456, 1);
    set.addStrokeText(2, 0x123456, 1, 0, 1);
    set.addText(0x40123456, 1);
}

TEST(Copy, KeepsIdsTypesAndOrder) {
    VFEffect original;
    addEverything(original);
    original.removeEffect(2);
    original.addEffect(77, kLinearGradient, nullptr);
    VFEffect copy(original);
    EXPECT_EQ(typesOf(copy), typesOf(original));
    EXPECT_EQ(idsOf(copy), idsOf(original));
    EXPECT_EQ(keyOf(copy), keyOf(original));
    EXPECT_EQ(copy.getNewEffectId(), 9);
    EXPECT_EQ(original.getNewEffectId(), 9);
}

TEST(Copy, KeepsTheTextNumbers) {
    VFEffect original;
    original.setTextOpacity(0.25F);
    delete[] original.getMapKey(0x40123456);
    VFEffect copy(original);
    EXPECT_EQ(copy.getTextOpacity(), 0.25F);
    EXPECT_EQ(textAlphaOf(copy), 0x40);
    EXPECT_EQ(textColorOf(copy), 0x40123456U);
}

TEST(Copy, OwnsItsRecords) {
    VFEffect original;
    addEverything(original);
    VFEffect copy(original);
    for (const int type : kCoreTypes) {
        EXPECT_NE(copy.getEffect(type), original.getEffect(type));
        EXPECT_NE(copy.getEffect(type)->getProperty(), original.getEffect(type)->getProperty());
    }
    const VFGradient* stops = recordOf<VFLinearGradientProperty>(copy, kLinearGradient).mGradient;
    const VFBitmap* pattern = recordOf<VFPatternProperty>(copy, kPattern).mPattern;
    EXPECT_NE(stops, recordOf<VFLinearGradientProperty>(original, kLinearGradient).mGradient);
    EXPECT_NE(pattern, recordOf<VFPatternProperty>(original, kPattern).mPattern);

    const std::string key = keyOf(copy);
    original.addText(0xFFFFFF, 0.5F);
    original.addStrokeText(9, 0, 1, 0, 2);
    original.releaseEffect();
    EXPECT_EQ(keyOf(copy), key);
    EXPECT_EQ(stops[1].mColor, 0x80445566U);
    EXPECT_EQ(bytesOf(*pattern), std::vector<uint8_t>(16, 9));
}

TEST(Copy, OutlivesTheOriginal) {
    auto original = std::make_unique<VFEffect>();
    addEverything(*original);
    const std::string key = keyOf(*original);
    VFEffect copy(*original);
    original.reset();
    EXPECT_EQ(keyOf(copy), key);
}

TEST(Copy, LeavesTheRunBehind) {
    VFEffect original;
    VFBitmap picture(4, 4, 4);
    SolidGlyph glyph(2, 2);
    original.setTextOpacity(0.5F);
    original.initEffect(4, 4);
    original.setDstBitmap(&picture);
    original.renderEffectLayer(1, 1, &glyph.glyph);
    VFEffect copy(original);
    EXPECT_EQ(copy.getSrcBitmap(), nullptr);
    EXPECT_EQ(copy.getDstBitmap(), nullptr);
    EXPECT_EQ(sidesOf(*copy.getTextRect()), (std::vector<int>{0, 0, 0, 0}));
    EXPECT_TRUE(isLayered(copy));

    copy.initEffect(4, 4);
    copy.renderEffectLayer(2, 2, &glyph.glyph);
    EXPECT_EQ(sidesOf(*copy.getTextRect()), (std::vector<int>{2, 2, 4, 4}));
    copy.doEffectPostProcessing();
    copy.compositeLayers(&picture);
}

TEST(Copy, OfAPlannedSet_IsOrderedAnew) {
    VFEffect original;
    planShadowAndStroke(original);
    VFEffect copy(original);
    EXPECT_EQ(orderOf(copy), "KS");
    EXPECT_EQ(planAndOrder(copy), "SK");
    EXPECT_EQ(planAndOrder(original), "KS");
}

TEST(Copy, OfAnEmptyPlannedSet_KeepsTheOrderFlag) {
    VFEffect original;
    original.initEffect(4, 4);
    VFEffect copy(original);
    insertCore(copy, kOuterShadow);
    insertCore(copy, kOuterGlow);
    copy.initEffect(4, 4);
    EXPECT_EQ(typesOf(copy), (std::vector<int>{kOuterShadow, kOuterGlow}));
}

TEST(Copy, OfCoresWithoutRecords_HasNoRecordsEither) {
    VFEffect original;
    for (const int type : kCoreTypes)
        original.addEffect(type, nullptr);
    VFEffect copy(original);
    EXPECT_EQ(typesOf(copy), typesOf(original));
    EXPECT_EQ(idsOf(copy), idsOf(original));
    for (const int type : kCoreTypes)
        EXPECT_EQ(copy.getEffect(type)->getProperty(), nullptr);
}

}  // namespace
