#include <gtest/gtest.h>

#include <iterator>
#include <string>

#include "support/random.h"
#include "support/thinned.h"
#include "unicode/characters.h"
#include "unit/text/made_font.h"
#include "unit/text/test_font.h"

/// Random texts in random settings: what is laid out keeps its promises, all else is refused.
namespace voreltext {
namespace {

using vorel_test::edges;
using vorel_test::Random;

/// Characters that are apt to go wrong beside each other.
uint32_t randomCode(Random& random) {
    constexpr uint32_t kOdd[]{' ',     ' ',     '\t',    '\n',    '\r',    0x85,   0xA0,   0xAD,
                              0x200B,  0x200C,  0x200D,  0x200E,  0x200F,  0x202A, 0x202B, 0x202C,
                              0x202E,  0x2066,  0x2067,  0x2069,  0x2028,  0x2029, 0x2060, 0xFE0E,
                              0xFE0F,  0x20E3,  0xFFFC,  0xFFFD,  0xFFFF,  0xFEFF, 0x3164, 0x1F3FB,
                              0x1F3FF, 0x1F1E6, 0x1F468, 0xE0061, 0xE007F, 0x640,  0x34F,  0x301,
                              0x326,   0x94D,   0x93F,   0xE33,   0x1100};
    constexpr vorelunicode::CodeRange kBlocks[]{
        {'a', 'z'},       {'!', '~'},       {0x5D0, 0x5EA},     {0x620, 0x64A},   {0x905, 0x94F},
        {0xE01, 0xE4E},   {0x1820, 0x1842}, {0x3041, 0x30FF},   {0x4E00, 0x9FFF}, {0xAC00, 0xD7A3},
        {0xD800, 0xDFFF}, {0x2190, 0x2BFF}, {0x1F300, 0x1FAFF}, {0xA0, 0x2FFFF},  {0x110000, 0x110002}};
    if (random.chance(40)) return kOdd[random.next() % std::size(kOdd)];
    const vorelunicode::CodeRange& block = kBlocks[random.next() % std::size(kBlocks)];
    return block.first + random.next() % (block.last - block.first + 1);
}

std::vector<uint32_t> randomText(Random& random) {
    std::vector<uint32_t> text;
    const int length = random.between(0, 60);
    for (int i = 0; i < length; ++i)
        text.push_back(random.chance(30) && i > 0 ? text.back() : randomCode(random));
    return text;
}

TextSettings randomSettings(Random& random) {
    TextSettings settings;
    settings.align = static_cast<Align>(random.between(0, 4));
    if (random.chance(50)) settings.lineHeight = random.real(0, 3);
    if (random.chance(50)) settings.letterSpacing = random.between(-2000, 2000);
    if (random.chance(70)) settings.wrapWidth = random.between(1, 400);
    if (random.chance(30)) settings.features = {random.chance(50) ? "liga=0" : "kern=0"};
    return settings;
}

/// Every layout's glyphs, lines and boxes agree.
void expectSound(const TextLayout& layout, const std::vector<uint32_t>& text, const Fonts& fonts) {
    Box ink;
    size_t line = 0;
    for (size_t i = 0; i < layout.glyphCount(); ++i) {
        const Glyph& glyph = layout.glyph(i);
        ASSERT_GE(glyph.line, line);
        line = glyph.line;
        ASSERT_LT(glyph.font, fonts.count());
        ASSERT_GE(glyph.cluster, layout.lines()[line].begin);
        ASSERT_LT(glyph.cluster, layout.lines()[line].end);
        const GlyphMask mask = layout.rasterise(i);
        ASSERT_EQ(edges(mask.box), edges(glyph.box));
        ASSERT_EQ(mask.coverage.size(), static_cast<size_t>(mask.box.width() * mask.box.height()));
        ASSERT_EQ(mask.pixels.size(), glyph.isPicture ? mask.coverage.size() * 4 : 0);
        ink.grow(mask.box);
    }
    EXPECT_EQ(edges(layout.inkBox()), edges(ink));
    for (size_t i = 0; i < layout.lines().size(); ++i) {
        const Line& each = layout.lines()[i];
        ASSERT_LE(each.begin, each.end);
        ASSERT_LE(each.end, text.size());
        if (i == 0) continue;
        const Line& before = layout.lines()[i - 1];
        ASSERT_GE(each.begin, before.end);
        ASSERT_LE(each.begin, before.end + 2) << "nothing is left out but line ends";
        ASSERT_EQ(each.box.top, before.box.bottom);
    }
    for (const MissingCharacter& each : layout.missing())
        ASSERT_EQ(text.at(each.first), each.code);
}

/// No line is wider than it may be.
void expectWithin(const TextLayout& layout, const TextSettings& settings) {
    if (settings.wrapWidth == 0) return;
    for (const Line& line : layout.lines())
        ASSERT_LE(line.box.width(), settings.wrapWidth + 1) << "both ends of a fraction of a pixel";
}

TEST(RandomText, IsLaidOutSoundlyOrRefused) {
    Random random(77);
    Fonts fonts{Font(FontFile{VOREL_TEST_FONT}, 20)};
    for (const char* file : {vorel_test::kArabicFont, vorel_test::kDevanagariFont, vorel_test::kThaiFont,
                             vorel_test::kKoreanFont, vorel_test::kEmojiFont}) {
        fonts.add(Font(FontFile{file}, 20));
    }
    fonts.setFallback([](const Cluster&) { return FontFile{vorel_test::kJapaneseFont}; });
    int laidOut = 0;
    const int rounds = vorel_test::thinned(1600);
    for (int round = 0; round < rounds; ++round) {
        const std::vector<uint32_t> text = randomText(random);
        const TextSettings settings = randomSettings(random);
        SCOPED_TRACE(round);
        try {
            const TextLayout layout(fonts, text, settings);
            ASSERT_NO_FATAL_FAILURE(expectSound(layout, text, fonts));
            ASSERT_NO_FATAL_FAILURE(expectWithin(layout, settings));
            ++laidOut;
        } catch (const TextError& error) {
            const std::string fault = error.what();
            EXPECT_EQ(fault.find('\n'), std::string::npos);
            EXPECT_TRUE(fault.find("is wider than") != std::string::npos) << fault;
        }
    }
    EXPECT_GT(laidOut, rounds / 2);
}

}  // namespace
}  // namespace voreltext
