#include "text/font.h"

#include <gtest/gtest.h>

#include <string>

#include "text/error.h"
#include "text/text_layout.h"
#include "text/utf8.h"
#include "unit/text/test_font.h"

namespace voreltext {
namespace {

FontBytes viewOf(const std::string& bytes) {
    return {reinterpret_cast<const uint8_t*>(bytes.data()), bytes.size()};
}

template <typename Source>
std::string faultOf(const Source& source) {
    try {
        const Font font(source, 32);
        return "";
    } catch (const TextError& error) {
        return error.what();
    }
}

TEST(Font, Bytes_GiveTheGlyphsOfTheFile) {
    const std::string bytes = vorel_test::testFontBytes();
    Fonts ofFile{Font(FontFile{VOREL_TEST_FONT}, 48)};
    Fonts ofBytes{Font(viewOf(bytes), 48)};
    EXPECT_EQ(ofBytes.main().lineHeight(), ofFile.main().lineHeight());
    const std::vector<uint32_t> words = decodeUtf8("Quick\nfox AV");
    const TextLayout expected(ofFile, words, {Align::center});
    const TextLayout text(ofBytes, words, {Align::center});
    ASSERT_EQ(expected.glyphCount(), 10U);
    ASSERT_EQ(text.glyphCount(), expected.glyphCount());
    for (size_t i = 0; i < text.glyphCount(); ++i) {
        const GlyphMask glyph = text.rasterise(i);
        const GlyphMask same = expected.rasterise(i);
        EXPECT_EQ(glyph.box.left, same.box.left) << i;
        EXPECT_EQ(glyph.box.top, same.box.top) << i;
        EXPECT_EQ(glyph.coverage, same.coverage) << i;
    }
}

TEST(Font, WhatIsNoFont_IsRefused) {
    EXPECT_EQ(faultOf(FontFile{"no/such.ttf"}), "'no/such.ttf' is no font that can be read");
    EXPECT_EQ(faultOf(viewOf("no font")), "the bytes are no font that can be read");
    EXPECT_EQ(faultOf(FontBytes{nullptr, 0}), "the bytes are no font that can be read");
}

TEST(Font, CutBytes_AreRefused) {
    const std::string bytes = vorel_test::testFontBytes().substr(0, 100);
    EXPECT_NE(faultOf(viewOf(bytes)), "");
}

TEST(Font, FaceIndexBeyondTheLast_IsRefused) {
    EXPECT_EQ(faultOf(FontFile{VOREL_TEST_FONT, 1}),
              "'" VOREL_TEST_FONT "' is no font that can be read");
}

}  // namespace
}  // namespace voreltext
