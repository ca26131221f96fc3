#include "ops/blur/blur_plan.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <map>
#include <utility>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/guarded.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

/// The blur's edges: every radius, divisions at the multiples of every total, masks of all widths that
/// touch the ends of their memory.
namespace {

using namespace vorel_test;
using literal::Box;
using literal::Mask;
using VFontEffect::VFBitmap;
using VFontEffect::VFECore;
using VFontEffect::VFInnerGlow;
using VFontEffect::VFInnerGlowProperty;
using VFontEffect::VFInnerShadow;
using VFontEffect::VFInnerShadowProperty;
using VFontEffect::VFOuterGlow;
using VFontEffect::VFOuterGlowProperty;
using VFontEffect::VFOuterShadow;
using VFontEffect::VFOuterShadowProperty;
using VFontEffect::VFRect;
using VFontEffect::internal::BlurWeights;
using VFontEffect::internal::gaussianOf100;
using VFontEffect::internal::gaussianOf128;
using VFontEffect::internal::inverseAbove;
using VFontEffect::internal::NarrowDivision;
using VFontEffect::internal::narrowDivision;

constexpr int kLargestRadius = 256;

// --- Division ---------------------------------------------------------------------------------------

/// The quotient as the blur takes it.
uint32_t quotient(uint32_t sum, float inverse) {
    return static_cast<uint32_t>(static_cast<float>(sum) * inverse);
}

/// Products by a positive constant and truncation keep the order of their arguments: what holds at both
/// sides of each multiple of the total holds for all sums between.
void expectWholeQuotients(uint32_t total, int radius) {
    const float inverse = inverseAbove(total);
    for (uint32_t n = 1; n <= 256; ++n) {
        ASSERT_EQ(n - 1, quotient(n * total - 1, inverse)) << "radius " << radius;
        ASSERT_EQ(n - 1, quotient((n - 1) * total, inverse)) << "radius " << radius;
    }
}

TEST(BlurDivision, OfEveryRadius_IsExactAroundEveryMultipleOfTheTotal) {
    for (int radius = 0; radius <= kLargestRadius; ++radius) {
        expectWholeQuotients(gaussianOf100(radius).total, radius);
        // The largest glow has a radius of 231: 0.9 times 257.
        if (radius <= 231) expectWholeQuotients(gaussianOf128(radius).total, radius);
    }
}

/// The bound of a total by its radius, and the one under which the reciprocal divides exactly.
TEST(BlurDivision, TotalsOfEveryRadius_StayBelowTheirBound) {
    using VFontEffect::internal::kLargestTotal;
    using VFontEffect::internal::totalBound;
    for (int radius = 0; radius <= kLargestRadius; ++radius) {
        EXPECT_LE(gaussianOf100(radius).total, totalBound(100, static_cast<uint32_t>(radius)));
        EXPECT_LE(gaussianOf128(radius).total, totalBound(128, static_cast<uint32_t>(radius)));
    }
    for (uint32_t total = kLargestTotal - 2000; total <= kLargestTotal; ++total)
        expectWholeQuotients(total, static_cast<int>(total));
}

TEST(BlurDivision, OfSomeRadii_IsExactForEverySum) {
    for (const int radius : {4, 17, 100, 231}) {
        const uint32_t total = gaussianOf128(radius).total;
        const float inverse = inverseAbove(total);
        for (uint32_t sum = 0; sum < 256 * total; ++sum)
            ASSERT_EQ(sum / total, quotient(sum, inverse)) << sum << ", radius " << radius;
    }
}

TEST(BlurDivision, In16Bits_IsExactForEveryDivisorAndSum) {
    for (uint32_t divisor = 128; divisor <= 255; ++divisor) {
        const NarrowDivision division = narrowDivision(divisor);
        for (uint32_t sum = 0; sum < 256 * divisor; ++sum) {
            const uint32_t raised = (sum + division.start) & 0xFFFF;
            const uint32_t high = raised * division.multiplier >> 16;
            ASSERT_EQ(sum / divisor, high >> VFontEffect::internal::kNarrowShift)
                << sum << " by " << divisor;
        }
    }
}

// --- Blurs by their definition, in the part that a picture of the mask's size shows -----------------

int64_t weightOf(const std::vector<uint32_t>& weights, int64_t distance) {
    const auto k = static_cast<size_t>(distance < 0 ? -distance : distance);
    return k < weights.size() ? weights[k] : 0;
}

/// A blur of a box of the mask; what lies outside of it is 0. Taps there add nothing and are left out,
/// so that large radii can be tried by the hundred.
class DefinedBlur {
  public:
    DefinedBlur(const Mask& mask, Box box, std::vector<uint32_t> weights)
        : mMask(mask), mBox(box), mWeights(std::move(weights)) {
        mTotal = mWeights[0];
        for (size_t i = 1; i < mWeights.size(); ++i)
            mTotal += 2 * mWeights[i];
    }

    /// The columns, then the rows; as the outer shadow.
    std::vector<int> downThenAcross() const {
        std::vector<int> blurred;
        for (int y = 0; y < mMask.height; ++y) {
            std::vector<int64_t> row;
            for (int x = mBox.left; x < mBox.right; ++x) {
                int64_t sum = 0;
                for (int tap = mBox.top; tap < mBox.bottom; ++tap)
                    sum += coverage(x, tap) * weightOf(mWeights, tap - y);
                row.push_back(sum / mTotal);
            }
            for (int x = 0; x < mMask.width; ++x) {
                int64_t sum = 0;
                for (int tap = mBox.left; tap < mBox.right; ++tap)
                    sum += row[static_cast<size_t>(tap - mBox.left)] * weightOf(mWeights, tap - x);
                blurred.push_back(static_cast<int>(sum / mTotal));
            }
        }
        return blurred;
    }

    /// The inverse's rows, then its columns; as the inner shadow, which is not moved. Outside the box 0.
    std::vector<int> inverseAcrossThenDown() const {
        std::vector<int> blurred(mMask.bytes.size(), 0);
        for (int x = mBox.left; x < mBox.right; ++x) {
            std::vector<int64_t> column;
            for (int y = mBox.top; y < mBox.bottom; ++y) {
                int64_t sum = 0;
                for (int tap = mBox.left; tap < mBox.right; ++tap)
                    sum += coverage(tap, y) * weightOf(mWeights, tap - x);
                column.push_back((255 * mTotal - sum) / mTotal);
            }
            for (int y = mBox.top; y < mBox.bottom; ++y) {
                int64_t sum = 255 * mTotal;
                for (int tap = mBox.top; tap < mBox.bottom; ++tap) {
                    const int64_t missing = 255 - column[static_cast<size_t>(tap - mBox.top)];
                    sum -= missing * weightOf(mWeights, tap - y);
                }
                blurred[static_cast<size_t>(y * mMask.width + x)] = static_cast<int>(sum / mTotal);
            }
        }
        return blurred;
    }

  private:
    int64_t coverage(int x, int y) const {
        return mMask.bytes[static_cast<size_t>(y * mMask.width + x)];
    }

    const Mask& mMask;
    Box mBox;
    std::vector<uint32_t> mWeights;
    int64_t mTotal;
};

template <class Core, class Record>
std::vector<int> shadowAlpha(const Scene& scene, int size) {
    const auto core =
        coreOf<Core, Record>(0.0F, 0.0F, static_cast<float>(size), uint32_t{0xFF000000}, 1.0F);
    return alphaOf(painted(*core, scene).dst);
}

Mask alternatingMask(Random& random, int width, int height) {
    Mask mask = filledMask(width, height, 0);
    const int period = random.between(1, 5);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            if ((x + y) / period % 2 == 0) mask.bytes[static_cast<size_t>(y * width + x)] = 255;
        }
    }
    return mask;
}

/// Masks that drive sums to their ends: full ones, alternating ones, noise, and pieces that touch edges.
Mask extremeMask(Random& random, int width, int height) {
    switch (random.between(0, 3)) {
        case 0:
            return filledMask(width, height, 255);
        case 1:
            return alternatingMask(random, width, height);
        default:
            return randomMask(random, width, height);
    }
}

Scene extremeScene(Random& random, int width, int height) {
    const Mask mask = extremeMask(random, width, height);
    return sceneOf(mask, random.chance(60) ? wholeBox(mask) : randomBox(random, mask));
}

TEST(Blur, OfEveryRadiusAndWidth_IsTheDefinedOne) {
    for (int radius = 0; radius <= kLargestRadius; ++radius) {
        const std::vector<uint32_t> weights = literal::shadowWeights(radius);
        // Widths 1 to 130, each with some of the radii.
        forSeeds(static_cast<uint64_t>(radius) * 10, 4, [&](Random& random) {
            const int width = 1 + (radius * 7 + random.between(0, 3) * 33) % 130;
            const Scene scene = extremeScene(random, width, random.between(1, 40));
            const DefinedBlur blur(scene.mask, scene.text, weights);
            ASSERT_EQ(blur.downThenAcross(),
                      (shadowAlpha<VFOuterShadow, VFOuterShadowProperty>(scene, radius)))
                << describe(scene) << ", radius " << radius;
            ASSERT_EQ(blur.inverseAcrossThenDown(),
                      (shadowAlpha<VFInnerShadow, VFInnerShadowProperty>(scene, radius)))
                << describe(scene) << ", radius " << radius;
        });
        if (HasFatalFailure()) return;
    }
}

TEST(Blur, OfSmallRadiiAndAllWidths_IsTheDefinedOne) {
    for (int width = 1; width <= 130; ++width) {
        Random random(static_cast<uint64_t>(width));
        for (int radius = 0; radius <= 9; ++radius) {
            const Scene scene = extremeScene(random, width, random.between(1, 70));
            const DefinedBlur blur(scene.mask, scene.text, literal::shadowWeights(radius));
            ASSERT_EQ(blur.downThenAcross(),
                      (shadowAlpha<VFOuterShadow, VFOuterShadowProperty>(scene, radius)))
                << describe(scene) << ", radius " << radius;
        }
    }
}

TEST(Blur, OfTallAndWideMasks_IsTheDefinedOne) {
    // More rows than the passes keep at a time, and coverage far apart.
    forSeeds(4000, 24, [&](Random& random) {
        const bool tall = random.chance(50);
        const int length = random.between(200, 700);
        Mask mask = filledMask(tall ? 20 : length, tall ? length : 20, 0);
        for (int i = random.between(0, 12); i > 0; --i) {
            const auto at =
                static_cast<size_t>(random.between(0, static_cast<int>(mask.bytes.size()) - 1));
            mask.bytes[at] = random.byte();
        }
        const Scene scene = sceneOf(mask);
        const int radius = random.between(0, 60);
        const DefinedBlur blur(scene.mask, scene.text, literal::shadowWeights(radius));
        ASSERT_EQ(blur.downThenAcross(),
                  (shadowAlpha<VFOuterShadow, VFOuterShadowProperty>(scene, radius)));
        ASSERT_EQ(blur.inverseAcrossThenDown(),
                  (shadowAlpha<VFInnerShadow, VFInnerShadowProperty>(scene, radius)));
    });
}

// --- Whole cores ------------------------------------------------------------------------------------

/// Both shadows of a scene, and what the literal form makes of them.
void expectShadowsLikeTheLiteralForm(const Scene& scene, float angle, float distance, float size,
                                     uint32_t color) {
    EXPECT_TRUE(paintsLike(
        *coreOf<VFOuterShadow, VFOuterShadowProperty>(angle, distance, size, color, 1.0F), scene,
        [&](Scene& expected) {
            literal::paintOuterShadow(expected.dst, expected.mask, expected.text, angle, distance, size,
                                      color);
        }))
        << describe(scene) << ", angle " << angle << ", distance " << distance << ", size " << size;
    const VFInnerShadowProperty reduced(angle, distance, size, color, 1.0F);
    EXPECT_TRUE(paintsLike(
        *coreOf<VFInnerShadow, VFInnerShadowProperty>(angle, distance, size, color, 1.0F), scene,
        [&](Scene& expected) {
            literal::paintInnerShadow(expected.dst, expected.mask, expected.text, reduced.mAngle,
                                      distance, size, color);
        }))
        << describe(scene) << ", angle " << angle << ", distance " << distance << ", size " << size;
}

TEST(Blur, ShadowsMovedByEveryDistance_AreThoseOfTheLiteralForm) {
    // Every place that a vector of results can have to the columns that hold coverage.
    Random random(7000);
    for (const int length : {64, 100, 130, 200}) {
        for (const bool wide : {true, false}) {
            const Mask mask = randomMask(random, wide ? length : 8, wide ? 8 : length);
            const Scene scene = sceneOf(mask);
            for (int moved = -140; moved <= 140; ++moved) {
                const float angle = (wide ? 0.0F : 90.0F) + (moved < 0 ? 0.0F : 180.0F);
                expectShadowsLikeTheLiteralForm(scene, angle, std::abs(static_cast<float>(moved)),
                                                static_cast<float>((moved + 140) % 5), kRed);
                if (HasFailure()) return;
            }
        }
    }
}

TEST(Blur, OfASolidSquare_ReachesTheLargestSumsInBothPasses) {
    const Mask solid = filledMask(230, 230, 255);
    const Scene scene = sceneOf(solid);
    for (const float size : {35.0F, 64.0F, 100.0F})
        expectShadowsLikeTheLiteralForm(scene, 0.0F, 0.0F, size, kRed);
}

TEST(Blur, ShadowsThatTheDestinationCuts_AreThoseOfTheLiteralForm) {
    forSeeds(5000, 250, [&](Random& random) {
        Scene scene = extremeScene(random, random.between(1, 90), random.between(1, 40));
        scene.dst = randomPicture(random, random.between(1, 150), random.between(1, 60));
        const float angle = random.real(0, 360);
        const float distance = random.real(0, 60);
        const float size = random.real(0, 30);
        const uint32_t color = randomPremultiplied(random);
        expectShadowsLikeTheLiteralForm(scene, angle, distance, size, color);
    });
}

TEST(Blur, GlowsThatTheDestinationCuts_AreThoseOfTheLiteralForm) {
    forSeeds(6000, 250, [&](Random& random) {
        Scene scene = extremeScene(random, random.between(1, 70), random.between(1, 30));
        scene.dst = randomPicture(random, random.between(1, 160), random.between(1, 80));
        const float size = random.chance(30) ? random.real(0, 3) : random.real(0, 30);
        const auto stops = randomStops(random, random.between(0, 3));
        const uint32_t color = randomStraight(random);
        auto array = libraryStops(stops);
        const auto count = static_cast<int>(array.size());
        EXPECT_TRUE(paintsLike(
            *coreOf<VFOuterGlow, VFOuterGlowProperty>(size, color, 1.0F, count, array.data()), scene,
            [&](Scene& expected) {
                literal::paintOuterGlow(expected.dst, expected.mask, expected.text, size, color, stops);
            }));
        EXPECT_TRUE(paintsLike(
            *coreOf<VFInnerGlow, VFInnerGlowProperty>(size, color, 1.0F, count, array.data()), scene,
            [&](Scene& expected) {
                literal::paintInnerGlow(expected.dst, expected.mask, expected.text, size, color, stops);
            }))
            << "size " << size;
    });
}

TEST(Blur, GlowsOfTheLargestSizes_AreThoseOfTheLiteralForm) {
    const Scene scene = sceneOf(discMask(33, 12, 15.0F, 5.0F, 8.0F, true), {3, 1, 31, 11});
    // Painted once for all levels: it takes longer than all else.
    static std::map<float, literal::Picture> outer;
    static std::map<float, literal::Picture> inner;
    for (const float size : {130.0F, 201.5F, 256.0F}) {
        if (outer.count(size) == 0) {
            outer[size] = inner[size] = scene.dst;
            literal::paintOuterGlow(outer[size], scene.mask, scene.text, size, kRed, {});
            literal::paintInnerGlow(inner[size], scene.mask, scene.text, size, kRed, {});
        }
        EXPECT_TRUE(paintsLike(*coreOf<VFOuterGlow, VFOuterGlowProperty>(size, kRed, 1.0F, 0, nullptr),
                               scene, [&](Scene& expected) { expected.dst = outer[size]; }));
        EXPECT_TRUE(paintsLike(*coreOf<VFInnerGlow, VFInnerGlowProperty>(size, kRed, 1.0F, 0, nullptr),
                               scene, [&](Scene& expected) { expected.dst = inner[size]; }));
    }
}

// --- Memory -----------------------------------------------------------------------------------------

/// Paints from a mask and into a destination that inaccessible pages enclose.
void paintBetweenGuards(VFECore& core, const Scene& scene, Edge edge) {
    GuardedBitmap mask(scene.mask.width, scene.mask.height, 1, edge);
    GuardedBitmap dst(scene.mask.width, scene.mask.height, 4, edge);
    std::copy(scene.mask.bytes.begin(), scene.mask.bytes.end(), mask.pixels().begin());
    VFRect text(scene.text.left, scene.text.top, scene.text.right, scene.text.bottom);
    VFECore::ParamPostProcessing params = {dst.bitmap(), mask.bitmap(), &text, 0, nullptr};
    core.doPostProcessing(&params);
    const Scene expected = painted(core, scene);
    EXPECT_TRUE(std::equal(dst.pixels().begin(), dst.pixels().end(), expected.dst.bytes.begin()))
        << describe(scene);
}

TEST(Blur, NeverReadsOrWritesBeyondMaskAndDestination) {
    for (int width = 1; width <= 130; ++width) {
        Random random(static_cast<uint64_t>(width) + 77);
        Mask mask = noiseMask(random, width, random.between(1, 9), 20);
        const Scene scene = sceneOf(mask);
        // Up to 12 by dot products at every level, above 90 by differences where there are no dot
        // products of four.
        const auto size =
            static_cast<float>(random.chance(70) ? random.between(0, 12) : random.between(91, 110));
        for (const Edge edge : {Edge::kStart, Edge::kEnd}) {
            paintBetweenGuards(
                *coreOf<VFOuterShadow, VFOuterShadowProperty>(30.0F, 2.0F, size, kRed, 1.0F), scene,
                edge);
            paintBetweenGuards(
                *coreOf<VFInnerShadow, VFInnerShadowProperty>(30.0F, 2.0F, size, kRed, 1.0F), scene,
                edge);
            paintBetweenGuards(*coreOf<VFOuterGlow, VFOuterGlowProperty>(size, kRed, 1.0F, 0, nullptr),
                               scene, edge);
            paintBetweenGuards(*coreOf<VFInnerGlow, VFInnerGlowProperty>(size, kRed, 1.0F, 0, nullptr),
                               scene, edge);
        }
    }
}

}  // namespace
