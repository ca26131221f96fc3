#include "text/wrapping.h"

#include <gtest/gtest.h>

#include <string>

#include "text/utf8.h"

namespace voreltext {
namespace {

using Ends = Wrapping::Ends;

/// A text whose characters are clusters of an advance of 10.
Wrapping wrappingOf(const std::string& text) {
    const std::vector<uint32_t> codes = decodeUtf8(text);
    std::vector<ShapedGlyph> glyphs;
    for (size_t i = 0; i < codes.size(); ++i)
        glyphs.push_back({1, 0, i, 10, 0, 0});
    return {splitParagraphs(codes).front(), glyphs};
}

TEST(Wrapping, LastFittingEnd_IsThatOfAWord) {
    const Wrapping wrapping = wrappingOf("ab cd ef");
    EXPECT_EQ(wrapping.lastFitting(Ends::ofWords, 0, 80), 8U);
    EXPECT_EQ(wrapping.lastFitting(Ends::ofWords, 0, 79), 6U);
    EXPECT_EQ(wrapping.lastFitting(Ends::ofWords, 0, 50), 6U) << "the blank behind does not count";
    EXPECT_EQ(wrapping.lastFitting(Ends::ofWords, 0, 49), 3U);
    EXPECT_EQ(wrapping.lastFitting(Ends::ofWords, 3, 20), 6U);
    EXPECT_EQ(wrapping.lastFitting(Ends::ofWords, 0, 5), 3U) << "the first, when none fits";
}

TEST(Wrapping, EndsOfClusters_AreEverywhereBetweenThem) {
    const Wrapping wrapping = wrappingOf("abcdef");
    EXPECT_EQ(wrapping.lastFitting(Ends::ofWords, 0, 30), 6U);
    EXPECT_EQ(wrapping.lastFitting(Ends::ofClusters, 0, 30), 3U);
    EXPECT_EQ(wrapping.lastFitting(Ends::ofClusters, 3, 1), 4U);
}

TEST(Wrapping, Neighbours_EndAtTheTextsEnds) {
    const Wrapping wrapping = wrappingOf("ab cd ef");
    EXPECT_EQ(wrapping.endAfter(Ends::ofWords, 0), 3U);
    EXPECT_EQ(wrapping.endAfter(Ends::ofWords, 6), 8U);
    EXPECT_EQ(wrapping.endAfter(Ends::ofWords, 8), 8U);
    EXPECT_EQ(wrapping.endBefore(Ends::ofWords, 8, 0), 6U);
    EXPECT_EQ(wrapping.endBefore(Ends::ofWords, 6, 3), 3U) << "back at the beginning";
    EXPECT_EQ(wrapping.endBefore(Ends::ofClusters, 8, 0), 7U);
}

TEST(Wrapping, Blanks_EndNoPart) {
    const Wrapping wrapping = wrappingOf("ab  ");
    EXPECT_EQ(wrapping.withoutBlanks(0, 4), 2U);
    EXPECT_EQ(wrapping.withoutBlanks(3, 4), 3U);
    EXPECT_EQ(wrapping.width(0, 4), 20);
    EXPECT_EQ(wrapping.width(2, 4), 0);
}

TEST(Wrapping, Cluster_IsNotCut) {
    const std::vector<ShapedGlyph> glyphs{{1, 0, 0, 10, 0, 0}, {1, 0, 1, 30, 0, 0}, {1, 0, 4, 10, 0, 0}};
    const Wrapping wrapping(splitParagraphs(decodeUtf8("a日本語b")).front(), glyphs);
    EXPECT_EQ(wrapping.endAfter(Ends::ofWords, 1), 4U);
    EXPECT_EQ(wrapping.endAfter(Ends::ofClusters, 1), 4U);
    EXPECT_EQ(wrapping.width(0, 2), 20) << "each of its characters has a third of it";
}

TEST(Wrapping, SoftHyphen_PartsALigature) {
    const std::vector<ShapedGlyph> glyphs{{1, 0, 0, 30, 0, 0}};
    const Wrapping wrapping(splitParagraphs(decodeUtf8("f\u00ADi")).front(), glyphs);
    EXPECT_EQ(wrapping.endAfter(Ends::ofWords, 0), 2U);
    EXPECT_EQ(wrapping.endAfter(Ends::ofClusters, 0), 3U);
}

/// A text whose letters have an advance of 10 and whose other characters show nothing.
Wrapping wrappingOfLetters(const std::string& text) {
    const std::vector<uint32_t> codes = decodeUtf8(text);
    std::vector<ShapedGlyph> glyphs;
    for (size_t i = 0; i < codes.size(); ++i)
        glyphs.push_back({1, 0, i, codes[i] < 0x80 ? 10 : 0, 0, 0});
    return {splitParagraphs(codes).front(), glyphs};
}

TEST(Wrapping, EndsThatShowNoMore_AreOneStep) {
    const Wrapping spaces = wrappingOfLetters("a\u200B\u200B\u200Bb\u200Bc");
    EXPECT_EQ(spaces.longer(Ends::ofWords, 0, 0), 4U);
    EXPECT_EQ(spaces.longer(Ends::ofClusters, 0, 4), 6U);
    EXPECT_EQ(spaces.shorter(Ends::ofWords, 0, 6), 4U);
    EXPECT_EQ(spaces.shorter(Ends::ofWords, 0, 4), 0U);
    const Wrapping hyphens = wrappingOfLetters("a\u00AD\u00AD\u00ADb");
    EXPECT_EQ(hyphens.shorter(Ends::ofClusters, 0, 4), 1U) << "without a hyphen it may fit";
    EXPECT_EQ(hyphens.longer(Ends::ofClusters, 0, 0), 1U) << "with one it may not";
    EXPECT_EQ(hyphens.longer(Ends::ofClusters, 0, 1), 4U);
}

}  // namespace
}  // namespace voreltext
