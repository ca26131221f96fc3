#include "text/letter_spacing.h"

#include <gtest/gtest.h>

#include <string>

#include "text/utf8.h"

namespace voreltext {
namespace {

/// What is added behind each of the text's characters, shown from left to right one glyph each.
std::vector<int64_t> gaps(const std::string& text) {
    const std::vector<uint32_t> codes = decodeUtf8(text);
    std::vector<ShapedGlyph> glyphs;
    for (size_t i = 0; i < codes.size(); ++i)
        glyphs.push_back({1, 0, i, 0, 0, 0});
    addLetterSpacing(glyphs, codes, 7);
    std::vector<int64_t> added;
    for (const ShapedGlyph& glyph : glyphs)
        added.push_back(glyph.advance);
    return added;
}

TEST(LetterSpacing, IsBetweenClusters) {
    EXPECT_EQ(gaps(""), std::vector<int64_t>{});
    EXPECT_EQ(gaps("a"), std::vector<int64_t>{0});
    EXPECT_EQ(gaps("a b"), (std::vector<int64_t>{7, 7, 0})) << "none behind the last";
}

TEST(LetterSpacing, GlyphsOfOneCluster_StayTogether) {
    std::vector<ShapedGlyph> glyphs{{1, 0, 0, 10, 0, 0}, {2, 0, 0, 0, 0, 0}, {3, 0, 2, 10, 0, 0}};
    addLetterSpacing(glyphs, decodeUtf8("abc"), -3);
    EXPECT_EQ(glyphs[0].advance, 10);
    EXPECT_EQ(glyphs[1].advance, -3);
    EXPECT_EQ(glyphs[2].advance, 10);
}

TEST(LetterSpacing, WhatShowsNothing_HasNone) {
    EXPECT_EQ(gaps("a\u00AD\u200Bb\u00AD"), (std::vector<int64_t>{7, 0, 0, 0, 0}));
    EXPECT_EQ(gaps("\u200Bx"), (std::vector<int64_t>{0, 0}));
}

TEST(LetterSpacing, JoinedLetters_HaveNone) {
    for (const char* text : {"بسم", "ܫܠܡ", "ᠮᠣᠩ", "ߒߞߏ", "ـبـ", "ب\u200Dب", "𞤀𞤁"}) {
        for (const int64_t gap : gaps(text))
            EXPECT_EQ(gap, 0) << text;
    }
    EXPECT_EQ(gaps("بب a"), (std::vector<int64_t>{0, 7, 7, 0})) << "but at their blanks";
    EXPECT_EQ(gaps("שם"), (std::vector<int64_t>{7, 0})) << "Hebrew is not joined";
}

}  // namespace
}  // namespace voreltext
