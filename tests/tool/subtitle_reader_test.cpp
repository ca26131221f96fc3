#include "subtitle_reader.h"

#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

#include "compose/error.h"
#include "error.h"
#include "program.h"
#include "tests/support/thinned.h"

namespace vorelpaint {
namespace {

using vorel_test::TempDir;
using Names = std::vector<std::string>;

std::vector<Cue> srt(const std::string& bytes) {
    return subtitlesIn(bytes, "a.srt");
}
std::vector<Cue> vtt(const std::string& bytes) {
    return subtitlesIn(bytes, "a.vtt");
}
std::vector<Cue> ass(const std::string& lines) {
    return subtitlesIn("[Script Info]\nScriptType: v4.00+\n\n[Events]\n" + lines, "a.ass");
}

std::string faultOf(const std::string& path, const std::string& bytes) {
    try {
        subtitlesIn(bytes, path);
        return "";
    } catch (const ToolError& error) {
        return error.what();
    }
}

constexpr const char* kAssFormat =
    "Format: Layer, Start, End, Style, Name, MarginL, MarginR, MarginV, Effect, Text\n";

// --- SubRip -----------------------------------------------------------------------------------------

TEST(SubtitleReader, Srt_CuesHaveTimesTextAndLine) {
    const std::vector<Cue> cues =
        srt("1\n00:00:00,500 --> 00:00:02,500\nOne\nline\n\n"
            "2\n01:02:03.004 --> 10:00:00,000 X1:10 X2:20\n<i>Two</i>\n");
    ASSERT_EQ(cues.size(), 2U);
    EXPECT_EQ(cues[0].startMs, 500);
    EXPECT_EQ(cues[0].endMs, 2500);
    EXPECT_EQ(cues[0].text, "One\nline");
    EXPECT_EQ(cues[0].line, 2U);
    EXPECT_EQ(cues[1].startMs, 3723004);
    EXPECT_EQ(cues[1].endMs, 36000000);
    EXPECT_EQ(cues[1].text, "Two");
    EXPECT_EQ(cues[1].line, 7U);
}

TEST(SubtitleReader, Srt_LineEndsOfEverySystemAndAMark) {
    for (const std::string end : {"\n", "\r\n", "\r"}) {
        const std::vector<Cue> cues =
            srt("\xEF\xBB\xBF"
                "1" +
                end + "00:00:01,000 --> 00:00:02,000" + end + "One" + end + "line" + end + end + "2" +
                end + "00:00:03,000 --> 00:00:04,000" + end + "Two");
        ASSERT_EQ(cues.size(), 2U);
        EXPECT_EQ(cues[0].text, "One\nline");
        EXPECT_EQ(cues[1].text, "Two");
        EXPECT_EQ(cues[1].line, 7U);
    }
}

TEST(SubtitleReader, Srt_NumbersAndBlankLinesMayBeMissing) {
    const std::vector<Cue> cues =
        srt("00:00:01,000 --> 00:00:02,000\nOne\n00:00:03,000 --> "
            "00:00:04,000\nTwo\n3\n00:00:05,000 --> 00:00:06,000\nThree");
    ASSERT_EQ(cues.size(), 3U);
    EXPECT_EQ(cues[0].text, "One");
    EXPECT_EQ(cues[1].text, "Two");
    EXPECT_EQ(cues[2].text, "Three");
}

TEST(SubtitleReader, Srt_TextMayHaveBlankLinesAndNumbers) {
    const std::vector<Cue> cues =
        srt("1\n00:00:01,000 --> 00:00:02,000\nOne\n\n1984\n\n00:00:03,000 --> 00:00:04,000\n42\n");
    ASSERT_EQ(cues.size(), 2U);
    EXPECT_EQ(cues[0].text, "One\n\n1984");
    EXPECT_EQ(cues[1].text, "42");
}

TEST(SubtitleReader, Srt_FaultsNameTheirLine) {
    EXPECT_EQ(faultOf("a.srt", "1\n00:00:01,000 -> 00:00:02,000\n"),
              "'a.srt', line 2: no number and no times of a cue, which are 00:00:01,000 --> "
              "00:00:02,500");
    const std::string good = "1\n00:00:01,000 --> 00:00:02,000\nA\n\n2\n";
    for (const char* times :
         {"00:00:03,000 --> x", "00:00:03,00 --> 00:00:04,000", "00:61:03,000 --> 00:62:04,000",
          "00:03,000 --> 00:04,000", "-1:00:03,000 --> 00:00:04,000", "00:00:03,000 -->",
          "00:00:03:000 --> 00:00:04,000", "9999999:00:03,000 --> 9999999:00:04,000",
          "00:00:+3,000 --> 00:00:04,000", "an arrow --> is no time"}) {
        EXPECT_EQ(faultOf("a.srt", good + times + "\nB\n"),
                  "'a.srt', line 6: no times of a cue; write 00:00:01,000 --> 00:00:02,500")
            << times;
    }
}

// --- any format -------------------------------------------------------------------------------------

TEST(SubtitleReader, Times_RunForwards) {
    EXPECT_EQ(faultOf("a.srt", "1\n00:00:05,000 --> 00:00:03,500\nA\n"),
              "'a.srt', line 2: the cue ends at 00:00:03.500, before it starts at 00:00:05.000");
    EXPECT_EQ(faultOf("a.srt", "1\n23:59:59,000 --> 00:00:01,000\nA\n"),
              "'a.srt', line 2: the cue ends at 00:00:01.000, before it starts at 23:59:59.000");
    EXPECT_EQ(faultOf("a.srt", "23:59:59,000 --> 24:00:00,000\nA\n"), "");
    EXPECT_EQ(faultOf("a.srt", "23:59:59,000 --> 24:00:00,001\nA\n"),
              "'a.srt', line 1: a cue at 24:00:00.001; a film has at most 24:00:00.000");
    EXPECT_EQ(faultOf("a.srt", "596:31:23,647 --> 999999:59:59,999\nA\n"),
              "'a.srt', line 1: a cue at 999999:59:59.999; a film has at most 24:00:00.000");
}

TEST(SubtitleReader, Cues_StandInTheOrderOfTheirStarts) {
    const std::vector<Cue> cues =
        srt("00:00:03,000 --> 00:00:04,000\nC\n\n00:00:01,000 --> "
            "00:00:09,000\nA\n\n00:00:01,000 --> 00:00:02,000\nB\n");
    ASSERT_EQ(cues.size(), 3U);
    EXPECT_EQ(cues[0].text + cues[1].text + cues[2].text, "ABC");
}

TEST(SubtitleReader, NothingToShow_IsLeftOut) {
    const std::vector<Cue> cues =
        srt("1\n00:00:01,000 --> 00:00:02,000\n\n2\n00:00:03,000 --> "
            "00:00:03,000\nnever\n\n3\n00:00:04,000 --> 00:00:05,000\nA\n");
    ASSERT_EQ(cues.size(), 1U);
    EXPECT_EQ(cues[0].text, "A");
    for (const char* path : {"a.srt", "a.ass"})
        EXPECT_EQ(faultOf(path, ""), "'" + std::string(path) + "' has no cue with a text");
    EXPECT_EQ(faultOf("a.srt", "1\n00:00:01,000 --> 00:00:02,000\n<i> </i>\n"),
              "'a.srt' has no cue with a text");
}

TEST(SubtitleReader, OtherFiles_AreRefused) {
    for (const char* path : {"a.txt", "srt", "dir.srt/a", "-"}) {
        EXPECT_EQ(faultOf(path, "x"),
                  "'" + std::string(path) + "' is no subtitle file; .srt, .vtt, .ass and .ssa are read");
    }
    EXPECT_EQ(faultOf("a.srt", std::string("\xFF\xFE"
                                           "1\0",
                                           4)),
              "'a.srt' is in UTF-16; subtitles are read in UTF-8");
    EXPECT_EQ(faultOf("a.SRT", "00:00:01,000 --> 00:00:02,000\nA"), "");
}

TEST(SubtitleReader, TooMuch_IsRefused) {
    std::string bytes;
    for (size_t i = 0; i <= kMostCues; ++i)
        bytes += "00:00:01,000 --> 00:00:02,000\nA\n";
    EXPECT_EQ(faultOf("a.srt", bytes), "'a.srt', line 200001: more than 100000 cues");
    const TempDir dir;
    const std::string path = dir.write("a.srt", std::string(kMaxSubtitleBytes + 1, '\n'));
    EXPECT_THROW(readSubtitles(path), vorelcompose::ComposeError);
}

/// Whatever the bytes are, they are read or refused.
TEST(SubtitleReader, DamagedFiles_DoNoHarm) {
    const std::vector<std::string> whole{
        "1\n00:00:00,500 --> 00:00:02,500\n<i>A</i> &amp;#65; {\\an8}b\n\n2\n00:00:03,000 --> "
        "00:00:05,000\nB<br>\n",
        "WEBVTT\n\nNOTE x\n\nid\n00:00.500 --> 00:02.500 line:0\n<v.a B>A&lt;</v>\n\nSTYLE\nx\n",
        std::string("[Events]\n") + kAssFormat +
            "Dialogue: 0,0:00:00.50,0:00:02.50,*A,B,0,0,0,,{\\p1}m 0{\\p0}A\\N,b\n"};
    const std::vector<std::string> paths{"a.srt", "a.vtt", "a.ass"};
    const int seed = ::testing::UnitTest::GetInstance()->random_seed();
    SCOPED_TRACE(seed);
    std::minstd_rand random(static_cast<unsigned int>(seed));
    for (int round = 0; round < vorel_test::thinned(20000); ++round) {
        const size_t kind = random() % whole.size();
        std::string bytes = whole[kind];
        for (unsigned int change = 0; change <= random() % 4; ++change) {
            const size_t at = random() % bytes.size();
            const char byte = "<>&;{}\\\n\r:,.-0 \xFF[]"[random() % 18];
            if (random() % 2 == 0)
                bytes[at] = byte;
            else
                bytes.erase(at, random() % 8);
            if (bytes.empty()) break;
        }
        try {
            for (const Cue& cue : subtitlesIn(bytes, paths[kind])) {
                EXPECT_LT(cue.startMs, cue.endMs);
                EXPECT_FALSE(cue.text.empty());
            }
        } catch (const ToolError&) {
            continue;
        }
    }
}

// --- WebVTT -----------------------------------------------------------------------------------------

TEST(SubtitleReader, Vtt_CuesHaveTimesTextAndNames) {
    const std::vector<Cue> cues =
        vtt("WEBVTT - a title\nKind: captions\n\nintro\n00:00.500 --> "
            "00:02.500 line:10%\n<v.loud Fred>One\nline\n\n"
            "01:00:03.000-->01:00:03.000\nnever\n\n"
            "01:02:03.004\t-->\t01:02:04.000\nTwo");
    ASSERT_EQ(cues.size(), 2U);
    EXPECT_EQ(cues[0].startMs, 500);
    EXPECT_EQ(cues[0].endMs, 2500);
    EXPECT_EQ(cues[0].text, "One\nline");
    EXPECT_EQ(cues[0].names, (Names{"loud", "Fred", "intro"}));
    EXPECT_EQ(cues[0].line, 5U);
    EXPECT_EQ(cues[1].startMs, 3723004);
    EXPECT_EQ(cues[1].names, Names{});
}

TEST(SubtitleReader, Vtt_NotesStylesAndRegionsAreNoCues) {
    const std::vector<Cue> cues =
        vtt("WEBVTT\n\nSTYLE\n::cue { color: red }\n\nNOTE one line\n\n"
            "NOTE\nof two\n\nREGION\nid:fred\n\n00:01.000 --> 00:02.000\nA\n\n"
            "NOTE\n\n00:03.000 --> 00:04.000\nB\n");
    ASSERT_EQ(cues.size(), 2U);
    EXPECT_EQ(cues[0].text + cues[1].text, "AB");
}

TEST(SubtitleReader, Vtt_FirstCueMayFollowTheHeadAtOnce) {
    EXPECT_EQ(vtt("WEBVTT\n00:01.000 --> 00:02.000\nA\n").front().text, "A");
}

TEST(SubtitleReader, Vtt_FaultsNameTheirLine) {
    EXPECT_EQ(faultOf("a.vtt", ""), "'a.vtt', line 1: WEBVTT is missing");
    EXPECT_EQ(faultOf("a.vtt", "WEBVTTX\n"), "'a.vtt', line 1: WEBVTT is missing");
    EXPECT_EQ(faultOf("a.vtt", "WEBVTT\n\nA\nB\n"),
              "'a.vtt', line 3: a block without times, which are 00:01.000 --> 00:02.500");
    EXPECT_EQ(faultOf("a.vtt", "WEBVTT\n\n00:01,000 --> 00:02,000\nA\n"),
              "'a.vtt', line 3: no times of a cue; write 00:01.000 --> 00:02.500");
    EXPECT_EQ(faultOf("a.vtt", "WEBVTT\n\n00:01.000 --> 00:02.000\nA\n00:03.000 --> 00:04.000\nB\n"),
              "'a.vtt', line 5: times within the text of a cue");
    EXPECT_EQ(faultOf("a.vtt", "WEBVTT\n\nx\n00:05.000 --> 00:04.000\nA\n"),
              "'a.vtt', line 4: the cue ends at 00:00:04.000, before it starts at 00:00:05.000");
}

// --- ASS --------------------------------------------------------------------------------------------

TEST(SubtitleReader, Ass_CuesHaveTimesTextAndNames) {
    const std::vector<Cue> cues = ass(std::string(kAssFormat) +
                                      "Comment: 0,0:00:00.00,0:00:09.00,Default,,0,0,0,,no\n"
                                      "Dialogue: 0,0:00:00.50,0:00:02.50,*Default,Fred,0,0,0,,One, "
                                      "two\\Nlines\n"
                                      "dialogue:1, 1:02:03.04 ,1:02:04.00,Sign,,0,0,0,, Two\n");
    ASSERT_EQ(cues.size(), 2U);
    EXPECT_EQ(cues[0].startMs, 500);
    EXPECT_EQ(cues[0].endMs, 2500);
    EXPECT_EQ(cues[0].text, "One, two\nlines");
    EXPECT_EQ(cues[0].names, (Names{"Default", "Fred"}));
    EXPECT_EQ(cues[0].line, 7U);
    EXPECT_EQ(cues[1].startMs, 3723040);
    EXPECT_EQ(cues[1].names, Names{"Sign"});
}

TEST(SubtitleReader, Ass_FormatTellsWhatIsWhere) {
    const std::vector<Cue> cues = ass(
        "Format: Marked, End, Start, Actor, Text\nDialogue: Marked=0,0:00:02.00,0:00:01.00,Ann,A,b\n");
    ASSERT_EQ(cues.size(), 1U);
    EXPECT_EQ(cues[0].startMs, 1000);
    EXPECT_EQ(cues[0].text, "A,b");
    EXPECT_EQ(cues[0].names, Names{"Ann"});
}

TEST(SubtitleReader, Ass_OtherSectionsAreNotRead) {
    const std::vector<Cue> cues =
        subtitlesIn(std::string("[V4+ Styles]\nFormat: Name\nDialogue: x\n[events]\n") + kAssFormat +
                        "Dialogue: 0,0:00:00.50,0:00:02.50,A,,0,0,0,,A\n[Fonts]\nDialogue: x\n",
                    "a.ssa");
    EXPECT_EQ(cues.size(), 1U);
}

TEST(SubtitleReader, Ass_FaultsNameTheirLine) {
    const auto fault = [](const std::string& lines) { return faultOf("a.ass", "[Events]\n" + lines); };
    EXPECT_EQ(fault("Dialogue: 0,0:00:00.50,0:00:02.50,A,,0,0,0,,A\n"),
              "'a.ass', line 2: a cue before the Format of [Events]");
    EXPECT_EQ(fault("Format: Start, End, Text, Style\n"),
              "'a.ass', line 2: a Format without Start, End and, in the last place, Text");
    EXPECT_EQ(fault(std::string(kAssFormat) + "Dialogue: 0,0:00:00.50,0:00:02.50,A\n"),
              "'a.ass', line 3: a cue of 4 parts; by the Format it has 10");
    EXPECT_EQ(fault(std::string(kAssFormat) + "Dialogue: 0,0:00:00.5,0:00:02.50,A,,0,0,0,,A\n"),
              "'a.ass', line 3: no times of a cue; write 0:00:01.00,0:00:02.50");
    EXPECT_EQ(fault(std::string(kAssFormat) + "Dialogue: 0,0:00:05.00,0:00:02.50,A,,0,0,0,,A\n"),
              "'a.ass', line 3: the cue ends at 00:00:02.500, before it starts at 00:00:05.000");
}

TEST(SubtitleReader, TimeName_HasHoursAndMilliseconds) {
    EXPECT_EQ(timeName(0), "00:00:00.000");
    EXPECT_EQ(timeName(3723004), "01:02:03.004");
    EXPECT_EQ(timeName(int64_t{999999} * 3600000), "999999:00:00.000");
}

}  // namespace
}  // namespace vorelpaint
