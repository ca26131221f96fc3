#include <gtest/gtest.h>

#include <cmath>
#include <cstdlib>
#include <limits>
#include <string>
#include <vector>

#include "tests/support/literal_cores.h"
#include "voreleffect/voreleffect.h"

namespace {

using vorel_test::literal::CircleKernel;

/// The library's kernel, its buffer released.
CircleKernel libraryKernel(float radius) {
    unsigned char* weights = nullptr;
    CircleKernel kernel;
    kernel.side = VFontEffect::makeCircleKernel(&weights, radius);
    if (weights == nullptr) return kernel;
    const auto cells = static_cast<size_t>(kernel.side) * static_cast<size_t>(kernel.side);
    kernel.weights.assign(weights, weights + cells);
    std::free(weights);
    return kernel;
}

TEST(CircleKernel, RadiusTwo_CoversTheAxesAndSoftensTheCorners) {
    const CircleKernel kernel = libraryKernel(2.0F);
    EXPECT_EQ(5, kernel.side);
    // d = sqrt(5): 1 - 0.236 = 0.764 of 255; d = sqrt(8): 1 - 0.828 = 0.172 of 255.
    const std::vector<uint8_t> expected{44,  195, 255, 195, 44,   //
                                        195, 255, 255, 255, 195,  //
                                        255, 255, 255, 255, 255,  //
                                        195, 255, 255, 255, 195,  //
                                        44,  195, 255, 195, 44};
    EXPECT_EQ(expected, kernel.weights);
}

TEST(CircleKernel, RadiusZero_IsOneFullCell) {
    const CircleKernel kernel = libraryKernel(0.0F);
    EXPECT_EQ(1, kernel.side);
    EXPECT_EQ(std::vector<uint8_t>{255}, kernel.weights);
}

TEST(CircleKernel, RadiusHalf_HasARimOfHalfWeight) {
    const CircleKernel kernel = libraryKernel(0.5F);
    // d = 1: 0.5 * 255 + 0.5 = 128; d = 1.4142: 0.0858 * 255 + 0.5 = 22.4.
    EXPECT_EQ((std::vector<uint8_t>{22, 128, 22, 128, 255, 128, 22, 128, 22}), kernel.weights);
}

TEST(CircleKernel, CellsBeyondTheRim_AreZero) {
    const CircleKernel kernel = libraryKernel(2.5F);
    ASSERT_EQ(7, kernel.side);
    // The top row, 3 above the centre: d = 3.606 is outside; 3.162 leaves 0.338, 3 leaves 0.5.
    const std::vector<uint8_t> topRow(kernel.weights.begin(), kernel.weights.begin() + 7);
    EXPECT_EQ((std::vector<uint8_t>{0, 0, 86, 128, 86, 0, 0}), topRow);
}

TEST(CircleKernel, Side_FollowsTheRoundedRadius) {
    EXPECT_EQ(1, libraryKernel(0.49F).side);
    EXPECT_EQ(5, libraryKernel(2.49F).side);
    EXPECT_EQ(7, libraryKernel(2.5F).side);
    EXPECT_EQ(201, libraryKernel(100.0F).side);
}

TEST(CircleKernel, SmallNegativeRadius_FadesItsOnlyCell) {
    // d = 0: 1 - (0 + 0.5) = 0.5 of 255, plus 0.5.
    EXPECT_EQ(std::vector<uint8_t>{128}, libraryKernel(-0.5F).weights);
    EXPECT_EQ(std::vector<uint8_t>{0}, libraryKernel(-1.4F).weights);
}

TEST(CircleKernel, RadiusWithoutASide_StoresNothing) {
    const float infinity = std::numeric_limits<float>::infinity();
    for (float radius : {-1.5F, -2.0F, -1e9F, 1e9F, 3e38F, infinity, -infinity}) {
        SCOPED_TRACE("radius " + std::to_string(radius));
        unsigned char* weights = nullptr;
        EXPECT_EQ(0, VFontEffect::makeCircleKernel(&weights, radius));
        EXPECT_EQ(nullptr, weights);
    }
}

TEST(CircleKernel, RadiusOutOfProportion_HasASideButNoBuffer) {
    unsigned char* weights = nullptr;
    for (const int reach : {4096, 5000}) {
        EXPECT_EQ(2 * reach + 1, VFontEffect::makeCircleKernel(&weights, static_cast<float>(reach)));
        EXPECT_EQ(nullptr, weights) << reach;
    }
    EXPECT_EQ(8191, VFontEffect::makeCircleKernel(&weights, 4095.0F));
    EXPECT_NE(nullptr, weights);
    std::free(weights);
}

TEST(CircleKernel, LargestDisc_HasASideOf8191) {
    unsigned char* weights = nullptr;
    EXPECT_EQ(8191, VFontEffect::makeCircleKernel(&weights, 4095.0F));
    ASSERT_NE(nullptr, weights);
    EXPECT_EQ(255, weights[size_t{4095} * 8191]);
    EXPECT_EQ(0, weights[0]);
    std::free(weights);

    weights = nullptr;
    EXPECT_EQ(8193, VFontEffect::makeCircleKernel(&weights, 4096.0F));
    EXPECT_EQ(nullptr, weights);
}

TEST(CircleKernel, NotANumber_IsOneEmptyCell) {
    const CircleKernel kernel = libraryKernel(std::nanf(""));
    EXPECT_EQ(1, kernel.side);
    EXPECT_EQ(std::vector<uint8_t>{0}, kernel.weights);
}

TEST(CircleKernel, EveryRadius_MatchesTheLiteralForm) {
    for (int eighth = -12; eighth <= 110 * 8; ++eighth) {
        const float radius = static_cast<float>(eighth) / 8.0F + static_cast<float>(eighth % 5) * 0.013F;
        SCOPED_TRACE("radius " + std::to_string(radius));
        const CircleKernel expected = vorel_test::literal::circleKernel(radius);
        const CircleKernel actual = libraryKernel(radius);
        ASSERT_EQ(expected.side, actual.side);
        ASSERT_EQ(expected.weights, actual.weights);
    }
}

}  // namespace
