#include "text/clusters.h"

#include <gtest/gtest.h>

#include "text/utf8.h"

namespace voreltext {
namespace {

TEST(Clusters, VariationSelectors_ChooseThePresentation) {
    EXPECT_EQ(presentationOf({0x2764, 0xFE0F}), Presentation::picture);
    EXPECT_EQ(presentationOf({'1', 0xFE0F, 0x20E3}), Presentation::picture);
    EXPECT_EQ(presentationOf({0x2764, 0xFE0E}), Presentation::text);
    EXPECT_EQ(presentationOf({0x1F600, 0xFE0E}), Presentation::text);
    EXPECT_EQ(presentationOf({0x2764}), Presentation::any);
}

TEST(Clusters, Sequences_ArePictures) {
    for (const char* text : {"👍🏽", "👩‍👩‍👧", "🇩🇪", "🏳️‍🌈", "⛹🏿‍♀"})
        EXPECT_EQ(presentationOf(decodeUtf8(text)), Presentation::picture) << text;
    for (const char* text : {"", "A", "👍", "🇩", "é", "क्‍ष"})
        EXPECT_EQ(presentationOf(decodeUtf8(text)), Presentation::any) << text;
}

TEST(Clusters, PicturesByDefault_AreEmojiThatDoNotAskForText) {
    for (const char* text : {"😀", "⌚", "👍🏽", "❤️", "🇩🇪"})
        EXPECT_TRUE(isPictureByDefault(decodeUtf8(text))) << text;
    for (const char* text : {"", "A", "❤", "😀︎", "1"})
        EXPECT_FALSE(isPictureByDefault(decodeUtf8(text))) << text;
}

}  // namespace
}  // namespace voreltext
