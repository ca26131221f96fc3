// Writes the coverage masks of a line of text for the tests:
//
//     glyph_masks FONT.ttf SIZE "text" OUT
//
// OUT holds, all little-endian: a 32-bit count; then for each glyph its place in the line (two
// signed 32-bit numbers, x and y of the top left pixel), its width and height (16 bits each) and its
// coverage, one byte per pixel, top row first.
#include <ft2build.h>
#include FT_FREETYPE_H

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

void append(std::vector<uint8_t>& out, uint32_t value, int bytes) {
    for (int i = 0; i < bytes; ++i)
        out.push_back(static_cast<uint8_t>(value >> (8 * i)));
}

/// Renders `character` with the pen at `penX` and returns how far the pen moves.
int appendGlyph(std::vector<uint8_t>& out, FT_Face face, unsigned char character, int penX,
                int baseline) {
    if (FT_Load_Char(face, character, FT_LOAD_RENDER | FT_LOAD_NO_HINTING) != 0) return 0;
    const FT_GlyphSlot slot = face->glyph;
    const FT_Bitmap& bitmap = slot->bitmap;
    append(out, static_cast<uint32_t>(penX + slot->bitmap_left), 4);
    append(out, static_cast<uint32_t>(baseline - slot->bitmap_top), 4);
    append(out, bitmap.width, 2);
    append(out, bitmap.rows, 2);
    for (unsigned int y = 0; y < bitmap.rows; ++y) {
        const unsigned char* row = bitmap.buffer + static_cast<ptrdiff_t>(y) * bitmap.pitch;
        out.insert(out.end(), row, row + bitmap.width);
    }
    return static_cast<int>(slot->advance.x >> 6);
}

std::vector<uint8_t> rasterise(FT_Face face, const std::string& text) {
    std::vector<uint8_t> out;
    append(out, static_cast<uint32_t>(text.size()), 4);
    const int baseline = static_cast<int>(face->size->metrics.ascender >> 6);
    int penX = 0;
    for (const char character : text) {
        penX += appendGlyph(out, face, static_cast<unsigned char>(character), penX, baseline);
    }
    return out;
}

bool writeFile(const char* path, const std::vector<uint8_t>& bytes) {
    FILE* file = std::fopen(path, "wb");
    if (file == nullptr) return false;
    const bool written = std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size();
    return std::fclose(file) == 0 && written;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 5) {
        std::fprintf(stderr, "usage: glyph_masks FONT.ttf SIZE \"text\" OUT\n");
        return 2;
    }
    FT_Library library = nullptr;
    FT_Face face = nullptr;
    const auto pixels = static_cast<FT_UInt>(std::strtoul(argv[2], nullptr, 10));
    if (FT_Init_FreeType(&library) != 0 || FT_New_Face(library, argv[1], 0, &face) != 0 ||
        FT_Set_Pixel_Sizes(face, 0, pixels) != 0) {
        std::fprintf(stderr, "glyph_masks: cannot use %s at %s pixels\n", argv[1], argv[2]);
        return 1;
    }
    const std::vector<uint8_t> bytes = rasterise(face, argv[3]);
    FT_Done_Face(face);
    FT_Done_FreeType(library);
    if (!writeFile(argv[4], bytes)) {
        std::fprintf(stderr, "glyph_masks: cannot write %s\n", argv[4]);
        return 1;
    }
    return 0;
}
