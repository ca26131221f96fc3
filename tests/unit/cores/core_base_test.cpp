#include <gtest/gtest.h>
#include <voreleffect/VFECore.h>

#include <cstddef>

#include "tests/support/compare.h"
#include "tests/support/engine.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

/// The defaults alone, with a settable reach.
class PlainCore : public VFECoreBase {
  public:
    explicit PlainCore(int offset = 0) : reach(offset) {}
    void setProperty(VFProperty*) override {}
    VFProperty* getProperty() override { return nullptr; }
    int getOffset() override { return reach != 0 ? reach : VFECoreBase::getOffset(); }

    int reach;
};

std::vector<int> offsetsOf(VFECore& core) {
    return {core.getLeftOffset(), core.getTopOffset(), core.getRightOffset(), core.getBottomOffset()};
}

TEST(CoreBase, Defaults) {
    PlainCore core;
    EXPECT_EQ(core.getStyle(), kNone);
    EXPECT_EQ(core.getId(), -1);
    EXPECT_EQ(core.getOpacity(), 1.0F);
    EXPECT_EQ(core.getOffset(), 0);
    EXPECT_EQ(offsetsOf(core), (std::vector<int>{0, 0, 0, 0}));
    VFECore::ParamInit init = {4, 4, 0};
    EXPECT_EQ(core.initEffect(&init), 1);
    VFECore::ParamRender render = {1, 2, nullptr, nullptr};
    EXPECT_EQ(core.render(&render), 1);
}

TEST(CoreBase, NullParameters_GiveTheSame) {
    PlainCore core;
    EXPECT_EQ(core.initEffect(nullptr), 1);
    EXPECT_EQ(core.render(nullptr), 1);
    core.doPostProcessing(nullptr);
}

TEST(CoreBase, DefaultPostProcessing_PaintsNothing) {
    PlainCore core;
    VFBitmap picture(2, 2, 4);
    VFBitmap mask(2, 2, 1);
    fillBytes(picture, 77);
    fillBytes(mask, 128);
    VFRect box(0, 0, 2, 2);
    VFECore::ParamPostProcessing params = {&picture, &mask, &box, 1, &picture};
    core.doPostProcessing(&params);
    EXPECT_EQ(bytesOf(picture), std::vector<uint8_t>(16, 77));
}

TEST(CoreBase, Id_IsWhatWasSet) {
    PlainCore core;
    for (const int id : {0, 7, -1, INT32_MAX, INT32_MIN}) {
        core.setId(id);
        EXPECT_EQ(core.getId(), id);
    }
}

TEST(CoreBase, EverySide_ReturnsTheOffset) {
    PlainCore core(9);
    EXPECT_EQ(offsetsOf(core), (std::vector<int>{9, 9, 9, 9}));
}

template <class Core>
void expectFresh(int type) {
    Core core;
    EXPECT_EQ(core.getStyle(), type);
    EXPECT_EQ(core.getId(), -1);
    EXPECT_EQ(core.getOpacity(), 1.0F);
    EXPECT_EQ(core.getProperty(), nullptr);
    EXPECT_EQ(core.getOffset(), 0);
    EXPECT_EQ(offsetsOf(core), (std::vector<int>{0, 0, 0, 0}));
    EXPECT_EQ(core.initEffect(nullptr), 1);
    EXPECT_EQ(core.render(nullptr), 1);
}

TEST(CoreBase, EveryCore_StartsWithItsTypeAndNothingElse) {
    expectFresh<VFOuterShadow>(kOuterShadow);
    expectFresh<VFInnerShadow>(kInnerShadow);
    expectFresh<VFOuterGlow>(kOuterGlow);
    expectFresh<VFInnerGlow>(kInnerGlow);
    expectFresh<VFLinearGradient>(kLinearGradient);
    expectFresh<VFRadialGradient>(kRadialGradient);
    expectFresh<VFStroke>(kStroke);
    expectFresh<VFPattern>(kPattern);
    expectFresh<VFText>(kText);
}

// --- Slots ------------------------------------------------------------------------------------

/// Notes the slot of the operation that was called.
class SlotCore : public VFECore {
  public:
    int initEffect(ParamInit*) override { return called = 2; }
    int render(ParamRender*) override { return called = 3; }
    void doPostProcessing(ParamPostProcessing*) override { called = 4; }
    void setProperty(VFProperty*) override { called = 5; }
    VFProperty* getProperty() override {
        called = 6;
        return nullptr;
    }
    float getOpacity() override {
        called = 7;
        return 0;
    }
    int getStyle() override { return called = 8; }
    int getLeftOffset() override { return called = 9; }
    int getRightOffset() override { return called = 10; }
    int getTopOffset() override { return called = 11; }
    int getBottomOffset() override { return called = 12; }
    void setId(int) override { called = 13; }
    int getId() override { return called = 14; }
    int getOffset() override { return called = 15; }

    int called = 0;
};

TEST(Core, OperationsStandInTheirSlots) {
    for (int slot = 2; slot <= 15; ++slot) {
        SlotCore core;
        void** table = *reinterpret_cast<void***>(static_cast<VFECore*>(&core));
        // Called by the slot alone, as code compiled against the fixed order calls it.
        reinterpret_cast<void (*)(VFECore*, void*)>(table[slot])(&core, nullptr);
        EXPECT_EQ(core.called, slot);
    }
}

TEST(Core, ParameterRecords_HaveTheirFieldsInOrder) {
    EXPECT_EQ(offsetof(VFECore::ParamInit, height), sizeof(int));
    EXPECT_EQ(offsetof(VFECore::ParamInit, useOuterLayer), 2 * sizeof(int));
    EXPECT_EQ(offsetof(VFECore::ParamRender, glyph), 2 * sizeof(int));
    EXPECT_EQ(offsetof(VFECore::ParamRender, dstBitmap), 2 * sizeof(int) + sizeof(void*));
    EXPECT_EQ(offsetof(VFECore::ParamPostProcessing, srcBitmap), sizeof(void*));
    EXPECT_EQ(offsetof(VFECore::ParamPostProcessing, textRect), 2 * sizeof(void*));
    EXPECT_EQ(offsetof(VFECore::ParamPostProcessing, useOuterLayer), 3 * sizeof(void*));
    EXPECT_EQ(offsetof(VFECore::ParamPostProcessing, subDstBitmap), 4 * sizeof(void*));
}

// --- The text fill ----------------------------------------------------------------------------

/// A row of four pixels of a picture, painted through coverage 0, 1, 128 and 255.
class TextFill : public ::testing::Test {
  protected:
    TextFill() : picture(4, 1, 4), mask(4, 1, coverage, 1), record(0x80402010, 0.5F) {
        text.setProperty(&record);
    }

    void paint(int useOuterLayer) {
        params.useOuterLayer = useOuterLayer;
        text.doPostProcessing(&params);
    }

    void expectPicture(const std::vector<uint8_t>& expected) {
        EXPECT_TRUE(sameBytes(expected.data(), picture.mData, 4, 1, 4));
    }

    uint8_t coverage[4] = {0, 1, 128, 255};
    VFBitmap picture;
    VFBitmap mask;
    VFTextProperty record;
    VFRect box = VFRect(0, 0, 4, 1);
    VFECore::ParamPostProcessing params = {&picture, &mask, &box, 0, nullptr};
    VFText text;
};

TEST_F(TextFill, IntoATransparentPicture_IsColourTimesCoverage) {
    paint(0);
    // 128 * (0x40 + 1) >> 8 = 32, 128 * 33 >> 8 = 16, 128 * 17 >> 8 = 8, 128 * 129 >> 8 = 64
    expectPicture({0, 0, 0, 0, 0, 0, 0, 0, 32, 16, 8, 64, 0x40, 0x20, 0x10, 0x80});
}

TEST_F(TextFill, OverAnOpaquePicture_ClipsItToTheCoverage) {
    fillBytes(picture, 255);
    paint(0);
    expectPicture({0, 0, 0, 0, 1, 1, 1, 1, 128, 128, 128, 128, 255, 255, 255, 255});
}

TEST_F(TextFill, OverATranslucentPicture_SlidesUnderAndClips) {
    const uint8_t pixel[] = {100, 50, 20, 128};
    for (int i = 0; i < 4; ++i)
        std::memcpy(picture.mData + 4 * i, pixel, 4);
    paint(0);
    // Coverage 255, inv 127: 100 + (127 * 65 >> 8) = 132, 50 + (127 * 33 >> 8) = 66,
    // 20 + (127 * 17 >> 8) = 28; alpha: 128 + (127 * 129 >> 8) = 191 (0x80 times 255 is 128).
    // Coverage 128: red (100 + (33 * 127 >> 8) + 1) * 128 >> 8 = 58, green (50 + (17 * 127 >> 8) + 1)
    // * 128 >> 8 = 29, blue (20 + (9 * 127 >> 8) + 1) * 128 >> 8 = 12, alpha (128 + (127 * 65 >> 8) +
    // 1) * 128 >> 8 = 80. Coverage 1: all below 256 before the shift.
    expectPicture({0, 0, 0, 0, 0, 0, 0, 0, 58, 29, 12, 80, 132, 66, 28, 191});
}

TEST_F(TextFill, InLayeredMode_IsTheFullColourWhereverThereIsCoverage) {
    paint(1);
    expectPicture({0, 0, 0, 0, 0x40, 0x20, 0x10, 0x80, 0x40, 0x20, 0x10, 0x80, 0x40, 0x20, 0x10, 0x80});
}

TEST_F(TextFill, InLayeredMode_LeavesOpaquePaintAndPaintOutsideTheGlyph) {
    fillBytes(picture, 255);
    picture.mData[3] = 7;
    paint(1);
    std::vector<uint8_t> expected(16, 255);
    expected[3] = 7;
    expectPicture(expected);
}

TEST_F(TextFill, OnlyOneSelectsTheLayeredForm) {
    for (const int useOuterLayer : {0, 2, -1}) {
        fillBytes(picture, 255);
        paint(useOuterLayer);
        expectPicture({0, 0, 0, 0, 1, 1, 1, 1, 128, 128, 128, 128, 255, 255, 255, 255});
    }
}

TEST_F(TextFill, CoversTheWholeMaskWhateverTheTextBox) {
    box = VFRect(3, 0, 4, 1);
    fillBytes(picture, 255);
    paint(0);
    EXPECT_EQ(picture.mData[0], 0);
    EXPECT_EQ(picture.mData[8], 128);

    params.textRect = nullptr;
    fillBytes(picture, 255);
    paint(0);
    EXPECT_EQ(picture.mData[8], 128);
}

TEST_F(TextFill, IgnoresTheSecondTarget) {
    VFBitmap second(4, 1, 4);
    params.subDstBitmap = &second;
    paint(0);
    EXPECT_EQ(bytesOf(second), std::vector<uint8_t>(16, 0));
}

TEST_F(TextFill, DoesNotApplyTheOpacityOfItsRecord) {
    VFTextProperty opaque(0xFF402010, 0.0F);
    text.setProperty(&opaque);
    paint(0);
    EXPECT_EQ(std::vector<uint8_t>(picture.mData + 12, picture.mData + 16),
              (std::vector<uint8_t>{0x40, 0x20, 0x10, 0xFF}));
}

TEST_F(TextFill, MissingInput_PaintsNothing) {
    fillBytes(picture, 77);
    text.doPostProcessing(nullptr);

    params.srcBitmap = nullptr;
    paint(0);
    VFBitmap empty(4, 1, nullptr, 1);
    params.srcBitmap = &empty;
    paint(0);
    params.srcBitmap = &mask;

    params.dstBitmap = nullptr;
    paint(0);
    VFBitmap hollow(4, 1, nullptr, 4);
    params.dstBitmap = &hollow;
    paint(0);
    params.dstBitmap = &picture;

    VFText fresh;
    fresh.doPostProcessing(&params);
    expectPicture(std::vector<uint8_t>(16, 77));
}

TEST_F(TextFill, NullRecord_KeepsThePreviousOne) {
    VFProperty* stored = text.getProperty();
    text.setProperty(nullptr);
    EXPECT_EQ(text.getProperty(), stored);
    EXPECT_EQ(text.getProperty()->mColor, 0x80402010U);
}

}  // namespace
