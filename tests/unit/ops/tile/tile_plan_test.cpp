#include "ops/tile/tile_plan.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

#include "core/numeric.h"
#include "tests/support/core_compare.h"
#include "tests/support/plans.h"

/// Tiled patterns by their definition, at any place of any row.
namespace {

using namespace vorel_test;
using VFontEffect::internal::ColourView;
using VFontEffect::internal::TileAxis;

/// A channel of a pattern pixel, bytes A, R, G, B.
struct Pattern {
    int width;
    int height;
    std::vector<uint8_t> bytes;

    uint32_t at(int64_t x, int64_t y, int channel) const {
        return bytes[static_cast<size_t>((y * width + x) * 4 + channel)];
    }
};

/// Between four pattern pixels, by weights of up to 255 on each axis, shifted by 16; then times the
/// alpha that the opacity leaves.
uint32_t definedPixel(const Pattern& pattern, float scale, float opacity, int64_t x, int64_t y) {
    const auto columns = TileAxis(pattern.width, scale).at(x);
    const auto rows = TileAxis(pattern.height, scale).at(y);
    const auto sampled = [&](int channel) {
        const uint32_t above = pattern.at(columns.near, rows.near, channel) * columns.nearWeight +
                               pattern.at(columns.far, rows.near, channel) * columns.farWeight;
        const uint32_t below = pattern.at(columns.near, rows.far, channel) * columns.nearWeight +
                               pattern.at(columns.far, rows.far, channel) * columns.farWeight;
        return (above * rows.nearWeight + below * rows.farWeight) >> 16;
    };
    const float seen = static_cast<float>(sampled(0)) * opacity;
    const auto alpha = static_cast<uint32_t>(std::clamp(VFontEffect::internal::toInt(seen), 0, 255));
    const auto scaled = [&](int channel) { return ((sampled(channel) + 1) * alpha) >> 8; };
    return scaled(1) | scaled(2) << 8 | scaled(3) << 16 | alpha << 24;
}

TEST(TilePlan, OfAnyPattern_IsTheDefinedOne) {
    forSeeds(0, 200, [](Random& random) {
        Pattern pattern = {random.between(1, 20), random.between(1, 20), {}};
        for (int i = 0; i < 4 * pattern.width * pattern.height; ++i)
            pattern.bytes.push_back(random.chance(30) ? 255 : random.byte());
        const float scale = random.real(0.1F, 4.0F);
        const float opacity = random.chance(20) ? 1.0F : random.real(-0.2F, 1.5F);
        const int width = random.between(1, 100);
        const int height = random.between(1, 30);
        const ColourView view = {pattern.bytes.data(), pattern.width, pattern.height};
        std::vector<uint32_t> expected;
        for (int64_t y = 0; y < height; ++y) {
            for (int64_t x = 0; x < width; ++x)
                expected.push_back(definedPixel(pattern, scale, opacity, x, y));
        }
        ASSERT_EQ(tiled(view, scale, opacity, width, height), expected)
            << pattern.width << " x " << pattern.height << ", scale " << scale << ", opacity "
            << opacity;
    });
}

TEST(TilePlan, AxisOfAWholeScale_RepeatsItsPixels) {
    // Three pixels at twice their size: places 0, 0.5, 1, 1.5, 2, 2.5, of which a half weighs 127 of
    // 255.
    const TileAxis axis(3, 2.0F);
    EXPECT_EQ(axis.period(), 6);
    const TileAxis::Tap between = axis.at(5);
    EXPECT_EQ(between.near, 2);
    EXPECT_EQ(between.far, 0) << "the pixel beside the last one is the first";
    EXPECT_EQ(between.farWeight, 127U);
    EXPECT_EQ(between.nearWeight, 128U);
    EXPECT_EQ(axis.at(6).near, 0);
    EXPECT_EQ(axis.at(6).farWeight, 0U);
}

TEST(TilePlan, AxisOfABrokenScale_EndsWithItsTile) {
    // Seven pixels at two fifths of their size are 2.8 pixels, cut to 2: places 0 and 2.5, then 0 again.
    const TileAxis axis(7, 0.4F);
    EXPECT_EQ(axis.period(), 2);
    EXPECT_EQ(axis.at(1).near, 2);
    EXPECT_EQ(axis.at(1).far, 3);
    EXPECT_EQ(axis.at(1).farWeight, 127U);
    EXPECT_EQ(axis.at(2).near, 0);
    EXPECT_EQ(axis.at(2).farWeight, 0U);
    // Two pixels at 0.2 are less than one, which counts as one.
    EXPECT_EQ(TileAxis(2, 0.2F).period(), 1);
}

}  // namespace
