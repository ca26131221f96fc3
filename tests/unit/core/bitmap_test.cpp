#include <gtest/gtest.h>
#include <voreleffect/VFBitmap.h>

#include <climits>
#include <numeric>

#include "tests/support/engine.h"

using namespace VFontEffect;
using namespace vorel_test;

namespace {

using Bytes = std::vector<uint8_t>;

void expectNumbers(const VFBitmap& bitmap, unsigned width, unsigned height, unsigned bytesPerPixel,
                   unsigned format) {
    EXPECT_EQ(bitmap.mWidth, width);
    EXPECT_EQ(bitmap.mHeight, height);
    EXPECT_EQ(bitmap.mBytesPerPixel, bytesPerPixel);
    EXPECT_EQ(bitmap.mFormat, format);
}

/// A 5 x 5 mask of the bytes 0 to 24: pixel (x, y) is 5y + x.
VFBitmap numberedMask() {
    Bytes numbers(25);
    std::iota(numbers.begin(), numbers.end(), uint8_t{0});
    return VFBitmap(5, 5, numbers.data(), 1);
}

TEST(Rect, StartsAsZeros) {
    EXPECT_EQ(sidesOf(VFRect()), (std::vector<int>{0, 0, 0, 0}));
}

TEST(Rect, KeepsItsSidesInOrder) {
    const VFRect rect(1, 2, 3, 4);
    EXPECT_EQ(rect.mLeft, 1);
    EXPECT_EQ(rect.mTop, 2);
    EXPECT_EQ(rect.mRight, 3);
    EXPECT_EQ(rect.mBottom, 4);
}

TEST(Glyph, SizesStandSideBySide) {
    EXPECT_EQ(offsetof(VFGlyph, mHeight), offsetof(VFGlyph, mWidth) + 2);
}

TEST(Gradient, IsThreeWordsLong) {
    EXPECT_EQ(sizeof(VFGradient), 12U);
    EXPECT_EQ(offsetof(VFGradient, mOpacity), 4U);
    EXPECT_EQ(offsetof(VFGradient, mLocation), 8U);
}

TEST(Bitmap, Default_IsEmptyOfFormatFour) {
    const VFBitmap bitmap;
    expectNumbers(bitmap, 0, 0, 0, 4);
    EXPECT_EQ(bitmap.mData, nullptr);
}

TEST(Bitmap, Colour_IsZeroedAndOfFormatOne) {
    const VFBitmap bitmap(4, 2, 4);
    expectNumbers(bitmap, 4, 2, 4, 1);
    EXPECT_EQ(bytesOf(bitmap), Bytes(32, 0));
}

TEST(Bitmap, Mask_IsZeroedAndOfFormatTwo) {
    const VFBitmap bitmap(4, 2, 1);
    expectNumbers(bitmap, 4, 2, 1, 2);
    EXPECT_EQ(bytesOf(bitmap), Bytes(8, 0));
}

TEST(Bitmap, OtherByteCounts_AreOfFormatTwo) {
    for (const unsigned bytesPerPixel : {0U, 2U, 3U, 5U, 8U}) {
        const VFBitmap bitmap(4, 2, bytesPerPixel);
        expectNumbers(bitmap, 4, 2, bytesPerPixel, 2);
        EXPECT_EQ(bytesOf(bitmap), Bytes(8U * bytesPerPixel, 0));
    }
}

TEST(Bitmap, WithoutWidthOrHeight_KeepsItsNumbersThroughCopies) {
    for (const auto& [width, height] : {std::pair{0U, 7U}, std::pair{7U, 0U}, std::pair{0U, 0U}}) {
        const VFBitmap bitmap(width, height, 4);
        const VFBitmap copy(bitmap);
        VFBitmap assigned(3, 3, 1);
        assigned = bitmap;
        expectNumbers(bitmap, width, height, 4, 1);
        expectNumbers(copy, width, height, 4, 1);
        expectNumbers(assigned, width, height, 4, 1);
    }
}

TEST(Bitmap, FromData_OwnsItsOwnCopy) {
    Bytes data = {1, 2, 3, 4, 5, 6};
    const VFBitmap bitmap(3, 2, data.data(), 1);
    expectNumbers(bitmap, 3, 2, 1, 2);
    EXPECT_NE(bitmap.mData, data.data());
    data.assign(6, 99);
    EXPECT_EQ(bytesOf(bitmap), (Bytes{1, 2, 3, 4, 5, 6}));
}

TEST(Bitmap, FromNullData_HasNoPixels) {
    const VFBitmap bitmap(3, 2, nullptr, 4);
    expectNumbers(bitmap, 3, 2, 4, 1);
    EXPECT_EQ(bitmap.mData, nullptr);
}

TEST(Bitmap, FromDataOfTwoGigabytes_ReadsNothingAndHasNoPixels) {
    uint8_t one = 1;
    const VFBitmap bitmap(65536, 32768, &one, 1);
    expectNumbers(bitmap, 65536, 32768, 1, 2);
    EXPECT_EQ(bitmap.mData, nullptr);
}

TEST(Bitmap, ByteCountBeyond32Bits_Survives) {
    const VFBitmap bitmap(65536, 65536, 1);  // 2^32 bytes are 0 in 32 bits
    const VFBitmap copy(bitmap);
    VFBitmap assigned;
    assigned = bitmap;
    expectNumbers(copy, 65536, 65536, 1, 2);
    expectNumbers(assigned, 65536, 65536, 1, 2);
}

TEST(Bitmap, Copy_IsDeep) {
    VFBitmap original = numberedMask();
    const VFBitmap copy(original);
    EXPECT_NE(copy.mData, original.mData);
    const Bytes before = bytesOf(copy);
    fillBytes(original, 77);
    EXPECT_EQ(bytesOf(copy), before);
    EXPECT_EQ(before, bytesOf(numberedMask()));
}

TEST(Bitmap, Copy_TakesTheFormatOverAsItStands) {
    VFBitmap original(2, 2, 4);
    original.mFormat = 42;
    VFBitmap assigned;
    assigned = original;
    EXPECT_EQ(VFBitmap(original).mFormat, 42U);
    EXPECT_EQ(assigned.mFormat, 42U);
}

TEST(Bitmap, CopyOfBitmapWithoutPixels_HasNone) {
    const VFBitmap empty;
    const VFBitmap copy(empty);
    expectNumbers(copy, 0, 0, 0, 4);
    EXPECT_EQ(copy.mData, nullptr);

    const VFBitmap sized(3, 2, nullptr, 1);
    VFBitmap assigned(4, 4, 4);
    assigned = sized;
    expectNumbers(assigned, 3, 2, 1, 2);
    EXPECT_EQ(assigned.mData, nullptr);
}

TEST(Bitmap, Assignment_ReplacesPixelsOfAnotherSizeAndReturnsItself) {
    const VFBitmap original = numberedMask();
    for (const unsigned size : {0U, 1U, 5U, 40U}) {
        VFBitmap assigned(size, size, 4);
        EXPECT_EQ(&(assigned = original), &assigned);
        expectNumbers(assigned, 5, 5, 1, 2);
        EXPECT_NE(assigned.mData, original.mData);
        EXPECT_EQ(bytesOf(assigned), bytesOf(original));
    }
}

TEST(Bitmap, AssignmentToItself_LeavesPixelsUntouched) {
    VFBitmap bitmap = numberedMask();
    const uint8_t* pixels = bitmap.mData;
    const VFBitmap& itself = bitmap;
    EXPECT_EQ(&(bitmap = itself), &bitmap);
    EXPECT_EQ(bitmap.mData, pixels);
    EXPECT_EQ(bytesOf(bitmap), bytesOf(numberedMask()));
}

TEST(Crop, OfMask_HoldsTheBox) {
    const VFBitmap source = numberedMask();
    VFRect rect(1, 1, 3, 4);
    const VFBitmap crop(source, &rect);
    expectNumbers(crop, 2, 3, 1, 2);
    EXPECT_EQ(bytesOf(crop), (Bytes{6, 7, 11, 12, 16, 17}));
}

TEST(Crop, OfWholeMask_IsTheMask) {
    const VFBitmap source = numberedMask();
    VFRect rect(0, 0, 5, 5);
    EXPECT_EQ(bytesOf(VFBitmap(source, &rect)), bytesOf(source));
}

TEST(Crop, OfColour_MovesOneBytePerPixelByPixelIndex) {
    Bytes numbers(4 * 3 * 4);
    std::iota(numbers.begin(), numbers.end(), uint8_t{0});
    const VFBitmap source(4, 3, numbers.data(), 4);
    VFRect rect(1, 1, 3, 3);
    const VFBitmap crop(source, &rect);
    expectNumbers(crop, 2, 2, 4, 1);
    // Rows of 4 pixels count as rows of 4 bytes: bytes 5, 6, 9 and 10.
    EXPECT_EQ(Bytes(crop.mData, crop.mData + 4), (Bytes{5, 6, 9, 10}));
}

TEST(Crop, InvertedRectangle_HasPositiveSizeAndNoCoverage) {
    const VFBitmap source = numberedMask();
    for (VFRect rect : {VFRect(3, 1, 1, 4), VFRect(1, 4, 3, 1), VFRect(3, 4, 1, 1)}) {
        const VFBitmap crop(source, &rect);
        expectNumbers(crop, 2, 3, 1, 2);
        EXPECT_EQ(bytesOf(crop), Bytes(6, 0));
    }
}

TEST(Crop, EmptyRectangle_HasNoExtent) {
    const VFBitmap source = numberedMask();
    VFRect rect(2, 1, 2, 4);
    expectNumbers(VFBitmap(source, &rect), 0, 3, 1, 2);
}

TEST(Crop, RectangleLeavingTheSource_HasNoCoverage) {
    const VFBitmap source = numberedMask();
    for (VFRect rect : {VFRect(3, 3, 6, 5), VFRect(-1, 0, 2, 2), VFRect(0, -1, 3, 1), VFRect(0, 4, 3, 6),
                        VFRect(7, 7, 10, 9)}) {
        const VFBitmap crop(source, &rect);
        expectNumbers(crop, 3, 2, 1, 2);
        EXPECT_EQ(bytesOf(crop), Bytes(6, 0));
    }
}

TEST(Crop, OfPixelsWithoutBytes_HasNoPixels) {
    const VFBitmap source(4, 4, 0U);
    VFRect rect(0, 0, 2, 2);
    const VFBitmap crop(source, &rect);
    EXPECT_EQ(crop.mData, nullptr);
    EXPECT_EQ(crop.mBytesPerPixel, 0U);
}

TEST(Crop, LargestRectangle_Survives) {
    const VFBitmap source = numberedMask();
    VFRect rect(INT_MIN, INT_MIN, INT_MAX, INT_MAX);
    EXPECT_EQ(VFBitmap(source, &rect).mBytesPerPixel, 1U);
}

TEST(Crop, NullRectangleOrSourceWithoutPixels_HasNoPixels) {
    const VFBitmap source = numberedMask();
    EXPECT_EQ(VFBitmap(source, nullptr).mData, nullptr);

    VFRect rect(0, 0, 2, 2);
    EXPECT_EQ(VFBitmap(VFBitmap(), &rect).mData, nullptr);
    EXPECT_EQ(VFBitmap(VFBitmap(4, 4, nullptr, 1), &rect).mData, nullptr);
}

}  // namespace
