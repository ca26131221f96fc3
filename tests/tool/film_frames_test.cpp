#include "film_frames.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "film_request.h"
#include "program.h"

namespace vorelpaint {
namespace {

using vorel_test::TempDir;
using voreltext::Image;

constexpr FrameRate kTen{10, 1};

class FilmFramesOf : public ::testing::Test {
  protected:
    FilmFramesOf() {
        mOptions.canvas.width = 160;
        mOptions.canvas.height = 90;
        mOptions.size = 20;
        takeFilmDefaults(mOptions, [](std::string_view) { return false; });
        mOptions.film.subtitles =
            mDir.write("a.srt",
                       "00:00:00,200 --> 00:00:00,600\nOne\n\n00:00:00,400 --> "
                       "00:00:00,800\nTwo\n\n00:00:00,900 --> 00:00:01,100\nOne\n");
    }

    TempDir mDir;
    Options mOptions;
};

/// Of a straight pixel.
uint8_t alphaAt(const Image& image, int x, int y) {
    return image.pixels[offsetOf(image, x, y) + 3];
}

TEST_F(FilmFramesOf, Frames_ChangeWhereACueBeginsOrEnds) {
    const FilmCues cues(mOptions, kTen);
    FilmFrames frames(mOptions, cues, kTen, 1);
    std::vector<bool> changes;
    std::vector<bool> blanks;
    for (int frame = 0; frame < 12; ++frame) {
        changes.push_back(frames.advanceTo(frame));
        blanks.push_back(frames.isBlank());
    }
    EXPECT_EQ(changes, (std::vector<bool>{true, false, true, false, true, false, true, false, true, true,
                                          false, true}));
    EXPECT_EQ(blanks, (std::vector<bool>{true, true, false, false, false, false, false, false, true,
                                         false, false, true}));
}

TEST_F(FilmFramesOf, Frame_DoesNotDependOnThoseBefore) {
    mOptions.film.fadeInMs = 150;
    mOptions.background = {Background::Kind::checkerboard, 0};
    const FilmCues cues(mOptions, kTen);
    FilmFrames frames(mOptions, cues, kTen, 1);
    for (int frame = 0; frame < 12; ++frame) {
        frames.advanceTo(frame);
        FilmFrames other(mOptions, cues, kTen, 1);
        other.advanceTo(frame);
        EXPECT_EQ(frames.picture().pixels, other.picture().pixels) << frame;
    }
}

/// More cues than threads paint ahead, some of which no frame shows.
TEST_F(FilmFramesOf, AnyNumberOfThreads_PaintsTheSame) {
    std::string cues;
    for (int i = 0; i < 40; ++i) {
        const std::string tenth = std::to_string(i / 10) + "," + std::to_string(i % 10);
        cues += "00:00:0" + tenth + "10 --> 00:00:0" + tenth + (i % 3 == 0 ? "90" : "95") + "\nA\n\n" +
                "00:00:0" + tenth + "00 --> 00:00:0" + tenth + "99\n" + std::to_string(i) + "\n\n";
    }
    mOptions.film.subtitles = mDir.write("many.srt", cues);
    const FilmCues set(mOptions, kTen);
    FilmFrames alone(mOptions, set, kTen, 1);
    FilmFrames many(mOptions, set, kTen, 3);
    FilmFrames skipping(mOptions, set, kTen, 2);
    for (int frame = 0; frame < 41; ++frame) {
        EXPECT_EQ(alone.advanceTo(frame), many.advanceTo(frame)) << frame;
        ASSERT_EQ(alone.picture().pixels, many.picture().pixels) << frame;
        if (frame % 7 != 0) continue;
        skipping.advanceTo(frame);
        ASSERT_EQ(alone.picture().pixels, skipping.picture().pixels) << frame;
    }
}

TEST_F(FilmFramesOf, Frame_HasTheCuesInTheirPlaces) {
    const FilmCues cues(mOptions, kTen);
    FilmFrames frames(mOptions, cues, kTen, 1);
    const auto inkIn = [&](int frame, const voreltext::Box& box) {
        frames.advanceTo(frame);
        int most = 0;
        for (int y = box.top; y < box.bottom; ++y) {
            for (int x = 0; x < 160; ++x)
                most = std::max<int>(most, alphaAt(frames.picture(), x, y));
        }
        return most;
    };
    const voreltext::Box lower = cues.all()[0].box;
    voreltext::Box upper = cues.all()[1].box;
    upper.bottom -= upper.height() / 2;  // the effects of the lower one reach into the rest
    EXPECT_EQ(inkIn(1, lower), 0);
    EXPECT_EQ(inkIn(2, lower), 255);
    EXPECT_EQ(inkIn(4, upper), 255);
    EXPECT_EQ(inkIn(6, upper), 255);
    EXPECT_EQ(inkIn(8, upper), 0);
    EXPECT_EQ(inkIn(9, lower), 255);
    EXPECT_EQ(inkIn(10, upper), 0);
}

TEST_F(FilmFramesOf, Fading_MultipliesThePremultipliedPicture) {
    const FilmCues cues(mOptions, kTen);
    Workbench bench;
    const Image whole = cues.paint(cues.all()[0], bench);
    mOptions.film.fadeInMs = 500;  // at 0.3 seconds a fifth: 51 of 255
    FilmFrames frames(mOptions, cues, kTen, 1);
    frames.advanceTo(3);
    const voreltext::Box& area = cues.all()[0].area;
    for (int y = 0; y < area.height(); ++y) {
        for (int x = 0; x < area.width(); ++x) {
            const unsigned int alpha = alphaAt(whole, x, y);
            const unsigned int fifth = (alpha * 51 + 127) / 255;
            ASSERT_EQ(alphaAt(frames.picture(), area.left + x, area.top + y), fifth);
        }
    }
}

}  // namespace
}  // namespace vorelpaint
