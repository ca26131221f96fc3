#include "text/picture_scaling.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "support/random.h"
#include "support/thinned.h"

namespace voreltext {
namespace {

/// A picture with the bytes that it is a view of.
struct Source {
    int width;
    int height;
    std::vector<uint8_t> bytes;  ///< B, G, R, A

    PictureView view() const { return {bytes.data(), ptrdiff_t{width} * 4, width, height}; }
};

/// The length that two stretches have in common.
int64_t common(int64_t begin, int64_t end, int64_t otherBegin, int64_t otherEnd) {
    return std::max<int64_t>(0, std::min(end, otherEnd) - std::max(begin, otherBegin));
}

/// The mean by area of what covers a pixel: every pixel of the picture is looked at.
std::vector<uint8_t> literalPixel(const Source& source, const PicturePlace& place, int x, int y) {
    const int64_t pixel = int64_t{64} * place.from;
    const int64_t step = int64_t{64} * place.to;
    const int64_t left = place.left * step + place.x * place.from;
    const int64_t top = place.top * step + place.y * place.from;
    std::vector<int64_t> sums(4, pixel * pixel / 2);
    for (int row = 0; row < source.height; ++row) {
        for (int column = 0; column < source.width; ++column) {
            const int64_t area =
                common(x * pixel, (x + 1) * pixel, left + column * step, left + (column + 1) * step) *
                common(y * pixel, (y + 1) * pixel, top + row * step, top + (row + 1) * step);
            for (size_t i = 0; i < 4; ++i)
                sums[i] += area * source.bytes[static_cast<size_t>(row * source.width + column) * 4 + i];
        }
    }
    std::vector<uint8_t> colour;
    for (const size_t channel : {2U, 1U, 0U, 3U})
        colour.push_back(static_cast<uint8_t>(sums[channel] / (pixel * pixel)));
    return colour;
}

std::vector<uint8_t> pixelAt(const GlyphMask& mask, int x, int y) {
    const auto at =
        mask.pixels.begin() + 4 * ((y - mask.box.top) * mask.box.width() + x - mask.box.left);
    return {at, at + 4};
}

const Source kRed{1, 1, {0, 0, 255, 255}};

TEST(PictureScaling, InItsOwnSize_KeepsItsPixels) {
    const Source source{2, 1, {10, 20, 30, 40, 1, 2, 3, 4}};
    const GlyphMask mask = scaledPicture(source.view(), {-1, 5, 7, 7, 0, 0});
    EXPECT_EQ(mask.box.left, -1);
    EXPECT_EQ(mask.box.top, 5);
    EXPECT_EQ(mask.box.right, 1);
    EXPECT_EQ(mask.box.bottom, 6);
    EXPECT_EQ(mask.pixels, (std::vector<uint8_t>{30, 20, 10, 40, 3, 2, 1, 4}));
    EXPECT_EQ(mask.coverage, (std::vector<uint8_t>{40, 4}));
}

TEST(PictureScaling, HalfTheSize_IsTheMeanOfFour) {
    const Source source{2, 2, {0, 0, 255, 255, 0, 0, 0, 0, 100, 0, 0, 100, 0, 0, 0, 3}};
    const GlyphMask mask = scaledPicture(source.view(), {0, 0, 1, 2, 0, 0});
    EXPECT_EQ(mask.box.width(), 1);
    EXPECT_EQ(mask.pixels, (std::vector<uint8_t>{64, 0, 25, 90})) << "63.75, 0, 25 and 89.5";
}

TEST(PictureScaling, FractionOfAPixel_IsSharedByItsNeighbours) {
    // A pixel that stands 16 of 64 to the right and 32 down.
    const GlyphMask mask = scaledPicture(kRed.view(), {0, 0, 1, 1, 16, 32});
    EXPECT_EQ(mask.box.width(), 2);
    EXPECT_EQ(mask.box.height(), 2);
    EXPECT_EQ(mask.coverage, (std::vector<uint8_t>{96, 32, 96, 32})) << "3/8 and 1/8 of 255";
}

TEST(PictureScaling, Enlarged_FillsItsSquare) {
    const GlyphMask mask = scaledPicture(kRed.view(), {-1, -1, 3, 2, 0, 0});
    // A pixel and a half, up to the origin.
    EXPECT_EQ(mask.box.left, -2);
    EXPECT_EQ(mask.box.right, 0);
    EXPECT_EQ(mask.coverage, (std::vector<uint8_t>{64, 128, 128, 255}));
}

TEST(PictureScaling, RowsFromBelow_AreReadByTheirPitch) {
    const std::vector<uint8_t> bytes{1, 1, 1, 1, 9, 9, 9, 9, 2, 2, 2, 2, 9, 9, 9, 9};
    const GlyphMask mask = scaledPicture({bytes.data() + 8, -8, 1, 2}, {0, 0, 1, 1, 0, 0});
    EXPECT_EQ(mask.coverage, (std::vector<uint8_t>{2, 1}));
}

TEST(PictureScaling, AnySizeAndPlace_IsTheLiteralForm) {
    vorel_test::Random random(20240607);
    for (int round = 0; round < vorel_test::thinned(4000); ++round) {
        Source source{random.between(1, 7), random.between(1, 7), {}};
        for (int i = 0; i < source.width * source.height; ++i) {
            const int alpha = random.between(0, 255);
            for (int channel = 0; channel < 3; ++channel)
                source.bytes.push_back(static_cast<uint8_t>(random.between(0, alpha)));
            source.bytes.push_back(static_cast<uint8_t>(alpha));
        }
        const PicturePlace place{random.between(-9, 9),   random.between(-9, 9),
                                 random.between(1, 40),   random.between(1, 40),
                                 random.between(-99, 99), random.between(-99, 99)};
        const GlyphMask mask = scaledPicture(source.view(), place);
        const Box box = boxOf(source.view(), place);
        ASSERT_EQ(mask.box.left, box.left);
        ASSERT_EQ(mask.box.bottom, box.bottom);
        ASSERT_EQ(mask.pixels.size(), static_cast<size_t>(box.width() * box.height() * 4));
        for (int y = box.top - 1; y <= box.bottom; ++y) {
            for (int x = box.left - 1; x <= box.right; ++x) {
                const bool isInside = x >= box.left && x < box.right && y >= box.top && y < box.bottom;
                const std::vector<uint8_t> expected = literalPixel(source, place, x, y);
                ASSERT_EQ(isInside ? pixelAt(mask, x, y) : std::vector<uint8_t>(4, 0), expected)
                    << "round " << round << " at " << x << ' ' << y;
                ASSERT_LE(*std::max_element(expected.begin(), expected.end()), expected[3]);
            }
        }
    }
}

}  // namespace
}  // namespace voreltext
