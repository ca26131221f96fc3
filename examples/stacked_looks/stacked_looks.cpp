// A double outline. A set holds one effect of a kind: a second addStrokeText would change the first
// stroke. So there are two sets, each painted into a picture of its own, one laid over the other.
//
//     stacked_looks [TEXT [FONT_FILE [PICTURE.png]]]
#include <ft2build.h>
#include <png.h>
#include <voreleffect/voreleffect.h>

#include <algorithm>
#include <cstdio>
#include <vector>
#include FT_FREETYPE_H

using namespace VFontEffect;

namespace {

constexpr int kTextPixels = 120;
constexpr int kLetterSpacing = 8;
constexpr int kPaper[] = {0x2F, 0x9E, 0x8F};

/// A line of text as one mask: the library takes a whole line as well as glyph by glyph.
struct LineMask {
    int width;
    int height;
    std::vector<unsigned char> coverage;
};

LineMask drawLine(FT_Face face, const char* text) {
    const int ascent = static_cast<int>(face->size->metrics.ascender >> 6);
    const int height = static_cast<int>(face->size->metrics.height >> 6);
    int width = 0;
    for (const char* c = text; *c != '\0'; ++c) {
        if (FT_Load_Char(face, static_cast<unsigned char>(*c), FT_LOAD_DEFAULT) != 0) continue;
        width += static_cast<int>(face->glyph->advance.x >> 6) + kLetterSpacing;
    }

    LineMask line = {width, height, std::vector<unsigned char>(static_cast<size_t>(width * height))};
    int pen = kLetterSpacing / 2;
    for (const char* c = text; *c != '\0'; ++c) {
        if (FT_Load_Char(face, static_cast<unsigned char>(*c), FT_LOAD_RENDER) != 0) continue;
        const FT_Bitmap& bitmap = face->glyph->bitmap;
        for (int row = 0; row < static_cast<int>(bitmap.rows); ++row) {
            const int y = ascent - face->glyph->bitmap_top + row;
            for (int column = 0; column < static_cast<int>(bitmap.width); ++column) {
                const int x = pen + face->glyph->bitmap_left + column;
                if (x < 0 || x >= width || y < 0 || y >= height) continue;
                unsigned char& cell = line.coverage[static_cast<size_t>(y * width + x)];
                cell = std::max(cell, bitmap.buffer[row * bitmap.pitch + column]);
            }
        }
        pen += static_cast<int>(face->glyph->advance.x >> 6) + kLetterSpacing;
    }
    return line;
}

/// Paints the line with its top left corner at (left, top) of a picture of this size.
VFBitmap paint(VFEffect& look, LineMask& line, int left, int top, int width, int height) {
    VFBitmap picture(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
    VFGlyph glyph = {line.coverage.data(), static_cast<unsigned short>(line.width),
                     static_cast<unsigned short>(line.height)};
    look.initEffect(width, height);
    look.setDstBitmap(&picture);
    look.renderEffectLayer(left, top, &glyph);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);
    return picture;
}

/// Lays a premultiplied picture over opaque pixels.
void layOver(std::vector<unsigned char>& rgb, const VFBitmap& picture) {
    const unsigned char* source = picture.mData;
    for (size_t i = 0; i < rgb.size(); i += 3, source += 4) {
        for (size_t channel = 0; channel < 3; ++channel) {
            const int through = rgb[i + channel] * (255 - source[3]) / 255;
            rgb[i + channel] = static_cast<unsigned char>(std::min(source[channel] + through, 255));
        }
    }
}

bool writePng(const char* path, int width, int height, const std::vector<unsigned char>& rgb) {
    png_image png = {};
    png.version = PNG_IMAGE_VERSION;
    png.width = static_cast<png_uint_32>(width);
    png.height = static_cast<png_uint_32>(height);
    png.format = PNG_FORMAT_RGB;
    return png_image_write_to_file(&png, path, 0, rgb.data(), 0, nullptr) != 0;
}

}  // namespace

int main(int argc, char** argv) {
    const char* text = argc > 1 ? argv[1] : "Two rims";
    const char* font = argc > 2 ? argv[2] : "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf";
    const char* path = argc > 3 ? argv[3] : "stacked_looks.png";

    FT_Library library = nullptr;
    FT_Face face = nullptr;
    if (FT_Init_FreeType(&library) != 0 || FT_New_Face(library, font, 0, &face) != 0 ||
        FT_Set_Pixel_Sizes(face, 0, kTextPixels) != 0) {
        std::fprintf(stderr, "cannot read the font %s\n", font);
        return 1;
    }
    LineMask line = drawLine(face, text);
    FT_Done_Face(face);
    FT_Done_FreeType(library);

    VFEffect below;
    below.addStrokeText(14, 0x1D2A44, 1, 0, 1);  // the outer rim: wide enough to show around the inner
    below.addText(0x1D2A44, 1);

    VFEffect above;
    VFGradient candy[] = {{0xFFE27A, 1, 0}, {0xFF7E5F, 1, 1}};
    above.addLinearGradientText(270, 1, 1, 2, candy);  // downwards
    above.addStrokeText(6, 0xFFFFFF, 1, 0, 1);         // the inner rim
    above.addText(0, 1);                               // beneath the gradient

    // Both pictures share size and origin, so the margins are the larger ones of the two.
    const int left = std::max(below.getLeftOffset(), above.getLeftOffset());
    const int top = std::max(below.getTopOffset(), above.getTopOffset());
    const int width = left + line.width + std::max(below.getRightOffset(), above.getRightOffset());
    const int height = top + line.height + std::max(below.getBottomOffset(), above.getBottomOffset());

    std::vector<unsigned char> rgb;
    for (int pixel = 0; pixel < width * height; ++pixel) {
        for (const int channel : kPaper)
            rgb.push_back(static_cast<unsigned char>(channel));
    }
    layOver(rgb, paint(below, line, left, top, width, height));
    layOver(rgb, paint(above, line, left, top, width, height));
    if (!writePng(path, width, height, rgb)) {
        std::fprintf(stderr, "cannot write %s\n", path);
        return 1;
    }
    return 0;
}
