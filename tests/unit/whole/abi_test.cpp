#include <gtest/gtest.h>

#include <cstddef>
#include <cstring>

#include "voreleffect/voreleffect.h"

/// What a program that was compiled against an earlier build relies on, the same on both
/// architectures: slots of the virtual operations, sizes and offsets of the public records.
namespace VFontEffect {
namespace {

/// The vtable slot of a virtual operation, read from a pointer to it: the Itanium C++ ABI stores the
/// offset in the vtable, on x86-64 with the lowest bit set.
template <class Operation>
size_t slotOf(Operation operation) {
    struct {
        ptrdiff_t offset;
        ptrdiff_t adjustment;
    } parts = {};
    static_assert(sizeof parts == sizeof operation, "pointer to a member operation");
    std::memcpy(&parts, &operation, sizeof parts);
    return static_cast<size_t>(parts.offset) / sizeof(void*);
}

TEST(Abi, CoreOperations_StandInTheirSlots) {
    EXPECT_EQ(slotOf(&VFECore::initEffect), 2U);
    EXPECT_EQ(slotOf(&VFECore::render), 3U);
    EXPECT_EQ(slotOf(&VFECore::doPostProcessing), 4U);
    EXPECT_EQ(slotOf(&VFECore::setProperty), 5U);
    EXPECT_EQ(slotOf(&VFECore::getProperty), 6U);
    EXPECT_EQ(slotOf(&VFECore::getOpacity), 7U);
    EXPECT_EQ(slotOf(&VFECore::getStyle), 8U);
    EXPECT_EQ(slotOf(&VFECore::getLeftOffset), 9U);
    EXPECT_EQ(slotOf(&VFECore::getRightOffset), 10U);
    EXPECT_EQ(slotOf(&VFECore::getTopOffset), 11U);
    EXPECT_EQ(slotOf(&VFECore::getBottomOffset), 12U);
    EXPECT_EQ(slotOf(&VFECore::setId), 13U);
    EXPECT_EQ(slotOf(&VFECore::getId), 14U);
    EXPECT_EQ(slotOf(&VFECore::getOffset), 15U);
}

TEST(Abi, PropertyOperations_StandInTheirSlots) {
    EXPECT_EQ(slotOf(&VFProperty::getSequentialCharLength), 2U);
    EXPECT_EQ(slotOf(&VFProperty::toSequentialChar), 3U);
}

/// Distance of a field from the start of its record, in bytes.
template <class Record, class Field>
size_t offsetIn(const Record& record, const Field& field) {
    return static_cast<size_t>(reinterpret_cast<const char*>(&field) -
                               reinterpret_cast<const char*>(&record));
}

TEST(Abi, Bitmap_IsLaidOut) {
    const VFBitmap b;
    EXPECT_EQ(sizeof b, 32U);
    EXPECT_EQ(offsetIn(b, b.mWidth), 8U);
    EXPECT_EQ(offsetIn(b, b.mHeight), 12U);
    EXPECT_EQ(offsetIn(b, b.mData), 16U);
    EXPECT_EQ(offsetIn(b, b.mFormat), 24U);
    EXPECT_EQ(offsetIn(b, b.mBytesPerPixel), 28U);
}

/// On 64-bit machines: a table of operations and the fields, all of them private.
TEST(Abi, ObjectsThatCallersHold_HaveTheirSizes) {
    EXPECT_EQ(sizeof(VFEffect), 8U + 24 + 3 * 8 + 24 + 2 * 4 + 4 * 4);
    EXPECT_EQ(sizeof(VFECoreBase), 8U + 2 * 4);
    for (const size_t size : {sizeof(VFText), sizeof(VFStroke), sizeof(VFPattern)})
        EXPECT_EQ(size, sizeof(VFECoreBase) + 8);
    EXPECT_EQ(sizeof(VFOuterShadow), sizeof(VFECoreBase) + 8 + 2 * 4);
}

TEST(Abi, SmallRecords_AreLaidOut) {
    const VFRect r;
    EXPECT_EQ(sizeof r, 24U);
    EXPECT_EQ(offsetIn(r, r.mLeft), 8U);
    EXPECT_EQ(offsetIn(r, r.mTop), 12U);
    EXPECT_EQ(offsetIn(r, r.mRight), 16U);
    EXPECT_EQ(offsetIn(r, r.mBottom), 20U);

    EXPECT_EQ(sizeof(VFGlyph), 16U);
    EXPECT_EQ(offsetof(VFGlyph, mBuffer), 0U);
    EXPECT_EQ(offsetof(VFGlyph, mWidth), 8U);
    EXPECT_EQ(offsetof(VFGlyph, mHeight), 10U);

    EXPECT_EQ(sizeof(VFGradient), 12U);
    EXPECT_EQ(offsetof(VFGradient, mColor), 0U);
    EXPECT_EQ(offsetof(VFGradient, mOpacity), 4U);
    EXPECT_EQ(offsetof(VFGradient, mLocation), 8U);
}

TEST(Abi, CoreParameters_AreLaidOut) {
    EXPECT_EQ(sizeof(VFECore::ParamInit), 12U);
    EXPECT_EQ(offsetof(VFECore::ParamInit, height), 4U);
    EXPECT_EQ(offsetof(VFECore::ParamInit, useOuterLayer), 8U);

    EXPECT_EQ(sizeof(VFECore::ParamRender), 24U);
    EXPECT_EQ(offsetof(VFECore::ParamRender, y), 4U);
    EXPECT_EQ(offsetof(VFECore::ParamRender, glyph), 8U);
    EXPECT_EQ(offsetof(VFECore::ParamRender, dstBitmap), 16U);

    using Post = VFECore::ParamPostProcessing;
    EXPECT_EQ(sizeof(Post), 40U);
    EXPECT_EQ(offsetof(Post, dstBitmap), 0U);
    EXPECT_EQ(offsetof(Post, srcBitmap), 8U);
    EXPECT_EQ(offsetof(Post, textRect), 16U);
    EXPECT_EQ(offsetof(Post, useOuterLayer), 24U);
    EXPECT_EQ(offsetof(Post, subDstBitmap), 32U);
}

TEST(Abi, TextAndShadowRecords_AreLaidOut) {
    const VFTextProperty t(0, 0);
    EXPECT_EQ(sizeof t, 16U);
    EXPECT_EQ(offsetIn(t, t.mColor), 8U);
    EXPECT_EQ(offsetIn(t, t.mOpacity), 12U);

    const VFOuterShadowProperty s(0, 0, 0, 0, 0);
    EXPECT_EQ(sizeof s, 32U);
    EXPECT_EQ(offsetIn(s, s.mAngle), 16U);
    EXPECT_EQ(offsetIn(s, s.mDistance), 20U);
    EXPECT_EQ(offsetIn(s, s.mSize), 24U);

    const VFInnerShadowProperty i(0, 0, 0, 0, 0);
    EXPECT_EQ(sizeof i, 32U);
    EXPECT_EQ(offsetIn(i, i.mAngle), 16U);
    EXPECT_EQ(offsetIn(i, i.mDistance), 20U);
    EXPECT_EQ(offsetIn(i, i.mSize), 24U);
}

TEST(Abi, StrokeAndPatternRecords_AreLaidOut) {
    const VFStrokeProperty s(0, 0, 0, 0, 0);
    EXPECT_EQ(sizeof s, 32U);
    EXPECT_EQ(offsetIn(s, s.mSize), 16U);
    EXPECT_EQ(offsetIn(s, s.mStrokeStyle), 20U);
    EXPECT_EQ(offsetIn(s, s.mPosition), 24U);

    const VFPatternProperty p(nullptr, 0, 0);
    EXPECT_EQ(sizeof p, 32U);
    EXPECT_EQ(offsetIn(p, p.mPattern), 16U);
    EXPECT_EQ(offsetIn(p, p.mScale), 24U);
}

template <class Glow>
void expectGlowLayout() {
    const Glow g(0, 0, 0, 0, nullptr);
    EXPECT_EQ(sizeof g, 32U);
    EXPECT_EQ(offsetIn(g, g.mSize), 16U);
    EXPECT_EQ(offsetIn(g, g.mGradientCount), 20U);
    EXPECT_EQ(offsetIn(g, g.mGradient), 24U);
}

template <class Gradient>
void expectGradientLayout() {
    const Gradient g(0, 0, 0, 0, nullptr);
    EXPECT_EQ(sizeof g, 40U);
    EXPECT_EQ(offsetIn(g, g.mAngle), 16U);
    EXPECT_EQ(offsetIn(g, g.mScale), 20U);
    EXPECT_EQ(offsetIn(g, g.mGradientCount), 24U);
    EXPECT_EQ(offsetIn(g, g.mGradient), 32U);
}

template <class Relief>
void expectReliefLayout() {
    const Relief r(0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0);
    EXPECT_EQ(sizeof r, 64U);
    EXPECT_EQ(offsetIn(r, r.mStyle), 16U);
    EXPECT_EQ(offsetIn(r, r.mSize), 20U);
    EXPECT_EQ(offsetIn(r, r.mDepth), 24U);
    EXPECT_EQ(offsetIn(r, r.mTechnique), 28U);
    EXPECT_EQ(offsetIn(r, r.mDirection), 32U);
    EXPECT_EQ(offsetIn(r, r.mSoften), 36U);
    EXPECT_EQ(offsetIn(r, r.mAngle), 40U);
    EXPECT_EQ(offsetIn(r, r.mAltitude), 44U);
    EXPECT_EQ(offsetIn(r, r.mHighlightColor), 48U);
    EXPECT_EQ(offsetIn(r, r.mHighlightOpacity), 52U);
    EXPECT_EQ(offsetIn(r, r.mShadowColor), 56U);
    EXPECT_EQ(offsetIn(r, r.mShadowOpacity), 60U);
}

TEST(Abi, RecordsWithStops_AreLaidOut) {
    expectGlowLayout<VFOuterGlowProperty>();
    expectGlowLayout<VFInnerGlowProperty>();
    expectGradientLayout<VFLinearGradientProperty>();
    expectGradientLayout<VFRadialGradientProperty>();
}

TEST(Abi, ReliefRecords_AreLaidOut) {
    expectReliefLayout<VFBevelProperty>();
    expectReliefLayout<VFEmbossProperty>();
}

}  // namespace
}  // namespace VFontEffect
