#include "subtitle_text.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace vorelpaint {
namespace {

using Names = std::vector<std::string>;

TEST(SubtitleText, Srt_TagsAreDropped) {
    EXPECT_EQ(textOfSrt("<i>Then</i> <font color=\"#ff0000\">we</font> <B>walk</B>"), "Then we walk");
    EXPECT_EQ(textOfSrt("<i/>a<b >b</b >"), "ab");
    EXPECT_EQ(textOfSrt("{\\an8}up <c.yellow>there</c>"), "up there");
}

TEST(SubtitleText, Srt_BreakIsALine) {
    EXPECT_EQ(textOfSrt("one<br>two<BR/>three\nfour"), "one\ntwo\nthree\nfour");
}

TEST(SubtitleText, Srt_WhatIsNoTagStays) {
    for (const char* text : {"1 < 2 and 3 > 2", "I <3 you", "<Anna> Hello", "a <b", "a <i b < c",
                             "{curly}", "{\\", "<>", "<", "<bold>"}) {
        EXPECT_EQ(textOfSrt(text), text);
    }
}

TEST(SubtitleText, CharacterReferences_AreDecodedOnce) {
    EXPECT_EQ(textOfSrt("&lt;i&gt; &amp;amp; &quot;&apos;"), "<i> &amp; \"'");
    EXPECT_EQ(textOfSrt("a&nbsp;b&#65;&#x42;&#X20AC;"),
              "a\xC2\xA0"
              "bAB\xE2\x82\xAC");
    EXPECT_EQ(textOfVtt("&lrm;a&rlm;").text,
              "\xE2\x80\x8E"
              "a\xE2\x80\x8F");
}

TEST(SubtitleText, WhatIsNoCharacterReference_Stays) {
    for (const char* text : {"AT&T", "a & b; c", "&;", "&nosuch;", "&#;", "&#x;", "&#0;", "&#xD800;",
                             "&#x110000;", "&#99999999999999;", "&#6 5;", "&"}) {
        EXPECT_EQ(textOfSrt(text), text);
        EXPECT_EQ(textOfVtt(text).text, text);
    }
}

TEST(SubtitleText, BlankLinesAtTheEnds_AreDropped) {
    EXPECT_EQ(textOfSrt("\n \n one\n\ntwo \n\t\n"), " one\n\ntwo");
    EXPECT_EQ(textOfSrt(" \n<i></i>\n"), "");
}

TEST(SubtitleText, Vtt_TagsOfEveryKindAreDropped) {
    EXPECT_EQ(textOfVtt("<v Fred>Hi, <00:00:04.000><lang en>all</lang> <nosuch>of</nosuch></v>").text,
              "Hi, all of");
    EXPECT_EQ(textOfVtt("cut <c.off").text, "cut");
    EXPECT_EQ(textOfVtt("cut <").text, "cut");
}

TEST(SubtitleText, Vtt_ClassesAndVoicesAreNames) {
    EXPECT_EQ(textOfVtt("<v.loud.far Fred &amp; Ann >Hi</v> <c.gold>you</c><i.far>!</i>").names,
              (Names{"loud", "far", "Fred & Ann", "gold", "far"}));
    EXPECT_EQ(textOfVtt("<v\nMary\nAnn>Hi").names, Names{"Mary Ann"});
    EXPECT_EQ(textOfVtt("<b>Hi</b> <lang en.us>you").names, Names{});
}

TEST(SubtitleText, Ass_OverridesAreDroppedAndEscapesDecoded) {
    EXPECT_EQ(textOfAss("{\\i1}The light,{\\i0\\c&HFF&} goes\\Nnow\\hthen\\nnever"),
              "The light, goes\nnow\xC2\xA0then never");
    EXPECT_EQ(textOfAss("{a comment}one{ {two}"), "one");
    EXPECT_EQ(textOfAss("<i>{open \\x \\"), "<i>{open \\x \\");
}

TEST(SubtitleText, Ass_DrawingsAreDropped) {
    EXPECT_EQ(textOfAss("{\\p1}m 0 0 l 9 9{\\p0}text"), "text");
    EXPECT_EQ(textOfAss("a{\\an7\\p2\\bord0}m 0 0\\N{\\b1}l 9 9{\\p0}b{\\pos(1,2)}c{\\pbo3}d"), "abcd");
    EXPECT_EQ(textOfAss("{\\p1}m 0 0 l 9 9"), "");
}

/// A search for the end of each of them from its beginning would take hours.
TEST(SubtitleText, BeginningsWithoutAnEnd_TakeNoTime) {
    const auto repeated = [](const std::string& text) {
        std::string all;
        for (int i = 0; i < 4000000; ++i)
            all += text;
        return all;
    };
    for (const std::string& beginning : {std::string("&"), std::string("{\\"), std::string("<")}) {
        const std::string written = repeated(beginning);
        EXPECT_TRUE(textOfSrt(written) == written) << beginning;
    }
    EXPECT_TRUE(textOfVtt(repeated("&")).text == repeated("&"));
    EXPECT_TRUE(textOfAss(repeated("{")) == repeated("{"));
}

}  // namespace
}  // namespace vorelpaint
