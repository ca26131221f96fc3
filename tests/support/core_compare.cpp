#include "core_compare.h"

#include <algorithm>
#include <limits>

#include "compare.h"
#include "mask_gallery.h"

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

}  // namespace vorel_test
