#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "literal_image.h"
#include "random.h"
#include "voreleffect/voreleffect.h"

/// Driving a core and comparing what it paints with the literal form of the same effect.
namespace vorel_test {

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

/// Size and box of the scene, for the trace of a failure.
std::string describe(const Scene& scene);

/// The core ignores null parameters, null fields, bitmaps without pixels, and boxes that are empty,
/// inverted or outside the mask. The core must have a record with which it paints.
void expectNothingFromBrokenInput(VFontEffect::VFECore& core);

/// A new core has its type, no id, full opacity, no record and no reach, and paints nothing.
template <class Core>
void expectFreshCore(int style) {
    Core core;
    EXPECT_EQ(style, core.getStyle());
    EXPECT_EQ(-1, core.getId());
    EXPECT_EQ(1.0F, core.getOpacity());
    EXPECT_EQ(nullptr, core.getProperty());
    EXPECT_EQ(0, core.getOffset());
    EXPECT_EQ(0, core.getLeftOffset());
    EXPECT_EQ(0, core.getRightOffset());
    EXPECT_EQ(0, core.getTopOffset());
    EXPECT_EQ(0, core.getBottomOffset());
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

/// Paints with the core and with `reference`, which is handed a copy of the scene to paint into.
template <class Reference>
::testing::AssertionResult paintsLike(VFontEffect::VFECore& core, const Scene& scene,
                                      Reference reference) {
    Scene expected = scene;
    reference(expected);
    return samePaint(expected, painted(core, scene));
}

/// Calls `check(random)` for `cases` seeds; stops after the first one that fails and names it.
template <class Check>
void forSeeds(uint64_t firstSeed, int cases, Check check) {
    for (uint64_t seed = firstSeed; seed < firstSeed + static_cast<uint64_t>(cases); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(seed);
        check(random);
        if (::testing::Test::HasFailure()) return;
    }
}

}  // namespace vorel_test
