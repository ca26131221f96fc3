// Sets texts and writes the masks of their glyphs: glyph_masks FONT LIST
//
// Each line of LIST is: FILE SIZE ALIGN LINE_HEIGHT LETTER_SPACING TEXT, the align as a number, the
// spacing in 64ths of a pixel, the text as UTF-8 in hexadecimal. FILE gets, as numbers of 4 bytes, the
// highest first, the count of glyphs, then of each its left, top, width, height, line, word, cluster,
// and its coverage.
#include <cstdint>
#include <fstream>
#include <initializer_list>
#include <iostream>
#include <sstream>
#include <string>
#include <vector>

#include "text/voreltext.h"
#include "unicode/utf8.h"

namespace {

using voreltext::Font;
using voreltext::Fonts;
using voreltext::Glyph;
using voreltext::GlyphMask;
using voreltext::TextLayout;
using voreltext::TextSettings;

void writeNumber(std::ostream& out, long long number) {
    for (int shift = 24; shift >= 0; shift -= 8)
        out.put(static_cast<char>(number >> shift & 0xFF));
}

std::vector<uint32_t> decoded(const std::string& hexadecimal) {
    std::string bytes;
    for (size_t i = 0; i + 1 < hexadecimal.size(); i += 2)
        bytes += static_cast<char>(std::stoi(hexadecimal.substr(i, 2), nullptr, 16));
    std::vector<uint32_t> codes;
    for (size_t at = 0; at < bytes.size();) {
        const auto [code, length] = vorelunicode::decodeAt(bytes, at);
        codes.push_back(code);
        at += length;
    }
    return codes;
}

void writeMasks(std::ostream& out, const TextLayout& layout) {
    writeNumber(out, static_cast<long long>(layout.glyphCount()));
    for (size_t i = 0; i < layout.glyphCount(); ++i) {
        const Glyph& glyph = layout.glyph(i);
        const GlyphMask mask = layout.rasterise(i);
        for (const int number : {mask.box.left, mask.box.top, mask.box.width(), mask.box.height()})
            writeNumber(out, number);
        for (const size_t number : {glyph.line, glyph.word, glyph.cluster})
            writeNumber(out, static_cast<long long>(number));
        out.write(reinterpret_cast<const char*>(mask.coverage.data()),
                  static_cast<std::streamsize>(mask.coverage.size()));
    }
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3) return 2;
    std::ifstream list(argv[2]);
    for (std::string line; std::getline(list, line);) {
        std::istringstream words(line);
        std::string file;
        std::string text;
        int size = 0;
        int align = 0;
        TextSettings settings;
        words >> file >> size >> align >> settings.lineHeight >> settings.letterSpacing >> text;
        settings.align = static_cast<voreltext::Align>(align);
        Fonts fonts(Font(voreltext::FontFile{argv[1]}, size));
        std::ofstream out(file, std::ios::binary);
        writeMasks(out, TextLayout(fonts, decoded(text), settings));
        if (!out.flush()) {
            std::cerr << file << ": cannot be written\n";
            return 1;
        }
    }
    return 0;
}
