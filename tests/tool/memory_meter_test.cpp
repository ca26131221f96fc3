#include "memory_meter.h"

#include <gtest/gtest.h>
#include <voreleffect/VFBitmap.h>

#include <cstdlib>
#include <string>

namespace vorelpaint {
namespace {

using VFontEffect::VFBitmap;

class MemoryMeterTest : public ::testing::Test {
  protected:
    void SetUp() override {
        if (!MemoryMeter::works()) GTEST_SKIP() << "a sanitizer has the allocator";
    }
};

/// Allocators round up by a few bytes, and by a page in large blocks.
void expectAbout(size_t bytes, size_t expected) {
    EXPECT_GE(bytes, expected);
    EXPECT_LE(bytes, expected + 8192);
}

TEST_F(MemoryMeterTest, Peak_IsTheMostAtOneTime) {
    const MemoryMeter meter;
    { const VFBitmap first(1000, 300, 1); }
    { const VFBitmap second(1000, 500, 1); }
    { const VFBitmap third(1000, 100, 1); }
    expectAbout(meter.peak(), 500000);
}

TEST_F(MemoryMeterTest, Peak_AddsWhatIsInUseTogether) {
    const MemoryMeter meter;
    const VFBitmap first(1000, 300, 1);
    const VFBitmap second(1000, 500, 1);
    expectAbout(meter.peak(), 800000);
}

TEST_F(MemoryMeterTest, ThisProgram_IsCountedToo) {
    const MemoryMeter meter;
    const std::string text(static_cast<size_t>(std::atoi("400000")), 'x');
    EXPECT_EQ(text.back(), 'x');
    expectAbout(meter.peak(), 400000);
}

TEST_F(MemoryMeterTest, MovedBlock_CountsOnce) {
    const MemoryMeter meter;
    void* block = std::malloc(100000);
    ASSERT_NE(block, nullptr);
    void* const grown = std::realloc(block, 200000);
    EXPECT_NE(grown, nullptr);
    std::free(grown);
    expectAbout(meter.peak(), 200000);
}

TEST_F(MemoryMeterTest, NewMeter_StartsAtNothing) {
    const VFBitmap before(1000, 300, 1);
    const MemoryMeter meter;
    EXPECT_EQ(meter.peak(), 0U);
}

}  // namespace
}  // namespace vorelpaint
