#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "literal_image.h"
#include "mask_gallery.h"
#include "random.h"
#include "thinned.h"
#include "voreleffect/voreleffect.h"

/// Driving a core and comparing what it paints with the literal form of the same effect.
namespace vorel_test {

// Opaque colour words.
constexpr uint32_t kBlack = 0xFF000000;
constexpr uint32_t kWhite = 0xFFFFFFFF;
constexpr uint32_t kRed = 0xFFFF0000;
constexpr uint32_t kGreen = 0xFF00FF00;
constexpr uint32_t kBlue = 0xFF0000FF;

/// What a core is handed for one call, by value.
struct Scene {
    literal::Mask mask;
    literal::Box text;
    literal::Picture dst;
    std::optional<literal::Picture> sub;
    bool useOuterLayer = false;
};

/// A transparent picture of the mask's size, and a text box.
Scene sceneOf(literal::Mask mask, literal::Box text);

/// The same with the whole mask as the text box.
Scene sceneOf(literal::Mask mask);

literal::Box wholeBox(const literal::Mask& mask);

/// Every pixel of `width` x `height` the same four bytes R, G, B, A.
literal::Picture filledPicture(int width, int height, uint32_t color);

/// A transparent, an opaque or a random picture; premultiplied for the most part.
literal::Picture randomPicture(Random& random, int width, int height);

/// A random part of the mask, as often as not touching some of its edges, or the whole of it.
literal::Box randomBox(Random& random, const literal::Mask& mask);

/// Mask, box and picture at random; the sides have up to `longestSide` pixels, now and then two of
/// them make a line of one pixel.
Scene randomScene(Random& random, int longestSide);

/// A random picture and box for the given mask.
Scene randomScene(Random& random, const literal::Mask& mask);

/// A colour word premultiplied by its alpha, transparent and opaque ones included.
uint32_t randomPremultiplied(Random& random);

/// A straight colour word with any alpha.
uint32_t randomStraight(Random& random);

/// `count` stops: mostly ascending, now and then unsorted, equal, or ending early.
std::vector<literal::Stop> randomStops(Random& random, int count);

/// The library's own stop array for `stops`.
std::vector<VFontEffect::VFGradient> libraryStops(const std::vector<literal::Stop>& stops);

VFontEffect::VFBitmap bitmapOf(const literal::Mask& mask);
VFontEffect::VFBitmap bitmapOf(const literal::Picture& picture);

/// Runs doPostProcessing on copies of the scene and returns the scene as it is afterwards. The mask
/// and the box must not have changed.
Scene painted(VFontEffect::VFECore& core, const Scene& scene);

::testing::AssertionResult samePicture(const literal::Picture& expected, const literal::Picture& actual);

/// Both pictures of both scenes are the same.
::testing::AssertionResult samePaint(const Scene& expected, const Scene& actual);

/// The core leaves the scene as it is.
::testing::AssertionResult paintsNothing(VFontEffect::VFECore& core, const Scene& scene);

/// One channel of the picture (0 red to 3 alpha) as a list of numbers, row by row.
std::vector<int> channelOf(const literal::Picture& picture, int channel);
std::vector<int> alphaOf(const literal::Picture& picture);

/// The colour words of one row.
std::vector<uint32_t> rowOf(const literal::Picture& picture, int y);

/// Size and box of the scene, for the trace of a failure.
std::string describe(const Scene& scene);

/// The core ignores null parameters, null fields, bitmaps without pixels, and boxes that are empty,
/// inverted or outside the mask. The core must have a record with which it paints.
void expectNothingFromBrokenInput(VFontEffect::VFECore& core);

/// The core paints nothing beyond the text box.
void expectNoReach(VFontEffect::VFECore& core);

/// The core slides its paint beneath the destination: an opaque one keeps every pixel.
void expectOpaqueDestinationUntouched(VFontEffect::VFECore& core, Scene scene);

/// The core paints the same in layered mode, and nothing into a second destination.
void expectLayersNotRead(VFontEffect::VFECore& core);

/// The core paints `pixel` (R, G, B, A) wherever there is any coverage, however faint.
void expectCoverageGates(VFontEffect::VFECore& core, const std::vector<uint8_t>& pixel);

/// A core that was given a record made of `arguments`; the record is gone by the time it returns.
template <class Core, class Record, class... Arguments>
std::unique_ptr<VFontEffect::VFECore> coreOf(Arguments... arguments) {
    Record record(arguments...);
    auto core = std::make_unique<Core>();
    core->setProperty(&record);
    return core;
}

/// A new core has its type, no id, full opacity, no record and no reach, and paints nothing.
template <class Core>
void expectFreshCore(int style) {
    Core core;
    EXPECT_EQ(style, core.getStyle());
    EXPECT_EQ(-1, core.getId());
    EXPECT_EQ(1.0F, core.getOpacity());
    EXPECT_EQ(nullptr, core.getProperty());
    expectNoReach(core);
    EXPECT_EQ(1, core.initEffect(nullptr));
    EXPECT_EQ(1, core.render(nullptr));
    core.setId(41);
    EXPECT_EQ(41, core.getId());

    Random random(7);
    Scene scene = randomScene(random, 20);
    EXPECT_TRUE(paintsNothing(core, scene));
    core.setProperty(nullptr);
    EXPECT_EQ(nullptr, core.getProperty());
    EXPECT_TRUE(paintsNothing(core, scene));
}

/// The core keeps a copy of its record: null and the core's own record change nothing, another record
/// replaces it, and the caller's record may go away. `first` and `second` must paint differently.
template <class Core, class Record>
void expectOwnsItsRecord(const Record& first, const Record& second, const Scene& scene) {
    const auto paintOf = [&](const Record& record) {
        Core core;
        Record copy = record;
        core.setProperty(&copy);
        return painted(core, scene);
    };
    const Scene firstPaint = paintOf(first);
    const Scene secondPaint = paintOf(second);
    ASSERT_FALSE(samePaint(firstPaint, secondPaint)) << "the records must paint differently";
    ASSERT_FALSE(samePaint(scene, firstPaint)) << "the first record must paint something";

    Core core;
    {
        auto record = std::make_unique<Record>(first);
        core.setProperty(record.get());
        EXPECT_NE(record.get(), core.getProperty());
    }
    EXPECT_TRUE(samePaint(firstPaint, painted(core, scene)));

    const VFontEffect::VFProperty* stored = core.getProperty();
    core.setProperty(nullptr);
    EXPECT_EQ(stored, core.getProperty());
    EXPECT_TRUE(samePaint(firstPaint, painted(core, scene)));

    core.setProperty(core.getProperty());
    ASSERT_NE(nullptr, core.getProperty());
    EXPECT_TRUE(samePaint(firstPaint, painted(core, scene)));

    Record other = second;
    core.setProperty(&other);
    EXPECT_TRUE(samePaint(secondPaint, painted(core, scene)));

    Record again = first;
    core.setProperty(&again);
    EXPECT_TRUE(samePaint(firstPaint, painted(core, scene)));
    EXPECT_TRUE(samePaint(firstPaint, painted(core, scene))) << "painting twice paints the same";
}

/// The core keeps a copy of its record's stops: the caller's array may change and go away.
/// `makeRecord` is handed an array of two stops.
template <class MakeRecord>
void expectCopiesItsStops(VFontEffect::VFECore& core, const Scene& scene, MakeRecord makeRecord) {
    auto stops = std::make_unique<VFontEffect::VFGradient[]>(2);
    stops[0] = {kRed, 0.25F, 0.0F};
    stops[1] = {kBlue, 0.75F, 0.5F};
    auto record = makeRecord(stops.get());
    core.setProperty(&record);
    const Scene before = painted(core, scene);
    stops[0].mColor = kGreen;
    stops[1].mLocation = 0.1F;
    EXPECT_TRUE(samePaint(before, painted(core, scene)));
    stops.reset();
    EXPECT_TRUE(samePaint(before, painted(core, scene)));

    const auto* stored = static_cast<decltype(record)*>(core.getProperty());
    ASSERT_EQ(2, stored->mGradientCount);
    EXPECT_EQ(kRed, stored->mGradient[0].mColor);
    EXPECT_EQ(0.25F, stored->mGradient[0].mOpacity);
    EXPECT_EQ(0.0F, stored->mGradient[0].mLocation);
    EXPECT_EQ(kBlue, stored->mGradient[1].mColor);
    EXPECT_EQ(0.75F, stored->mGradient[1].mOpacity);
    EXPECT_EQ(0.5F, stored->mGradient[1].mLocation);
}

/// Paints with the core and with `reference`, which is handed a copy of the scene to paint into.
template <class Reference>
::testing::AssertionResult paintsLike(VFontEffect::VFECore& core, const Scene& scene,
                                      Reference reference) {
    Scene expected = scene;
    reference(expected);
    return samePaint(expected, painted(core, scene));
}

/// Calls `check(random)` for `cases` seeds, thinned; stops after the first one that fails and names it.
template <class Check>
void forSeeds(uint64_t firstSeed, int cases, Check check) {
    for (uint64_t seed = firstSeed; seed < firstSeed + static_cast<uint64_t>(thinned(cases)); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(seed);
        check(random);
        if (::testing::Test::HasFailure()) return;
    }
}

/// Calls `check(random, mask)` for every mask of the gallery, each with a fresh generator; stops after
/// the first one that fails and names it.
template <class Check>
void forGallery(Check check) {
    for (const NamedMask& named : maskGallery()) {
        SCOPED_TRACE(named.name);
        Random random(99);
        check(random, named.mask);
        if (::testing::Test::HasFailure()) return;
    }
}

/// Calls `check(random, scene)` for `cases` scenes whose destination has another size than the mask:
/// sides up to `longestMaskSide` and up to `longestSide`.
template <class Check>
void forOtherDestinations(int cases, int longestMaskSide, int longestSide, Check check) {
    forSeeds(3000, cases, [&](Random& random) {
        Scene scene = randomScene(random, longestMaskSide);
        scene.dst =
            randomPicture(random, random.between(1, longestSide), random.between(1, longestSide));
        check(random, scene);
    });
}

/// One of the two glows: its core, its literal form, and the checks that hold for both glows.
struct Glow {
    using Stops = std::vector<literal::Stop>;

    std::unique_ptr<VFontEffect::VFECore> (*makeCore)(float size, uint32_t color, float opacity,
                                                      int count, VFontEffect::VFGradient* stops);
    void (*paintLiteral)(literal::Picture& dst, const literal::Mask& mask, literal::Box text, float size,
                         uint32_t color, const Stops& stops);

    std::unique_ptr<VFontEffect::VFECore> core(float size, uint32_t color,
                                               const Stops& stops = {}) const;
    Scene painted(const Scene& scene, float size, uint32_t color, const Stops& stops = {}) const;
    ::testing::AssertionResult matchesLiteral(const Scene& scene, float size, uint32_t color,
                                              const Stops& stops = {}) const;

    void expectNothingOfSizeZero() const;
    void expectNothingOfSizesOutOfProportion() const;
    void expectOpacityNotRead() const;
    void expectOneColourWithoutStops() const;
    void expectHardStopsNotSmoothed(const Scene& disc) const;

    void expectLiteralFormOfSmallNegativeAndUnorderedSizes() const;
    void expectLiteralFormOfSmallScenes() const;
    void expectLiteralFormOfEveryWholeSize() const;
    void expectLiteralFormOfTheGallery() const;
    void expectClippingToTheDestination() const;
};

/// One of the two shadows: its core, its literal form, and the checks that hold for both shadows.
struct Shadow {
    std::unique_ptr<VFontEffect::VFECore> (*makeCore)(float angle, float distance, float size,
                                                      uint32_t color, float opacity);
    void (*paintLiteral)(literal::Picture& dst, const literal::Mask& mask, literal::Box text,
                         float angle, float distance, float size, uint32_t color);

    std::unique_ptr<VFontEffect::VFECore> core(float angle, float distance, float size,
                                               uint32_t color = kWhite) const;
    Scene painted(const Scene& scene, float angle, float distance, float size,
                  uint32_t color = kWhite) const;
    ::testing::AssertionResult matchesLiteral(const Scene& scene, float angle, float distance,
                                              float size, uint32_t color = kWhite) const;

    /// A box within a mask of even coverage, which the shadow leaves as the distance grows.
    void expectLiteralFormAroundTheEdges(uint8_t coverage, int angleStep, int farthest) const;
    void expectLiteralFormOfSmallScenes(int cases, float largestSize) const;
    void expectLiteralFormOfLargeSizes(int cases, float farthest) const;
    void expectLiteralFormOfTheGallery() const;
    void expectClippingToTheDestination() const;
};

/// One of the two gradients: its core and the checks that hold for both gradients.
struct Gradient {
    using Stops = std::vector<literal::Stop>;
    using TableOf = std::vector<uint32_t> (*)(const Stops& stops);

    std::unique_ptr<VFontEffect::VFECore> (*makeCore)(float angle, float scale, float opacity, int count,
                                                      VFontEffect::VFGradient* stops);

    /// Black to white: entry i of the table is the grey i * 255 >> 8.
    static const Stops& ramp();
    static int greyOf(int entry) { return entry * 255 >> 8; }

    std::unique_ptr<VFontEffect::VFECore> core(float angle, float scale, const Stops& stops) const;
    Scene painted(const Scene& scene, float angle, float scale, const Stops& stops) const;

    void expectNothingWithoutStops() const;
    void expectOpacitiesNotRead(float angle) const;

    /// The colour table of the core, which `tableOf` reads off what it paints: 256 entries.
    static void expectLinearRampOfTwoStops(TableOf tableOf);
    static void expectFirstColourBeforeTheFirstStop(TableOf tableOf);
    static void expectLastSegmentWhenStopsEndEarly(TableOf tableOf);
    static void expectOneStopPassedPerEntry(TableOf tableOf);
};

}  // namespace vorel_test
