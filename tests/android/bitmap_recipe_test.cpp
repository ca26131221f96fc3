#include <gtest/gtest.h>

#include <cstdint>
#include <utility>
#include <vector>

// The code of docs/android.md as it stands there, between a bitmap and a libjnigraphics of the test's
// own.
#include "bitmap_recipe.cpp"

namespace {

constexpr unsigned int kWidth = 40;
constexpr unsigned int kHeight = 30;
constexpr unsigned char kUntouched = 0xA5;

/// Android's bitmap; a jobject points to one.
struct Bitmap {
    AndroidBitmapInfo info;
    std::vector<unsigned char> memory;
    int getInfoGives = ANDROID_BITMAP_RESULT_SUCCESS;
    int lockGives = ANDROID_BITMAP_RESULT_SUCCESS;
    int locks = 0;
    int unlocks = 0;

    explicit Bitmap(unsigned int gap, unsigned char filling = 0)
        : info{kWidth, kHeight, kWidth * 4 + gap, ANDROID_BITMAP_FORMAT_RGBA_8888, 0},
          memory(size_t{info.stride} * kHeight, kUntouched) {
        for (size_t y = 0; y < kHeight; ++y)
            std::memset(row(y), filling, kWidth * 4);
    }

    unsigned char* row(size_t y) { return memory.data() + y * info.stride; }

    std::vector<unsigned char> pixels() {
        std::vector<unsigned char> packed;
        for (size_t y = 0; y < kHeight; ++y)
            packed.insert(packed.end(), row(y), row(y) + size_t{kWidth} * 4);
        return packed;
    }
};

Bitmap& bitmapOf(jobject object) {
    return *reinterpret_cast<Bitmap*>(object);
}

/// A shadow and a fill: painted under and over what is there.
void describe(VFEffect& look) {
    look.addOuterShadowText(135, 3, 2, 0x000000, 0.8F);
    look.addText(0x3366CC, 1);
}

class Line {
  public:
    Line() : mCoverage(12 * 10, 200), mGlyphs{{8, 7, {mCoverage.data(), 12, 10}}} {}
    std::vector<PlacedGlyph>& glyphs() { return mGlyphs; }

    bool paintInto(Bitmap& bitmap) {
        VFEffect look;
        describe(look);
        return paintIntoBitmap(nullptr, reinterpret_cast<jobject>(&bitmap), look, mGlyphs);
    }

  private:
    std::vector<unsigned char> mCoverage;
    std::vector<PlacedGlyph> mGlyphs;
};

std::vector<unsigned char> paintedByTheLibrary(unsigned char filling) {
    VFEffect look;
    describe(look);
    VFBitmap picture(kWidth, kHeight, 4);
    std::memset(picture.mData, filling, size_t{kWidth} * kHeight * 4);
    look.initEffect(kWidth, kHeight);
    look.setDstBitmap(&picture);
    Line line;
    look.renderEffectLayer(8, 7, &line.glyphs().front().glyph);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);
    return {picture.mData, picture.mData + size_t{kWidth} * kHeight * 4};
}

class BitmapRecipe : public testing::TestWithParam<unsigned int> {};

INSTANTIATE_TEST_SUITE_P(Gap, BitmapRecipe, testing::Values(0U, 4U, 24U));

TEST_P(BitmapRecipe, PaintsThePixelsOfTheLibrary) {
    Bitmap bitmap(GetParam());
    EXPECT_TRUE(Line().paintInto(bitmap));
    EXPECT_EQ(bitmap.pixels(), paintedByTheLibrary(0));
    EXPECT_NE(bitmap.pixels(), Bitmap(0).pixels());
}

TEST_P(BitmapRecipe, PaintsUnderAndOverWhatIsThere) {
    Bitmap bitmap(GetParam(), 90);
    EXPECT_TRUE(Line().paintInto(bitmap));
    EXPECT_EQ(bitmap.pixels(), paintedByTheLibrary(90));
    EXPECT_NE(bitmap.pixels(), paintedByTheLibrary(0));
}

TEST_P(BitmapRecipe, LeavesTheGapsBetweenRowsAlone) {
    Bitmap bitmap(GetParam());
    EXPECT_TRUE(Line().paintInto(bitmap));
    for (size_t y = 0; y < kHeight; ++y) {
        for (size_t x = kWidth * 4; x < bitmap.info.stride; ++x)
            EXPECT_EQ(bitmap.row(y)[x], kUntouched) << "row " << y << ", byte " << x;
    }
}

TEST_P(BitmapRecipe, LocksOnceAndUnlocksOnce) {
    Bitmap bitmap(GetParam());
    EXPECT_TRUE(Line().paintInto(bitmap));
    EXPECT_EQ(std::pair(bitmap.locks, bitmap.unlocks), std::pair(1, 1));
}

TEST(BitmapRecipe, RefusesABitmapThatCannotBePaintedInto) {
    Bitmap otherFormat(0);
    otherFormat.info.format = ANDROID_BITMAP_FORMAT_A_8;
    Bitmap withoutInfo(0);
    withoutInfo.getInfoGives = ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    Bitmap withoutPixels(0);
    withoutPixels.lockGives = ANDROID_BITMAP_RESULT_JNI_EXCEPTION;
    for (Bitmap* bitmap : {&otherFormat, &withoutInfo, &withoutPixels}) {
        EXPECT_FALSE(Line().paintInto(*bitmap));
        EXPECT_EQ(bitmap->pixels(), Bitmap(0).pixels());
        EXPECT_EQ(bitmap->unlocks, 0);
    }
}

}  // namespace

extern "C" {

int AndroidBitmap_getInfo(JNIEnv*, jobject object, AndroidBitmapInfo* info) {
    *info = bitmapOf(object).info;
    return bitmapOf(object).getInfoGives;
}

int AndroidBitmap_lockPixels(JNIEnv*, jobject object, void** address) {
    Bitmap& bitmap = bitmapOf(object);
    if (bitmap.lockGives != ANDROID_BITMAP_RESULT_SUCCESS) return bitmap.lockGives;
    ++bitmap.locks;
    *address = bitmap.memory.data();
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

int AndroidBitmap_unlockPixels(JNIEnv*, jobject object) {
    ++bitmapOf(object).unlocks;
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

}  // extern "C"
