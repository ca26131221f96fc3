#include "ops/grow/growth_plan.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/mask_gallery.h"
#include "tests/support/plans.h"

/// Growth by its definition, pass after pass, with margins and with a frame of the source's own.
namespace {

using namespace vorel_test;
using VFontEffect::internal::GrowthInput;
using VFontEffect::internal::kAsIs;
using VFontEffect::internal::kInverse;

/// A picture with a frame of one pixel around what grows.
struct Framed {
    int64_t width;  // frame included
    int64_t height;
    std::vector<int> values;

    int& at(int64_t x, int64_t y) { return values[static_cast<size_t>(y * width + x)]; }
};

Framed framedSource(const GrowthInput& input) {
    const int64_t around = input.margin + 1;
    const auto& source = input.source;
    Framed framed = {source.width + 2 * around, source.height + 2 * around, {}};
    framed.values.assign(static_cast<size_t>(framed.width * framed.height), source.invertMask);
    for (int64_t y = 0; y < source.height; ++y) {
        for (int64_t x = 0; x < source.width; ++x)
            framed.at(x + around, y + around) = source.start[y * source.stride + x] ^ source.invertMask;
    }
    return framed;
}

/// Each pass: a quarter of the 3 x 3 sum, at most 255. From the second one on the frame beside the rows
/// counts as empty, or full in the inverse.
std::vector<uint8_t> definedGrowth(const GrowthInput& input) {
    Framed framed = framedSource(input);
    const uint8_t invertMask = input.source.invertMask;
    for (int pass = 0; pass < input.passes; ++pass) {
        Framed next = framed;
        for (int64_t y = 1; y < framed.height - 1; ++y) {
            for (int64_t x = 1; x < framed.width - 1; ++x) {
                int sum = 0;
                for (int64_t i = 0; i < 9; ++i)
                    sum += framed.at(x - 1 + i % 3, y - 1 + i / 3);
                next.at(x, y) = std::min(sum / 4, 255);
            }
            next.at(0, y) = next.at(framed.width - 1, y) = invertMask;
        }
        framed = next;
    }
    std::vector<uint8_t> inside;
    for (int64_t y = 1; y < framed.height - 1; ++y) {
        for (int64_t x = 1; x < framed.width - 1; ++x)
            inside.push_back(static_cast<uint8_t>(framed.at(x, y) ^ invertMask));
    }
    return inside;
}

TEST(GrowthPlan, OfAnyMarginPassesAndParts_IsTheDefinedOne) {
    forSeeds(0, 600, [](Random& random) {
        const int stride = random.between(3, 90);
        const int width = random.between(3, stride);
        const int height = random.between(3, 40);
        const auto mask = randomMask(random, stride, height);
        const uint8_t invertMask = random.chance(50) ? kAsIs : kInverse;
        const GrowthInput input = {{mask.bytes.data(), stride, width, height, invertMask},
                                   random.between(-1, 20),
                                   random.between(1, 9)};
        const bool whole = random.chance(50);
        const WindowSize parts = {whole ? 0 : random.between(1, 60), random.between(1, 40)};
        ASSERT_EQ(grown(input, parts), definedGrowth(input))
            << width << " x " << height << ", margin " << input.margin << ", passes " << input.passes
            << ", parts " << parts.width << " x " << parts.height;
    });
}

}  // namespace
