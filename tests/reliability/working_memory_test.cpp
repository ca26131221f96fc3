#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

#include "allocation_watch.h"
#include "build_kind.h"
#include "tests/support/core_compare.h"
#include "tests/support/thinned.h"
#include "voreleffect/voreleffect.h"

/// Working memory: whatever the size of a picture and of an effect, an effect takes few megabytes, and
/// is painted.
namespace {

using namespace vorel_test;
using namespace VFontEffect;

constexpr long kMostBytes = 4'000'000;

/// A row of discs and gaps, dark at the picture's edges and all along it.
uint8_t coverageAt(int64_t x, int64_t y) {
    const int64_t across = (x + y / 3) % 61;
    return across < 30 ? 255 : across < 32 ? 128 : 0;
}

/// A part of the endless pattern from (left, top) on, and a destination of its size.
class Canvas {
  public:
    Canvas(unsigned width, unsigned height, int left = 0, int top = 0)
        : mMask(width, height, 1), mDst(width, height, 4) {
        if (!isMade()) return;
        for (int64_t y = 0; y < height; ++y) {
            for (int64_t x = 0; x < width; ++x)
                mMask.mData[y * width + x] = coverageAt(left + x, top + y);
        }
        mText = VFRect(0, 0, static_cast<int>(width), static_cast<int>(height));
    }

    bool isMade() const { return mMask.mData != nullptr && mDst.mData != nullptr; }

    /// The peak of working memory.
    long paint(VFECore& core) {
        std::memset(mDst.mData, 0, bytes());
        VFECore::ParamPostProcessing params = {&mDst, &mMask, &mText, 0, nullptr};
        const PeakMemory peak;
        core.doPostProcessing(&params);
        return peak.bytes();
    }

    bool isPainted() const {
        for (size_t i = 0; i < bytes(); ++i)
            if (mDst.mData[i] != 0) return true;
        return false;
    }

    const unsigned char* at(int64_t x, int64_t y) const {
        return mDst.mData + (y * mDst.mWidth + x) * 4;
    }

  private:
    size_t bytes() const { return size_t{mDst.mWidth} * mDst.mHeight * 4; }

    VFBitmap mMask;
    VFBitmap mDst;
    VFRect mText;
};

struct NamedCore {
    std::string name;
    std::unique_ptr<VFECore> core;
};

std::vector<NamedCore> coresOf(float size) {
    std::vector<NamedCore> cores;
    for (const int position : {0, 1, 2}) {
        cores.push_back({"stroke " + std::to_string(position),
                         coreOf<VFStroke, VFStrokeProperty>(size, kRed, 1.0F, 0, position)});
    }
    // Not moved out of pictures that are a pixel wide.
    cores.push_back(
        {"outer shadow", coreOf<VFOuterShadow, VFOuterShadowProperty>(30.0F, 0.0F, size, kRed, 1.0F)});
    cores.push_back(
        {"inner shadow", coreOf<VFInnerShadow, VFInnerShadowProperty>(30.0F, 0.0F, size, kRed, 1.0F)});
    VFGradient* const none = nullptr;
    cores.push_back({"outer glow", coreOf<VFOuterGlow, VFOuterGlowProperty>(size, kRed, 1.0F, 0, none)});
    cores.push_back({"inner glow", coreOf<VFInnerGlow, VFInnerGlowProperty>(size, kRed, 1.0F, 0, none)});
    return cores;
}

void expectFewBytes(Canvas& canvas, float size) {
    ASSERT_TRUE(canvas.isMade());
    for (const NamedCore& named : coresOf(size)) {
        EXPECT_LE(canvas.paint(*named.core), kMostBytes) << named.name << " of size " << size;
        // Of a line of one pixel a blur beyond the limit of the add-calls leaves nothing.
        const bool mayVanish = size > 100.0F;
        EXPECT_TRUE(mayVanish || canvas.isPainted()) << named.name << " of size " << size;
    }
}

/// All of the sizes, or where each takes many times as long the first.
void expectFewBytes(Canvas& canvas, const std::vector<float>& sizes) {
    for (size_t i = 0; i < (kThinned > 1 ? 1 : sizes.size()); ++i)
        expectFewBytes(canvas, sizes[i]);
}

class WorkingMemory : public ::testing::Test {
  protected:
    void SetUp() override {
        if (!canWatchMemory() || kSanitized) GTEST_SKIP() << "sizes are not counted in this build";
    }
};

TEST_F(WorkingMemory, OfASmallPicture_IsLessThanItsDestination) {
    Canvas canvas(200, 60);
    for (const float size : {1.0F, 2.0F, 3.0F, 8.0F}) {
        for (const NamedCore& named : coresOf(size))
            EXPECT_LE(canvas.paint(*named.core), 200L * 60 * 4 * 2) << named.name << " " << size;
    }
}

TEST_F(WorkingMemory, OfALargePicture_IsFewMegabytes) {
    if (kThinned > 1) GTEST_SKIP() << "takes a minute under an emulator";
    Canvas canvas(4096, 4096);
    expectFewBytes(canvas, 100.0F);
}

TEST_F(WorkingMemory, OfALongLine_IsFewMegabytes) {
    Canvas canvas(26'000, 200);
    expectFewBytes(canvas, {48.0F, 2.0F, 17.0F, 256.0F});
}

TEST_F(WorkingMemory, OfARowOfPixels_IsFewMegabytes) {
    Canvas canvas(100'000, 1);
    expectFewBytes(canvas, {24.0F, 1.0F, 3.0F, 8.0F, 100.0F, 256.0F});
}

TEST_F(WorkingMemory, OfAColumnOfPixels_IsFewMegabytes) {
    Canvas canvas(1, 100'000);
    expectFewBytes(canvas, {24.0F, 1.0F, 3.0F, 8.0F, 100.0F, 256.0F});
}

TEST_F(WorkingMemory, OfAPattern_IsFewBytesAColumn) {
    constexpr long kColumns = 26'000;
    Canvas canvas(kColumns, 20);
    VFBitmap tile(5, 3, 4);
    std::fill_n(tile.mData, 5 * 3 * 4, uint8_t{255});
    for (const float scale : {0.1F, 1.0F, 2.5F, 10.0F}) {
        const auto pattern = coreOf<VFPattern, VFPatternProperty>(&tile, scale, 1.0F);
        EXPECT_LE(canvas.paint(*pattern), 40 * kColumns) << scale;
        EXPECT_TRUE(canvas.isPainted()) << scale;
    }
}

TEST_F(WorkingMemory, OfTheBoxFilter_IsTwoPlanesOfWhatGrows) {
    std::vector<unsigned char> mask(size_t{1000} * 800, 0);
    mask[400 * 1000 + 500] = 255;
    VFOuterGlow glow;
    const PeakMemory few;
    glow.increaseByBoxFilter(mask.data(), 20, 1000, 800);
    EXPECT_LE(few.bytes(), 20'000);
    std::fill(mask.begin(), mask.end(), uint8_t{200});
    const PeakMemory whole;
    glow.increaseByBoxFilter(mask.data(), 20, 1000, 800);
    EXPECT_LE(whole.bytes(), 2 * (1000 + 128) * 810L);
}

/// A plane for each pixel with all that the disc reaches beside it would take 5 GB.
TEST_F(WorkingMemory, OfTheStrokeOfALongColumn_IsFewMegabytes) {
    const auto length = static_cast<unsigned>(thinned(4'000'000));
    Canvas canvas(1, length);
    const auto stroke = coreOf<VFStroke, VFStrokeProperty>(24.0F, kRed, 1.0F, 0, 1);
    EXPECT_LE(canvas.paint(*stroke), kMostBytes);
    EXPECT_TRUE(canvas.isPainted());
}

/// By hand, as it holds 3.4 GB: the middle of a picture whose planes would be beyond 2 GiB is that of a
/// small one.
TEST_F(WorkingMemory, DISABLED_OfTheLargestPictures_IsFewMegabytes) {
    constexpr int kSide = 26'000;
    constexpr int kLeft = 12'345;
    constexpr int kTop = 13'579;
    constexpr int kPart = 2000;
    constexpr int kEdge = 400;  // what lies beyond the small picture reaches no farther
    Canvas large(kSide, kSide);
    Canvas small(kPart, kPart, kLeft, kTop);
    ASSERT_TRUE(large.isMade() && small.isMade());
    for (const float size : {24.0F, 100.0F}) {
        for (const NamedCore& named : coresOf(size)) {
            SCOPED_TRACE(named.name + " of size " + std::to_string(size));
            EXPECT_LE(large.paint(*named.core), kMostBytes);
            small.paint(*named.core);
            EXPECT_TRUE(small.isPainted());
            for (int y = kEdge; y < kPart - kEdge; ++y) {
                ASSERT_EQ(0, std::memcmp(large.at(kLeft + kEdge, kTop + y), small.at(kEdge, y),
                                         size_t{kPart - 2 * kEdge} * 4))
                    << "row " << y;
            }
        }
    }
}

}  // namespace
