#include "film_clip.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "error.h"

namespace vorelpaint {
namespace {

std::string video(const std::string& more = "") {
    return "streams.stream.0.codec_type=\"video\"\nstreams.stream.0.width=320\n"
           "streams.stream.0.height=180\nstreams.stream.0.r_frame_rate=\"25/1\"\n" +
           more;
}

std::string with(const std::string& key, const std::string& value) {
    return video("streams.stream.0." + key + "=\"" + value + "\"\n");
}

std::string faultOf(const std::string& told) {
    try {
        clipIn(told);
        return "";
    } catch (const ToolError& error) {
        return error.what();
    }
}

TEST(FilmClip, FirstPicturesAndAllSounds_AreTold) {
    const Clip clip = clipIn(
        "streams.stream.0.codec_type=\"audio\"\nstreams.stream.0.codec_name=\"aac\"\n"
        "streams.stream.1.codec_type=\"video\"\nstreams.stream.1.width=320\n"
        "streams.stream.1.height=180\nstreams.stream.1.r_frame_rate=\"24000/1001\"\n"
        "streams.stream.2.codec_type=\"video\"\nstreams.stream.2.width=99\n"
        "streams.stream.3.codec_type=\"audio\"\nstreams.stream.3.codec_name=\"opus\"\n"
        "format.duration=\"2.0005\"\n");
    EXPECT_EQ(clip.width, 320);
    EXPECT_EQ(clip.height, 180);
    EXPECT_EQ(clip.rate->text(), "24000/1001");
    EXPECT_EQ(clip.durationMs, 2001);
    EXPECT_EQ(clip.audioCodecs, (std::vector<std::string>{"aac", "opus"}));
    EXPECT_TRUE(clip.hasSquarePixels);
    EXPECT_FALSE(clip.isFullRange);
}

TEST(FilmClip, CoverOfASound_IsNoMovingPicture) {
    std::string told = video("streams.stream.0.disposition.attached_pic=1\n");
    EXPECT_EQ(faultOf(told), "it has no moving pictures");
    told +=
        "streams.stream.1.codec_type=\"video\"\nstreams.stream.1.width=64\n"
        "streams.stream.1.height=48\nstreams.stream.1.disposition.attached_pic=0\n";
    EXPECT_EQ(clipIn(told).width, 64);
}

TEST(FilmClip, TurnedPictures_HaveTheirSidesAsTheyAreSeen) {
    for (const char* degrees : {"90", "-90", "270"}) {
        const Clip clip = clipIn(video(
            "streams.stream.0.side_data_list.side_data.0.rotation=" + std::string(degrees) + "\n"));
        EXPECT_EQ(clip.width, 180) << degrees;
        EXPECT_EQ(clip.height, 320);
    }
    EXPECT_EQ(clipIn(with("rotation", "180")).width, 320);
}

TEST(FilmClip, Rate_IsTheSteadyOneElseTheMean) {
    EXPECT_EQ(clipIn(with("avg_frame_rate", "24/1")).rate->text(), "25/1");
    std::string told = video("streams.stream.0.avg_frame_rate=\"24/1\"\n");
    told.replace(told.find("25/1"), 4, "90000/1");
    EXPECT_EQ(clipIn(told).rate->text(), "24/1");
    told.replace(told.find("24/1"), 4, "0/00");
    EXPECT_FALSE(clipIn(told).rate);
}

TEST(FilmClip, Colours_AreThoseThatItNamesElseThoseOfItsHeight) {
    EXPECT_EQ(clipIn(with("color_space", "bt709")).matrix, "bt709");
    EXPECT_EQ(clipIn(with("color_space", "bt2020nc")).matrix, "bt2020");
    EXPECT_EQ(clipIn(with("color_space", "unknown")).matrix, "smpte170m");
    std::string told = video();
    told.replace(told.find("180"), 3, "720");
    EXPECT_EQ(clipIn(told).matrix, "bt709");
    EXPECT_TRUE(clipIn(with("color_range", "pc")).isFullRange);
    EXPECT_FALSE(clipIn(with("color_range", "tv")).isFullRange);
}

TEST(FilmClip, Blending_KeepsThePixelsOfTheClip) {
    for (const auto& [pixels, blending] :
         std::vector<std::pair<const char*, const char*>>{{"yuv420p", "yuv420"},
                                                          {"yuvj420p", "yuv420"},
                                                          {"nv12", "yuv420"},
                                                          {"yuv420p10le", "yuv420p10"},
                                                          {"p010le", "yuv420p10"},
                                                          {"yuv422p", "yuv422"},
                                                          {"yuv422p10le", "yuv422p10"},
                                                          {"yuv444p", "yuv444"},
                                                          {"gbrp", "gbrp"},
                                                          {"bgr0", "gbrp"},
                                                          {"rgb24", "gbrp"},
                                                          {"gray", "yuv420"}}) {
        EXPECT_EQ(clipIn(with("pix_fmt", pixels)).blending, blending) << pixels;
    }
}

TEST(FilmClip, PixelsThatAreNotSquare_AreNoticed) {
    EXPECT_TRUE(clipIn(with("sample_aspect_ratio", "1:1")).hasSquarePixels);
    EXPECT_TRUE(clipIn(with("sample_aspect_ratio", "N/A")).hasSquarePixels);
    EXPECT_FALSE(clipIn(with("sample_aspect_ratio", "16:11")).hasSquarePixels);
}

TEST(FilmClip, NoPicturesOrNoSize_IsRefused) {
    EXPECT_EQ(faultOf(""), "it has no moving pictures");
    EXPECT_EQ(faultOf("streams.stream.0.codec_type=\"audio\"\n"), "it has no moving pictures");
    EXPECT_EQ(faultOf("streams.stream.0.codec_type=\"video\"\nstreams.stream.0.width=99999\n"),
              "its pictures are larger than 16384 pixels, or of no known size");
    EXPECT_FALSE(clipIn(video("format.duration=\"N/A\"\n")).durationMs);
    EXPECT_FALSE(clipIn(video("format.duration=\"1e300\"\n")).durationMs);
}

TEST(FilmClip, FileUrl_IsNoOption) {
    EXPECT_EQ(fileUrl("-i"), "file:-i");
}

}  // namespace
}  // namespace vorelpaint
