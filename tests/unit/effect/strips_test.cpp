#include "effect/strips.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <utility>
#include <vector>

#include "core/effect_types.h"
#include "effect/placement.h"
#include "tests/reliability/whole_looks.h"
#include "tests/support/bitmap_bytes.h"
#include "tests/support/core_compare.h"
#include "tests/support/float_states.h"
#include "tests/support/plans.h"

/// Effects that paint by turns paint what they do one after the other.
namespace {

using namespace vorel_test;
using namespace VFontEffect;
using VFontEffect::internal::RunBitmaps;

using Core = std::unique_ptr<VFECore>;

float randomSize(Random& random) {
    return random.chance(20) ? random.real(-2.0F, 1.0F) : random.real(0.0F, 24.0F);
}

/// One of each kind, with random records.
std::vector<Core> randomCores(Random& random) {
    auto stops = libraryStops(randomStops(random, random.between(2, 4)));
    VFGradient* const ramp = stops.data();
    const int count = static_cast<int>(stops.size());
    const int glowCount = random.chance(50) ? 0 : count;
    VFBitmap tile(3, 5, 4);
    std::generate_n(tile.mData, 60, [&] { return random.byte(); });
    const auto angle = [&] { return random.real(0.0F, 360.0F); };
    const auto far = [&] { return random.real(0.0F, 20.0F); };
    const auto scale = [&] { return random.real(0.0F, 2.0F); };
    std::vector<Core> cores;
    cores.push_back(coreOf<VFOuterShadow, VFOuterShadowProperty>(angle(), far(), randomSize(random),
                                                                 randomPremultiplied(random), 1.0F));
    cores.push_back(coreOf<VFInnerShadow, VFInnerShadowProperty>(angle(), far(), randomSize(random),
                                                                 randomPremultiplied(random), 1.0F));
    cores.push_back(coreOf<VFOuterGlow, VFOuterGlowProperty>(randomSize(random), randomStraight(random),
                                                             1.0F, glowCount, ramp));
    cores.push_back(coreOf<VFInnerGlow, VFInnerGlowProperty>(randomSize(random), randomStraight(random),
                                                             1.0F, glowCount, ramp));
    cores.push_back(
        coreOf<VFLinearGradient, VFLinearGradientProperty>(angle(), scale(), 1.0F, count, ramp));
    cores.push_back(
        coreOf<VFRadialGradient, VFRadialGradientProperty>(0.0F, scale(), 1.0F, count, ramp));
    cores.push_back(coreOf<VFStroke, VFStrokeProperty>(randomSize(random), randomPremultiplied(random),
                                                       1.0F, 0, random.between(0, 3)));
    cores.push_back(coreOf<VFPattern, VFPatternProperty>(&tile, scale(), random.real(0.0F, 1.0F)));
    cores.push_back(coreOf<VFText, VFTextProperty>(randomPremultiplied(random), 1.0F));
    return cores;
}

/// Some of them, in any order.
std::vector<VFECore*> shuffled(Random& random, const std::vector<Core>& cores) {
    std::vector<VFECore*> order;
    for (const Core& core : cores) {
        if (random.chance(70))
            order.insert(order.begin() + random.between(0, static_cast<int>(order.size())), core.get());
    }
    return order;
}

/// A run's bitmaps, by value.
struct Layers {
    Layers(const Scene& scene, const literal::Picture& outerPixels)
        : mask(bitmapOf(scene.mask)),
          destination(bitmapOf(scene.dst)),
          outer(bitmapOf(outerPixels)),
          text(scene.text.left, scene.text.top, scene.text.right, scene.text.bottom),
          isLayered(scene.useOuterLayer) {}

    RunBitmaps run() { return {&destination, isLayered ? &outer : nullptr, &mask, &text}; }

    VFBitmap mask;
    VFBitmap destination;
    VFBitmap outer;
    VFRect text;
    bool isLayered;
};

void paintInTurn(const std::vector<VFECore*>& cores, Layers& layers) {
    for (VFECore* core : cores) {
        VFECore::ParamPostProcessing params = {&layers.destination, &layers.mask, &layers.text, 0,
                                               nullptr};
        if (layers.isLayered) {
            params.useOuterLayer = 1;
            const internal::Placement& placement = internal::placementOf(*core);
            if (placement.inOuterLayer) params.dstBitmap = &layers.outer;
            if (placement.inOuterLayer && placement.inDestination)
                params.subDstBitmap = &layers.destination;
        }
        core->doPostProcessing(&params);
    }
}

TEST(Strips, OfAllHeights_HaveTheBytesOfOneEffectAfterTheOther) {
    forSeeds(0, 1500, [](Random& random) {
        const std::vector<Core> cores = randomCores(random);
        const std::vector<VFECore*> order = shuffled(random, cores);
        Scene scene = randomScene(random, 70);
        if (random.chance(30))
            scene.dst = randomPicture(random, random.between(1, 90), random.between(1, 110));
        const literal::Picture outer = randomPicture(random, scene.dst.width, scene.dst.height);
        Layers expected(scene, outer);
        Layers actual(scene, outer);
        paintInTurn(order, expected);
        const int rows = random.between(1, 50);
        ASSERT_TRUE(paintByTurns(order, actual.run(), rows));
        ASSERT_EQ(bytesOf(expected.destination), bytesOf(actual.destination)) << rows << " rows";
        ASSERT_EQ(bytesOf(expected.outer), bytesOf(actual.outer)) << rows << " rows";
    });
}

TEST(Strips, InAnyFloatState_HaveTheSameBytesAndLeaveTheState) {
    Random random(11);
    const std::vector<Core> cores = randomCores(random);
    std::vector<VFECore*> order;
    for (const Core& core : cores)
        order.push_back(core.get());
    const Scene scene = randomScene(random, maskGallery().front().mask);
    Layers expected(scene, scene.dst);
    paintInTurn(order, expected);
    for (const FloatState& state : floatStates()) {
        Layers actual(scene, scene.dst);
        FloatState after = {};
        {
            const InFloatState in(state);
            const FloatState before = currentFloatState();
            ASSERT_TRUE(paintByTurns(order, actual.run(), 7));
            after = currentFloatState();
            EXPECT_TRUE(before == after) << state.name;
        }
        EXPECT_EQ(bytesOf(expected.destination), bytesOf(actual.destination)) << state.name;
        EXPECT_EQ(bytesOf(expected.outer), bytesOf(actual.outer)) << state.name;
    }
}

TEST(Strips, AMovedShadow_StaysWhereItsCoreHasItWhateverItsRecordSaysNow) {
    Scene scene = sceneOf(discMask(30, 30, 12.0F, 12.0F, 6.0F, true));
    const Core core = coreOf<VFOuterShadow, VFOuterShadowProperty>(135.0F, 5.0F, 2.0F, kBlack, 1.0F);
    static_cast<VFOuterShadowProperty*>(core->getProperty())->mDistance = 9.0F;
    Layers expected(scene, scene.dst);
    Layers actual(scene, scene.dst);
    paintInTurn({core.get()}, expected);
    ASSERT_TRUE(paintByTurns({core.get()}, actual.run(), 4));
    EXPECT_EQ(bytesOf(expected.destination), bytesOf(actual.destination));
    EXPECT_NE(bytesOf(expected.destination), bytesOf(bitmapOf(scene.dst)));
}

// --- Where they serve -------------------------------------------------------------------------------

struct Sizes {
    unsigned width;
    unsigned height;
    bool isLayered;
    int64_t rows;
};

// Targets of 16 MiB and more are large. A strip has half a MiB of them, and 32 rows or more.
TEST(Strips, ServeLargePictures) {
    for (const Sizes& size :
         {Sizes{2048, 2047, false, 0}, Sizes{2048, 2048, false, 64}, Sizes{2048, 1024, true, 32},
          Sizes{2048, 1023, true, 0}, Sizes{1024, 4096, false, 128}, Sizes{100'000, 50, false, 32},
          Sizes{1, 4'194'304, false, 131'072}}) {
        VFBitmap destination(size.width, size.height, 4);
        VFBitmap outer(size.width, size.height, 4);
        VFBitmap mask(size.width, size.height, 1);
        VFRect text(0, 0, 1, 1);
        EXPECT_EQ(size.rows,
                  rowsOfStrips({&destination, size.isLayered ? &outer : nullptr, &mask, &text}))
            << size.width << " x " << size.height;
    }
}

TEST(Strips, DoNotServeWithoutPixels) {
    VFBitmap large(2048, 2048, 4);
    VFBitmap mask(2048, 2048, 1);
    VFBitmap hollow;
    VFRect text(0, 0, 1, 1);
    EXPECT_EQ(0, rowsOfStrips({nullptr, nullptr, &mask, &text}));
    EXPECT_EQ(0, rowsOfStrips({&large, nullptr, &hollow, &text}));
    for (const auto& [width, height] : {std::pair{2048U, 0U}, {0U, 0U}, {0U, 0xFFFFFFFFU}}) {
        VFBitmap empty(width, height, 4);
        EXPECT_EQ(0, rowsOfStrips({&empty, &large, &mask, &text})) << width << " x " << height;
        Kit<VFEffect> kit;
        VFEffect set;
        describe(kCentred, set, kit);
        set.initEffect(2048, 2048);
        set.setDstBitmap(&empty);
        uint8_t coverage = 255;
        VFGlyph dot = {&coverage, 1, 1};
        set.renderEffectLayer(5, 5, &dot);
        set.doEffectPostProcessing();
        set.compositeLayers(&empty);
    }
}

/// A bitmap whose pixels stand in somebody else's bytes.
class Lying {
  public:
    Lying(unsigned char* bytes, unsigned width, unsigned height, unsigned bytesPerPixel) : bitmap() {
        bitmap.mData = bytes;
        bitmap.mWidth = width;
        bitmap.mHeight = height;
        bitmap.mBytesPerPixel = bytesPerPixel;
    }
    ~Lying() { bitmap.mData = nullptr; }
    Lying(const Lying&) = delete;
    Lying& operator=(const Lying&) = delete;

    VFBitmap bitmap;
};

TEST(Strips, DoNotServeWhereBitmapsShareAByte) {
    constexpr int64_t kLayer = int64_t{1024} * 2048 * 4;
    constexpr int64_t kMask = int64_t{1024} * 2048;
    std::vector<uint8_t> bytes(static_cast<size_t>(2 * kLayer + kMask));
    VFRect text(0, 0, 1, 1);
    const auto rowsAt = [&](int64_t destination, int64_t outer, int64_t mask) {
        Lying first(bytes.data() + destination, 1024, 2048, 4);
        Lying second(bytes.data() + outer, 1024, 2048, 4);
        Lying third(bytes.data() + mask, 1024, 2048, 1);
        return rowsOfStrips({&first.bitmap, &second.bitmap, &third.bitmap, &text});
    };
    // Neighbours, in all orders.
    EXPECT_EQ(64, rowsAt(0, kLayer, 2 * kLayer));
    EXPECT_EQ(64, rowsAt(kLayer, 0, 2 * kLayer));
    EXPECT_EQ(64, rowsAt(kMask, kMask + kLayer, 0));
    EXPECT_EQ(64, rowsAt(0, kMask + kLayer, kLayer));
    // A byte of two of them is one.
    EXPECT_EQ(0, rowsAt(0, kLayer - 1, 2 * kLayer));
    EXPECT_EQ(0, rowsAt(kLayer - 1, 0, 2 * kLayer));
    EXPECT_EQ(0, rowsAt(0, kLayer, 2 * kLayer - 1));
    EXPECT_EQ(0, rowsAt(kMask - 1, kMask + kLayer, 0));
    EXPECT_EQ(0, rowsAt(0, kLayer, kLayer / 2));
    EXPECT_EQ(0, rowsAt(0, kLayer, kLayer + 5));
}

// --- Whole runs -------------------------------------------------------------------------------------

/// The look on pictures of more than 16 MiB, by the library and by the literal form.
template <class Set>
literal::Picture paintedLarge(WholeLook look, const literal::Mask& mask) {
    Kit<Set> kit;
    Set set;
    describe(look, set, kit);
    return paintedRun(set, mask, {4200, 1010, 17, 3});
}

TEST(Strips, OfWholeRuns_HaveTheBytesOfTheLiteralForm) {
    Random random(5);
    const literal::Mask mask = noiseMask(random, 60, 1000, 60);
    for (const WholeLook look : {kEveryEffect, kTranslucent, kCentred}) {
        EXPECT_TRUE(
            samePicture(paintedLarge<literal::Engine>(look, mask), paintedLarge<VFEffect>(look, mask)));
    }
}

}  // namespace
