#include "core_compare.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "compare.h"

namespace vorel_test {

using literal::Box;
using literal::Mask;
using literal::Picture;
using literal::Stop;
using VFontEffect::VFBitmap;
using VFontEffect::VFECore;
using VFontEffect::VFGradient;
using VFontEffect::VFRect;

namespace {

Picture pictureOf(const VFBitmap& bitmap) {
    const size_t bytes = static_cast<size_t>(bitmap.mWidth) * bitmap.mHeight * 4;
    return {static_cast<int>(bitmap.mWidth), static_cast<int>(bitmap.mHeight),
            std::vector<uint8_t>(bitmap.mData, bitmap.mData + bytes)};
}

void storePixel(uint8_t* pixel, uint32_t color) {
    pixel[0] = static_cast<uint8_t>(color >> 16);
    pixel[1] = static_cast<uint8_t>(color >> 8);
    pixel[2] = static_cast<uint8_t>(color);
    pixel[3] = static_cast<uint8_t>(color >> 24);
}

/// Boxes that are empty, inverted, or reach outside a mask of width x height.
std::vector<Box> brokenBoxes(int width, int height) {
    constexpr int kLeast = std::numeric_limits<int>::min();
    constexpr int kMost = std::numeric_limits<int>::max();
    return {
        {3, 2, 3, 6},
        {3, 2, 6, 2},
        {0, 0, 0, 0},
        {6, 2, 3, 6},
        {3, 6, 6, 2},
        {width, height, 0, 0},
        {-1, 0, width, height},
        {0, -1, width, height},
        {1, 0, width + 1, height},
        {0, 1, width, height + 1},
        {width, height, width + 4, height + 4},
        {-8, -8, -2, -2},
        {kLeast, kLeast, kMost, kMost},
        {kMost, kMost, kLeast, kLeast},
        {kLeast, 0, kLeast + 5, 5},
        {0, kMost - 5, 5, kMost},
        {kMost - 5, 0, kMost, 5},
    };
}

/// A disc in the middle of 20 x 20 pixels.
Mask smallDisc() {
    return discMask(20, 20, 10.0F, 10.0F, 6.0F, true);
}

}  // namespace

Box wholeBox(const Mask& mask) {
    return {0, 0, mask.width, mask.height};
}

Picture filledPicture(int width, int height, uint32_t color) {
    Picture picture{width, height, {}};
    picture.bytes.resize(static_cast<size_t>(width) * static_cast<size_t>(height) * 4);
    for (size_t i = 0; i < picture.bytes.size(); i += 4)
        storePixel(&picture.bytes[i], color);
    return picture;
}

Scene sceneOf(Mask mask, Box text) {
    Scene scene;
    scene.dst = filledPicture(mask.width, mask.height, 0);
    scene.text = text;
    scene.mask = std::move(mask);
    return scene;
}

Scene sceneOf(Mask mask) {
    const Box text = wholeBox(mask);
    return sceneOf(std::move(mask), text);
}

uint32_t randomStraight(Random& random) {
    const uint32_t color = random.next();
    switch (random.between(0, 4)) {
        case 0:
            return color | 0xFF000000;
        case 1:
            return color & 0x00FFFFFF;
        default:
            return color;
    }
}

uint32_t randomPremultiplied(Random& random) {
    const uint32_t color = randomStraight(random);
    const uint32_t alpha = color >> 24;
    uint32_t result = alpha << 24;
    for (uint32_t shift = 0; shift < 24; shift += 8) {
        result |= ((color >> shift & 0xFF) * (alpha + 1) >> 8) << shift;
    }
    return result;
}

Picture randomPicture(Random& random, int width, int height) {
    switch (random.between(0, 5)) {
        case 0:
        case 1:
            return filledPicture(width, height, 0);
        case 2:
            return filledPicture(width, height, random.next() | 0xFF000000);
        default:
            break;
    }
    Picture picture = filledPicture(width, height, 0);
    const bool premultiplied = random.chance(80);
    for (size_t i = 0; i < picture.bytes.size(); i += 4) {
        storePixel(&picture.bytes[i], premultiplied ? randomPremultiplied(random) : random.next());
    }
    return picture;
}

Box randomBox(Random& random, const Mask& mask) {
    Box box = wholeBox(mask);
    if (random.chance(25)) return box;
    if (random.chance(60)) box.left = random.between(0, mask.width - 1);
    if (random.chance(60)) box.top = random.between(0, mask.height - 1);
    if (random.chance(60)) box.right = random.between(box.left + 1, mask.width);
    if (random.chance(60)) box.bottom = random.between(box.top + 1, mask.height);
    return box;
}

Scene randomScene(Random& random, const Mask& mask) {
    Scene scene;
    scene.mask = mask;
    scene.text = randomBox(random, mask);
    scene.dst = randomPicture(random, mask.width, mask.height);
    if (random.chance(30)) scene.sub = randomPicture(random, mask.width, mask.height);
    scene.useOuterLayer = random.chance(50);
    return scene;
}

Scene randomScene(Random& random, int longestSide) {
    const int width = random.chance(10) ? 1 : random.between(1, longestSide);
    const int height = random.chance(10) ? 1 : random.between(1, longestSide);
    return randomScene(random, randomMask(random, width, height));
}

std::vector<Stop> randomStops(Random& random, int count) {
    std::vector<Stop> stops;
    for (int i = 0; i < count; ++i)
        stops.push_back({randomStraight(random), 1.0F, random.real(0.0F, 1.0F)});
    if (random.chance(40)) {
        // Positions that the entries of a table of 256 hit exactly.
        for (Stop& stop : stops)
            stop.location = static_cast<float>(random.between(0, 256)) / 256.0F;
    }
    if (random.chance(80)) {
        std::sort(stops.begin(), stops.end(),
                  [](const Stop& a, const Stop& b) { return a.location < b.location; });
    }
    if (count == 0) return stops;
    if (random.chance(40)) stops.front().location = 0.0F;
    if (random.chance(50)) stops.back().location = 1.0F;
    if (random.chance(10)) stops[stops.size() / 2].location = stops[0].location;
    if (random.chance(5)) stops[stops.size() / 2].location = std::numeric_limits<float>::quiet_NaN();
    if (random.chance(5)) stops[stops.size() / 2].location = random.chance(50) ? -3.0F : 7.0F;
    return stops;
}

std::vector<VFGradient> libraryStops(const std::vector<Stop>& stops) {
    std::vector<VFGradient> result;
    for (const Stop& stop : stops)
        result.push_back({stop.color, stop.opacity, stop.location});
    return result;
}

VFBitmap bitmapOf(const Mask& mask) {
    Mask copy = mask;
    return VFBitmap(static_cast<unsigned>(mask.width), static_cast<unsigned>(mask.height),
                    copy.bytes.data(), 1);
}

VFBitmap bitmapOf(const Picture& picture) {
    Picture copy = picture;
    return VFBitmap(static_cast<unsigned>(picture.width), static_cast<unsigned>(picture.height),
                    copy.bytes.data(), 4);
}

Scene painted(VFECore& core, const Scene& scene) {
    VFBitmap mask = bitmapOf(scene.mask);
    VFBitmap dst = bitmapOf(scene.dst);
    std::optional<VFBitmap> sub;
    if (scene.sub) sub.emplace(bitmapOf(*scene.sub));
    VFRect text(scene.text.left, scene.text.top, scene.text.right, scene.text.bottom);
    VFECore::ParamPostProcessing params{&dst, &mask, &text, scene.useOuterLayer ? 1 : 0,
                                        sub ? &*sub : nullptr};
    core.doPostProcessing(&params);

    EXPECT_TRUE(sameBytes(scene.mask.bytes.data(), mask.mData, scene.mask.width, scene.mask.height, 1))
        << "the mask must stay as it is";
    EXPECT_EQ(scene.text.left, text.mLeft);
    EXPECT_EQ(scene.text.top, text.mTop);
    EXPECT_EQ(scene.text.right, text.mRight);
    EXPECT_EQ(scene.text.bottom, text.mBottom);

    Scene result = scene;
    result.dst = pictureOf(dst);
    if (sub) result.sub = pictureOf(*sub);
    return result;
}

::testing::AssertionResult samePicture(const Picture& expected, const Picture& actual) {
    if (expected.width != actual.width || expected.height != actual.height) {
        return ::testing::AssertionFailure() << "sizes differ";
    }
    return sameBytes(expected.bytes.data(), actual.bytes.data(), expected.width, expected.height, 4);
}

::testing::AssertionResult samePaint(const Scene& expected, const Scene& actual) {
    ::testing::AssertionResult same = samePicture(expected.dst, actual.dst);
    if (!same) return same << " in the destination; " << describe(expected);
    if (expected.sub) same = samePicture(*expected.sub, *actual.sub);
    if (!same) return same << " in the second destination; " << describe(expected);
    return same;
}

::testing::AssertionResult paintsNothing(VFECore& core, const Scene& scene) {
    return samePaint(scene, painted(core, scene));
}

std::vector<int> channelOf(const Picture& picture, int channel) {
    std::vector<int> values;
    for (size_t i = static_cast<size_t>(channel); i < picture.bytes.size(); i += 4) {
        values.push_back(picture.bytes[i]);
    }
    return values;
}

std::vector<int> alphaOf(const Picture& picture) {
    return channelOf(picture, 3);
}

std::vector<uint32_t> rowOf(const Picture& picture, int y) {
    std::vector<uint32_t> row;
    const size_t stride = static_cast<size_t>(picture.width) * 4;
    for (size_t i = static_cast<size_t>(y) * stride; i < static_cast<size_t>(y + 1) * stride; i += 4) {
        row.push_back(uint32_t{picture.bytes[i + 3]} << 24 | uint32_t{picture.bytes[i]} << 16 |
                      uint32_t{picture.bytes[i + 1]} << 8 | picture.bytes[i + 2]);
    }
    return row;
}

std::string describe(const Scene& scene) {
    const auto text = [](int value) { return std::to_string(value); };
    return "mask " + text(scene.mask.width) + " x " + text(scene.mask.height) + ", box " +
           text(scene.text.left) + " " + text(scene.text.top) + " " + text(scene.text.right) + " " +
           text(scene.text.bottom) + (scene.useOuterLayer ? ", layered" : "");
}

void expectNothingFromBrokenInput(VFECore& core) {
    const Scene scene = sceneOf(discMask(12, 9, 5.0F, 4.0F, 3.0F, true), {1, 1, 11, 8});
    ASSERT_FALSE(paintsNothing(core, scene)) << "the core must paint from sound input";
    const Picture untouched = scene.dst;

    VFBitmap mask = bitmapOf(scene.mask);
    VFBitmap dst = bitmapOf(scene.dst);
    VFBitmap noPixels;
    VFBitmap noArea(0, 0, 4);
    VFBitmap noAreaMask(0, 0, 1);
    VFRect text(scene.text.left, scene.text.top, scene.text.right, scene.text.bottom);
    using Params = VFECore::ParamPostProcessing;
    std::vector<Params> broken{
        {&dst, nullptr, &text, 0, nullptr},         {&dst, &mask, nullptr, 0, nullptr},
        {&dst, nullptr, nullptr, 1, nullptr},       {nullptr, &mask, &text, 0, nullptr},
        {nullptr, nullptr, nullptr, 0, nullptr},    {&noPixels, &mask, &text, 0, nullptr},
        {&noArea, &mask, &text, 0, nullptr},        {&dst, &noPixels, &text, 0, nullptr},
        {&dst, &noAreaMask, &text, 1, nullptr},     {nullptr, &mask, &text, 1, &dst},
        {&noPixels, &noPixels, &text, 0, &noPixels}};
    core.doPostProcessing(nullptr);
    for (size_t i = 0; i < broken.size(); ++i) {
        SCOPED_TRACE("broken record " + std::to_string(i));
        core.doPostProcessing(&broken[i]);
        EXPECT_TRUE(samePicture(untouched, pictureOf(dst)));
    }
    for (const Box& box : brokenBoxes(scene.mask.width, scene.mask.height)) {
        Scene wrong = scene;
        wrong.text = box;
        EXPECT_TRUE(paintsNothing(core, wrong));
    }
}

void expectNoReach(VFECore& core) {
    EXPECT_EQ(0, core.getOffset());
    EXPECT_EQ(0, core.getLeftOffset());
    EXPECT_EQ(0, core.getRightOffset());
    EXPECT_EQ(0, core.getTopOffset());
    EXPECT_EQ(0, core.getBottomOffset());
}

void expectOpaqueDestinationUntouched(VFECore& core, Scene scene) {
    scene.dst = filledPicture(scene.dst.width, scene.dst.height, 0xFF112233);
    EXPECT_TRUE(paintsNothing(core, scene));
}

void expectLayersNotRead(VFECore& core) {
    Scene scene = sceneOf(smallDisc());
    const Scene plain = painted(core, scene);
    scene.useOuterLayer = true;
    scene.sub = filledPicture(20, 20, 0);
    const Scene layered = painted(core, scene);
    EXPECT_TRUE(samePicture(plain.dst, layered.dst));
    EXPECT_TRUE(samePicture(*scene.sub, *layered.sub));
}

void expectCoverageGates(VFECore& core, const std::vector<uint8_t>& pixel) {
    Scene scene = sceneOf(filledMask(3, 1, 0));
    scene.mask.bytes = {1, 0, 255};
    std::vector<uint8_t> expected = pixel;
    expected.insert(expected.end(), 4, 0);
    expected.insert(expected.end(), pixel.begin(), pixel.end());
    EXPECT_EQ(expected, painted(core, scene).dst.bytes);
}

// --- Glows ------------------------------------------------------------------------------------------

std::unique_ptr<VFECore> Glow::core(float size, uint32_t color, const Stops& stops) const {
    std::vector<VFGradient> array = libraryStops(stops);
    return makeCore(size, color, 1.0F, static_cast<int>(array.size()),
                    array.empty() ? nullptr : array.data());
}

Scene Glow::painted(const Scene& scene, float size, uint32_t color, const Stops& stops) const {
    return vorel_test::painted(*core(size, color, stops), scene);
}

::testing::AssertionResult Glow::matchesLiteral(const Scene& scene, float size, uint32_t color,
                                                const Stops& stops) const {
    auto same = paintsLike(*core(size, color, stops), scene, [&](Scene& expected) {
        paintLiteral(expected.dst, expected.mask, expected.text, size, color, stops);
    });
    if (!same) same << "; size " << size << ", stops " << stops.size();
    return same;
}

void Glow::expectNothingOfSizeZero() const {
    const Scene scene = sceneOf(smallDisc());
    EXPECT_TRUE(samePaint(scene, painted(scene, 0.0F, kWhite)));
    EXPECT_TRUE(
        samePaint(scene, painted(scene, 0.0F, kWhite, {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}})));
}

void Glow::expectNothingOfSizesOutOfProportion() const {
    const Scene scene = sceneOf(filledMask(10, 10, 255));
    const float infinity = std::numeric_limits<float>::infinity();
    for (float size : {-1.0F, -1.9F, -2.0F, -50.0F, -1e9F, 256.5F, 1e9F, 3e38F, infinity, -infinity}) {
        EXPECT_TRUE(samePaint(scene, painted(scene, size, kWhite))) << size;
    }
}

void Glow::expectOpacityNotRead() const {
    const Scene scene = sceneOf(smallDisc());
    const auto faint = makeCore(5.0F, kRed, 0.25F, 0, nullptr);
    EXPECT_TRUE(samePaint(painted(scene, 5.0F, kRed), vorel_test::painted(*faint, scene)));
}

void Glow::expectOneColourWithoutStops() const {
    const Scene scene = sceneOf(smallDisc());
    for (int count : {1, 2, 256, -4}) {
        const auto counting = makeCore(5.0F, kRed, 1.0F, count, nullptr);
        EXPECT_TRUE(samePaint(painted(scene, 5.0F, kRed), vorel_test::painted(*counting, scene)))
            << count;
    }
}

void Glow::expectHardStopsNotSmoothed(const Scene& disc) const {
    // The pixels of both colours; the border of an inner glow, which is white, has green, too.
    const auto mixedOf = [&](float start, float end) {
        const Stops stops{
            {kRed, 1.0F, 0.0F}, {kRed, 1.0F, start}, {kBlue, 1.0F, end}, {kBlue, 1.0F, 1.0F}};
        const literal::Picture picture = painted(disc, 12.0F, 0, stops).dst;
        const std::vector<int> red = channelOf(picture, 0);
        const std::vector<int> green = channelOf(picture, 1);
        const std::vector<int> blue = channelOf(picture, 2);
        int count = 0;
        for (size_t i = 0; i < red.size(); ++i)
            count += red[i] > 0 && green[i] == 0 && blue[i] > 0 ? 1 : 0;
        return count;
    };
    EXPECT_EQ(0, mixedOf(0.4F, 0.4F));
    // A twelfth of the way is a pixel: an edge around a disc of more than 50 pixels.
    EXPECT_LT(50, mixedOf(0.36F, 0.44F));
}

void Glow::expectLiteralFormOfSmallNegativeAndUnorderedSizes() const {
    const Scene scene = sceneOf(discMask(14, 14, 7.0F, 7.0F, 4.0F, true));
    for (float size : {-0.0F, -0.5F, -0.99F, std::nanf("")}) {
        EXPECT_TRUE(matchesLiteral(scene, size, kRed));
    }
}

void Glow::expectLiteralFormOfSmallScenes() const {
    forSeeds(1000, 2200, [&](Random& random) {
        const Scene scene = randomScene(random, 26);
        const float size =
            random.chance(50) ? static_cast<float>(random.between(0, 9)) : random.real(0.0F, 12.0F);
        const int count = random.chance(30) ? 0 : random.between(1, 6);
        EXPECT_TRUE(matchesLiteral(scene, size, randomStraight(random), randomStops(random, count)));
    });
}

void Glow::expectLiteralFormOfEveryWholeSize() const {
    const Stops stops{{kGreen, 1.0F, 0.0F}, {0x80FF0000, 1.0F, 0.4F}, {kBlue, 1.0F, 1.0F}};
    const Scene scene = sceneOf(discMask(15, 9, 7.0F, 4.0F, 4.0F, true), {2, 1, 13, 8});
    for (int size = 0; size <= 100; size += kThinned) {
        ASSERT_TRUE(matchesLiteral(scene, static_cast<float>(size), 0, stops));
    }
}

void Glow::expectLiteralFormOfTheGallery() const {
    forGallery([&](Random& random, const Mask& mask) {
        for (float size : {1.0F, 4.0F, 13.0F}) {
            const Scene scene = randomScene(random, mask);
            ASSERT_TRUE(matchesLiteral(scene, size, randomStraight(random), randomStops(random, 3)));
            ASSERT_TRUE(matchesLiteral(sceneOf(mask), size, kWhite));
        }
    });
}

void Glow::expectClippingToTheDestination() const {
    forOtherDestinations(200, 16, 24, [&](Random& random, const Scene& scene) {
        EXPECT_TRUE(matchesLiteral(scene, random.real(0.0F, 6.0F), randomStraight(random)));
    });
}

// --- Shadows ----------------------------------------------------------------------------------------

std::unique_ptr<VFECore> Shadow::core(float angle, float distance, float size, uint32_t color) const {
    return makeCore(angle, distance, size, color, 1.0F);
}

Scene Shadow::painted(const Scene& scene, float angle, float distance, float size,
                      uint32_t color) const {
    return vorel_test::painted(*core(angle, distance, size, color), scene);
}

::testing::AssertionResult Shadow::matchesLiteral(const Scene& scene, float angle, float distance,
                                                  float size, uint32_t color) const {
    auto same = paintsLike(*core(angle, distance, size, color), scene, [&](Scene& expected) {
        paintLiteral(expected.dst, expected.mask, expected.text, angle, distance, size, color);
    });
    if (!same) same << "; angle " << angle << ", distance " << distance << ", size " << size;
    return same;
}

void Shadow::expectLiteralFormAroundTheEdges(uint8_t coverage, int angleStep, int farthest) const {
    const Scene scene = sceneOf(filledMask(12, 9, coverage), {2, 3, 9, 7});
    for (int angle = 0; angle < 360; angle += angleStep) {
        for (int size = 0; size <= 4; ++size) {
            for (int distance = 0; distance <= farthest; ++distance) {
                ASSERT_TRUE(matchesLiteral(scene, static_cast<float>(angle),
                                           static_cast<float>(distance), static_cast<float>(size)));
            }
        }
    }
}

void Shadow::expectLiteralFormOfSmallScenes(int cases, float largestSize) const {
    forSeeds(1000, cases, [&](Random& random) {
        const Scene scene = randomScene(random, 32);
        const float size = random.chance(50) ? static_cast<float>(random.between(0, 9))
                                             : random.real(-1.0F, largestSize);
        EXPECT_TRUE(matchesLiteral(scene, random.real(-400.0F, 400.0F), random.real(0.0F, 40.0F), size,
                                   randomPremultiplied(random)));
    });
}

void Shadow::expectLiteralFormOfLargeSizes(int cases, float farthest) const {
    forSeeds(2000, cases, [&](Random& random) {
        const Scene scene = randomScene(random, 40);
        EXPECT_TRUE(matchesLiteral(scene, random.real(0.0F, 360.0F), random.real(0.0F, farthest),
                                   random.real(12.0F, 100.0F), randomPremultiplied(random)));
    });
}

void Shadow::expectLiteralFormOfTheGallery() const {
    forGallery([&](Random& random, const Mask& mask) {
        for (float size : {0.0F, 1.0F, 6.0F, 17.5F}) {
            const Scene scene = randomScene(random, mask);
            ASSERT_TRUE(matchesLiteral(scene, random.real(0.0F, 360.0F), random.real(0.0F, 20.0F), size,
                                       randomPremultiplied(random)));
            ASSERT_TRUE(matchesLiteral(sceneOf(mask), 120.0F, 5.0F, size));
        }
    });
}

void Shadow::expectClippingToTheDestination() const {
    forOtherDestinations(300, 16, 24, [&](Random& random, const Scene& scene) {
        EXPECT_TRUE(matchesLiteral(scene, random.real(0.0F, 360.0F), random.real(0.0F, 30.0F),
                                   random.real(0.0F, 6.0F), randomPremultiplied(random)));
    });
}

// --- Gradients --------------------------------------------------------------------------------------

const Gradient::Stops& Gradient::ramp() {
    static const Stops stops{{kBlack, 1.0F, 0.0F}, {kWhite, 1.0F, 1.0F}};
    return stops;
}

std::unique_ptr<VFECore> Gradient::core(float angle, float scale, const Stops& stops) const {
    std::vector<VFGradient> array = libraryStops(stops);
    return makeCore(angle, scale, 1.0F, static_cast<int>(array.size()), array.data());
}

Scene Gradient::painted(const Scene& scene, float angle, float scale, const Stops& stops) const {
    return vorel_test::painted(*core(angle, scale, stops), scene);
}

void Gradient::expectNothingWithoutStops() const {
    const Scene scene = sceneOf(filledMask(8, 8, 255));
    VFGradient stops[] = {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}};
    for (int count : {0, -1, std::numeric_limits<int>::min()}) {
        EXPECT_TRUE(paintsNothing(*makeCore(0.0F, 1.0F, 1.0F, count, stops), scene)) << count;
    }
    for (int count : {0, 1, 2, 256, -5}) {
        EXPECT_TRUE(paintsNothing(*makeCore(0.0F, 1.0F, 1.0F, count, nullptr), scene)) << count;
    }
}

void Gradient::expectOpacitiesNotRead(float angle) const {
    const Scene scene = sceneOf(filledMask(20, 20, 255));
    VFGradient faintRamp[] = {{kBlack, 0.1F, 0.0F}, {kWhite, 0.2F, 1.0F}};
    const auto faint = makeCore(angle, 1.0F, 0.3F, 2, faintRamp);
    EXPECT_TRUE(samePaint(painted(scene, angle, 1.0F, ramp()), vorel_test::painted(*faint, scene)));
}

void Gradient::expectLinearRampOfTwoStops(TableOf tableOf) {
    const std::vector<uint32_t> table = tableOf(ramp());
    for (uint32_t i = 0; i < 256; ++i) {
        const uint32_t grey = i * 255 >> 8;
        ASSERT_EQ(0xFF000000 | grey << 16 | grey << 8 | grey, table[i]) << i;
    }
}

void Gradient::expectFirstColourBeforeTheFirstStop(TableOf tableOf) {
    const std::vector<uint32_t> table = tableOf({{kBlack, 1.0F, 0.5F}, {kWhite, 1.0F, 1.0F}});
    for (size_t i = 0; i <= 128; ++i)
        ASSERT_EQ(kBlack, table[i]) << i;
    EXPECT_EQ(0xFF7F7F7F, table[192]);  // half way: 128 * 255 >> 8
}

void Gradient::expectLastSegmentWhenStopsEndEarly(TableOf tableOf) {
    const std::vector<uint32_t> table =
        tableOf({{kBlack, 1.0F, 0.0F}, {kRed, 1.0F, 0.125F}, {kBlue, 1.0F, 0.25F}});
    EXPECT_EQ(kRed, table[32]);
    EXPECT_EQ(0xFF7F007F, table[48]);
    for (size_t i = 64; i <= 255; ++i)
        ASSERT_EQ(kBlue, table[i]) << i;
}

void Gradient::expectOneStopPassedPerEntry(TableOf tableOf) {
    // i / 256 passes 0.1, 0.1001 and 0.1002 between entries 25 and 26.
    const std::vector<uint32_t> table = tableOf({{kBlack, 1.0F, 0.0F},
                                                 {kRed, 1.0F, 0.1F},
                                                 {kGreen, 1.0F, 0.1001F},
                                                 {kBlue, 1.0F, 0.1002F},
                                                 {kBlack, 1.0F, 1.0F}});
    EXPECT_EQ(kGreen, table[26]);
    EXPECT_EQ(kBlue, table[27]);
    EXPECT_EQ(0xFF0000FDU, table[28]);  // 2 of 256 towards black
}

}  // namespace vorel_test
