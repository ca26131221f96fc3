// A line of text: HarfBuzz places the glyphs, FreeType draws their coverage, the library paints the run.
//
//     freetype_text [TEXT [FONT_FILE [PICTURE.png]]]
#include <ft2build.h>
#include <hb-ft.h>
#include <png.h>
#include <voreleffect/voreleffect.h>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <vector>
#include FT_FREETYPE_H

using namespace VFontEffect;

namespace {

constexpr int kTextPixels = 96;
constexpr int kPadding = 16;
constexpr int kPaper[] = {0xF4, 0xF1, 0xEA};

/// The coverage of one glyph and where its top left corner goes, from the start of the line.
struct PlacedGlyph {
    int x;
    int y;
    int width;
    int height;
    std::vector<unsigned char> coverage;
};

/// HarfBuzz and FreeType count in 64ths of a pixel.
int wholePixels(long sixtyFourths) {
    return static_cast<int>((sixtyFourths + 32) >> 6);
}

PlacedGlyph rasterise(FT_Face face, unsigned glyphIndex, long penX, long penY) {
    if (FT_Load_Glyph(face, glyphIndex, FT_LOAD_RENDER | FT_LOAD_NO_HINTING) != 0) return {};
    const FT_Bitmap& bitmap = face->glyph->bitmap;
    PlacedGlyph glyph = {wholePixels(penX) + face->glyph->bitmap_left,
                         wholePixels(-penY) - face->glyph->bitmap_top,
                         static_cast<int>(bitmap.width),
                         static_cast<int>(bitmap.rows),
                         {}};
    // FreeType may pad its rows; the library takes them packed.
    for (unsigned row = 0; row < bitmap.rows; ++row) {
        const unsigned char* start = bitmap.buffer + static_cast<int>(row) * bitmap.pitch;
        glyph.coverage.insert(glyph.coverage.end(), start, start + bitmap.width);
    }
    return glyph;
}

/// Shapes `text` (UTF-8) and gives the glyphs that have pixels.
std::vector<PlacedGlyph> layOut(FT_Face face, const char* text) {
    hb_font_t* font = hb_ft_font_create_referenced(face);
    hb_ft_font_set_load_flags(font, FT_LOAD_NO_HINTING);
    hb_buffer_t* buffer = hb_buffer_create();
    hb_buffer_add_utf8(buffer, text, -1, 0, -1);
    hb_buffer_guess_segment_properties(buffer);
    hb_shape(font, buffer, nullptr, 0);

    unsigned count = 0;
    const hb_glyph_info_t* infos = hb_buffer_get_glyph_infos(buffer, &count);
    const hb_glyph_position_t* positions = hb_buffer_get_glyph_positions(buffer, &count);
    std::vector<PlacedGlyph> glyphs;
    long penX = 0;
    long penY = 0;
    for (unsigned i = 0; i < count; ++i) {
        PlacedGlyph glyph = rasterise(face, infos[i].codepoint, penX + positions[i].x_offset,
                                      penY + positions[i].y_offset);
        if (!glyph.coverage.empty()) glyphs.push_back(std::move(glyph));
        penX += positions[i].x_advance;
        penY += positions[i].y_advance;
    }
    hb_buffer_destroy(buffer);
    hb_font_destroy(font);
    return glyphs;
}

/// Paints the glyphs as one run, so that a shadow never falls on the next letter.
VFBitmap paint(VFEffect& look, std::vector<PlacedGlyph>& glyphs) {
    VFRect box(glyphs[0].x, glyphs[0].y, glyphs[0].x, glyphs[0].y);
    for (const PlacedGlyph& glyph : glyphs) {
        box.mLeft = std::min(box.mLeft, glyph.x);
        box.mTop = std::min(box.mTop, glyph.y);
        box.mRight = std::max(box.mRight, glyph.x + glyph.width);
        box.mBottom = std::max(box.mBottom, glyph.y + glyph.height);
    }
    // The margins keep the effects from being cut off; the padding is for the eye.
    const int left = look.getLeftOffset() + kPadding - box.mLeft;
    const int top = look.getTopOffset() + kPadding - box.mTop;
    const int width = left + box.mRight + look.getRightOffset() + kPadding;
    const int height = top + box.mBottom + look.getBottomOffset() + kPadding;

    VFBitmap picture(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
    look.initEffect(width, height);
    look.setDstBitmap(&picture);
    for (PlacedGlyph& glyph : glyphs) {
        VFGlyph mask = {glyph.coverage.data(), static_cast<unsigned short>(glyph.width),
                        static_cast<unsigned short>(glyph.height)};
        look.renderEffectLayer(left + glyph.x, top + glyph.y, &mask);
    }
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);
    return picture;
}

/// Lays the premultiplied picture over the paper and writes it.
bool writePng(const char* path, const VFBitmap& picture) {
    std::vector<unsigned char> rgb;
    const unsigned char* end = picture.mData + size_t{4} * picture.mWidth * picture.mHeight;
    for (const unsigned char* pixel = picture.mData; pixel != end; pixel += 4) {
        for (int channel = 0; channel < 3; ++channel) {
            const int paper = kPaper[channel] * (255 - pixel[3]) / 255;
            rgb.push_back(static_cast<unsigned char>(std::min(pixel[channel] + paper, 255)));
        }
    }
    png_image png = {};
    png.version = PNG_IMAGE_VERSION;
    png.width = picture.mWidth;
    png.height = picture.mHeight;
    png.format = PNG_FORMAT_RGB;
    return png_image_write_to_file(&png, path, 0, rgb.data(), 0, nullptr) != 0;
}

}  // namespace

int main(int argc, char** argv) {
    const char* text = argc > 1 ? argv[1] : "Affinity, Ávila, Straße";
    const char* font = argc > 2 ? argv[2] : "/usr/share/fonts/truetype/dejavu/DejaVuSerif-Bold.ttf";
    const char* path = argc > 3 ? argv[3] : "freetype_text.png";

    FT_Library library = nullptr;
    FT_Face face = nullptr;
    if (FT_Init_FreeType(&library) != 0 || FT_New_Face(library, font, 0, &face) != 0 ||
        FT_Set_Pixel_Sizes(face, 0, kTextPixels) != 0) {
        std::fprintf(stderr, "cannot read the font %s\n", font);
        return 1;
    }
    std::vector<PlacedGlyph> glyphs = layOut(face, text);
    FT_Done_Face(face);
    FT_Done_FreeType(library);
    if (glyphs.empty()) {
        std::fprintf(stderr, "the text has no pixels\n");
        return 1;
    }

    VFEffect look;
    VFGradient metal[] = {{0x7FB4E6, 1, 0}, {0x2D6BB5, 1, 0.5F}, {0x173B73, 1, 1}};
    look.addInnerShadowText(270, 2, 2, 0xFFFFFF, 0.55F);   // light along the lower edges
    look.addLinearGradientText(270, 1, 1, 3, metal);       // downwards
    look.addStrokeText(4, 0xFFFFFF, 1, 0, 1);              // 4 pixels, outside
    look.addOuterShadowText(125, 8, 12, 0x1B2A41, 0.65F);  // light from the upper left
    look.addText(0, 1);                                    // beneath the gradient

    if (!writePng(path, paint(look, glyphs))) {
        std::fprintf(stderr, "cannot write %s\n", path);
        return 1;
    }
    return 0;
}
