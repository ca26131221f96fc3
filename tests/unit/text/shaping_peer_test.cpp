#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>

#include "text/paragraphs.h"
#include "text/shaper.h"
#include "unit/text/test_font.h"

/// What is shaped is compared with HarfBuzz's own program, hb-shape.
namespace voreltext {
namespace {

struct Close {
    void operator()(std::FILE* pipe) const { ::pclose(pipe); }
};

std::string outputOf(const std::string& command) {
    const std::unique_ptr<std::FILE, Close> pipe(::popen(command.c_str(), "r"));
    std::string output;
    for (int byte = 0; pipe && (byte = std::fgetc(pipe.get())) != EOF;)
        output += static_cast<char>(byte);
    return output;
}

/// The glyphs of "[12=0@3,-4+500|...]", in units of the font.
std::vector<ShapedGlyph> parsed(const std::string& output) {
    std::vector<ShapedGlyph> glyphs;
    for (size_t at = output.find('['); at + 1 < output.size() && output[at] != ']';) {
        const char* text = output.c_str() + at + 1;
        ShapedGlyph glyph{};
        int read = 0;
        std::sscanf(text, "%u=%zu%n", &glyph.index, &glyph.cluster, &read);
        text += read;
        if (*text == '@' && std::sscanf(text, "@%ld,%ld%n", &glyph.x, &glyph.y, &read) == 2)
            text += read;
        std::sscanf(text, "+%ld", &glyph.advance);
        glyphs.push_back(glyph);
        at = output.find_first_of("|]", at + 1);
    }
    return glyphs;
}

std::vector<ShapedGlyph> peersGlyphs(const char* font, const std::string& text,
                                     const std::string& features) {
    return parsed(outputOf(std::string(VOREL_HB_SHAPE) +
                           " --no-glyph-names --font-size=upem --features='" + features +
                           "' --font-file='" + font + "' --text='" + text + "'"));
}

/// The units of the em of each font, at which a unit is a pixel.
struct Case {
    const char* font;
    int unitsPerEm;
    const char* text;
    const char* features = "";
};

std::vector<ShapedGlyph> ownGlyphs(const Case& each) {
    const Fonts fonts{Font(FontFile{each.font}, each.unitsPerEm)};
    const Paragraph line = splitParagraphs(decodeUtf8(each.text)).front();
    const std::vector<size_t> main(line.codes.size());
    std::vector<std::string> features;
    if (*each.features != '\0') features.emplace_back(each.features);
    return Shaper(fonts, features)
        .shape({line.codes.data(), main.data(), line.scripts.data(), line.levels.data(),
                line.codes.size(), line.isRightToLeft});
}

class ShapingPeer : public ::testing::Test {
  protected:
    void SetUp() override {
        if (*VOREL_HB_SHAPE == '\0') GTEST_SKIP() << "there is no hb-shape (libharfbuzz-bin)";
    }

    /// With positions no further apart than `tolerance` in units of the font.
    static void expectSame(const Case& each, int64_t tolerance = 0) {
        const std::vector<ShapedGlyph> expected = peersGlyphs(each.font, each.text, each.features);
        const std::vector<ShapedGlyph> glyphs = ownGlyphs(each);
        ASSERT_FALSE(expected.empty()) << each.text;
        ASSERT_EQ(glyphs.size(), expected.size()) << each.text;
        for (size_t i = 0; i < glyphs.size(); ++i) {
            EXPECT_NE(glyphs[i].index, 0U) << each.text << " glyph " << i;
            EXPECT_EQ(glyphs[i].index, expected[i].index) << each.text << " glyph " << i;
            EXPECT_EQ(glyphs[i].cluster, expected[i].cluster) << each.text << " glyph " << i;
            EXPECT_LE(std::abs(glyphs[i].advance - expected[i].advance * 64), tolerance * 64)
                << each.text;
            EXPECT_LE(std::abs(glyphs[i].x - expected[i].x * 64), tolerance * 64) << each.text;
            EXPECT_LE(std::abs(glyphs[i].y - expected[i].y * 64), tolerance * 64) << each.text;
        }
    }
};

TEST_F(ShapingPeer, Latin_IsKernedAndHasLigatures) {
    expectSame({VOREL_TEST_FONT, 2048, "AVATAR office"});
    expectSame({VOREL_TEST_FONT, 2048, "AVATAR office", "liga=0"});
    expectSame({VOREL_TEST_FONT, 2048, "AVATAR office", "kern=0"});
    expectSame({VOREL_TEST_FONT, 2048, "e\xCC\x81 q\xCC\x8A"});
}

TEST_F(ShapingPeer, Arabic_IsJoinedWithItsMarks) {
    for (const char* text : {"السلام عليكم", "بِسْمِ ٱللَّهِ", "لا إله", "كتابٌ", "گچپژ"})
        expectSame({vorel_test::kArabicFont, 1000, text});
}

TEST_F(ShapingPeer, Hebrew_HasItsPoints) {
    for (const char* text : {"שלום", "שָׁלוֹם", "בְּרֵאשִׁית"})
        expectSame({vorel_test::kHebrewFont, 1200, text});
}

TEST_F(ShapingPeer, Devanagari_IsReordered) {
    for (const char* text : {"नमस्ते", "हिन्दी", "क्षत्रिय", "र्कि", "श्री"})
        expectSame({vorel_test::kDevanagariFont, 1024, text});
}

TEST_F(ShapingPeer, Thai_HasItsMarksInPlace) {
    for (const char* text : {"สวัสดี", "น้ำ", "ที่นี่", "ปู่"})
        expectSame({vorel_test::kThaiFont, 2048, text});
}

TEST_F(ShapingPeer, Japanese_IsShaped) {
    for (const char* text : {"日本語", "テスト、です。", "か\xE3\x82\x99"})
        expectSame({vorel_test::kJapaneseFont, 1000, text});
}

TEST_F(ShapingPeer, Korean_IsShaped) {
    for (const char* text : {"한국어", "안녕하세요"})
        expectSame({vorel_test::kKoreanFont, 600, text});
}

TEST_F(ShapingPeer, Emoji_AreJoined) {
    // Their font has one size of pictures, in whose 64ths of a pixel positions are rounded.
    for (const char* text :
         {"😀", "👩\u200D👩\u200D👧", "👍🏽", "🇩🇪🇫🇷", "🏳\uFE0F\u200D🌈", "1\uFE0F⃣", "❤\uFE0F"})
        expectSame({vorel_test::kEmojiFont, 2048, text}, 1);
}

}  // namespace
}  // namespace voreltext
