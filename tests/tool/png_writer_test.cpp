#include "png_writer.h"

#include <gtest/gtest.h>
#include <png.h>

#include <algorithm>
#include <array>
#include <random>
#include <string>
#include <vector>

#include "compose/system/png_reader.h"
#include "program.h"
#include "style_file.h"

namespace vorelpaint {
namespace {

using Bytes = std::vector<uint8_t>;
using vorelcompose::readPng;
using voreltext::Image;

constexpr std::array<PngEffort, 3> kEfforts{PngEffort::fast, PngEffort::normal, PngEffort::small};
constexpr size_t kKind = 25;  ///< where the file says what its samples are

class PngWriter : public ::testing::Test {
  protected:
    /// What libpng, which checks every chunk, reads of a file.
    Image readBack(const Bytes& file) {
        return readPng(mDir.write("a.png", std::string(file.begin(), file.end())));
    }

    void expectReadBack(const Image& image) {
        for (const PngEffort effort : kEfforts) {
            const Image read = readBack(encodedPng(image, effort));
            EXPECT_EQ(read.width, image.width);
            EXPECT_EQ(read.height, image.height);
            EXPECT_EQ(read.pixels, image.pixels) << static_cast<int>(effort);
        }
    }

    vorel_test::TempDir mDir;
};

/// Pixels of one of `colours` colours each, of any alpha or opaque.
Image randomImage(std::mt19937& random, int width, int height, size_t colours, bool opaque) {
    std::vector<std::array<uint8_t, 4>> palette(colours);
    for (auto& colour : palette) {
        for (uint8_t& channel : colour)
            channel = static_cast<uint8_t>(random());
        if (opaque) colour[3] = 255;
    }
    Image image{width, height, {}};
    for (int i = 0; i < width * height; ++i) {
        const auto& colour = palette[random() % colours];
        image.pixels.insert(image.pixels.end(), colour.begin(), colour.end());
    }
    return image;
}

/// Like a photograph: every channel a slow wave with a little noise.
Image photograph(int width, int height) {
    std::mt19937 random(3);
    Image image{width, height, {}};
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            for (const int slope : {3, 5, 7})
                image.pixels.push_back(
                    static_cast<uint8_t>((x * slope + y * 2) / 4 + static_cast<int>(random() % 3)));
            image.pixels.push_back(255);
        }
    }
    return image;
}

TEST_F(PngWriter, OnePixel_IsReadBack) {
    expectReadBack({1, 1, {1, 2, 3, 4}});
    expectReadBack({1, 1, {0, 0, 0, 0}});
    expectReadBack({1, 2, {1, 2, 3, 4, 5, 6, 7, 255}});
}

TEST_F(PngWriter, AnyPicture_IsReadBack) {
    std::mt19937 random(20263);
    for (int round = 0; round < 60; ++round) {
        const int width = 1 + static_cast<int>(random() % 60);
        const int height = 1 + static_cast<int>(random() % 60);
        const size_t colours = size_t{1} << (random() % 12);
        expectReadBack(randomImage(random, width, height, colours, random() % 2 == 0));
    }
}

TEST_F(PngWriter, Photograph_IsReadBack) {
    expectReadBack(photograph(200, 100));
}

/// 256 colours have a palette, the 257th takes it away.
TEST_F(PngWriter, Palette_HasRoomFor256Colours) {
    Image image{257, 1, {}};
    for (int i = 0; i < 257; ++i) {
        const auto low = static_cast<uint8_t>(i);
        const auto high = static_cast<uint8_t>(i >> 8);
        image.pixels.insert(image.pixels.end(), {low, high, 7, static_cast<uint8_t>(255 - low)});
    }
    expectReadBack(image);
    EXPECT_EQ(encodedPng(image, PngEffort::normal)[kKind], 6);
    image.width = 256;
    image.pixels.resize(256 * 4);
    expectReadBack(image);
    EXPECT_EQ(encodedPng(image, PngEffort::normal)[kKind], 3);
}

TEST_F(PngWriter, GreyPicture_HasOneChannelOfColour) {
    Image image{512, 1, {}};
    for (int i = 0; i < 512; ++i) {
        const auto grey = static_cast<uint8_t>(i);
        image.pixels.insert(image.pixels.end(), {grey, grey, grey, static_cast<uint8_t>(255 - i / 2)});
    }
    expectReadBack(image);
    EXPECT_EQ(encodedPng(image, PngEffort::normal)[kKind], 4);
    Image opaque = image;
    for (size_t at = 3; at < opaque.pixels.size(); at += 4)
        opaque.pixels[at] = 255;
    expectReadBack(opaque);
    EXPECT_EQ(encodedPng(opaque, PngEffort::normal)[kKind], 0);
    for (size_t i = 0; i < 3; ++i) {
        Image coloured = image;
        coloured.pixels[4 * 300 + i] ^= 1;
        expectReadBack(coloured);
        EXPECT_EQ(encodedPng(coloured, PngEffort::normal)[kKind], 6) << i;
    }
}

TEST_F(PngWriter, OpaquePictureOfManyColours_HasNoAlpha) {
    EXPECT_EQ(encodedPng(photograph(100, 100), PngEffort::normal)[kKind], 2);
}

TEST_F(PngWriter, Photograph_IsFiltered) {
    const Image image = photograph(300, 200);
    EXPECT_LT(encodedPng(image, PngEffort::normal).size(),
              encodedPng(image, PngEffort::fast).size() / 2);
}

TEST_F(PngWriter, Small_IsTheSmallest) {
    const Image image = photograph(300, 200);
    const size_t small = encodedPng(image, PngEffort::small).size();
    EXPECT_LT(small, encodedPng(image, PngEffort::normal).size());
    EXPECT_LT(small, encodedPng(image, PngEffort::fast).size());
}

/// The size of libpng's file by default.
size_t sizeByLibpng(const Image& image) {
    png_image record{};
    record.version = PNG_IMAGE_VERSION;
    record.width = static_cast<png_uint_32>(image.width);
    record.height = static_cast<png_uint_32>(image.height);
    record.format = PNG_FORMAT_RGBA;
    png_alloc_size_t size = PNG_IMAGE_PNG_SIZE_MAX(record);
    Bytes file(size);
    EXPECT_NE(png_image_write_to_memory(&record, file.data(), &size, 0, image.pixels.data(), 0, nullptr),
              0);
    return size;
}

TEST_F(PngWriter, PresetsTogether_AreSmallerThanByLibpng) {
    size_t byLibpng = 0;
    size_t fast = 0;
    size_t normal = 0;
    for (const std::string& preset : presetNames()) {
        const std::string path = mDir.file("preset.png");
        vorel_test::runVorelpaint(
            {"--preset", preset, "--font", VOREL_TEST_FONT, "-o", path, "Typefaces"});
        const Image image = readPng(path);
        byLibpng += sizeByLibpng(image);
        fast += encodedPng(image, PngEffort::fast).size();
        normal += encodedPng(image, PngEffort::normal).size();
    }
    EXPECT_LT(fast, byLibpng);
    EXPECT_LE(normal, fast);
}

}  // namespace
}  // namespace vorelpaint
