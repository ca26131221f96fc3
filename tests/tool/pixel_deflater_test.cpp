#include "pixel_deflater.h"

#include <gtest/gtest.h>
#include <libdeflate.h>

#include <memory>
#include <random>
#include <vector>

namespace vorelpaint {
namespace {

using Bytes = std::vector<uint8_t>;

struct FreeDecompressor {
    void operator()(libdeflate_decompressor* it) const { libdeflate_free_decompressor(it); }
};

/// What libdeflate, which checks the sum as well, reads of a stream; nothing when it is broken.
Bytes inflated(const Bytes& stream, size_t size) {
    const std::unique_ptr<libdeflate_decompressor, FreeDecompressor> reader(
        libdeflate_alloc_decompressor());
    Bytes bytes(size);
    const libdeflate_result result = libdeflate_zlib_decompress(
        reader.get(), stream.data(), stream.size(), bytes.data(), size, nullptr);
    return result == LIBDEFLATE_SUCCESS ? bytes : Bytes{};
}

void expectReadBack(const Bytes& pixels, size_t width, size_t height) {
    for (const size_t bytesPerPixel : {size_t{3}, size_t{4}}) {
        const PngRows rows{pixels.data(), width, height, bytesPerPixel};
        const Bytes wanted = unfiltered(rows);
        ASSERT_EQ(inflated(deflatedPixels(rows).stream, wanted.size()), wanted)
            << width << " x " << height << " of " << bytesPerPixel;
    }
}

void addPixel(Bytes& pixels, uint64_t colour) {
    for (int c = 0; c < 4; ++c)
        pixels.push_back(static_cast<uint8_t>(colour >> (8 * c)));
}

/// Runs of colours of a small palette, parts of earlier pixels, and pixels of any colour.
Bytes patchwork(std::mt19937& random, size_t count) {
    Bytes pixels;
    while (pixels.size() < 4 * count) {
        const size_t left = count - pixels.size() / 4;
        const size_t length = std::min<size_t>(left, 1 + random() % (1U << (random() % 10)));
        const uint64_t kind = random() % 4;
        const uint64_t colour = kind == 0 ? random() : 0x40302010U * (random() % 5);
        const size_t before = pixels.empty() ? 0 : random() % (pixels.size() / 4);
        for (size_t i = 0; i < length; ++i) {
            if (kind == 1) {
                addPixel(pixels, random());
            } else if (kind == 2 && !pixels.empty()) {
                for (size_t c = 0; c < 4; ++c)
                    pixels.push_back(pixels[4 * (before + i) + c]);
            } else {
                addPixel(pixels, colour);
            }
        }
    }
    return pixels;
}

TEST(PixelDeflater, AnyPicture_IsReadBack) {
    std::mt19937 random(20265);
    for (int round = 0; round < 400; ++round) {
        const size_t width = 1 + random() % (1U << (random() % 11));
        const size_t height = 1 + random() % 40;
        expectReadBack(patchwork(random, width * height), width, height);
    }
}

/// Deflate tells 3 to 258 bytes at once: every remainder of a run's length occurs here.
TEST(PixelDeflater, RunsOfEveryLength_AreReadBack) {
    for (size_t width = 1; width <= 400; ++width)
        expectReadBack(Bytes(4 * 3 * width, 77), width, 3);
}

/// Rows of more than 32 KiB: the row above is out of reach.
TEST(PixelDeflater, WideRows_AreReadBack) {
    std::mt19937 random(3);
    for (const size_t width : {8191U, 8192U, 10922U, 10923U, 16384U})
        expectReadBack(patchwork(random, 3 * width), width, 3);
}

TEST(PixelDeflater, NarrowRows_AreReadBack) {
    std::mt19937 random(4);
    for (const size_t width : {1U, 2U, 3U})
        expectReadBack(patchwork(random, width * 20000), width, 20000);
}

TEST(PixelDeflater, Noise_HardlyGrows) {
    std::mt19937 random(5);
    Bytes pixels(4 * 300 * 300);
    for (uint8_t& byte : pixels)
        byte = static_cast<uint8_t>(random());
    expectReadBack(pixels, 300, 300);
    EXPECT_LT(deflatedPixels({pixels.data(), 300, 300, 4}).stream.size(), pixels.size() * 101 / 100);
}

/// Two bits for each 258 bytes of a row, 31 and a rest here, and at most 24 for its begin: the filter
/// and a pixel of the row above.
TEST(PixelDeflater, OneColour_TakesElevenBytesARow) {
    const Bytes pixels(4 * 2000 * 1000, 9);
    EXPECT_LT(deflatedPixels({pixels.data(), 2000, 1000, 4}).stream.size(),
              1000 * (2 * 32 + 24) / 8 + 200);
}

TEST(PixelDeflater, FiltersAreAdvised_ForSlopesAlone) {
    std::mt19937 random(6);
    Bytes slopes;
    Bytes patches = patchwork(random, 200 * 100);
    for (unsigned int y = 0; y < 100; ++y) {
        for (unsigned int x = 0; x < 200; ++x)
            addPixel(slopes, 0x010305 * x + 0x020104 * y + random() % 2);
    }
    EXPECT_TRUE(deflatedPixels({slopes.data(), 200, 100, 4}).isBetterFiltered);
    EXPECT_FALSE(deflatedPixels({patches.data(), 200, 100, 4}).isBetterFiltered);
}

}  // namespace
}  // namespace vorelpaint
