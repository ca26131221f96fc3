#include "ops/dilate/disc_shape.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdlib>
#include <limits>
#include <memory>
#include <string>
#include <vector>

#include "tests/support/literal_cores.h"
#include "voreleffect/voreleffect.h"

namespace {

using VFontEffect::internal::DiscShape;

/// The weights of the row `dy` below the middle.
std::vector<uint8_t> rowOf(const DiscShape& disc, int dy) {
    std::vector<uint8_t> row(static_cast<size_t>(2 * disc.reach + 1));
    for (int x = 0; x <= 2 * disc.reach; ++x) {
        const int dx = std::abs(x - disc.reach);
        uint8_t& weight = row[static_cast<size_t>(x)];
        if (dx <= disc.flatReach[dy]) {
            weight = 255;
        } else if (dx <= disc.outerReach[dy]) {
            const int cell = disc.rimStart[dy] + dx - disc.flatReach[dy] - 1;
            weight = static_cast<uint8_t>(255 - disc.rimDeficit[cell]);
        }
    }
    return row;
}

void expectRows(const DiscShape& disc, int side, const uint8_t* weights) {
    ASSERT_EQ(side, 2 * disc.reach + 1);
    for (int dy = -disc.reach; dy <= disc.reach; ++dy) {
        const uint8_t* const row = weights + (disc.reach + dy) * side;
        ASSERT_EQ(std::vector<uint8_t>(row, row + side), rowOf(disc, std::abs(dy))) << "row " << dy;
    }
}

TEST(DiscShape, RadiusTwo_HasItsRowsWrittenOut) {
    const DiscShape disc(2.0F);
    ASSERT_EQ(2, disc.reach);
    EXPECT_EQ((std::vector<uint8_t>{255, 255, 255, 255, 255}), rowOf(disc, 0));
    EXPECT_EQ((std::vector<uint8_t>{195, 255, 255, 255, 195}), rowOf(disc, 1));
    EXPECT_EQ((std::vector<uint8_t>{44, 195, 255, 195, 44}), rowOf(disc, 2));
}

TEST(DiscShape, EveryQuarterOfARadius_IsTheKernelOfTheStroke) {
    for (int quarter = -4; quarter <= 256 * 4; ++quarter) {
        const float radius = static_cast<float>(quarter) / 4.0F;
        SCOPED_TRACE("radius " + std::to_string(radius));
        unsigned char* weights = nullptr;
        const int side = VFontEffect::makeCircleKernel(&weights, radius);
        const std::unique_ptr<unsigned char, void (*)(void*)> owned(weights, std::free);
        expectRows(DiscShape(radius), side, weights);
        if (HasFatalFailure()) return;
    }
}

TEST(DiscShape, SomeRadiiToTheLargest_MatchTheLiteralForm) {
    for (float radius = 0.0F; radius <= 256.0F; radius += 5.3125F) {
        SCOPED_TRACE("radius " + std::to_string(radius));
        const auto expected = vorel_test::literal::circleKernel(radius);
        expectRows(DiscShape(radius), expected.side, expected.weights.data());
        if (HasFatalFailure()) return;
    }
    const auto largest = vorel_test::literal::circleKernel(256.0F);
    expectRows(DiscShape(256.0F), largest.side, largest.weights.data());
}

TEST(DiscShape, RowsOnlyShrink) {
    for (int eighth = 0; eighth <= 256 * 8; ++eighth) {
        const DiscShape disc(static_cast<float>(eighth) / 8.0F);
        for (int dy = 1; dy <= disc.reach; ++dy) {
            ASSERT_LE(disc.flatReach[dy], disc.flatReach[dy - 1]) << eighth;
            ASSERT_LE(disc.outerReach[dy], disc.outerReach[dy - 1]) << eighth;
            ASSERT_LE(disc.flatReach[dy], disc.outerReach[dy]) << eighth;
        }
        const int last = disc.reach;
        const int cells = disc.rimStart[last] + disc.outerReach[last] - disc.flatReach[last];
        ASSERT_LE(cells, DiscShape::kMostRimCells) << eighth;
    }
}

TEST(DiscShape, RadiiOutOfProportion_HaveNone) {
    const float infinity = std::numeric_limits<float>::infinity();
    for (float radius : {-1.5F, -40.0F, 256.5F, 1000.0F, 1e9F, infinity, -infinity})
        EXPECT_FALSE(DiscShape(radius)) << radius;
    EXPECT_TRUE(DiscShape(256.0F));
    EXPECT_TRUE(DiscShape(-0.5F));
}

TEST(DiscShape, NotANumber_IsOneEmptyCell) {
    const DiscShape disc(std::nanf(""));
    EXPECT_EQ(0, disc.reach);
    EXPECT_EQ(std::vector<uint8_t>{0}, rowOf(disc, 0));
}

}  // namespace
