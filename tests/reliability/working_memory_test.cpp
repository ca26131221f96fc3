#include <gtest/gtest.h>

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

/// A mask of any size with a destination of its width, as high as it is or a few rows of it.
class Canvas {
  public:
    Canvas(unsigned width, unsigned height, unsigned seenRows)
        : mMask(width, height, 1), mDst(width, seenRows, 4) {
        for (int64_t y = 0; y < height; ++y) {
            for (int64_t x = 0; x < width; ++x)
                mMask.mData[y * width + x] = coverageAt(x, y);
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
        EXPECT_TRUE(canvas.isPainted()) << named.name << " of size " << size;
    }
}

class WorkingMemory : public ::testing::Test {
  protected:
    void SetUp() override {
        if (!canWatchMemory() || kSanitized) GTEST_SKIP() << "sizes are not counted in this build";
    }
};

TEST_F(WorkingMemory, OfASmallPicture_IsLessThanItsDestination) {
    Canvas canvas(200, 60, 60);
    for (const float size : {1.0F, 2.0F, 3.0F, 8.0F}) {
        for (const NamedCore& named : coresOf(size))
            EXPECT_LE(canvas.paint(*named.core), 200L * 60 * 4 * 2) << named.name << " " << size;
    }
}

TEST_F(WorkingMemory, OfALargePicture_IsFewMegabytes) {
    if (kThinned > 1) GTEST_SKIP() << "takes a minute under an emulator";
    Canvas canvas(4096, 4096, 4096);
    expectFewBytes(canvas, 100.0F);
}

TEST_F(WorkingMemory, OfALongLine_IsFewMegabytes) {
    Canvas canvas(26'000, 200, 200);
    for (const float size : {2.0F, 17.0F, 48.0F, 256.0F})
        expectFewBytes(canvas, size);
}

TEST_F(WorkingMemory, OfARowOfPixels_IsFewMegabytes) {
    Canvas canvas(100'000, 1, 1);
    for (const float size : {1.0F, 3.0F, 8.0F, 24.0F, 100.0F, 256.0F})
        expectFewBytes(canvas, size);
}

TEST_F(WorkingMemory, OfAColumnOfPixels_IsFewMegabytes) {
    Canvas canvas(1, 100'000, 100'000);
    for (const float size : {1.0F, 3.0F, 8.0F, 24.0F, 100.0F, 256.0F})
        expectFewBytes(canvas, size);
}

/// A plane for each pixel with all that the disc reaches beside it would take 5 GB.
TEST_F(WorkingMemory, OfTheStrokeOfALongColumn_IsFewMegabytes) {
    const auto length = static_cast<unsigned>(thinned(4'000'000));
    Canvas canvas(1, length, length);
    const auto stroke = coreOf<VFStroke, VFStrokeProperty>(24.0F, kRed, 1.0F, 0, 1);
    EXPECT_LE(canvas.paint(*stroke), kMostBytes);
    EXPECT_TRUE(canvas.isPainted());
}

}  // namespace
