#include <gtest/gtest.h>
#include <voreleffect/voreleffect.h>

#include <algorithm>

#include "tests/support/engine.h"

// Every public operation that takes a pointer is handed a null one: it survives and answers as its
// header says. (The log's are in log_test.cpp.)

using namespace VFontEffect;
using namespace vorel_test;

namespace {

// --- Bitmaps and records ----------------------------------------------------------------------

TEST(NullArguments, Bitmap) {
    EXPECT_EQ(VFBitmap(2, 2, nullptr, 4).mData, nullptr);
    EXPECT_EQ(VFBitmap(VFBitmap(2, 2, 1), nullptr).mData, nullptr);
}

template <class Record>
void expectNothingWritten(Record&& record) {
    EXPECT_FALSE(record.toSequentialChar(nullptr));
    char* nowhere = nullptr;
    EXPECT_FALSE(record.toSequentialChar(&nowhere));
    EXPECT_EQ(nowhere, nullptr);
}

TEST(NullArguments, Records) {
    expectNothingWritten(VFTextProperty(1, 1));
    expectNothingWritten(VFOuterShadowProperty(1, 1, 1, 1, 1));
    expectNothingWritten(VFInnerShadowProperty(1, 1, 1, 1, 1));
    expectNothingWritten(VFStrokeProperty(1, 1, 1, 1, 1));
    expectNothingWritten(VFOuterGlowProperty(1, 1, 1, 1, nullptr));
    expectNothingWritten(VFInnerGlowProperty(1, 1, 1, 1, nullptr));
    expectNothingWritten(VFLinearGradientProperty(1, 1, 1, 1, nullptr));
    expectNothingWritten(VFRadialGradientProperty(1, 1, 1, 1, nullptr));
    expectNothingWritten(VFBevelProperty(1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1));
    expectNothingWritten(VFEmbossProperty(1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1));
    expectNothingWritten(VFPatternProperty(nullptr, 1, 1));
}

// --- The blender ------------------------------------------------------------------------------

class NullBlends : public ::testing::Test {
  protected:
    NullBlends()
        : colour(2, 2, 4), mask(2, 2, 1), hollow(2, 2, nullptr, 4), hollowMask(2, 2, nullptr, 1) {
        fillBytes(colour, 77);
        fillBytes(mask, 77);
    }

    void expectUntouched() const {
        EXPECT_EQ(bytesOf(colour), std::vector<uint8_t>(16, 77));
        EXPECT_EQ(bytesOf(mask), std::vector<uint8_t>(4, 77));
    }

    VFBlender blender;
    VFBitmap colour;
    VFBitmap mask;
    VFBitmap hollow;
    VFBitmap hollowMask;
    unsigned char coverage[4] = {255, 255, 255, 255};
    unsigned int words[4] = {0xFFFFFFFF, 0xFFFFFFFF, 0xFFFFFFFF, 0xFFFFFFFF};
};

TEST_F(NullBlends, MissingSourceDrawsNothing) {
    unsigned char* noBytes = nullptr;
    unsigned int* noWords = nullptr;
    VFBitmap* noBitmap = nullptr;
    blender.drawBitmap(0, 0, &colour, noBitmap, 0xFFFFFFFF);
    blender.drawBitmap(0, 0, &mask, noBitmap, 0xFFFFFFFF);
    blender.drawBitmap(0, 0, &mask, &hollowMask, 0xFFFFFFFF);
    blender.drawBitmap(0, 0, &colour, &hollowMask, 0xFFFFFFFF);
    blender.drawBitmap(0, 0, &colour, noBytes, 2, 2, 0xFFFFFFFF);
    blender.drawBitmap(0, 0, &mask, noBytes, 2, 2, 0xFFFFFFFF);
    blender.drawBitmap8To8(0, 0, &mask, noBytes, 2, 2);
    blender.drawBitmap8To32(0, 0, &colour, noBytes, 2, 2, 0xFFFFFFFF);
    for (const int mode : {1, 2, 3, 7}) {
        blender.drawBitmapBlend8(0, 0, &colour, noBytes, 2, 2, 2, 0xFFFFFFFF, mode);
    }
    blender.blendSrcOver8To32(0, 0, &colour, noBytes, 2, 2, 2, 0xFFFFFFFF);
    blender.blendDstOver8To32(0, 0, &colour, noBytes, 2, 2, 2, 0xFFFFFFFF);
    blender.blendDstOver8To32NSA(0, 0, &colour, noBytes, 2, 2, 2, 0xFFFFFFFF);
    blender.blendDstOverSA8To32(0, 0, &colour, noBytes, 2, 2, 2, 0xFFFFFFFF);
    for (const int number : {0, 1, 2}) {
        blender.drawBitmapBlend32(0, 0, &colour, noWords, 2, 2, 2, number);
        blender.drawBitmapBlend32(0, 0, &colour, noBytes, 2, 2, 8, number);
        blender.blendDstOver32To32(0, 0, &colour, noBytes, 2, 2, 8, number);
    }
    blender.blendSrcOver32To32(0, 0, &colour, noWords, 2, 2, 2);
    blender.blendDstOver32To32(0, 0, &colour, noWords, 2, 2, 2);
    expectUntouched();
}

TEST_F(NullBlends, MissingDestinationDrawsNothing) {
    auto* bytes = reinterpret_cast<unsigned char*>(words);
    for (const VFBitmap* destination : {static_cast<VFBitmap*>(nullptr), &hollow, &hollowMask}) {
        blender.drawBitmap(0, 0, destination, &mask, 0xFFFFFFFF);
        blender.drawBitmap(0, 0, destination, coverage, 2, 2, 0xFFFFFFFF);
        blender.drawBitmap8To8(0, 0, destination, coverage, 2, 2);
        blender.drawBitmap8To32(0, 0, destination, coverage, 2, 2, 0xFFFFFFFF);
        for (const int mode : {1, 2, 3, 7}) {
            blender.drawBitmapBlend8(0, 0, destination, coverage, 2, 2, 2, 0xFFFFFFFF, mode);
        }
        blender.blendSrcOver8To32(0, 0, destination, coverage, 2, 2, 2, 0xFFFFFFFF);
        blender.blendDstOver8To32(0, 0, destination, coverage, 2, 2, 2, 0xFFFFFFFF);
        blender.blendDstOver8To32NSA(0, 0, destination, coverage, 2, 2, 2, 0xFFFFFFFF);
        blender.blendDstOverSA8To32(0, 0, destination, coverage, 2, 2, 2, 0xFFFFFFFF);
        for (const int number : {0, 1, 2}) {
            blender.drawBitmapBlend32(0, 0, destination, words, 2, 2, 2, number);
            blender.drawBitmapBlend32(0, 0, destination, bytes, 2, 2, 8, number);
            blender.blendDstOver32To32(0, 0, destination, bytes, 2, 2, 8, number);
        }
        blender.blendSrcOver32To32(0, 0, destination, words, 2, 2, 2);
        blender.blendDstOver32To32(0, 0, destination, words, 2, 2, 2);
    }
    EXPECT_EQ(hollow.mData, nullptr);
    EXPECT_EQ(hollowMask.mData, nullptr);
    expectUntouched();
}

// --- Cores ------------------------------------------------------------------------------------

TEST(NullArguments, CircleKernel) {
    EXPECT_EQ(makeCircleKernel(nullptr, 2), 5);
}

TEST(NullArguments, Dilation) {
    VFStroke::DilationWork work = {nullptr, nullptr, nullptr, 3, 3, 5, 5, 3, 0, 3, 1};
    for (void* argument : {static_cast<void*>(nullptr), static_cast<void*>(&work)}) {
        EXPECT_EQ(VFStroke::partalDTStrokeCenter(argument), 0);
        EXPECT_EQ(VFStroke::partalDTStrokeOutside(argument), 0);
        EXPECT_EQ(VFStroke::partalDTStrokeInside(argument), 0);
    }
}

template <class Glow, class Record>
void expectGlowRoutinesSurvive() {
    Glow glow;
    unsigned table[257];
    std::fill(std::begin(table), std::end(table), 7U);
    glow.makeColorLUT(nullptr, 0.5F, 0);
    glow.makeColorLUT(table, 0.5F, 0);  // no record: all zero
    for (const unsigned entry : table)
        EXPECT_EQ(entry, 0U);
    glow.increaseByBoxFilter(nullptr, 1, 4, 4);

    Record record(3, 0xFFFFFFFF, 1, 2, nullptr);
    glow.setProperty(&record);
    glow.makeColorLUT(nullptr, 0.5F, 0);
    glow.makeColorLUT(table, 0.5F, 0);
    EXPECT_EQ(table[256], 0U);
}

TEST(NullArguments, GlowRoutines) {
    expectGlowRoutinesSurvive<VFOuterGlow, VFOuterGlowProperty>();
    expectGlowRoutinesSurvive<VFInnerGlow, VFInnerGlowProperty>();
}

/// A set with every kind, whose records hold nothing where they can.
void addEverythingHollow(VFEffect& set) {
    set.addPatternText(nullptr, 1, 1);
    set.addRadialGradientText(1, 1, 2, nullptr);
    set.addLinearGradientText(30, 1, 1, 2, nullptr);
    set.addInnerGlowText(3, 0xFFFFFF, 1, 2, nullptr);
    set.addOuterGlowText(4, 0xFFFFFF, 1, 2, nullptr);
    set.addInnerShadowText(30, 2, 3, 0xFFFFFF, 1);
    set.addOuterShadowText(30, 2, 3, 0xFFFFFF, 1);
    set.addStrokeText(2, 0xFFFFFF, 1, 0, 1);
    set.addText(0xFFFFFF, 1);
}

/// Each combination of missing bitmaps and box, with a second target that must stay as it is.
/// The box is left alone for the text fill, which does not look at it.
void expectPaintsNothingWithMissingInput(VFECore& core) {
    VFBitmap picture(8, 8, 4);
    VFBitmap second(8, 8, 4);
    VFBitmap mask(8, 8, 1);
    VFBitmap hollow(8, 8, nullptr, 4);
    VFBitmap hollowMask(8, 8, nullptr, 1);
    fillBytes(picture, 77);
    fillBytes(second, 77);
    fillBytes(mask, 255);
    VFRect box(1, 1, 7, 7);
    core.doPostProcessing(nullptr);
    for (const int layered : {0, 1}) {
        for (VFBitmap* noMask : {static_cast<VFBitmap*>(nullptr), &hollowMask}) {
            VFECore::ParamPostProcessing params = {&picture, noMask, &box, layered, &second};
            core.doPostProcessing(&params);
        }
        VFECore::ParamPostProcessing noTarget = {nullptr, &mask, &box, layered, nullptr};
        core.doPostProcessing(&noTarget);
        VFECore::ParamPostProcessing hollowTargets = {&hollow, &mask, &box, layered, &hollow};
        core.doPostProcessing(&hollowTargets);
        if (core.getStyle() == kText) continue;
        VFECore::ParamPostProcessing noBox = {&picture, &mask, nullptr, layered, &second};
        core.doPostProcessing(&noBox);
    }
    EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(8 * 8 * 4, 77)) << core.getStyle();
    EXPECT_EQ(bytesOf(second), std::vector<uint8_t>(8 * 8 * 4, 77)) << core.getStyle();
    EXPECT_EQ(bytesOf(mask), std::vector<uint8_t>(8 * 8, 255)) << core.getStyle();
}

TEST(NullArguments, Cores) {
    VFEffect set;
    addEverythingHollow(set);
    VFEffect bare;
    for (const int type : kCoreTypes) {
        bare.addEffect(type, nullptr);
        for (VFECore* core : {set.getEffect(type), bare.getEffect(type)}) {
            EXPECT_EQ(core->initEffect(nullptr), 1);
            EXPECT_EQ(core->render(nullptr), 1);
            core->setProperty(nullptr);
            expectPaintsNothingWithMissingInput(*core);
        }
        EXPECT_EQ(bare.getEffect(type)->getProperty(), nullptr);
        EXPECT_NE(set.getEffect(type)->getProperty(), nullptr);
    }
}

// --- The effect set ---------------------------------------------------------------------------

TEST(NullArguments, Registry) {
    VFEffect set(nullptr);
    EXPECT_FALSE(set.hasEffects());
    set.releaseEffect(nullptr);
    EXPECT_EQ(set.addEffect(kBevel, nullptr), -1);
    EXPECT_EQ(set.addEffect(-1, kEmboss, nullptr), -1);
    EXPECT_EQ(set.addEffect(kText, nullptr), 0);
    VFECore* core = set.createEffect(5, kText, nullptr);
    EXPECT_EQ(core->getId(), 5);
    set.releaseEffect(core);
}

TEST(NullArguments, UnderEffect) {
    VFEffect set;
    EXPECT_FALSE(set.isUnderEffect(nullptr));
    for (const int type : {kBevel, kReserved, kStroke}) {
        FakeCore core(type, nullptr);
        set.setTextOpacity(1);
        const bool plain = set.isUnderEffect(&core);
        set.setTextOpacity(0.5F);
        set.initEffect(1, 1);
        EXPECT_EQ(set.isUnderEffect(&core), plain) << type;
        set.compositeLayers(nullptr);
    }
}

TEST(NullArguments, RunOfCoresWithoutRecords) {
    for (const float opacity : {1.0F, 0.5F}) {
        VFEffect set;
        set.setTextOpacity(opacity);
        for (const int type : kCoreTypes)
            set.addEffect(type, nullptr);
        for (const int type : {kBevel, kEmboss, kReserved, kStroke})
            insertCore(set, type, nullptr);
        EXPECT_EQ(keyOf(set), "");
        VFBitmap picture(9, 9, 4);
        fillBytes(picture, 77);
        SolidGlyph glyph(9, 9);
        set.initEffect(9, 9);
        set.setDstBitmap(&picture);
        set.renderEffectLayer(0, 0, &glyph.glyph);
        set.doEffectPostProcessing();
        set.compositeLayers(&picture);
        // A full mask keeps the picture in layered mode too.
        EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(9 * 9 * 4, 77));
        EXPECT_EQ(keyOf(set), "");
    }
}

TEST(NullArguments, RunWithNothing) {
    for (const float opacity : {1.0F, 0.5F}) {
        VFEffect set;
        set.setTextOpacity(opacity);
        addEverythingHollow(set);
        // Before any run.
        set.renderEffectLayer(0, 0, nullptr);
        set.doEffectPostProcessing();
        set.compositeLayers(nullptr);
        EXPECT_EQ(set.getSrcBitmap(), nullptr);
        // In a run whose every part is missing.
        set.initEffect(9, 9);
        set.setDstBitmap(nullptr);
        set.renderEffectLayer(0, 0, nullptr);
        VFGlyph hollow = {nullptr, 9, 9};
        set.renderEffectLayer(0, 0, &hollow);
        EXPECT_EQ(bytesOf(*set.getSrcBitmap()), std::vector<uint8_t>(81, 0));
        set.doEffectPostProcessing();
        set.compositeLayers(nullptr);
        EXPECT_EQ(set.getSrcBitmap(), nullptr);
        // In a run that lost its mask.
        set.initEffect(9, 9);
        delete set.getSrcBitmap();
        set.setSrcBitmap(nullptr);
        SolidGlyph glyph(9, 9);
        VFBitmap picture(9, 9, 4);
        fillBytes(picture, 77);
        set.setDstBitmap(&picture);
        set.renderEffectLayer(0, 0, &glyph.glyph);
        set.doEffectPostProcessing();
        set.compositeLayers(&picture);
        EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(9 * 9 * 4, 77));
    }
}

TEST(NullArguments, ArraysOfAddCalls) {
    VFEffect set;
    addEverythingHollow(set);
    EXPECT_EQ(recordOf<VFOuterGlowProperty>(set, kOuterGlow).mGradientCount, 0);
    EXPECT_EQ(recordOf<VFInnerGlowProperty>(set, kInnerGlow).mGradientCount, 0);
    EXPECT_EQ(recordOf<VFLinearGradientProperty>(set, kLinearGradient).mGradientCount, 0);
    EXPECT_EQ(recordOf<VFRadialGradientProperty>(set, kRadialGradient).mGradientCount, 0);
    EXPECT_EQ(recordOf<VFPatternProperty>(set, kPattern).mPattern, nullptr);
}

}  // namespace
