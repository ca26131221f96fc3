#include "ops/dilate/dilation_plan.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/mask_gallery.h"
#include "tests/support/plans.h"

/// Dilations by their definition: any part, at any place to the source, in all strategies.
namespace {

using namespace vorel_test;
using VFontEffect::internal::Box;
using VFontEffect::internal::CoverageRows;
using VFontEffect::internal::DilationPlan;
using VFontEffect::internal::DiscShape;
using VFontEffect::internal::discWeight;
using VFontEffect::internal::kAsIs;
using VFontEffect::internal::kInverse;

/// The source's value; one pixel around it is empty, or full in the inverse; beyond there is nothing.
int coverageAt(const CoverageRows& source, int64_t x, int64_t y) {
    if (x < -1 || y < -1 || x > source.width || y > source.height) return 0;
    const bool inside = x >= 0 && y >= 0 && x < source.width && y < source.height;
    return (inside ? source.start[y * source.stride + x] : 0) ^ source.invertMask;
}

/// The largest c - (255 - weight) under the disc around a pixel.
uint8_t definedDilation(const CoverageRows& source, float radius, int64_t x, int64_t y) {
    const int64_t reach = VFontEffect::internal::discReach(radius);
    int largest = 0;
    for (int64_t dy = -reach; dy <= reach; ++dy) {
        for (int64_t dx = -reach; dx <= reach; ++dx) {
            const int deficit = 255 - discWeight(std::abs(dx), std::abs(dy), radius);
            largest = std::max(largest, coverageAt(source, x + dx, y + dy) - deficit);
        }
    }
    return static_cast<uint8_t>(largest);
}

struct DilationCase {
    CoverageRows source;
    float radius;
    Box part;
    WindowSize windows;
};

std::string describe(const DilationCase& which) {
    std::ostringstream text;
    text << which.source.width << " x " << which.source.height << ", radius " << which.radius
         << ", part " << which.part.left << " " << which.part.top << " " << which.part.right << " "
         << which.part.bottom << ", mask " << int{which.source.invertMask} << ", windows "
         << which.windows.width << " x " << which.windows.height;
    return text.str();
}

void expectDefined(const DilationCase& which) {
    const DiscShape disc(which.radius);
    CoverageRows inverse = which.source;
    inverse.invertMask ^= kInverse;
    std::vector<uint8_t> expected;
    std::vector<uint8_t> smaller;
    for (int64_t y = which.part.top; y < which.part.bottom; ++y) {
        for (int64_t x = which.part.left; x < which.part.right; ++x) {
            expected.push_back(definedDilation(which.source, which.radius, x, y));
            smaller.push_back(std::min(expected.back(), definedDilation(inverse, which.radius, x, y)));
        }
    }
    ASSERT_EQ(dilated(which.source, disc, which.part, false, which.windows), expected)
        << describe(which);
    ASSERT_EQ(dilated(which.source, disc, which.part, true, which.windows), smaller) << describe(which);
}

TEST(DilationPlan, OfEveryReach_IsTheDefinedOne) {
    // Single cells up to 2, then spreading, then tiles: at most from 17 on.
    for (int reach = 0; reach <= 20; ++reach) {
        forSeeds(static_cast<uint64_t>(reach) * 50, 12, [&](Random& random) {
            const float radius = static_cast<float>(reach) + random.real(-0.5F, 0.49F);
            const int stride = random.between(1, 60);
            const int width = random.between(1, stride);
            const int height = random.between(1, 40);
            const auto mask = randomMask(random, stride, height);
            const Box reached = {-reach - 1, -reach - 1, width + reach + 1, height + reach + 1};
            const int left =
                random.between(static_cast<int>(reached.left), static_cast<int>(reached.right) - 1);
            const int top =
                random.between(static_cast<int>(reached.top), static_cast<int>(reached.bottom) - 1);
            const Box part = random.chance(40)
                                 ? reached
                                 : Box{left, top, random.between(left + 1, width + reach + 1),
                                       random.between(top + 1, height + reach + 1)};
            const uint8_t invertMask = random.chance(50) ? kAsIs : kInverse;
            const WindowSize windows = {random.between(1, 40), random.between(1, 50)};
            expectDefined({{mask.bytes.data(), stride, width, height, invertMask},
                           radius,
                           part,
                           random.chance(50) ? windows : WindowSize{}});
        });
        if (HasFatalFailure()) return;
    }
}

/// A single pixel grows to the disc itself: each of its cells is found, in whichever square or sector.
void expectDiscBySquares(float radius) {
    const uint8_t pixel = 255;
    const DiscShape disc(radius);
    const Box part = expanded(Box{0, 0, 1, 1}, disc.reach);
    const auto values = dilated({&pixel, 1, 1, 1, kAsIs}, disc, part, false, {}, LargeDiscs::bySquares);
    ASSERT_EQ(values.size(), static_cast<size_t>(part.width() * part.height()));
    size_t i = 0;
    for (int64_t y = part.top; y < part.bottom; ++y) {
        for (int64_t x = part.left; x < part.right; ++x) {
            ASSERT_EQ(values[i++], discWeight(std::abs(x), std::abs(y), radius))
                << "radius " << radius << ", cell " << x << " " << y;
        }
    }
}

TEST(DilationPlan, Squares_HaveEveryCellOfEveryDisc) {
    for (int reach = 9; reach <= DiscShape::kLongestReach; ++reach) {
        forSeeds(static_cast<uint64_t>(reach) * 10, reach < 60 ? 6 : 1, [&](Random& random) {
            // Discs whose last rows are full or of the rim alone.
            expectDiscBySquares(std::min(static_cast<float>(reach) + random.real(-0.5F, 0.49F), 256.0F));
        });
        if (HasFatalFailure()) return;
    }
}

TEST(DilationPlan, Squares_LookAtARimThatLacksOneTo255) {
    // Cells at a distance of 25 weigh 254.
    const DiscShape disc(25.0F - 1.0F / 255.0F);
    literal::Mask mask = filledMask(101, 101, 253);
    mask.bytes[50 * 101 + 50] = 255;
    const CoverageRows source = {mask.bytes.data(), 101, 101, 101, kAsIs};
    const auto values = dilated(source, disc, wholeOf(source), false, {}, LargeDiscs::bySquares);
    constexpr std::pair<int, int> kCells[] = {{25, 0},   {0, -25},  {20, 15},
                                              {-15, 20}, {-24, -7}, {7, -24}};
    for (const auto& [x, y] : kCells)
        EXPECT_EQ(values.at(static_cast<size_t>((50 + y) * 101 + 50 + x)), 254) << x << " " << y;
}

/// Of an area of any size a few pixels anywhere: of a dilation, or of the smaller one of that and the
/// inverse's, of which often just one gives up.
void expectDefinedHereAndThere(Random& random, const CoverageRows& source, float radius,
                               LargeDiscs largeDiscs) {
    const DiscShape disc(radius);
    const Box part = DilationPlan::reached({source, disc});
    const WindowSize windows =
        random.chance(50) ? WindowSize{random.between(20, 300), random.between(20, 100)} : WindowSize{};
    const bool andInverse = random.chance(50);
    CoverageRows inverse = source;
    inverse.invertMask ^= kInverse;
    const auto values = dilated(source, disc, part, andInverse, windows, largeDiscs);
    for (int i = 0; i < 40; ++i) {
        const int64_t x = random.between(0, static_cast<int>(part.width()) - 1);
        const int64_t y = random.between(0, static_cast<int>(part.height()) - 1);
        uint8_t expected = definedDilation(source, radius, part.left + x, part.top + y);
        if (andInverse) {
            expected = std::min(expected, definedDilation(inverse, radius, part.left + x, part.top + y));
        }
        ASSERT_EQ(values.at(static_cast<size_t>(y * part.width() + x)), expected)
            << describe({source, radius, part, windows}) << ", with the inverse " << andInverse
            << ", at " << x << " " << y;
    }
}

TEST(DilationPlan, WhatTilesGiveUp_IsTheDefinedOne) {
    forSeeds(7000, 60, [&](Random& random) {
        const int width = random.between(20, 400);
        const int height = random.between(20, 300);
        const literal::Mask mask = unlikeText(random, width, height);
        const uint8_t invertMask = random.chance(50) ? kAsIs : kInverse;
        const CoverageRows source = {mask.bytes.data(), width, width, height, invertMask};
        const float radius = random.real(17.0F, 70.0F);
        expectDefinedHereAndThere(random, source, radius, LargeDiscs::bySquares);
        expectDefinedHereAndThere(random, source, radius, LargeDiscs::asTheyCome);
    });
}

TEST(DilationPlan, ReachesOnePixelFartherThanTheDisc) {
    const CoverageRows source = {nullptr, 7, 5, 3, kAsIs};
    const DiscShape disc(4.0F);
    EXPECT_EQ(DilationPlan::reached({source, disc}), (Box{-5, -5, 10, 8}));
}

}  // namespace
