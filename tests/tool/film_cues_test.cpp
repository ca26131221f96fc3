#include "film_cues.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "error.h"
#include "film_request.h"
#include "program.h"

namespace vorelpaint {
namespace {

using vorel_test::TempDir;
using voreltext::Anchor;

constexpr FrameRate kTen{10, 1};

/// Cues set in frames of 320 x 180.
class FilmCuesOf : public ::testing::Test {
  protected:
    FilmCuesOf() {
        mOptions.canvas.width = 320;
        mOptions.canvas.height = 180;
        mOptions.size = 20;
        mOptions.canvas.margin = 14;
        takeFilmDefaults(mOptions, [](std::string_view) { return false; });
    }

    FilmCues cuesOf(const std::string& bytes, const char* name = "a.srt") {
        mOptions.film.subtitles = mDir.write(name, bytes);
        const FilmCues cues(mOptions, kTen);
        cues.notes().giveTo([&](const std::string& line) { mNotes.push_back(line); });
        return cues;
    }

    std::string faultOf(const std::string& bytes) {
        try {
            cuesOf(bytes);
            return "";
        } catch (const ToolError& error) {
            const std::string place = "'" + mDir.file("a.srt") + "'";
            const std::string fault = error.what();
            return fault.rfind(place, 0) == 0 ? fault.substr(place.size()) : fault;
        }
    }

    TempDir mDir;
    Options mOptions;
    std::vector<std::string> mNotes;
};

std::string cue(const char* start, const char* end, const char* text) {
    return std::string(start) + " --> " + end + "\n" + text + "\n\n";
}

TEST_F(FilmCuesOf, ALineStandsOnTheMargin) {
    mOptions.canvas.margin = 9;
    const FilmCues cues = cuesOf(cue("00:00:01,000", "00:00:02,000", "One"));
    ASSERT_EQ(cues.all().size(), 1U);
    EXPECT_EQ(cues.all()[0].box.bottom, 180 - 9);
    EXPECT_EQ(cues.all()[0].down, 0);
}

TEST_F(FilmCuesOf, Frames_AreThoseThatBeginWithinTheTimes) {
    const FilmCues cues =
        cuesOf(cue("00:00:01,000", "00:00:01,300", "One") + cue("00:00:01,301", "00:00:01,401", "Two"));
    EXPECT_EQ(cues.all()[0].firstFrame, 10);
    EXPECT_EQ(cues.all()[0].endFrame, 13);
    EXPECT_EQ(cues.all()[1].firstFrame, 14);
    EXPECT_EQ(cues.all()[1].endFrame, 15);
    EXPECT_EQ(cues.frameCount(), 15);
}

TEST_F(FilmCuesOf, SeenTogether_LaterOnesStandAboveWithoutAGap) {
    const FilmCues cues = cuesOf(cue("00:00:01,000", "00:00:04,000", "One") +
                                 cue("00:00:02,000", "00:00:09,000", "Two\nlines") +
                                 cue("00:00:03,000", "00:00:05,000", "Three"));
    const std::vector<PlacedCue>& all = cues.all();
    EXPECT_EQ(all[1].box.bottom, all[0].box.top);
    EXPECT_EQ(all[2].box.bottom, all[1].box.top);
}

TEST_F(FilmCuesOf, RoomThatIsFreeAgain_IsTakenByTheNext) {
    const FilmCues cues = cuesOf(
        cue("00:00:01,000", "00:00:03,000", "One") + cue("00:00:02,000", "00:00:09,000", "Two") +
        cue("00:00:03,000", "00:00:05,000", "Three") + cue("00:00:09,000", "00:00:10,000", "Four"));
    const std::vector<PlacedCue>& all = cues.all();
    EXPECT_EQ(all[1].box.bottom, all[0].box.top) << "it stays where it is when the first one ends";
    EXPECT_EQ(all[2].box.bottom, all[0].box.bottom);
    EXPECT_EQ(all[3].box.bottom, all[0].box.bottom);
}

TEST_F(FilmCuesOf, TallerThanTheFreeRoom_GoesAboveAll) {
    const FilmCues cues =
        cuesOf(cue("00:00:01,000", "00:00:03,000", "One") + cue("00:00:02,000", "00:00:09,000", "Two") +
               cue("00:00:03,000", "00:00:05,000", "Three\nlines"));
    EXPECT_EQ(cues.all()[2].box.bottom, cues.all()[1].box.top);
}

TEST_F(FilmCuesOf, AtTheTop_LaterOnesStandBelow) {
    mOptions.canvas.anchor = Anchor::topLeft;
    const FilmCues cues =
        cuesOf(cue("00:00:01,000", "00:00:04,000", "One") + cue("00:00:02,000", "00:00:09,000", "Two"));
    EXPECT_EQ(cues.all()[0].box.top, mOptions.canvas.margin);
    EXPECT_EQ(cues.all()[1].box.top, cues.all()[0].box.bottom);
}

TEST_F(FilmCuesOf, NoRoomLeft_IsNoted) {
    std::string bytes;
    for (int i = 0; i < 9; ++i)
        bytes += cue("00:00:01,000", "00:00:04,000", "One");
    cuesOf(bytes);
    ASSERT_FALSE(mNotes.empty());
    EXPECT_EQ(mNotes.front(), "'" + mDir.file("a.srt") +
                                  "', line 22: there is no room left beside the cues that are seen "
                                  "with it")
        << "seven lines of 23 pixels fit 166";
    EXPECT_EQ(mNotes.size(), 1U) << "it is said once";
}

TEST_F(FilmCuesOf, BetweenTwoFrames_IsNoted) {
    cuesOf(cue("00:00:01,000", "00:00:02,000", "One") + cue("00:00:02,010", "00:00:02,090", "Two"));
    ASSERT_EQ(mNotes.size(), 1U);
    EXPECT_EQ(mNotes.front(),
              "'" + mDir.file("a.srt") + "', line 4: the cue falls between two frames and is not seen");
}

TEST_F(FilmCuesOf, Faults_NameTheLineOfTheCue) {
    EXPECT_EQ(faultOf("1\n" + cue("00:00:01,000", "00:00:02,000", "a\x1B")),
              ", line 2: the text has the control character U+001B in line 1, character 2");
    EXPECT_EQ(faultOf(cue("00:00:01,000", "00:00:02,000", "a\xFF")).substr(0, 9), ", line 1:");
    mOptions.strict = true;
    EXPECT_EQ(faultOf(cue("00:00:01,000", "00:00:02,000", "a\xF3\xB0\x80\x80")),
              ", line 1: no font has U+F0000 (line 1, character 2); its sign for missing characters is "
              "painted");
}

TEST_F(FilmCuesOf, OnlyWhatIsVisible_IsShown) {
    const FilmCues cues = cuesOf(cue("00:00:01,000", "00:00:02,000", "&nbsp;") +
                                 cue("00:00:03,000", "00:00:04,000", "One"));
    EXPECT_EQ(cues.all().size(), 1U);
    EXPECT_EQ(faultOf(cue("00:00:01,000", "00:00:02,000", "&nbsp;")),
              "nothing to show: '" + mDir.file("a.srt") + "' has no cue that is seen");
}

TEST_F(FilmCuesOf, Names_ChooseLooksAndLeaveOut) {
    mOptions.film.cueStyles = {{"sign", "none"}, {"Ann", "neon"}, {"loud", "comic"}};
    const FilmCues cues = cuesOf(
        "WEBVTT\n\n00:01.000 --> 00:02.000\n<v.loud Ann>A\n\n"
        "00:02.000 --> 00:03.000\n<c.loud>B\n\nsign\n00:03.000 --> "
        "00:04.000\nC\n\n00:04.000 --> 00:05.000\nD\n",
        "a.vtt");
    const std::vector<PlacedCue>& all = cues.all();
    ASSERT_EQ(all.size(), 3U);
    EXPECT_EQ(all[0].look, "neon");
    EXPECT_EQ(all[1].look, "comic");
    EXPECT_EQ(all[2].cue.text, "D");
    EXPECT_EQ(all[2].look, "");
    EXPECT_TRUE(mNotes.empty());
}

TEST_F(FilmCuesOf, NameThatNoCueHas_IsNoted) {
    mOptions.film.cueStyles = {{"Fredd", "neon"}};
    cuesOf(cue("00:00:01,000", "00:00:02,000", "One"));
    EXPECT_EQ(mNotes, std::vector<std::string>{"no cue is named 'Fredd', as a --cue-style is"});
}

TEST_F(FilmCuesOf, Rows_HoldAllAreasAndAreEven) {
    const FilmCues cues =
        cuesOf(cue("00:00:01,000", "00:00:04,000", "One") + cue("00:00:02,000", "00:00:09,000", "Two"));
    const voreltext::Box rows = cues.rows();
    EXPECT_EQ(rows.left, 0);
    EXPECT_EQ(rows.right, 320);
    EXPECT_EQ(rows.top % 2, 0);
    EXPECT_EQ(rows.bottom % 2, 0);
    EXPECT_LE(rows.top, cues.all()[1].area.top);
    EXPECT_GE(rows.bottom, cues.all()[0].area.bottom);
    EXPECT_LE(rows.bottom, 180);
}

TEST(PlacedCue, Opacity_RisesAndFallsEvenly) {
    PlacedCue placed{};
    placed.cue.startMs = 1000;
    placed.cue.endMs = 2000;
    FilmOptions film;
    EXPECT_EQ(placed.opacityAt(1000, film), 1);
    film.fadeInMs = 400;
    film.fadeOutMs = 200;
    EXPECT_EQ(placed.opacityAt(1000, film), 0);
    EXPECT_FLOAT_EQ(placed.opacityAt(1100, film), 0.25F);
    EXPECT_EQ(placed.opacityAt(1400, film), 1);
    EXPECT_EQ(placed.opacityAt(1800, film), 1);
    EXPECT_FLOAT_EQ(placed.opacityAt(1950, film), 0.25F);
    film.fadeInMs = 1000;
    film.fadeOutMs = 1000;
    EXPECT_FLOAT_EQ(placed.opacityAt(1500, film), 0.5F) << "both at once: the lower one";
}

}  // namespace
}  // namespace vorelpaint
