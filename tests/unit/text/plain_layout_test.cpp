#include <ft2build.h>
#include <gtest/gtest.h>
#include FT_FREETYPE_H
#include FT_OUTLINE_H
#include <raqm.h>

#include <algorithm>
#include <iterator>
#include <memory>
#include <string>

#include "support/random.h"
#include "unit/text/test_font.h"

/// Text in one font without settings stands where raqm by itself puts it.
namespace voreltext {
namespace {

constexpr FT_Int32 kFlags = FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP;

struct DestroyRaqm {
    void operator()(raqm_t* shaper) const { raqm_destroy(shaper); }
};

/// A glyph and its origin in 64ths of a pixel, y upwards.
struct Placed {
    unsigned int index;
    FT_Pos x;
    FT_Pos y;
};

struct PlainLine {
    std::vector<Placed> glyphs;
    FT_Pos width = 0;
};

PlainLine plainLine(FT_Face face, const std::vector<uint32_t>& codes) {
    PlainLine line;
    if (codes.empty()) return line;
    const std::unique_ptr<raqm_t, DestroyRaqm> shaper(raqm_create());
    raqm_set_text(shaper.get(), codes.data(), codes.size());
    raqm_set_freetype_face(shaper.get(), face);
    raqm_set_freetype_load_flags(shaper.get(), kFlags);
    raqm_set_par_direction(shaper.get(), RAQM_DIRECTION_DEFAULT);
    EXPECT_TRUE(raqm_layout(shaper.get()));
    size_t count = 0;
    const raqm_glyph_t* glyphs = raqm_get_glyphs(shaper.get(), &count);
    for (size_t i = 0; i < count; ++i) {
        line.glyphs.push_back({glyphs[i].index, line.width + glyphs[i].x_offset, glyphs[i].y_offset});
        line.width += glyphs[i].x_advance;
    }
    return line;
}

Box boxOf(FT_Face face, const Placed& glyph) {
    EXPECT_EQ(FT_Load_Glyph(face, glyph.index, kFlags), 0);
    FT_Outline_Translate(&face->glyph->outline, glyph.x, glyph.y);
    FT_BBox outline;
    FT_Outline_Get_CBox(&face->glyph->outline, &outline);
    return {static_cast<int>(outline.xMin >> 6), -static_cast<int>((outline.yMax + 63) >> 6),
            static_cast<int>((outline.xMax + 63) >> 6), -static_cast<int>(outline.yMin >> 6)};
}

/// The boxes of glyphs with ink, centred, for source lines that end with LF.
std::vector<std::vector<int>> plainBoxes(FT_Face face, const std::vector<uint32_t>& text) {
    std::vector<PlainLine> lines;
    std::vector<uint32_t> codes;
    FT_Pos width = 0;
    for (size_t i = 0; i <= text.size(); ++i) {
        if (i < text.size() && text[i] != '\n') {
            codes.push_back(text[i]);
            continue;
        }
        lines.push_back(plainLine(face, codes));
        width = std::max(width, lines.back().width);
        codes.clear();
    }
    std::vector<std::vector<int>> boxes;
    FT_Pos baseline = 0;
    for (const PlainLine& line : lines) {
        for (const Placed& glyph : line.glyphs) {
            const Box box =
                boxOf(face, {glyph.index, glyph.x + (width - line.width) / 2, glyph.y + baseline});
            if (!box.isEmpty()) boxes.push_back(vorel_test::edges(box));
        }
        baseline -= face->size->metrics.height;
    }
    return boxes;
}

std::vector<std::vector<int>> boxesOf(const TextLayout& layout) {
    std::vector<std::vector<int>> boxes;
    for (size_t i = 0; i < layout.glyphCount(); ++i)
        boxes.push_back(vorel_test::edges(layout.glyph(i).box));
    return boxes;
}

TEST(PlainLayout, Glyphs_StandInTheirOrderAndPlace) {
    for (const char* file : {VOREL_TEST_FONT, vorel_test::kArabicFont, vorel_test::kThaiFont}) {
        Fonts fonts{Font(FontFile{file}, 37)};
        for (const char* text : {"Quick\nfox AV", "office é e\xCC\x81  ", "שלום abc (עולם)\nabc שלום 12",
                                 "بسم الله\n123 (ab)", "\u2067שלום\u2069 abc", "\u202Eabc\u202C def",
                                 "a\u00ADb\u200Bc\u200Dd", "\n\n", "สวัสดี 😀\xF0\x93\x80\x80"}) {
            const std::vector<uint32_t> codes = decodeUtf8(text);
            const TextLayout layout(fonts, codes, {Align::center});
            EXPECT_EQ(boxesOf(layout), plainBoxes(fonts.main().face(), codes)) << text;
        }
    }
}

TEST(PlainLayout, RandomTexts_StandInPlaceToo) {
    constexpr uint32_t kCodes[]{
        'a',    'b',    ' ',    '1',    '(',    ')',    '!',    '\n',   0x5D0,  0x5D1,  0x627,  0x628,
        0x64E,  0x661,  0x301,  0x3B1,  0x905,  0x915,  0x93F,  0x94D,  0xE01,  0xE33,  0x4E00, 0x1F600,
        0xAB,   0xBB,   0x201C, 0x201D, 0x300C, 0x300D, '[',    ']',    0xA0,   0xAD,   0x200B, 0x200C,
        0x200D, 0x200E, 0x200F, 0x202B, 0x202A, 0x202E, 0x202C, 0x2066, 0x2067, 0x2068, 0x2069, 0xFE0F};
    Fonts fonts{Font(FontFile{VOREL_TEST_FONT}, 24)};
    vorel_test::Random random(5);
    for (int round = 0; round < 1000; ++round) {
        std::vector<uint32_t> text;
        for (int i = random.between(0, 20); i > 0; --i)
            text.push_back(kCodes[random.next() % std::size(kCodes)]);
        const TextLayout layout(fonts, text, {Align::center});
        ASSERT_EQ(boxesOf(layout), plainBoxes(fonts.main().face(), text)) << round;
    }
}

}  // namespace
}  // namespace voreltext
