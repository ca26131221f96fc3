#include "ops/dilate/dilation_plan.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <sstream>
#include <string>
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

TEST(DilationPlan, ReachesOnePixelFartherThanTheDisc) {
    const CoverageRows source = {nullptr, 7, 5, 3, kAsIs};
    const DiscShape disc(4.0F);
    EXPECT_EQ(DilationPlan::reached({source, disc}), (Box{-5, -5, 10, 8}));
}

}  // namespace
