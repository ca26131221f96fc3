#include "compose/system/png_reader.h"

#include <gtest/gtest.h>
#include <png.h>

#include <cstdint>
#include <string>
#include <vector>

#include "compose/error.h"
#include "tests/tool/temp_dir.h"

namespace vorelcompose {
namespace {

using Bytes = std::vector<uint8_t>;
using vorel_test::readBytes;
using voreltext::Image;

class PngReader : public ::testing::Test {
  protected:
    /// A PNG of one row in one of libpng's formats.
    std::string write(png_uint_32 format, png_uint_32 width, const void* pixels,
                      const void* palette = nullptr, png_uint_32 colours = 0) {
        png_image png{};
        png.version = PNG_IMAGE_VERSION;
        png.width = width;
        png.height = 1;
        png.format = format;
        png.colormap_entries = colours;
        const std::string path = mDir.file("a.png");
        EXPECT_NE(png_image_write_to_file(&png, path.c_str(), 0, pixels, 0, palette), 0) << png.message;
        return path;
    }

    std::string faultOf(const std::string& path) {
        try {
            readPng(path);
            return "";
        } catch (const ComposeError& error) {
            return error.what();
        }
    }

    vorel_test::TempDir mDir;
};

TEST_F(PngReader, Grey_IsReadAsOpaqueColours) {
    const Bytes row{0, 100, 255};
    EXPECT_EQ(readPng(write(PNG_FORMAT_GRAY, 3, row.data())).pixels,
              (Bytes{0, 0, 0, 255, 100, 100, 100, 255, 255, 255, 255, 255}));
}

TEST_F(PngReader, Palette_IsReadAsItsColours) {
    const Bytes palette{10, 20, 30, 40, 50, 60};
    const Bytes row{1, 0};
    EXPECT_EQ(readPng(write(PNG_FORMAT_RGB_COLORMAP, 2, row.data(), palette.data(), 2)).pixels,
              (Bytes{40, 50, 60, 255, 10, 20, 30, 255}));
}

TEST_F(PngReader, SixteenBits_AreReadAsEight) {
    const std::vector<uint16_t> row{0, 65535};
    const std::string path = write(PNG_FORMAT_LINEAR_Y, 2, row.data());
    constexpr size_t kBitDepth = 24;
    ASSERT_EQ(readBytes(path).at(kBitDepth), 16);
    EXPECT_EQ(readPng(path).pixels, (Bytes{0, 0, 0, 255, 255, 255, 255, 255}));
}

TEST_F(PngReader, OtherFiles_AreRefusedByName) {
    const std::string path = mDir.write("a.png", "GIF89a");
    EXPECT_EQ(faultOf(path).rfind("'" + path + "' is no readable PNG: ", 0), 0U);
    EXPECT_NE(faultOf(mDir.write("b.png", "")).find("no readable PNG"), std::string::npos);
}

TEST_F(PngReader, TruncatedPicture_IsRefused) {
    const Bytes row(600, 77);
    const std::string whole = readBytes(write(PNG_FORMAT_GRAY, 600, row.data()));
    constexpr size_t kHeader = 33;  // the signature and the first chunk
    for (const size_t size : {size_t{20}, kHeader, whole.size() - 20}) {
        const std::string fault = faultOf(mDir.write("cut.png", whole.substr(0, size)));
        EXPECT_NE(fault.find("is no readable PNG: "), std::string::npos) << size;
    }
}

TEST_F(PngReader, SideBeyondTheLimit_IsRefused) {
    const Bytes row(4097, 1);
    EXPECT_EQ(readPng(write(PNG_FORMAT_GRAY, 4096, row.data())).width, 4096);
    const std::string path = write(PNG_FORMAT_GRAY, 4097, row.data());
    EXPECT_EQ(faultOf(path), "'" + path + "' has more than 4096 pixels on a side");
}

}  // namespace
}  // namespace vorelcompose
