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
#include <ft2build.h>
#include <hb-ft.h>
#include <voreleffect/voreleffect.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <istream>
#include <map>
#include <string>
#include <utility>
#include <vector>
#include FT_FREETYPE_H

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

/// Premultiplied pixels, and where their top left corner lies in the frame.
struct Overlay {
    int x;
    int y;
    VFBitmap pixels;
};

class CuePainter {
  public:
    explicit CuePainter(FT_Face face) : mFace(face), mFont(hb_ft_font_create_referenced(face)) {
        mLook.addStrokeText(3, 0x000000, 1, 0, 1);            // 3 pixels, outside
        mLook.addOuterShadowText(135, 4, 5, 0x000000, 0.7F);  // light from the upper left
        mLook.addText(0xFFF6D8, 1);
    }
    CuePainter(const CuePainter&) = delete;
    CuePainter& operator=(const CuePainter&) = delete;
    ~CuePainter() { hb_font_destroy(mFont); }

    /// The lines, centred, at the bottom of the frame, in a picture as small as the effects allow.
    Overlay paint(const Cue& cue) {
        const int lineHeight = static_cast<int>(mFace->size->metrics.height >> 6);
        const int ascent = static_cast<int>(mFace->size->metrics.ascender >> 6);
        const int left = mLook.getLeftOffset();
        const int top = mLook.getTopOffset();

        std::vector<int> widths;
        for (const std::string& line : cue.lines)
            widths.push_back(forEachGlyph(line, [](int, int, unsigned) {}));
        const int textWidth = *std::max_element(widths.begin(), widths.end());
        const int textHeight = lineHeight * static_cast<int>(cue.lines.size());
        const int width = left + textWidth + mLook.getRightOffset();
        const int height = top + textHeight + mLook.getBottomOffset();

        Overlay overlay = {(kWidth - textWidth) / 2 - left, kHeight - kFromBottom - textHeight - top,
                           VFBitmap(static_cast<unsigned>(width), static_cast<unsigned>(height), 4)};
        mLook.initEffect(width, height);
        mLook.setDstBitmap(&overlay.pixels);
        for (size_t i = 0; i < cue.lines.size(); ++i) {
            const int lineLeft = left + (textWidth - widths[i]) / 2;
            const int baseline = top + static_cast<int>(i) * lineHeight + ascent;
            forEachGlyph(cue.lines[i], [&](int x, int y, unsigned glyph) {
                addGlyph(lineLeft + x, baseline + y, glyph);
            });
        }
        mLook.doEffectPostProcessing();
        mLook.compositeLayers(&overlay.pixels);
        return overlay;
    }

  private:
    /// Shapes a line; calls use(x, y, glyph) with the pen of each glyph; returns the line's width.
    template <class Use>
    int forEachGlyph(const std::string& line, Use use) {
        hb_buffer_t* buffer = hb_buffer_create();
        hb_buffer_add_utf8(buffer, line.data(), static_cast<int>(line.size()), 0, -1);
        hb_buffer_guess_segment_properties(buffer);
        hb_shape(mFont, buffer, nullptr, 0);
        unsigned count = 0;
        const hb_glyph_info_t* infos = hb_buffer_get_glyph_infos(buffer, &count);
        const hb_glyph_position_t* positions = hb_buffer_get_glyph_positions(buffer, &count);
        int pen = 0;  // in 64ths of a pixel, as the positions
        for (unsigned i = 0; i < count; ++i) {
            use((pen + positions[i].x_offset + 32) >> 6, -((positions[i].y_offset + 32) >> 6),
                infos[i].codepoint);
            pen += positions[i].x_advance;
        }
        hb_buffer_destroy(buffer);
        return (pen + 63) >> 6;
    }

    void addGlyph(int x, int y, unsigned index) {
        if (FT_Load_Glyph(mFace, index, FT_LOAD_RENDER) != 0) return;
        const FT_Bitmap& bitmap = mFace->glyph->bitmap;
        std::vector<unsigned char> coverage;
        for (int row = 0; row < static_cast<int>(bitmap.rows); ++row) {
            const unsigned char* start = bitmap.buffer + row * bitmap.pitch;
            coverage.insert(coverage.end(), start, start + bitmap.width);
        }
        VFGlyph glyph = {coverage.data(), static_cast<unsigned short>(bitmap.width),
                         static_cast<unsigned short>(bitmap.rows)};
        mLook.renderEffectLayer(x + mFace->glyph->bitmap_left, y - mFace->glyph->bitmap_top, &glyph);
    }

    FT_Face mFace;
    hb_font_t* mFont;
    VFEffect mLook;
};

// --- Frames -----------------------------------------------------------------------------------------

using Frame = std::vector<unsigned char>;

/// Lays the overlay over the frame, both premultiplied, clipped.
void layOver(Frame& frame, const Overlay& overlay) {
    const int width = static_cast<int>(overlay.pixels.mWidth);
    const int height = static_cast<int>(overlay.pixels.mHeight);
    for (int row = std::max(0, -overlay.y); row < std::min(height, kHeight - overlay.y); ++row) {
        for (int column = std::max(0, -overlay.x); column < std::min(width, kWidth - overlay.x);
             ++column) {
            const unsigned char* source = overlay.pixels.mData + 4 * (row * width + column);
            unsigned char* target = frame.data() + 4 * ((overlay.y + row) * kWidth + overlay.x + column);
            for (int channel = 0; channel < 4; ++channel) {
                const int through = target[channel] * (255 - source[3]) / 255;
                target[channel] = static_cast<unsigned char>(std::min(source[channel] + through, 255));
            }
        }
    }
}

/// A cue is painted once and kept while it is seen; a frame like the one before is written again. The
/// last frame is clear: FFmpeg shows it for the rest of the film.
bool writeFrames(const std::vector<Cue>& cues, CuePainter& painter) {
    int endMs = 0;
    for (const Cue& cue : cues)
        endMs = std::max(endMs, cue.endMs);
    const int64_t frames = int64_t{endMs} * kFramesPerSecond / 1000 + 2;

    std::map<size_t, Overlay> seen;
    Frame frame(size_t{4} * kWidth * kHeight);
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
            for (const auto& [cue, overlay] : seen)
                layOver(frame, overlay);
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
    FT_Library library = nullptr;
    FT_Face face = nullptr;
    if (FT_Init_FreeType(&library) != 0 || FT_New_Face(library, font, 0, &face) != 0 ||
        FT_Set_Pixel_Sizes(face, 0, kTextPixels) != 0) {
        std::fprintf(stderr, "cannot read the font %s\n", font);
        return 1;
    }
    bool isWritten = false;
    {
        CuePainter painter(face);
        isWritten = writeFrames(readCues(file), painter);
    }
    FT_Done_Face(face);
    FT_Done_FreeType(library);
    if (!isWritten) std::fprintf(stderr, "cannot write the frames\n");
    return isWritten ? 0 : 1;
}
