// Paints the cues of an SRT file, each of them once, and writes the frames that show them to standard
// output: raw premultiplied R, G, B, A of 640 x 360 pixels, 25 a second, for FFmpeg to lay over a film.
//
//     subtitles FILE.srt [FONT_FILE] | ffmpeg -i film.mp4
//         -f rawvideo -pixel_format rgba -video_size 640x360 -framerate 25 -i - -filter_complex
//         "[1:v]format=gbrap,unpremultiply=inplace=1[cues]; [0:v][cues]overlay=format=gbrp"
//         subtitled.mp4
//
// What files of films have besides (tags, other formats, lines that are too long) is left to
// vorelpaint --subtitles.
#include <voreleffect/look.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <istream>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "../shared/shaped_text.h"

using namespace VFontEffect;

namespace {

constexpr int kWidth = 640;
constexpr int kHeight = 360;
constexpr int kFramesPerSecond = 25;
constexpr int kTextPixels = 28;
constexpr int kFromBottom = 18;

// --- The SRT file -----------------------------------------------------------------------------------

struct Cue {
    int startMs;
    int endMs;
    std::vector<std::string> lines;
};

/// "00:01:02,500 --> 00:01:05,000"
bool parseTimes(const std::string& line, Cue& cue) {
    int h[2], m[2], s[2], ms[2];
    if (std::sscanf(line.c_str(), "%2d:%2d:%2d,%3d --> %2d:%2d:%2d,%3d", &h[0], &m[0], &s[0], &ms[0],
                    &h[1], &m[1], &s[1], &ms[1]) != 8) {
        return false;
    }
    cue.startMs = ((h[0] * 60 + m[0]) * 60 + s[0]) * 1000 + ms[0];
    cue.endMs = ((h[1] * 60 + m[1]) * 60 + s[1]) * 1000 + ms[1];
    return true;
}

bool nextLine(std::istream& file, std::string& line) {
    if (!std::getline(file, line)) return false;
    if (!line.empty() && line.back() == '\r') line.pop_back();
    return true;
}

/// A cue is a line with its times and those behind it up to an empty one.
std::vector<Cue> readCues(std::istream& file) {
    std::vector<Cue> cues;
    std::string line;
    while (nextLine(file, line)) {
        Cue cue = {};
        if (!parseTimes(line, cue)) continue;  // its number
        while (nextLine(file, line) && !line.empty())
            cue.lines.push_back(line);
        if (!cue.lines.empty()) cues.push_back(std::move(cue));
    }
    return cues;
}

// --- A painted cue ----------------------------------------------------------------------------------

/// Black outlines over a soft shadow.
Look cueLook() {
    return Look()
        .fill(rgb(0xFFF6D8))
        .add(OuterShadow(rgb(0)).angle(135).distance(4).size(5).opacity(0.7F))  // light from upper left
        .add(Stroke(3, rgb(0)));                                                // 3 pixels, outside
}

class CuePainter {
  public:
    explicit CuePainter(const char* fontFile) : mFont(fontFile, kTextPixels), mPainter(cueLook()) {}

    bool isReady() const { return mFont.isReady(); }  ///< whether the font could be read

    /// The lines, centred, at the bottom of the frame, in a picture no larger than they need.
    Picture paint(const Cue& cue) {
        const auto height = static_cast<int>(cue.lines.size()) * mFont.lineHeight();
        int baseline = kHeight - kFromBottom - height + mFont.ascent();
        std::vector<Line> lines;
        std::vector<Glyph> glyphs;
        for (const std::string& text : cue.lines) {
            lines.push_back(mFont.line(text));
            for (Glyph glyph : lines.back().glyphs) {
                glyph.x += (kWidth - lines.back().width) / 2;
                glyph.y += baseline;
                glyphs.push_back(glyph);
            }
            baseline += mFont.lineHeight();
        }
        return mPainter.paint(glyphs).value_or(Picture());
    }

  private:
    Font mFont;
    Painter mPainter;
};

// --- Frames -----------------------------------------------------------------------------------------

/// A cue is painted once and kept while it is seen; a frame like the one before is written again. The
/// last frame is clear: FFmpeg shows it for the rest of the film.
bool writeFrames(const std::vector<Cue>& cues, CuePainter& painter) {
    int endMs = 0;
    for (const Cue& cue : cues)
        endMs = std::max(endMs, cue.endMs);
    const int64_t frames = int64_t{endMs} * kFramesPerSecond / 1000 + 2;

    std::map<size_t, Picture> seen;
    std::vector<unsigned char> frame(size_t{4} * kWidth * kHeight);
    for (int64_t number = 0; number < frames; ++number) {
        const int64_t nowMs = 1000 * number / kFramesPerSecond;
        bool changes = false;
        for (size_t i = 0; i < cues.size(); ++i) {
            const bool isSeen = cues[i].startMs <= nowMs && nowMs < cues[i].endMs;
            if (isSeen == (seen.count(i) != 0)) continue;
            changes = true;
            if (isSeen) {
                seen.emplace(i, painter.paint(cues[i]));
            } else {
                seen.erase(i);
            }
        }
        if (changes) {
            std::fill(frame.begin(), frame.end(), static_cast<unsigned char>(0));
            for (const auto& [cue, picture] : seen)
                picture.layOver({frame.data(), kWidth, kHeight}, 0, 0);
        }
        if (std::fwrite(frame.data(), frame.size(), 1, stdout) != 1) return false;
    }
    return std::fflush(stdout) == 0;
}

}  // namespace

int main(int argc, char** argv) {
    const char* font = argc > 2 ? argv[2] : "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf";
    std::ifstream file(argc > 1 ? argv[1] : "");
    if (!file) {
        std::fprintf(stderr, "usage: subtitles FILE.srt [FONT_FILE]\n");
        return 2;
    }
    CuePainter painter(font);
    if (!painter.isReady()) {
        std::fprintf(stderr, "cannot read the font %s\n", font);
        return 1;
    }
    if (!writeFrames(readCues(file), painter)) {
        std::fprintf(stderr, "cannot write the frames\n");
        return 1;
    }
    return 0;
}
