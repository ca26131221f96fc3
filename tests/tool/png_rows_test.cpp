#include "png_rows.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <random>
#include <vector>

namespace vorelpaint {
namespace {

using Bytes = std::vector<uint8_t>;

Bytes randomPixels(std::mt19937& random, size_t count, unsigned int most) {
    Bytes pixels(4 * count);
    for (uint8_t& byte : pixels)
        byte = static_cast<uint8_t>(random() % (most + 1));
    return pixels;
}

/// The predictor of the format's own text.
int paethLiterally(int a, int b, int c) {
    const int p = a + b - c;
    const int pa = std::abs(p - a);
    const int pb = std::abs(p - b);
    const int pc = std::abs(p - c);
    if (pa <= pb && pa <= pc) return a;
    return pb <= pc ? b : c;
}

/// Undoes the filters, byte by byte.
Bytes unfilteredLiterally(const Bytes& stream, size_t rowBytes, size_t bytesPerPixel) {
    Bytes bytes;
    const size_t count = rowBytes - 1;
    for (size_t row = 0; row * rowBytes < stream.size(); ++row) {
        const int filter = stream[row * rowBytes];
        const size_t begin = bytes.size();
        for (size_t i = 0; i < count; ++i) {
            const int a = i >= bytesPerPixel ? bytes[begin + i - bytesPerPixel] : 0;
            const int b = row > 0 ? bytes[begin + i - count] : 0;
            const int c = row > 0 && i >= bytesPerPixel ? bytes[begin + i - count - bytesPerPixel] : 0;
            const int guesses[]{0, a, b, (a + b) / 2, paethLiterally(a, b, c)};
            bytes.push_back(static_cast<uint8_t>(stream[row * rowBytes + 1 + i] + guesses[filter]));
        }
    }
    return bytes;
}

TEST(PngRows, Unfiltered_HasA0BeforeEachRow) {
    const Bytes pixels{1, 2, 3, 4, 5, 6, 7, 8};
    EXPECT_EQ(unfiltered({pixels.data(), 2, 1, kRgba}), (Bytes{0, 1, 2, 3, 4, 5, 6, 7, 8}));
    EXPECT_EQ(unfiltered({pixels.data(), 1, 2, kRgba}), (Bytes{0, 1, 2, 3, 4, 0, 5, 6, 7, 8}));
    EXPECT_EQ(unfiltered({pixels.data(), 1, 2, kRgb}), (Bytes{0, 1, 2, 3, 0, 5, 6, 7}));
    EXPECT_EQ(unfiltered({pixels.data(), 1, 2, kGreyAlpha}), (Bytes{0, 1, 4, 0, 5, 8}));
    EXPECT_EQ(unfiltered({pixels.data(), 2, 1, kGrey}), (Bytes{0, 1, 5}));
}

TEST(PngRows, Filters_AreUndoneByTheirLiteralForm) {
    std::mt19937 random(11);
    for (int round = 0; round < 300; ++round) {
        const size_t width = 1 + random() % 20;
        const size_t height = 1 + random() % 8;
        const Bytes pixels = randomPixels(random, width * height, round % 2 == 0 ? 255 : 3);
        for (const PngChannels& channels : {kGrey, kGreyAlpha, kRgb, kRgba}) {
            const PngRows rows{pixels.data(), width, height, channels};
            Bytes packed;
            for (size_t i = 0; i < pixels.size(); ++i) {
                const size_t* end = &channels.places[0] + channels.count;
                if (std::find(&channels.places[0], end, i % 4) != end) packed.push_back(pixels[i]);
            }
            ASSERT_EQ(unfilteredLiterally(filtered(rows), rows.rowBytes(), channels.count), packed);
        }
    }
}

TEST(PngRows, EachRow_HasTheFilterThatLeavesLeast) {
    // Up leaves nothing of a row that is the one above, Sub next to nothing of a slope.
    Bytes pixels;
    for (int y = 0; y < 2; ++y) {
        for (int x = 0; x < 32; ++x)
            pixels.insert(pixels.end(), 4, static_cast<uint8_t>(7 * x));
    }
    const PngRows rows{pixels.data(), 32, 2, kRgba};
    const Bytes stream = filtered(rows);
    EXPECT_EQ(stream[0], 1);
    EXPECT_EQ(stream[rows.rowBytes()], 2);
}

bool isOfNew(const Bytes& numbers, size_t width) {
    Bytes pixels;
    for (const uint8_t number : numbers)
        pixels.insert(pixels.end(), {1, 2, number, 4});
    return isOfNewPixels({pixels.data(), width, numbers.size() / width, kRgba});
}

/// The first row and column are only looked at.
TEST(PngRows, PixelsAreNew_WhereMostCameNotBefore) {
    EXPECT_TRUE(isOfNew({0, 0, 0, 0, 0, 1, 2, 3}, 4)) << "three new ones";
    EXPECT_TRUE(isOfNew({0, 0, 0, 0, 0, 0, 0, 1, 2, 3, 4, 1}, 6)) << "four of five";
    EXPECT_FALSE(isOfNew({0, 0, 0, 0, 0, 0, 1, 2, 3, 1}, 5)) << "three of four";
}

/// Those of the rows between are not looked at.
TEST(PngRows, PixelsAreNew_InEveryFourthRow) {
    const Bytes seen{0, 0, 0, 0, 0, 1, 2, 3};
    const Bytes between{0, 1, 2, 1, 0, 3, 1, 3, 0, 1, 3, 1};
    Bytes rows = seen;
    rows.insert(rows.end(), between.begin(), between.end());
    EXPECT_TRUE(isOfNew(rows, 4));
    rows.insert(rows.end(), {0, 2, 3, 2});
    EXPECT_FALSE(isOfNew(rows, 4));
}

TEST(PngRows, PixelsLikeANeighbour_AreNotCounted) {
    EXPECT_FALSE(isOfNew({0, 1, 2, 3, 0, 1, 2, 3}, 4)) << "above";
    EXPECT_FALSE(isOfNew({0, 0, 0, 0, 5, 5, 5, 5}, 4)) << "on the left";
    EXPECT_FALSE(isOfNew({1, 2, 3, 4}, 4)) << "one row";
    EXPECT_FALSE(isOfNew({1, 2, 3, 4}, 1)) << "one column";
}

}  // namespace
}  // namespace vorelpaint
