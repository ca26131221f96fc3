/// Films as the program makes them with FFmpeg, which also makes the clips and takes the films apart.
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <map>
#include <nlohmann/json.hpp>
#include <sstream>
#include <string>
#include <thread>
#include <tuple>
#include <vector>

#include "child_program.h"
#include "compose/system/png_reader.h"
#include "film_clip.h"
#include "film_rate.h"
#include "program.h"
#include "subtitle_reader.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

using Json = nlohmann::json;
using vorel_test::Outcome;
using vorel_test::readBytes;
using vorel_test::RunningVorelpaint;
using vorel_test::runVorelpaint;
using vorel_test::Surroundings;
using vorel_test::TempDir;
using vorelcompose::readPng;
using voreltext::Image;
using Clock = std::chrono::steady_clock;
using Words = std::vector<std::string>;

constexpr int kWidth = 320;
constexpr int kHeight = 180;
constexpr size_t kMuch = size_t{1} << 28;

constexpr const char* kTwoCues =
    "1\n00:00:00,200 --> 00:00:00,900\nGold\n\n"
    "2\n00:00:00,700 --> 00:00:01,500\n<i>Two</i> &amp; two\n";

Words operator+(Words words, const Words& more) {
    words.insert(words.end(), more.begin(), more.end());
    return words;
}

/// What a program of FFmpeg writes to its standard output.
std::string outputOf(const Words& words) {
    ChildProgram program(words, ChildProgram::Stream::output);
    std::string output = program.readAll(kMuch);
    program.finish();
    return output;
}

/// The frames of a film, one behind the other, in pixels of one of FFmpeg's formats.
std::string framesOf(const std::string& film, const char* pixels, const Words& before = {}) {
    return outputOf(Words{"ffmpeg", "-nostdin", "-v", "error"} + before +
                    Words{"-i", fileUrl(film), "-f", "rawvideo", "-pix_fmt", pixels, "-vsync",
                          "passthrough", "pipe:1"});
}

std::string probed(const std::string& film, const std::string& entries) {
    return outputOf({"ffprobe", "-v", "error", "-count_frames", "-show_entries", entries, "-of",
                     "compact=p=0:nk=1", fileUrl(film)});
}

/// A moving test picture.
std::string makeClip(const std::string& path, const std::string& rate, const Words& codec,
                     const std::string& size = "320x180", const std::string& seconds = "2") {
    outputOf(Words{"ffmpeg", "-nostdin", "-v", "error", "-f", "lavfi", "-i",
                   "testsrc2=duration=" + seconds + ":size=" + size + ":rate=" + rate} +
             codec + Words{"-y", fileUrl(path)});
    return path;
}

/// What is made without a word on standard error.
std::string made(const Words& arguments) {
    const Outcome outcome = runVorelpaint(arguments);
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.err, "");
    return outcome.out;
}

class Films : public ::testing::Test {
  protected:
    /// Cues in frames of 320 x 180, in a look that paints every alpha there is.
    Words asked(const Words& more, const std::string& subtitles = kTwoCues) {
        const Words words{"--subtitles",    mDir.write("a.srt", subtitles),
                          "--preset",       "gold",
                          "--size",         "40",
                          "--effect-scale", "0.5"};
        return words + more;
    }
    Words inFrames(const Words& more, const std::string& subtitles = kTwoCues) {
        return asked(Words{"--width", "320", "--height", "180"} + more, subtitles);
    }

    TempDir mDir;
};

/// Which frames of two films differ.
std::vector<bool> differences(const std::string& one, const std::string& other, size_t bytesPerFrame) {
    std::vector<bool> differ;
    for (size_t at = 0; at < std::min(one.size(), other.size()); at += bytesPerFrame)
        differ.push_back(one.compare(at, bytesPerFrame, other, at, bytesPerFrame) != 0);
    return differ;
}

// --- raw frames and pictures --------------------------------------------------------------------------

TEST_F(Films, RawFrames_AreWhatThePainterPaints) {
    const std::string raw = made(inFrames({"--fps", "10", "-o", "-"}));
    ASSERT_EQ(raw.size(), size_t{15} * kWidth * kHeight * 4);
    const std::string painted = mDir.file("painted.png");
    made({"--preset", "gold",     "--size",  "40",       "--effect-scale", "0.5",      "--width",
          "320",      "--height", "180",     "--anchor", "bottom",         "--margin", "9",
          "--box",    "line",     "--align", "center",   "--fit",          "wrap",     "-o",
          painted,    "Gold"});
    const Image picture = readPng(painted);
    const std::string expected(picture.pixels.begin(), picture.pixels.end());
    const size_t frame = expected.size();
    for (size_t i = 2; i < 7; ++i)
        EXPECT_EQ(raw.compare(i * frame, frame, expected), 0) << i;
    const std::string blank(frame, '\0');
    EXPECT_EQ(raw.compare(0, frame, blank), 0);
    EXPECT_EQ(raw.compare(frame, frame, blank), 0);
    EXPECT_NE(raw.compare(7 * frame, frame, expected), 0) << "with the second cue above it";
}

TEST_F(Films, RawFrames_GoIntoFilesAndPipesToo) {
    const std::string raw = made(inFrames({"--fps", "5", "-o", "-"}));
    const std::string path = mDir.file("a.rgba");
    made(inFrames({"--fps", "5", "-o", path}));
    EXPECT_EQ(readBytes(path), raw);
    EXPECT_EQ(made(inFrames({"--fps", "5", "-o", "/dev/stdout"})), raw);
}

TEST_F(Films, NumberedPictures_AreTheFrames) {
    const std::string raw = made(inFrames({"--fps", "10", "--fade-in", "300", "-o", "-"}));
    const TempDir frames;
    made(inFrames({"--fps", "10", "--fade-in", "300", "-o", frames.file("f_%03d.png")}));
    size_t number = 0;
    for (const std::string& name : frames.list()) {
        EXPECT_EQ(name, "f_0" + std::string(number < 10 ? "0" : "") + std::to_string(number) + ".png");
        const Image picture = readPng(frames.file(name));
        const std::string pixels(picture.pixels.begin(), picture.pixels.end());
        EXPECT_EQ(raw.compare(number * pixels.size(), pixels.size(), pixels), 0) << name;
        ++number;
    }
    EXPECT_EQ(number, 15U);
}

TEST_F(Films, AnyNumberOfThreads_MakesTheSame) {
    const auto madeBy = [&](const char* jobs, const Words& output) {
        const TempDir dir;
        made(inFrames(
            Words{"--fade-in", "200", "--fade-out", "200", "--jobs", jobs, "-o", dir.file(output[0])} +
            Words(output.begin() + 1, output.end())));
        std::map<std::string, std::string> files;
        for (const std::string& name : dir.list()) {
            const std::string path = dir.file(name);
            files[name] = output[0] == "f.mkv" ? framesOf(path, "rgba") : readBytes(path);
        }
        return files;
    };
    for (const Words& output :
         {Words{"f%d.png"}, Words{"f%d.png", "--each", "cue"}, Words{"f.rgba"}, Words{"f.mkv"}}) {
        const auto files = madeBy("1", output);
        EXPECT_EQ(files.size(), output[0] != "f%d.png" ? 1U : output.size() == 1 ? 45U : 2U);
        EXPECT_TRUE(files == madeBy("2", output)) << output[0];
        EXPECT_TRUE(files == madeBy("5", output)) << output[0];
    }
}

TEST_F(Films, PictureOfEachCue_StandsInTheReport) {
    const std::string report =
        made(inFrames({"--each", "cue", "-o", mDir.file("cue%d.png"), "--report", "json"}));
    const size_t end = report.find('\n');
    const Json first = Json::parse(report.substr(0, end));
    const Json second = Json::parse(report.substr(end));
    EXPECT_EQ(first["output"], mDir.file("cue1.png"));
    EXPECT_EQ(first["start"], 0.2);
    EXPECT_EQ(first["end"], 0.9);
    EXPECT_EQ(first["line"], 2);
    EXPECT_EQ(first["first-frame"], 6);
    EXPECT_EQ(first["end-frame"], 27);
    EXPECT_EQ(second["text"], "Two & two");
    EXPECT_EQ(second["box"]["bottom"], first["box"]["top"]);
    const std::string raw = made(inFrames({"-o", "-"}));
    for (const auto& [name, frame] : {std::pair{"cue1.png", 10}, std::pair{"cue2.png", 30}}) {
        const Image picture = readPng(mDir.file(name));
        const std::string pixels(picture.pixels.begin(), picture.pixels.end());
        EXPECT_EQ(raw.compare(static_cast<size_t>(frame) * pixels.size(), pixels.size(), pixels), 0);
    }
}

TEST_F(Films, WithoutFFmpeg_PicturesAreWrittenAndFilmsRefused) {
    const std::string path = std::getenv("PATH");
    ::setenv("PATH", mDir.path().c_str(), 1);
    const Outcome pictures = runVorelpaint(inFrames({"--fps", "1", "-o", mDir.file("f%d.png")}));
    const Outcome film = runVorelpaint(inFrames({"-o", mDir.file("a.mov")}));
    ::setenv("PATH", path.c_str(), 1);
    EXPECT_EQ(pictures.exitCode, 0) << pictures.err;
    EXPECT_EQ(film.exitCode, 2);
    EXPECT_EQ(film.err,
              "vorelpaint: there is no ffmpeg: films are made by FFmpeg, which is not installed\n");
    EXPECT_EQ(mDir.list(), (Words{"a.srt", "f0.png", "f1.png"}));
}

// --- transparent films --------------------------------------------------------------------------------

TEST_F(Films, LosslessTransparentFilms_HaveThePaintedPixels) {
    const Words fades{"--fade-in", "200", "--fade-out", "100"};
    const std::string raw = made(inFrames(fades + Words{"-o", "-"}));
    for (const auto& [ending, codec] : {std::pair{"mkv", "ffv1"}, std::pair{"mov", "png"}}) {
        const std::string film = mDir.file(std::string("a.") + ending);
        made(inFrames(fades + Words{"--codec", codec, "-o", film}));
        EXPECT_TRUE(framesOf(film, "rgba") == raw) << ending;
        EXPECT_NE(probed(film, "stream=r_frame_rate").find("30/1"), std::string::npos);
    }
}

TEST_F(Films, TransparentFilms_KeepTheirAlphaNearly) {
    const std::string raw = made(inFrames({"--fps", "10", "-o", "-"}));
    struct Kind {
        const char* ending;
        Words decoder;
    };
    for (const Kind& kind : {Kind{"mov", {}}, Kind{"webm", {"-c:v", "libvpx-vp9"}}}) {
        const std::string film = mDir.file(std::string("a.") + kind.ending);
        made(inFrames({"--fps", "10", "-o", film}));
        const std::string frames = framesOf(film, "rgba", kind.decoder);
        ASSERT_EQ(frames.size(), raw.size()) << kind.ending;
        int64_t sum = 0;
        for (size_t i = 3; i < raw.size(); i += 4)
            sum += std::abs(static_cast<uint8_t>(raw[i]) - static_cast<uint8_t>(frames[i]));
        EXPECT_LT(static_cast<double>(sum) / static_cast<double>(raw.size() / 4), 1.0) << kind.ending;
    }
}

TEST_F(Films, FilmsWithoutAClip_SayThatTheyAreInBt709) {
    for (const Words& form :
         {Words{"-o", mDir.file("a.mov")}, Words{"-o", mDir.file("a.webm")},
          Words{"--background", "#204060", "-o", mDir.file("a.mp4")},
          Words{"--background", "#204060", "--codec", "prores", "-o", mDir.file("b.mov")}}) {
        made(inFrames(Words{"--fps", "2"} + form));
        EXPECT_EQ(probed(form.back(), "stream=color_range,color_space,color_transfer,color_primaries"),
                  "tv|bt709|bt709|bt709\n")
            << form.back();
    }
}

/// In red letters the samples of colour are those of red, where one of their four pixels has alpha
/// enough to be seen: Cr = 128 + 112 / (1 - 0.2126) * (R - Y) / 255 with Y = 0.2126 R.
TEST_F(Films, TransparentFilms_HaveTheTextsColourAtItsEdges) {
    const std::string film = mDir.file("a.webm");
    made({"--subtitles", mDir.write("a.srt", kTwoCues), "--preset", "plain", "--color", "#E00000",
          "--size", "40", "--width", "320", "--height", "180", "--fps", "5", "-o", film});
    const std::string frames = framesOf(film, "yuva420p", {"-c:v", "libvpx-vp9"});
    constexpr size_t kPixels = size_t{kWidth} * kHeight;
    const auto* frame = reinterpret_cast<const uint8_t*>(frames.data()) + kPixels * 5 / 2;
    const uint8_t* alpha = frame + kPixels * 3 / 2;
    const double red = 128 + 112 / 0.7874 * 0.7874 * 0xE0 / 255;
    int seen = 0;
    double sum = 0;
    for (size_t y = 0; y < kHeight / 2; ++y) {
        for (size_t x = 0; x < kWidth / 2; ++x) {
            const uint8_t* block = alpha + 2 * y * kWidth + 2 * x;
            if (std::max({block[0], block[1], block[kWidth], block[kWidth + 1]}) < 128) continue;
            ++seen;
            sum += std::abs(frame[kPixels * 5 / 4 + y * (kWidth / 2) + x] - red);
        }
    }
    ASSERT_GT(seen, 200);
    EXPECT_LT(sum / seen, 5) << "of 98 that it is away from grey";
}

TEST_F(Films, Background_MakesThemOpaque) {
    const std::string film = mDir.file("a.mkv");
    made(inFrames({"--fps", "10", "--background", "#204060", "--codec", "ffv1", "-o", film}));
    const std::string raw = made(inFrames({"--fps", "10", "--background", "#204060", "-o", "-"}));
    EXPECT_TRUE(framesOf(film, "rgba") == raw);
    EXPECT_EQ(raw.substr(0, 4), "\x20\x40\x60\xFF");
    const std::string compressed = mDir.file("a.mp4");
    made(inFrames({"--fps", "10", "--background", "#204060", "-o", compressed}));
    const std::string pixel = framesOf(compressed, "rgb24").substr(0, 3);
    for (size_t c = 0; c < 3; ++c)
        EXPECT_NEAR(static_cast<uint8_t>(pixel[c]), 0x20 * static_cast<double>(c + 1), 3)
            << "converted in its colours";
}

// --- burnt into a clip --------------------------------------------------------------------------------

TEST_F(Films, BurntInto_RgbPixelsAreBlendedWithTheClips) {
    const std::string clip = makeClip(mDir.file("clip.mkv"), "10", {"-c:v", "ffv1", "-pix_fmt", "gbrp"});
    const std::string film = mDir.file("film.mkv");
    made(asked({"--over", clip, "--fade-in", "300", "--codec", "ffv1", "-o", film}));
    const std::string raw = made(inFrames({"--fps", "10", "--fade-in", "300", "-o", "-"}));
    const std::string below = framesOf(clip, "rgba");
    const std::string frames = framesOf(film, "rgba");
    ASSERT_EQ(frames.size(), below.size());
    for (size_t i = 0; i < raw.size(); ++i) {
        const double alpha = static_cast<uint8_t>(raw[i | 3]) / 255.0;
        const double over = static_cast<uint8_t>(raw[i]);
        const double expected =
            (i & 3) == 3 ? 255 : over * alpha + static_cast<uint8_t>(below[i]) * (1 - alpha);
        ASSERT_NEAR(static_cast<uint8_t>(frames[i]), expected, 1.5) << i;
    }
    EXPECT_TRUE(frames.compare(raw.size(), std::string::npos, below, raw.size()) == 0)
        << "behind the last cue the clip goes on";
}

/// Colours of halved planes are those of a film whose planes were halved after the cues were laid over
/// it.
TEST_F(Films, BurntInto_EdgesAreNotDarkened) {
    const Words white{"-vf", "drawbox=color=white:t=fill", "-c:v", "ffv1", "-pix_fmt"};
    const auto burnt = [&](const char* pixels) {
        const std::string clip = makeClip(mDir.file("clip.mkv"), "5", white + Words{pixels});
        const std::string film = mDir.file("film.mkv");
        made({"--subtitles", mDir.write("a.srt", kTwoCues), "--preset", "plain", "--color", "#E00000",
              "--size", "40", "--over", clip, "--codec", "ffv1", "-o", film});
        return framesOf(film, "yuv420p");
    };
    const std::string halvedBefore = burnt("yuv420p");
    const std::string halvedAfter = burnt("gbrp");
    ASSERT_EQ(halvedBefore.size(), halvedAfter.size());
    constexpr size_t kPixels = size_t{kWidth} * kHeight;
    int seen = 0;
    double lost = 0;
    for (size_t i = 3 * kPixels / 2 + kPixels * 5 / 4; i < 3 * kPixels; ++i) {  // Cr of the second frame
        const int red = static_cast<uint8_t>(halvedAfter[i]);
        if (red < 150) continue;
        ++seen;
        lost += red - static_cast<uint8_t>(halvedBefore[i]);
    }
    ASSERT_GT(seen, 200);
    EXPECT_LT(lost / seen, 3) << "of 98 that it is away from grey";
}

/// Whatever the clip's rate, container and pixels are: outside of the cues' times it is left as it is.
TEST_F(Films, BurntInto_CuesAreSeenInTheFramesThatBeginWithinTheirTimes) {
    struct Kind {
        const char* name;
        const char* rate;
        Words codec;
        const char* pixels;
        size_t bytes;
    };
    const std::vector<Kind> kinds{
        {"a.mkv", "24000/1001", {"-c:v", "ffv1", "-pix_fmt", "yuv420p"}, "yuv420p", 86400},
        {"b.mkv", "30", {"-c:v", "ffv1", "-pix_fmt", "yuv422p10le"}, "yuv422p10le", 230400},
        {"c.mp4", "25", {"-c:v", "libx264", "-qp", "0"}, "yuv420p", 86400},
        // Times that were cut to whole milliseconds, of a length that the file does not tell.
        {"d.mkv",
         "24000/1001",
         {"-vf", "settb=1/1000,setpts=floor(N*1001/24)", "-vsync", "passthrough", "-enc_time_base",
          "1/1000", "-c:v", "ffv1", "-pix_fmt", "yuv420p", "-live", "1"},
         "yuv420p",
         86400}};
    const std::vector<std::pair<int, int>> times{{200, 700}, {1000, 1033}, {1501, 1950}};
    for (const Kind& kind : kinds) {
        const std::string clip = makeClip(mDir.file(kind.name), kind.rate, kind.codec);
        const std::string film = mDir.file("film.mkv");
        std::string cues;
        for (const auto& [start, end] : times)
            cues += timeName(start) + " --> " + timeName(end) + "\nGold\n\n";
        made(asked({"--over", clip, "--codec", "ffv1", "-o", film}, cues));
        const std::string below = framesOf(clip, kind.pixels);
        const std::string frames = framesOf(film, kind.pixels);
        ASSERT_EQ(frames.size(), below.size()) << kind.name;
        const std::vector<bool> seen = differences(frames, below, kind.bytes);
        const FrameRate rate = parseFrameRate(kind.rate).value();
        for (size_t frame = 0; frame < seen.size(); ++frame) {
            const double ms = rate.startMs(static_cast<int64_t>(frame));
            const bool within = std::any_of(times.begin(), times.end(), [&](const auto& time) {
                return time.first <= ms && ms < time.second;
            });
            EXPECT_EQ(seen[frame], within) << kind.name << ", frame " << frame;
        }
    }
}

TEST_F(Films, BurntInto_PixelsStayInTheirFormat) {
    for (const char* pixels : {"yuv420p10le", "yuv422p", "yuv444p", "bgr0"}) {
        const std::string clip =
            makeClip(mDir.file("clip.mkv"), "5", {"-c:v", "ffv1", "-pix_fmt", pixels}, "64x64", "0.6");
        const std::string film = mDir.file("film.mkv");
        made({"--subtitles", mDir.write("a.srt", "00:00:00,200 --> 00:00:00,400\nGold\n"), "--preset",
              "outline", "--size", "16", "--over", clip, "--codec", "ffv1", "-o", film});
        EXPECT_EQ(probed(film, "stream=pix_fmt"), std::string(pixels) + "\n");
        const std::string below = framesOf(clip, pixels);
        const std::string frames = framesOf(film, pixels);
        EXPECT_EQ(differences(frames, below, below.size() / 3), (std::vector<bool>{false, true, false}))
            << pixels;
        EXPECT_EQ(frames.compare(below.size() / 3, 64, below, below.size() / 3, 64), 0)
            << pixels << ", above the cue";
    }
}

TEST_F(Films, BurntInto_SoundIsKeptAlone) {
    const std::string clip = mDir.file("clip.mkv");
    outputOf({"ffmpeg", "-nostdin",
              "-v",     "error",
              "-f",     "lavfi",
              "-i",     "testsrc2=duration=2:size=320x180:rate=10",
              "-f",     "lavfi",
              "-i",     "sine=duration=2",
              "-i",     fileUrl(mDir.write("b.srt", kTwoCues)),
              "-c:v",   "libx264",
              "-c:a",   "aac",
              "-c:s",   "srt",
              "-y",     fileUrl(clip)});
    ASSERT_EQ(probed(clip, "stream=codec_type"), "video\naudio\nsubtitle\n");
    const std::string film = mDir.file("film.mp4");
    made(asked({"--over", clip, "-o", film}));
    const auto sound = [](const std::string& of) {
        return outputOf({"ffmpeg", "-nostdin", "-v", "error", "-i", fileUrl(of), "-map", "0:a", "-c",
                         "copy", "-f", "md5", "pipe:1"});
    };
    EXPECT_EQ(sound(film), sound(clip));
    EXPECT_EQ(probed(film, "stream=codec_name"), "h264\naac\n");
    EXPECT_EQ(probed(film, "stream=nb_read_frames").substr(0, 3), "20\n");
    const std::string other = mDir.file("film.webm");
    made(asked({"--over", clip, "-o", other}));
    EXPECT_EQ(probed(other, "stream=codec_name"), "vp9\nopus\n");
}

/// In the other matrix of the two, green would be off by tens.
TEST_F(Films, BurntInto_CuesHaveTheirColoursAsPlayersTakeThem) {
    const std::string style = mDir.write("s.json", R"({"color": "#20C040"})");
    for (const auto& [size, matrix] : {std::pair{"320x180", "bt601"}, std::pair{"1280x720", "bt709"}}) {
        const std::string clip =
            makeClip(mDir.file("clip.mkv"), "5", {"-c:v", "ffv1", "-pix_fmt", "yuv420p"}, size, "0.2");
        const std::string film = mDir.file("film.mkv");
        // Blocks of ink, U+2588, as large as most of the frame.
        made({"--subtitles", mDir.write("a.srt", "00:00:00,000 --> 00:00:02,000\n\xE2\x96\x88\n"),
              "--style", style, "--size", "130", "--anchor", "center", "--over", clip, "--codec", "ffv1",
              "-o", film});
        const std::string pixel =
            outputOf({"ffmpeg", "-nostdin", "-v", "error", "-i", fileUrl(film), "-vf",
                      std::string("crop=2:2,scale=in_color_matrix=") + matrix + ",format=rgb24", "-f",
                      "rawvideo", "pipe:1"});
        ASSERT_GE(pixel.size(), 3U);
        EXPECT_NEAR(static_cast<uint8_t>(pixel[0]), 0x20, 3) << size;
        EXPECT_NEAR(static_cast<uint8_t>(pixel[1]), 0xC0, 3) << size;
        EXPECT_NEAR(static_cast<uint8_t>(pixel[2]), 0x40, 3) << size;
    }
}

TEST_F(Films, BurntInto_PixelsThatAreNotSquareAreNoted) {
    const std::string clip =
        makeClip(mDir.file("clip.mkv"), "5", {"-vf", "setsar=16/11", "-c:v", "ffv1"}, "320x180", "2");
    const Outcome outcome = runVorelpaint(asked({"--over", clip, "-o", mDir.file("film.mkv")}));
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.err,
              "vorelpaint: note: the clip's pixels are not square: the text is stretched with its "
              "pictures\n");
}

TEST_F(Films, BurntInto_ATurnedClipIsTurned) {
    const std::string lying = makeClip(mDir.file("lying.mp4"), "10", {"-c:v", "libx264"});
    const std::string clip = mDir.file("clip.mp4");
    outputOf({"ffmpeg", "-nostdin", "-v", "error", "-i", fileUrl(lying), "-c", "copy", "-metadata:s:v",
              "rotate=90", "-y", fileUrl(clip)});
    const std::string film = mDir.file("film.mp4");
    made(asked({"--over", clip, "-o", film}));
    EXPECT_EQ(probed(film, "stream=width,height"), "180|320\n");
}

TEST_F(Films, BurntInto_ShorterThanTheCues_EndsWithTheClip) {
    const std::string clip = makeClip(mDir.file("clip.mkv"), "10", {"-c:v", "ffv1"});
    const std::string film = mDir.file("film.mkv");
    const std::string cues =
        "00:00:01,500 --> 00:00:09,000\nGold\n\n"
        "00:00:02,000 --> 00:01:00,000\nnever\n";
    const Outcome outcome = runVorelpaint(asked({"--over", clip, "-o", film}, cues));
    EXPECT_EQ(outcome.exitCode, 0);
    EXPECT_EQ(outcome.err,
              "vorelpaint: note: 1 of 2 cues start behind the end of the clip '" + clip + "'\n");
    EXPECT_EQ(probed(film, "stream=nb_read_frames"), "20\n");
    const Outcome strict = runVorelpaint(asked({"--strict", "--over", clip, "-o", film}, cues));
    EXPECT_EQ(strict.exitCode, 2);
}

TEST_F(Films, Names_MayBeAnything) {
    const fs::path before = fs::current_path();
    const TempDir here;
    fs::current_path(here.path());
    makeClip("clip.mp4", "10", {"-c:v", "libx264", "-preset", "ultrafast"});
    for (const std::string name : {"-i", "$(touch x) 'a\n50%d \xFF*", "concat:a|b", "pipe:0"}) {
        fs::copy_file("clip.mp4", name + ".mp4");
        const std::string subtitles = name + ".srt";
        here.write(subtitles, kTwoCues);
        // Behind = an option takes what begins like another one.
        const Outcome outcome = runVorelpaint(
            {"--subtitles=" + subtitles, "--over=" + name + ".mp4", "--output=" + name + ".mov"});
        EXPECT_EQ(outcome.exitCode, 0) << name << outcome.err;
        EXPECT_TRUE(fs::exists(name + ".mov")) << name;
        for (const char* ending : {".mp4", ".srt", ".mov"})
            fs::remove(name + ending);
    }
    fs::current_path(before);
    EXPECT_EQ(here.list(), Words{"clip.mp4"});
}

TEST_F(Films, WhereFilesMustHaveNames_TheyAreMadeToo) {
    Surroundings surroundings;
    surroundings.unnamedFiles = false;
    const TempDir films;
    const Words asIs = inFrames({"--fps", "5", "-o"});
    const Outcome outcome = runVorelpaintIn(surroundings, asIs + Words{films.file("a.mkv")});
    EXPECT_EQ(outcome.exitCode, 0) << outcome.err;
    EXPECT_EQ(films.list(), Words{"a.mkv"});
    EXPECT_TRUE(framesOf(films.file("a.mkv"), "rgba") == made(asIs + Words{"-"}));
}

TEST_F(Films, InItsOwnPlace_AClipMayBeReplaced) {
    const std::string clip = makeClip(mDir.file("clip.mkv"), "10", {"-c:v", "ffv1"});
    const std::string old = readBytes(clip);
    made(asked({"--over", clip, "-o", clip}));
    EXPECT_NE(readBytes(clip), old);
    EXPECT_EQ(probed(clip, "stream=codec_name,nb_read_frames"), "h264|20\n");
}

// --- what cannot be done ------------------------------------------------------------------------------

/// One line on standard error, exit code 2, nothing written.
class RefusedFilms : public Films {
  protected:
    std::string faultOf(const Words& arguments) {
        const Outcome outcome = runVorelpaint(arguments);
        EXPECT_EQ(outcome.exitCode, 2);
        EXPECT_EQ(outcome.out, "");
        EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1) << outcome.err;
        EXPECT_TRUE(mOutputs.list().empty());
        const std::string begin = "vorelpaint: ";
        EXPECT_EQ(outcome.err.substr(0, begin.size()), begin);
        return outcome.err.substr(begin.size(), outcome.err.size() - begin.size() - 1);
    }
    std::string output(const char* name) const { return mOutputs.file(name); }

    TempDir mOutputs;
};

TEST_F(RefusedFilms, Subtitles_ThatCannotBeShown) {
    const std::string path = "'" + mDir.file("a.srt") + "'";
    for (const char* name : {"a.mov", "f%d.png"}) {
        const Words to{"-o", output(name)};
        EXPECT_EQ(faultOf(asked(to, "")), path + " has no cue with a text");
        EXPECT_EQ(faultOf(asked(to, "1\n00:00:02,000 --> 00:00:01,000\nA\n")),
                  path + ", line 2: the cue ends at 00:00:01.000, before it starts at 00:00:02.000");
        EXPECT_EQ(faultOf(asked(to,
                                "1\n00:00:01,000 --> 00:00:02,000\nA\n\n2\n00:00:03,000 --> "
                                "00:00:04,000\na\x1B\n")),
                  path + ", line 6: the text has the control character U+001B in line 1, character 2");
    }
    EXPECT_EQ(faultOf({"--subtitles", "no.srt", "-o", output("a.mov")}),
              "cannot read 'no.srt': No such file or directory");
}

TEST_F(RefusedFilms, Clips_ThatCannotBeRead) {
    const std::string text = mDir.write("text.mp4", "no clip");
    const Words to{"-o", output("a.mp4")};
    EXPECT_EQ(faultOf(asked(to + Words{"--over", text})).substr(0, 32 + text.size()),
              "cannot read '" + text + "': ffprobe failed: ");
    EXPECT_EQ(faultOf(asked(to + Words{"--over", "no.mp4"})),
              "cannot read 'no.mp4': No such file or directory");
    EXPECT_EQ(faultOf(asked(to + Words{"--over", mDir.path()})),
              "cannot read '" + mDir.path().string() + "': a clip must be a file");
    const std::string sound = mDir.file("sound.wav");
    outputOf(
        {"ffmpeg", "-nostdin", "-v", "error", "-f", "lavfi", "-i", "sine=duration=1", fileUrl(sound)});
    const std::string fast = makeClip(mDir.file("fast.mkv"), "500", {"-c:v", "ffv1"}, "64x64", "0.1");
    EXPECT_EQ(faultOf(asked(to + Words{"--over", fast})),
              "'" + fast + "' has no steady frame rate of 1 to 240; give one by --fps");
    EXPECT_EQ(faultOf(asked(to + Words{"--over", sound})),
              "cannot read '" + sound + "': it has no moving pictures");
}

TEST_F(RefusedFilms, Outputs_ThatAreNoFilms) {
    EXPECT_EQ(faultOf(asked({"-o", output("a.avi")})),
              "'" + output("a.avi") +
                  "' is named like no film; .mp4, .mov, .mkv, .webm, .rgba and "
                  "frame_%05d.png are known");
    EXPECT_EQ(faultOf(asked({"-o", output("a.png")})),
              "'" + output("a.png") +
                  "' names one picture; those of a film are numbered, as by frame_%05d.png");
    EXPECT_EQ(faultOf(asked({"-o", output("a.mp4")})),
              "a .mp4 holds no transparent film: give --over or --background, or end the name with "
              ".mov, .mkv or .webm");
    EXPECT_EQ(faultOf(asked({"-o", output("no/a.mov")})),
              "cannot write '" + output("no/a.mov") + "': No such file or directory");
    EXPECT_EQ(faultOf(asked({"--each", "cue", "-o", output("a.mov")})),
              "a picture of each cue needs a numbered name, such as cue_%03d.png");
    EXPECT_EQ(faultOf(asked({"--width", "321", "--background", "#000", "-o", output("a.mp4")})),
              "the sides of a film in h264 are even; these are 321 x 1080");
    EXPECT_EQ(faultOf(asked({})), "nowhere to show the subtitles: give -o FILE, or -o - for raw frames");
}

/// At the end of a file, too, which ffmpeg by itself takes lightly.
/// Before anything is read or made: a film may take hours.
TEST_F(RefusedFilms, Outputs_ThatAreFolders) {
    for (const char* name : {"a.mov", "a.rgba"}) {
        const std::string folder = mDir.file(name);
        std::filesystem::create_directory(folder);
        EXPECT_EQ(faultOf({"--subtitles", "no.srt", "-o", folder}),
                  "cannot write '" + folder + "': Is a directory");
    }
}

TEST_F(RefusedFilms, Outputs_WithoutRoom) {
    for (const char* name : {"a.mov", "a.mkv", "a.webm", "a.mp4", "a.rgba"}) {
        const Words films = inFrames({"--background", "#204060", "--fade-in", "500", "-o"});
        const std::string whole = mDir.file(name);
        made(films + Words{whole});
        const size_t size = fs::file_size(whole);
        for (const size_t room : {size - 1, size / 2, size_t{1000}}) {
            Surroundings surroundings;
            surroundings.largestFile = room;
            const Outcome outcome = runVorelpaintIn(surroundings, films + Words{output(name)});
            EXPECT_EQ(outcome.exitCode, 2) << name << ", " << room << " of " << size;
            EXPECT_EQ(outcome.err.find("vorelpaint: cannot write '" + output(name) + "': "), 0U)
                << outcome.err;
            EXPECT_NE(outcome.err.find("File too large\n"), std::string::npos) << outcome.err;
            EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1) << outcome.err;
            EXPECT_TRUE(mOutputs.list().empty()) << name;
        }
    }
}

TEST_F(RefusedFilms, StandardOutput_ThatNobodyReads) {
    Surroundings surroundings;
    surroundings.closedOutput = true;
    const Outcome outcome = runVorelpaintIn(surroundings, inFrames({"-o", "-"}));
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(outcome.err, "vorelpaint: cannot write standard output: Broken pipe\n");
}

TEST_F(RefusedFilms, Requests_ThatDoNotFitTogether) {
    const Words to{"-o", output("a.mov")};
    EXPECT_EQ(faultOf(asked(to + Words{"--codec", "vp9"})),
              "a .mov holds no transparent film in vp9, but in prores, png");
    EXPECT_EQ(faultOf(asked({"--over", "x.mp4", "-o", "-"})),
              "--over needs a film: end the output's name with .mp4, .mov, .mkv or .webm");
    EXPECT_EQ(faultOf(asked({"--codec", "png", "-o", output("f%d.png")})),
              "--codec needs a film: end the output's name with .mp4, .mov, .mkv or .webm");
    EXPECT_EQ(faultOf(asked({"--report", "json", "-o", "-"})),
              "standard output cannot take both the film and what is printed");
    EXPECT_EQ(faultOf(asked(to + Words{"A text"})), "TEXT excludes --subtitles");
    EXPECT_EQ(faultOf(asked(to + Words{"--over", "x.mp4", "--width", "9"})), "--width excludes --over");
    EXPECT_EQ(faultOf(asked(to + Words{"--fps", "23.976"})),
              "--fps: '23.976' is no frame rate from 1 to 240; write 30 or 24000/1001");
    EXPECT_EQ(faultOf(asked(to + Words{"--cue-style", "Ann"})),
              "--cue-style: 'Ann' is no NAME=LOOK, such as Narrator=chalk");
    EXPECT_EQ(faultOf(asked(to + Words{"--cue-style", "Ann=golld"})).substr(0, 18),
              "no preset 'golld';");
    EXPECT_EQ(faultOf({"--fps", "3", "-o", output("a.png"), "A"}), "--fps requires --subtitles");
}

/// A program of this name in a directory where programs are looked for.
class FilmsOfAnotherFFmpeg : public RefusedFilms {
  protected:
    FilmsOfAnotherFFmpeg() : mPath(std::getenv("PATH")) {}
    ~FilmsOfAnotherFFmpeg() override { ::setenv("PATH", mPath.c_str(), 1); }

    void putInPlace(const std::string& script) {
        const std::string program = mPrograms.write("ffmpeg", "#!/bin/sh\n" + script);
        ::chmod(program.c_str(), 0700);
        ::setenv("PATH", (mPrograms.path().string() + ":" + mPath).c_str(), 1);
    }

    TempDir mPrograms;
    std::string mPath;
};

TEST_F(FilmsOfAnotherFFmpeg, ItsFailure_IsToldInALine) {
    putInPlace(
        "head -c 1000000 > /dev/null; echo half > /proc/self/fd/3\n"
        "echo '[libx264 @ 0x5566] no room' >&2; echo more >&2; exit 1\n");
    EXPECT_EQ(faultOf(asked({"-o", output("a.mov")})),
              "cannot write '" + output("a.mov") + "': ffmpeg failed: no room");
    mOutputs.write("a.mov", "older film");
    const Outcome outcome = runVorelpaint(asked({"-o", output("a.mov")}));
    EXPECT_EQ(outcome.exitCode, 2);
    EXPECT_EQ(readBytes(output("a.mov")), "older film");
    EXPECT_EQ(mOutputs.list(), Words{"a.mov"});
}

/// Whatever ends the program, its film is not left half made, nor is ffmpeg left at work.
class StoppedFilms : public FilmsOfAnotherFFmpeg,
                     public ::testing::WithParamInterface<std::tuple<int, bool>> {
  protected:
    void SetUp() override {
        putInPlace("echo $$ > " + mDir.file("pid") + "; echo half > /proc/self/fd/3; exec sleep 60\n");
    }

    /// That of the program in the place of ffmpeg, once it is at work.
    pid_t waitForChild() const {
        const Clock::time_point end = Clock::now() + std::chrono::seconds(60);
        while (Clock::now() < end) {
            const std::string pid = readBytes(mDir.file("pid"));
            if (!pid.empty() && pid.back() == '\n') return std::stoi(pid);
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        }
        return -1;
    }

    static bool endsSoon(pid_t child) {
        const Clock::time_point end = Clock::now() + std::chrono::seconds(10);
        while (Clock::now() < end) {
            if (::kill(child, 0) != 0) return true;
            const std::string state = readBytes("/proc/" + std::to_string(child) + "/stat");
            if (state.find(") Z") != std::string::npos) return true;  // nobody has waited for it yet
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        }
        return false;
    }
};

TEST_P(StoppedFilms, LeaveNothing) {
    const auto [signal, unnamedFiles] = GetParam();
    if (signal == SIGKILL && !unnamedFiles) return;  // the one case in which a passing name stays
    Surroundings surroundings;
    surroundings.unnamedFiles = unnamedFiles;
    RunningVorelpaint program(asked({"-o", output("a.mov")}), surroundings);
    const pid_t child = waitForChild();
    ASSERT_GT(child, 0);
    EXPECT_TRUE(program.isWritingIn(mOutputs.path()));
    program.send(signal);
    const int status = program.wait();
    EXPECT_TRUE(WIFSIGNALED(status));
    EXPECT_TRUE(endsSoon(child));
    EXPECT_TRUE(mOutputs.list().empty());
}

INSTANTIATE_TEST_SUITE_P(Signals, StoppedFilms,
                         ::testing::Combine(::testing::Values(SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGKILL),
                                            ::testing::Bool()));

// --- the readers --------------------------------------------------------------------------------------

/// Of files that FFmpeg reads without a loss.
TEST(SubtitleReader, AgreesWithFFmpeg) {
    const TempDir dir;
    const std::vector<std::pair<const char*, const char*>> files{
        {"a.srt",
         "1\n00:00:00,500 --> 00:00:02,500\n<i>One</i>\nline\n\n2\n00:00:02,000 --> "
         "01:02:03,004\nTwo\n\n\nwith a blank line\n\n3\n10:00:00,000 --> "
         "10:00:01,000 X1:1 X2:2\nThree\n"},
        {"a.vtt",
         "WEBVTT - title\n\nNOTE no cue\n\none\n00:00.500 --> 00:02.500 line:10%\n<v Ann>One\n\n"
         "20:00:03.000 --> 20:00:04.000\nfar\n\n00:00:02.000 --> 01:02:03.004\nTwo\n"},
        {"a.ass",
         "[Script Info]\nScriptType: v4.00+\n\n[V4+ Styles]\nFormat: Name\nStyle: Default\n\n"
         "[Events]\nFormat: Layer, Start, End, Style, Name, MarginL, MarginR, MarginV, Effect, "
         "Text\nDialogue: 0,0:00:02.00,1:02:03.04,Default,,0,0,0,,Two\nComment: "
         "0,0:00:00.00,0:00:01.00,Default,,0,0,0,,no\nDialogue: "
         "0,0:00:00.50,0:00:02.50,Default,,0,0,0,,{\\i1}One\n"}};
    for (const auto& [name, bytes] : files) {
        const std::string path = dir.write(name, bytes);
        const std::string told =
            outputOf({"ffprobe", "-v", "error", "-show_entries", "packet=pts_time,duration_time", "-of",
                      "compact=p=0:nk=1", fileUrl(path)});
        std::istringstream packets(told);
        const std::vector<Cue> cues = readSubtitles(path);
        for (const Cue& cue : cues) {
            std::string line;  // what else there is to a packet, after another |, is left out
            while (line.empty() && std::getline(packets, line)) {
            }
            double start = 0;
            double duration = 0;
            ASSERT_EQ(std::sscanf(line.c_str(), "%lf|%lf", &start, &duration), 2) << name << told;
            EXPECT_EQ(std::llround(start * 1000), cue.startMs) << name;
            EXPECT_EQ(std::llround(duration * 1000), cue.endMs - cue.startMs) << name;
        }
        EXPECT_EQ(static_cast<size_t>(std::count(told.begin(), told.end(), '.')), 2 * cues.size());
    }
}

}  // namespace
}  // namespace vorelpaint
