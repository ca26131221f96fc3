#include "line.h"

#include <ft2build.h>
#include <png.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include FT_FREETYPE_H

using namespace VFontEffect;

namespace {

constexpr const char* kFont = "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf";

/// A channel of a straight pixel from that of a premultiplied one.
unsigned char straight(unsigned char channel, unsigned char alpha) {
    if (alpha == 0) return 0;
    return static_cast<unsigned char>(std::min(255, (channel * 255 + alpha / 2) / alpha));
}

/// The coverage in packed rows: FreeType may pad its own.
std::vector<unsigned char> packed(const FT_Bitmap& bitmap) {
    std::vector<unsigned char> coverage;
    for (unsigned row = 0; row < bitmap.rows; ++row) {
        const unsigned char* start = bitmap.buffer + static_cast<int>(row) * bitmap.pitch;
        coverage.insert(coverage.end(), start, start + bitmap.width);
    }
    return coverage;
}

}  // namespace

Line::Line(const char* text, int pixels) {
    FT_Library library = nullptr;
    FT_Face face = nullptr;
    check(FT_Init_FreeType(&library) == 0 && FT_New_Face(library, kFont, 0, &face) == 0, "a font");
    FT_Set_Pixel_Sizes(face, 0, static_cast<FT_UInt>(pixels));
    int pen = 0;
    for (; *text != '\0'; ++text) {
        if (FT_Load_Char(face, static_cast<unsigned char>(*text), FT_LOAD_RENDER) != 0) continue;
        const FT_GlyphSlot slot = face->glyph;
        if (slot->bitmap.width > 0) {
            mCoverage.push_back(packed(slot->bitmap));
            glyphs.push_back({pen + slot->bitmap_left, -slot->bitmap_top, mCoverage.back().data(),
                              static_cast<int>(slot->bitmap.width),
                              static_cast<int>(slot->bitmap.rows)});
        }
        pen += static_cast<int>(slot->advance.x >> 6);  // 64ths of a pixel
    }
    FT_Done_Face(face);
    FT_Done_FreeType(library);
}

Page::Page(int pageWidth, int pageHeight, Color color) : width(pageWidth), height(pageHeight) {
    const unsigned char rgba[] = {static_cast<unsigned char>(color.value >> 16),
                                  static_cast<unsigned char>(color.value >> 8 & 255U),
                                  static_cast<unsigned char>(color.value & 255U), 255};
    for (int pixel = 0; pixel < width * height; ++pixel)
        pixels.insert(pixels.end(), std::begin(rgba), std::end(rgba));
}

void writePng(const char* path, const PictureView& picture) {
    const bool isBgra = picture.order == PixelOrder::bgra;
    std::vector<unsigned char> rgba;
    for (int y = 0; y < picture.height; ++y) {
        const std::ptrdiff_t stride = picture.stride == 0 ? 4 * picture.width : picture.stride;
        const unsigned char* pixel = picture.data + y * stride;
        for (int x = 0; x < picture.width; ++x, pixel += 4) {
            for (const int channel : {isBgra ? 2 : 0, 1, isBgra ? 0 : 2})
                rgba.push_back(straight(pixel[channel], pixel[3]));
            rgba.push_back(pixel[3]);
        }
    }
    png_image png = {};
    png.version = PNG_IMAGE_VERSION;
    png.width = static_cast<png_uint_32>(picture.width);
    png.height = static_cast<png_uint_32>(picture.height);
    png.format = PNG_FORMAT_RGBA;
    check(png_image_write_to_file(&png, path, 0, rgba.data(), 0, nullptr) != 0, "a PNG");
}

void check(bool isTrue, const char* words) {
    if (isTrue) return;
    std::fprintf(stderr, "not so: %s\n", words);
    std::exit(1);
}
