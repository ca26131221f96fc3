#include "film_form.h"

#include <algorithm>
#include <array>
#include <filesystem>

#include "child_program.h"
#include "error.h"
#include "file_io.h"
#include "path_ending.h"
#include "style/vorelstyle.h"

namespace vorelpaint {
namespace {

using vorelstyle::isSameWord;
using Words = std::vector<std::string>;

/// A kind of file that holds pictures and sound.
struct Container {
    std::string_view ending;
    const char* format;                   ///< as ffmpeg names it
    std::vector<std::string_view> holds;  ///< codecs of sound that it is kept in; empty: in all
    const char* audioEncoder;             ///< for the others
};

const std::array<Container, 4>& containers() {
    static const std::array<Container, 4> all{
        {{"mp4", "mp4", {"aac", "mp3", "ac3", "eac3", "alac", "opus"}, "aac"},
         {"mov",
          "mov",
          {"aac", "mp3", "ac3", "eac3", "alac", "pcm_s16le", "pcm_s16be", "pcm_s24le", "pcm_s24be",
           "pcm_s32le", "pcm_f32le"},
          "aac"},
         {"mkv", "matroska", {}, ""},
         {"webm", "webm", {"opus", "vorbis"}, "libopus"}}};
    return all;
}

Words vp9In(const char* pixels) {
    return {"-c:v", "libvpx-vp9", "-crf", "24", "-b:v", "0", "-row-mt", "1", "-pix_fmt", pixels};
}

/// With a quantiser of its own the encoder looks for none, which takes five times as long.
Words proresIn(const char* pixels, const char* profile) {
    return {"-c:v", "prores_ks", "-profile:v", profile,    "-qscale:v",
            "4",    "-vendor",   "apl0",       "-pix_fmt", pixels};
}

/// Those of a container stand in the order in which they are chosen from. FFV1 keeps the pixels as they
/// come where there is nothing to see through.
const std::array<FilmCodec, 5>& codecs() {
    static const std::array<FilmCodec, 5> all{
        {{"h264",
          {"mp4", "mov", "mkv"},
          {"-c:v", "libx264", "-preset", "medium", "-crf", "18", "-pix_fmt", "yuv420p"},
          {},
          true,
          true},
         {"prores",
          {"mov"},
          proresIn("yuv422p10le", "hq"),
          proresIn("yuva444p10le", "4444"),
          true,
          false},
         {"ffv1",
          {"mkv"},
          {"-c:v", "ffv1", "-level", "3"},
          {"-c:v", "ffv1", "-level", "3", "-pix_fmt", "bgra"},
          false,
          false},
         {"png", {"mov", "mkv"}, {}, {"-c:v", "png", "-pix_fmt", "rgba"}, false, false},
         {"vp9", {"webm", "mkv"}, vp9In("yuv420p"), vp9In("yuva420p"), true, false}}};
    return all;
}

const Container* containerOf(const std::string& output) {
    for (const Container& container : containers()) {
        if (isSameWord(endingOf(output), container.ending)) return &container;
    }
    return nullptr;
}

bool holds(const std::vector<std::string_view>& all, std::string_view one) {
    return std::find(all.begin(), all.end(), one) != all.end();
}

void add(Words& words, Words more) {
    words.insert(words.end(), more.begin(), more.end());
}

/// From RGB to luma and chroma in the colours that a film says it has.
std::string scaleTo(const std::string& matrix, bool isFullRange) {
    return "scale=out_color_matrix=" + matrix + ":out_range=" + (isFullRange ? "pc" : "tv");
}

bool isRgb(const Clip& clip) {
    return clip.blending == "gbrp";
}

/// Whether there is anything but red, green and blue before the codec.
bool isYuvBlended(const FilmPlan& plan) {
    return plan.clip && !isRgb(*plan.clip);
}

/// The frames come from the middle of the frame before on: a clip's times, rounded in its container, may
/// lie a little before a frame's beginning. The frame behind the last cue is blank, so what is seen when
/// the frames end does not matter.
std::string overlayFilter(const FilmPlan& plan) {
    const std::string toYuv =
        isRgb(*plan.clip) ? "" : "," + scaleTo(plan.clip->matrix, plan.clip->isFullRange);
    return "[1:v]settb=intb/2,setpts=PTS-1" + toYuv +
           "[cues];[0:V:0][cues]overlay=x=0:y=" + std::to_string(plan.rows.top) +
           ":format=" + plan.clip->blending + ":eof_action=pass";
}

/// The rows without any cue are added to the frames.
std::string padFilter(const FilmPlan& plan) {
    return "[0:v]pad=w=" + std::to_string(plan.rows.width()) + ":h=" + std::to_string(plan.height) +
           ":x=0:y=" + std::to_string(plan.rows.top) + ":color=black@0";
}

/// What the codec is to find: colours of its kind, which say what they are, and no alpha where there is
/// nothing to see through. Options of the encoder would say it too, but what the frames say counts.
std::string coloursFilter(const FilmPlan& plan) {
    if (isYuvBlended(plan)) return "";
    if (plan.codec.isYuv) {
        return "," + scaleTo("bt709", false) +
               ",setparams=range=tv:colorspace=bt709:color_primaries=bt709:color_trc=bt709";
    }
    return plan.isTransparent ? "" : ",format=bgr0";
}

std::string filterOf(const FilmPlan& plan) {
    return (plan.clip ? overlayFilter(plan) : padFilter(plan)) + coloursFilter(plan) + "[film]";
}

/// Sound is kept as it is where the container can hold it.
Words soundWords(const FilmPlan& plan) {
    const Container& container = *containerOf(plan.output);
    Words words{"-map", "0:a?"};
    for (size_t i = 0; i < plan.clip->audioCodecs.size(); ++i) {
        const bool isKept = container.holds.empty() || holds(container.holds, plan.clip->audioCodecs[i]);
        add(words, {"-c:a:" + std::to_string(i), isKept ? "copy" : container.audioEncoder});
    }
    return words;
}

}  // namespace

FilmKind filmKindOf(const std::string& output) {
    std::error_code ignored;
    const bool isSpecial = std::filesystem::exists(output, ignored) &&
                           !std::filesystem::is_regular_file(output, ignored) &&
                           !std::filesystem::is_directory(output, ignored);
    if (isStandardOutput(output) || isSpecial || isSameWord(endingOf(output), "rgba")) {
        return FilmKind::raw;
    }
    if (isSameWord(endingOf(output), "png")) return FilmKind::pictures;
    if (containerOf(output) != nullptr) return FilmKind::file;
    throw ToolError(
        inQuotes(output) +
        " is named like no film; .mp4, .mov, .mkv, .webm, .rgba and frame_%05d.png are known");
}

const std::vector<std::string>& filmCodecNames() {
    static const std::vector<std::string> names = [] {
        std::vector<std::string> all;
        for (const FilmCodec& codec : codecs())
            all.emplace_back(codec.name);
        return all;
    }();
    return names;
}

const FilmCodec& filmCodec(const std::string& output, const std::optional<std::string>& asked,
                           bool isTransparent) {
    const std::string_view ending = containerOf(output)->ending;
    std::vector<std::string> others;
    for (const FilmCodec& codec : codecs()) {
        if ((isTransparent ? codec.transparent : codec.opaque).empty()) continue;
        if (!holds(codec.endings, ending)) continue;
        if (!asked || *asked == codec.name) return codec;
        others.emplace_back(codec.name);
    }
    const std::string what = isTransparent ? "transparent film" : "film";
    if (others.empty()) {
        throw ToolError("a ." + std::string(ending) + " holds no " + what +
                        ": give --over or --background, or end the name with .mov, .mkv or .webm");
    }
    throw ToolError("a ." + std::string(ending) + " holds no " + what + " in " + *asked + ", but in " +
                    vorelstyle::joined(others));
}

bool mixesColours(const FilmPlan& plan) {
    return plan.clip ? !isRgb(*plan.clip) : plan.isTransparent && plan.codec.isYuv;
}

std::vector<std::string> ffmpegWords(const FilmPlan& plan) {
    const Container& container = *containerOf(plan.output);
    Words words{"ffmpeg", "-hide_banner", "-nostdin", "-v", "error", "-y"};
    if (plan.clip) {
        add(words, {"-protocol_whitelist", "file,pipe", "-i", fileUrl(plan.over)});
    }
    add(words, {"-f", "rawvideo", "-pixel_format", "rgba", "-video_size",
                std::to_string(plan.rows.width()) + "x" + std::to_string(plan.rows.height()),
                "-framerate", plan.rate.text(), "-i", "pipe:0"});
    add(words, {"-filter_complex", filterOf(plan), "-map", "[film]"});
    if (plan.clip) add(words, soundWords(plan));
    add(words, plan.isTransparent ? plan.codec.transparent : plan.codec.opaque);
    if (container.ending == "mp4" || container.ending == "mov") add(words, {"-movflags", "+faststart"});
    add(words,
        {"-f", container.format, fileUrl("/proc/self/fd/" + std::to_string(ChildProgram::kGivenFile))});
    return words;
}

}  // namespace vorelpaint
