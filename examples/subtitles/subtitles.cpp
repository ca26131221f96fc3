// Burns subtitles into a film: reads an SRT file, paints each cue once with an outline and a shadow, and
// lays it over every frame in which it is shown. The frames, drawn by this program in place of a
// decoder's, are written as DIRECTORY/frame_00000.png and so on.
//
//     subtitles FILE.srt DIRECTORY [FRAMES_PER_SECOND [FONT_FILE]]
//
// A cue that cannot be read is reported and left out; the exit code is then 1.
#include <ft2build.h>
#include <hb-ft.h>
#include <png.h>
#include <unistd.h>
#include <voreleffect/voreleffect.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <istream>
#include <memory>
#include <string>
#include <utility>
#include <vector>
#include FT_FREETYPE_H

using namespace VFontEffect;
namespace fs = std::filesystem;

namespace {

constexpr int kWidth = 640;
constexpr int kHeight = 360;
constexpr int kTextPixels = 28;
constexpr int kFromBottom = 18;
constexpr int kFromSides = 40;
constexpr int kTailMs = 500;

// --- The SRT file -----------------------------------------------------------------------------------

struct Cue {
    int startMs;
    int endMs;
    std::vector<std::string> lines;
};

struct Script {
    std::vector<Cue> cues;
    int faults = 0;
};

/// The lines of a file of any system, without their ends.
class LineReader {
  public:
    explicit LineReader(std::istream& file) : mFile(file) {}

    bool next(std::string& line) {
        if (!std::getline(mFile, line)) return false;
        if (!line.empty() && line.back() == '\r') line.pop_back();
        if (++number == 1 && line.compare(0, 3, "\xEF\xBB\xBF") == 0) line.erase(0, 3);
        return true;
    }

    int number = 0;

  private:
    std::istream& mFile;
};

/// "00:01:02,500 --> 00:01:05,000"; some programs write a point for the comma.
bool parseTimes(const std::string& line, Cue& cue) {
    int h[2], m[2], s[2], ms[2];
    if (std::sscanf(line.c_str(), "%2d:%2d:%2d%*1[,.]%3d --> %2d:%2d:%2d%*1[,.]%3d", &h[0], &m[0], &s[0],
                    &ms[0], &h[1], &m[1], &s[1], &ms[1]) != 8) {
        return false;
    }
    cue.startMs = ((h[0] * 60 + m[0]) * 60 + s[0]) * 1000 + ms[0];
    cue.endMs = ((h[1] * 60 + m[1]) * 60 + s[1]) * 1000 + ms[1];
    return 0 <= cue.startMs && cue.startMs < cue.endMs;
}

/// Drops tags such as <i>.
std::string withoutTags(const std::string& line) {
    std::string text;
    bool inTag = false;
    for (const char c : line) {
        if (c == '<') inTag = true;
        if (!inTag) text += c;
        if (c == '>') inTag = false;
    }
    return text;
}

/// A block is a counter, the times, the text and an empty line.
Script readScript(std::istream& file) {
    Script script;
    LineReader reader(file);
    std::string line;
    while (reader.next(line)) {
        if (line.empty()) continue;
        const int blockAt = reader.number;
        Cue cue = {};
        const bool timed = reader.next(line) && parseTimes(line, cue);
        while (reader.next(line) && !line.empty())
            cue.lines.push_back(withoutTags(line));
        if (timed && !cue.lines.empty()) {
            script.cues.push_back(std::move(cue));
        } else {
            std::fprintf(stderr, "line %d: no cue with times and a text, left out\n", blockAt);
            ++script.faults;
        }
    }
    return script;
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

        std::vector<std::string> lines;
        for (const std::string& line : cue.lines)
            wrap(line, lines);
        std::vector<int> widths;
        for (const std::string& line : lines)
            widths.push_back(widthOf(line));
        const int textWidth = *std::max_element(widths.begin(), widths.end());
        const int textHeight = lineHeight * static_cast<int>(lines.size());
        const int width = left + textWidth + mLook.getRightOffset();
        const int height = top + textHeight + mLook.getBottomOffset();

        Overlay overlay = {(kWidth - textWidth) / 2 - left, kHeight - kFromBottom - textHeight - top,
                           VFBitmap(static_cast<unsigned>(width), static_cast<unsigned>(height), 4)};
        mLook.initEffect(width, height);
        mLook.setDstBitmap(&overlay.pixels);
        for (size_t i = 0; i < lines.size(); ++i) {
            const int lineLeft = left + (textWidth - widths[i]) / 2;
            const int baseline = top + static_cast<int>(i) * lineHeight + ascent;
            forEachGlyph(lines[i], [&](int x, int y, unsigned glyph) {
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

    int widthOf(const std::string& line) {
        return forEachGlyph(line, [](int, int, unsigned) {});
    }

    /// Breaks a line that is too wide at its blanks; a single word that is too wide stays whole.
    void wrap(const std::string& line, std::vector<std::string>& lines) {
        std::string fitting;
        for (size_t at = 0; at < line.size();) {
            const size_t end = std::min(line.find(' ', at), line.size());
            const std::string word = line.substr(at, end - at);
            const std::string longer = fitting.empty() ? word : fitting + ' ' + word;
            if (!fitting.empty() && widthOf(longer) > kWidth - 2 * kFromSides) {
                lines.push_back(fitting);
                fitting = word;
            } else {
                fitting = longer;
            }
            at = end + 1;
        }
        lines.push_back(fitting);
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

unsigned char toByte(double value) {
    return static_cast<unsigned char>(std::clamp(value, 0.0, 255.0));
}

/// A stand-in for a decoded frame: an evening sky that brightens to white and darkens again, with hills
/// that pass by, so that the text is seen on light and on dark.
std::vector<unsigned char> drawFrame(double seconds) {
    const double light = 0.5 - 0.5 * std::cos(seconds * 0.8);
    std::vector<unsigned char> rgb;
    rgb.reserve(size_t{3} * kWidth * kHeight);
    for (int y = 0; y < kHeight; ++y) {
        const double down = static_cast<double>(y) / kHeight;
        for (int x = 0; x < kWidth; ++x) {
            const double hill = 0.72 + 0.08 * std::sin(x * 0.011 + seconds) + 0.03 * std::sin(x * 0.037);
            const double shade = down > hill ? 0.35 + 0.5 * light : 1;
            rgb.push_back(toByte(shade * (60 + 150 * down + 120 * light)));
            rgb.push_back(toByte(shade * (50 + 60 * down + 170 * light)));
            rgb.push_back(toByte(shade * (110 - 30 * down + 160 * light)));
        }
    }
    return rgb;
}

/// Lays the overlay over the opaque frame, clipped.
void layOver(std::vector<unsigned char>& rgb, const Overlay& overlay) {
    const int width = static_cast<int>(overlay.pixels.mWidth);
    const int height = static_cast<int>(overlay.pixels.mHeight);
    for (int row = std::max(0, -overlay.y); row < std::min(height, kHeight - overlay.y); ++row) {
        for (int column = std::max(0, -overlay.x); column < std::min(width, kWidth - overlay.x);
             ++column) {
            const unsigned char* source = overlay.pixels.mData + 4 * (row * width + column);
            unsigned char* target = rgb.data() + 3 * ((overlay.y + row) * kWidth + overlay.x + column);
            for (int channel = 0; channel < 3; ++channel) {
                const int through = target[channel] * (255 - source[3]) / 255;
                target[channel] = static_cast<unsigned char>(std::min(source[channel] + through, 255));
            }
        }
    }
}

/// Written beside its place and then moved there: no frame is ever half written.
bool writePng(const fs::path& path, const std::vector<unsigned char>& rgb) {
    const fs::path part = path.string() + ".part";
    png_image png = {};
    png.version = PNG_IMAGE_VERSION;
    png.width = kWidth;
    png.height = kHeight;
    png.format = PNG_FORMAT_RGB;
    png.flags = PNG_IMAGE_FLAG_FAST;
    if (png_image_write_to_file(&png, part.c_str(), 0, rgb.data(), 0, nullptr) == 0) return false;
    std::error_code error;
    fs::rename(part, path, error);
    return !error;
}

/// Only for a person who is looking.
void showProgress(int done, int all) {
    if (isatty(STDERR_FILENO) == 0) return;
    constexpr int kCells = 40;
    const int filled = kCells * done / all;
    std::fprintf(stderr, "\r[%s%s] %d of %d frames%s",
                 std::string(static_cast<size_t>(filled), '#').c_str(),
                 std::string(static_cast<size_t>(kCells - filled), '.').c_str(), done, all,
                 done == all ? "\n" : "");
}

bool writeFilm(const std::vector<Cue>& cues, FT_Face face, const fs::path& directory,
               int framesPerSecond) {
    int endMs = 0;
    for (const Cue& cue : cues)
        endMs = std::max(endMs, cue.endMs);
    const int frames = static_cast<int>((endMs + kTailMs) * 1LL * framesPerSecond / 1000);

    CuePainter painter(face);
    std::vector<std::unique_ptr<Overlay>> overlays(cues.size());
    for (int frame = 0; frame < frames; ++frame) {
        const int nowMs = static_cast<int>(1000LL * frame / framesPerSecond);
        std::vector<unsigned char> rgb = drawFrame(nowMs / 1000.0);
        for (size_t i = 0; i < cues.size(); ++i) {
            if (nowMs < cues[i].startMs || nowMs >= cues[i].endMs) {
                overlays[i].reset();  // kept while it is shown: memory does not grow with the film
                continue;
            }
            if (!overlays[i]) overlays[i] = std::make_unique<Overlay>(painter.paint(cues[i]));
            layOver(rgb, *overlays[i]);
        }
        char name[32];
        std::snprintf(name, sizeof name, "frame_%05d.png", frame);
        if (!writePng(directory / name, rgb)) {
            std::fprintf(stderr, "cannot write %s\n", (directory / name).c_str());
            return false;
        }
        showProgress(frame + 1, frames);
    }
    return true;
}

}  // namespace

int main(int argc, char** argv) {
    const int framesPerSecond = argc > 3 ? std::atoi(argv[3]) : 12;
    const char* font = argc > 4 ? argv[4] : "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf";
    if (argc < 3 || framesPerSecond < 1 || framesPerSecond > 120) {
        std::fprintf(stderr, "usage: subtitles FILE.srt DIRECTORY [FRAMES_PER_SECOND [FONT_FILE]]\n");
        return 2;
    }
    std::ifstream file(argv[1], std::ios::binary);
    std::error_code error;
    fs::create_directories(argv[2], error);
    if (!file || error) {
        std::fprintf(stderr, "cannot %s\n", error ? "make the directory" : "read the subtitles");
        return 1;
    }
    const Script script = readScript(file);

    FT_Library library = nullptr;
    FT_Face face = nullptr;
    if (FT_Init_FreeType(&library) != 0 || FT_New_Face(library, font, 0, &face) != 0 ||
        FT_Set_Pixel_Sizes(face, 0, kTextPixels) != 0) {
        std::fprintf(stderr, "cannot read the font %s\n", font);
        return 1;
    }
    const bool written = writeFilm(script.cues, face, argv[2], framesPerSecond);
    FT_Done_Face(face);
    FT_Done_FreeType(library);
    return written && script.faults == 0 ? 0 : 1;
}
