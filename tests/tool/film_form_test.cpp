#include "film_form.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "error.h"
#include "program.h"

namespace vorelpaint {
namespace {

using Words = std::vector<std::string>;

template <typename Do>
std::string faultOf(Do&& act) {
    try {
        act();
        return "";
    } catch (const ToolError& error) {
        return error.what();
    }
}

std::string wordBehind(const Words& words, const std::string& option) {
    const auto at = std::find(words.begin(), words.end(), option);
    return at == words.end() ? "none" : *(at + 1);
}

FilmPlan plan(const std::string& output, const std::optional<Clip>& clip) {
    const FilmCodec& codec = filmCodec(output, {}, !clip);
    return {output, codec, !clip, {24000, 1001}, {0, 100, 320, 160}, 180, clip ? "-a:b.mp4" : "", clip};
}

TEST(FilmForm, Kind_IsThatOfTheName) {
    EXPECT_EQ(filmKindOf("-"), FilmKind::raw);
    EXPECT_EQ(filmKindOf("/dev/stdout"), FilmKind::raw);
    EXPECT_EQ(filmKindOf("/dev/null"), FilmKind::raw);
    EXPECT_EQ(filmKindOf("a.rgba"), FilmKind::raw);
    EXPECT_EQ(filmKindOf("a.%d.PNG"), FilmKind::pictures);
    for (const char* name : {"a.mp4", "a.MOV", "dir.x/a.mkv", "-.webm"})
        EXPECT_EQ(filmKindOf(name), FilmKind::file) << name;
    for (const char* name : {"", "a", "a.avi", "a.mp4/b", "mp4", "a.srt"}) {
        EXPECT_EQ(faultOf([&] { filmKindOf(name); }),
                  "'" + std::string(name) +
                      "' is named like no film; .mp4, .mov, .mkv, .webm, .rgba and frame_%05d.png are "
                      "known");
    }
}

TEST(FilmForm, Codec_IsTheContainersFirst) {
    const auto name = [](const char* output, bool isTransparent) {
        return std::string(filmCodec(output, {}, isTransparent).name);
    };
    EXPECT_EQ(name("a.mp4", false), "h264");
    EXPECT_EQ(name("a.mov", false), "h264");
    EXPECT_EQ(name("a.mkv", false), "h264");
    EXPECT_EQ(name("a.webm", false), "vp9");
    EXPECT_EQ(name("a.mov", true), "prores");
    EXPECT_EQ(name("a.webm", true), "vp9");
    EXPECT_EQ(name("a.mkv", true), "ffv1");
    EXPECT_STREQ(filmCodec("a.mkv", "vp9", true).name, "vp9");
}

TEST(FilmForm, CodecThatTheContainerDoesNotHold_IsRefused) {
    EXPECT_EQ(faultOf([] { filmCodec("a.mp4", {}, true); }),
              "a .mp4 holds no transparent film: give --over or --background, or end the name with "
              ".mov, .mkv or .webm");
    EXPECT_EQ(faultOf([] { filmCodec("a.webm", "h264", false); }),
              "a .webm holds no film in h264, but in vp9");
    EXPECT_EQ(faultOf([] { filmCodec("a.mov", "ffv1", true); }),
              "a .mov holds no transparent film in ffv1, but in prores, png");
}

TEST(FilmForm, EveryCodec_CanBeAskedFor) {
    for (const std::string& name : filmCodecNames()) {
        bool isHeld = false;
        for (const char* output : {"a.mp4", "a.mov", "a.mkv", "a.webm"}) {
            for (const bool isTransparent : {false, true})
                isHeld |= faultOf([&] { filmCodec(output, name, isTransparent); }).empty();
        }
        EXPECT_TRUE(isHeld) << name;
    }
}

TEST(FilmForm, Words_NameFilesSoThatTheyAreNothingElse) {
    Clip clip;
    clip.matrix = "bt709";
    const Words words = ffmpegWords(plan("a.mp4", clip));
    EXPECT_EQ(words.front(), "ffmpeg");
    EXPECT_EQ(wordBehind(words, "-i"), "file:-a:b.mp4");
    EXPECT_EQ(words.back(), "file:/proc/self/fd/3");
    EXPECT_EQ(wordBehind(words, "-protocol_whitelist"), "file,pipe");
    EXPECT_EQ(wordBehind(words, "-framerate"), "24000/1001");
    EXPECT_EQ(wordBehind(words, "-video_size"), "320x60");
}

TEST(FilmForm, Sound_IsKeptWhereTheContainerHoldsIt) {
    Clip clip;
    clip.audioCodecs = {"pcm_s16le", "aac", "opus"};
    const auto codecsIn = [&](const char* output) {
        const Words words = ffmpegWords(plan(output, clip));
        return Words{wordBehind(words, "-c:a:0"), wordBehind(words, "-c:a:1"),
                     wordBehind(words, "-c:a:2")};
    };
    EXPECT_EQ(codecsIn("a.mp4"), (Words{"aac", "copy", "copy"}));
    EXPECT_EQ(codecsIn("a.mov"), (Words{"copy", "copy", "aac"}));
    EXPECT_EQ(codecsIn("a.mkv"), (Words{"copy", "copy", "copy"}));
    EXPECT_EQ(codecsIn("a.webm"), (Words{"libopus", "libopus", "copy"}));
    EXPECT_EQ(wordBehind(ffmpegWords(plan("a.mov", {})), "-c:a:0"), "none");
}

}  // namespace
}  // namespace vorelpaint
