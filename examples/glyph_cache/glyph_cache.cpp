// A page of text from a bounded cache of painted glyphs, the one that was not used for longest going
// first. Prints the hit rate and the memory, and writes the page.
//
//     glyph_cache [FONT_FILE [PICTURE.png]]
#include <ft2build.h>
#include <png.h>
#include <voreleffect/voreleffect.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <functional>
#include <list>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>
#include FT_FREETYPE_H
#include FT_ADVANCES_H

using namespace VFontEffect;

namespace {

constexpr int kPageWidth = 900;
constexpr int kPageHeight = 640;
constexpr int kMargin = 40;
constexpr int kBodyPixels = 26;
constexpr int kHeadingPixels = 58;
constexpr int kPaper[] = {0x5C, 0x6F, 0x84};

// --- A look and its identity ------------------------------------------------------------------------

/// A set of effects and the name under which its glyphs are kept.
struct Look {
    Look(const std::function<void(VFEffect&)>& addEffects, unsigned fill,
         const std::string& patternName) {
        addEffects(set);
        // Taken here, once, from a set that has just been described and has painted nothing:
        // initEffect, which plans a run, puts the effects into another order, and the key follows that
        // order. A key taken after the first run would differ from this one, and every cached glyph
        // would be missed. Nor is it taken again later: getMapKey(colour) counts as an add-call, after
        // which the next run is planned anew, with the order of the effects turned round.
        char* key = set.getMapKey(fill);
        identity = key != nullptr ? key : "";
        delete[] key;
        // A pattern leaves no trace in the key: looks that differ in nothing else have equal keys.
        // The caller, who knows where the pattern came from, adds a name for it.
        identity += '/' + patternName;
    }

    VFEffect set;
    std::string identity;
};

// --- The cache --------------------------------------------------------------------------------------

/// A painted glyph: premultiplied pixels, and where their top left corner lies seen from the pen.
struct PaintedGlyph {
    PaintedGlyph(int width, int height)
        : pixels(static_cast<unsigned>(width), static_cast<unsigned>(height), 4) {}

    size_t bytes() const {
        return size_t{4} * pixels.mWidth * pixels.mHeight + sizeof *this + key.size();
    }

    std::string key;
    int left = 0;
    int top = 0;
    VFBitmap pixels;
};

class GlyphCache {
  public:
    GlyphCache(FT_Face face, size_t limitBytes) : mFace(face), mLimit(limitBytes) {}

    /// The glyph in this look and size; stays valid until the next call.
    const PaintedGlyph& get(Look& look, unsigned glyph, int pixels) {
        const std::string key =
            look.identity + '/' + std::to_string(glyph) + '/' + std::to_string(pixels);
        const auto found = mPlaces.find(key);
        if (found != mPlaces.end()) {
            ++hits;
            mGlyphs.splice(mGlyphs.begin(), mGlyphs, found->second);
            return mGlyphs.front();
        }
        ++misses;
        paint(look.set, glyph, pixels);
        mGlyphs.front().key = key;
        mPlaces[key] = mGlyphs.begin();
        used += mGlyphs.front().bytes();
        while (used > mLimit && mGlyphs.size() > 1)
            dropOldest();
        return mGlyphs.front();
    }

    size_t hits = 0;
    size_t misses = 0;
    size_t dropped = 0;
    size_t used = 0;

  private:
    /// Paints one glyph as a run of its own and puts it in front. A gradient or a pattern thus starts
    /// anew in every glyph; for one that runs through a line, paint and cache the line.
    void paint(VFEffect& look, unsigned index, int pixels) {
        FT_Set_Pixel_Sizes(mFace, 0, static_cast<unsigned>(pixels));
        const bool drawn = FT_Load_Glyph(mFace, index, FT_LOAD_RENDER | FT_LOAD_NO_HINTING) == 0;
        const FT_GlyphSlot slot = mFace->glyph;
        const int columns = drawn ? static_cast<int>(slot->bitmap.width) : 0;
        const int rows = drawn ? static_cast<int>(slot->bitmap.rows) : 0;
        std::vector<unsigned char> coverage;
        for (int row = 0; row < rows; ++row) {
            const unsigned char* start = slot->bitmap.buffer + row * slot->bitmap.pitch;
            coverage.insert(coverage.end(), start, start + columns);
        }

        const int left = look.getLeftOffset();
        const int top = look.getTopOffset();
        const int width = columns == 0 ? 0 : left + columns + look.getRightOffset();
        const int height = rows == 0 ? 0 : top + rows + look.getBottomOffset();
        mGlyphs.emplace_front(width, height);
        PaintedGlyph& painted = mGlyphs.front();
        painted.left = slot->bitmap_left - left;
        painted.top = -slot->bitmap_top - top;

        VFGlyph mask = {coverage.data(), static_cast<unsigned short>(columns),
                        static_cast<unsigned short>(rows)};
        look.initEffect(width, height);
        look.setDstBitmap(&painted.pixels);
        look.renderEffectLayer(left, top, &mask);
        look.doEffectPostProcessing();
        look.compositeLayers(&painted.pixels);
    }

    void dropOldest() {
        used -= mGlyphs.back().bytes();
        mPlaces.erase(mGlyphs.back().key);
        mGlyphs.pop_back();
        ++dropped;
    }

    FT_Face mFace;
    size_t mLimit;
    std::list<PaintedGlyph> mGlyphs;  // the one used last in front
    std::unordered_map<std::string, std::list<PaintedGlyph>::iterator> mPlaces;
};

// --- The page ---------------------------------------------------------------------------------------

struct Page {
    Page() {
        for (int pixel = 0; pixel < kPageWidth * kPageHeight; ++pixel) {
            for (const int channel : kPaper)
                rgb.push_back(static_cast<unsigned char>(channel));
        }
    }

    /// Lays the premultiplied glyph over the opaque page, with its corner at (x, y).
    void layOver(const PaintedGlyph& glyph, int x, int y) {
        const int width = static_cast<int>(glyph.pixels.mWidth);
        const int height = static_cast<int>(glyph.pixels.mHeight);
        for (int row = std::max(0, -y); row < std::min(height, kPageHeight - y); ++row) {
            for (int column = std::max(0, -x); column < std::min(width, kPageWidth - x); ++column) {
                const unsigned char* source = glyph.pixels.mData + 4 * (row * width + column);
                unsigned char* target = rgb.data() + 3 * ((y + row) * kPageWidth + x + column);
                for (int channel = 0; channel < 3; ++channel) {
                    const int through = target[channel] * (255 - source[3]) / 255;
                    target[channel] =
                        static_cast<unsigned char>(std::min(source[channel] + through, 255));
                }
            }
        }
    }

    std::vector<unsigned char> rgb;
};

/// Sets words from left to right and line by line, and draws them from the cache.
class Typesetter {
  public:
    Typesetter(FT_Face face, GlyphCache& cache, Page& page) : mFace(face), mCache(cache), mPage(page) {}

    /// The looks are painted one over the other, each line of text wholly in the first one before the
    /// next: so the outline of a letter lies beneath its neighbours, never on them.
    void paragraph(const std::string& text, const std::vector<Look*>& looks, int pixels) {
        FT_Set_Pixel_Sizes(mFace, 0, static_cast<unsigned>(pixels));
        const int lineHeight = static_cast<int>(mFace->size->metrics.height >> 6) + pixels / 5;
        std::string line;
        size_t at = 0;
        while (at < text.size()) {
            const size_t end = std::min(text.find(' ', at), text.size());
            const std::string word = text.substr(at, end - at) + ' ';
            FT_Set_Pixel_Sizes(mFace, 0, static_cast<unsigned>(pixels));
            if (widthOf(line + word) > kPageWidth - 2 * kMargin) {
                drawLine(line, looks, pixels, lineHeight);
                line.clear();
            }
            line += word;
            at = end + 1;
        }
        drawLine(line, looks, pixels, lineHeight);
        mTop += pixels / 2;
    }

  private:
    int advanceOf(unsigned glyph) {
        FT_Fixed advance = 0;  // in 65536ths of a pixel
        FT_Get_Advance(mFace, glyph, FT_LOAD_NO_HINTING, &advance);
        return static_cast<int>((advance + 0x8000) >> 16);
    }

    unsigned glyphOf(char c) { return FT_Get_Char_Index(mFace, static_cast<unsigned char>(c)); }

    int widthOf(const std::string& line) {
        int width = 0;
        for (const char c : line)
            width += advanceOf(glyphOf(c));
        return width;
    }

    void drawLine(const std::string& line, const std::vector<Look*>& looks, int pixels, int lineHeight) {
        const int baseline = mTop + pixels;
        for (Look* look : looks) {
            int pen = kMargin;
            for (const char c : line) {
                const PaintedGlyph& painted = mCache.get(*look, glyphOf(c), pixels);
                mPage.layOver(painted, pen + painted.left, baseline + painted.top);
                FT_Set_Pixel_Sizes(mFace, 0, static_cast<unsigned>(pixels));
                pen += advanceOf(glyphOf(c));
            }
        }
        mTop += lineHeight;
    }

    FT_Face mFace;
    GlyphCache& mCache;
    Page& mPage;
    int mTop = kMargin;
};

/// A tile of 8 x 8 pixels in two colours, memory order A, R, G, B: stripes along the sum or checks.
VFBitmap makeTile(unsigned first, unsigned second, bool stripes) {
    constexpr unsigned kSide = 8;
    VFBitmap tile(kSide, kSide, 4);
    for (unsigned i = 0; i < kSide * kSide; ++i) {
        const unsigned x = i % kSide;
        const unsigned y = i / kSide;
        const bool odd = stripes ? (x + y) % kSide < kSide / 2 : (x < kSide / 2) != (y < kSide / 2);
        const unsigned color = odd ? first : second;
        unsigned char* pixel = tile.mData + size_t{4} * i;
        pixel[0] = 255;
        pixel[1] = static_cast<unsigned char>(color >> 16);
        pixel[2] = static_cast<unsigned char>(color >> 8);
        pixel[3] = static_cast<unsigned char>(color);
    }
    return tile;
}

/// The four looks of the page.
struct Looks {
    VFBitmap stripes = makeTile(0xFFD166, 0xF2994A, true);
    VFBitmap checks = makeTile(0x9BE7C4, 0x52B69A, false);

    static void outline(VFEffect& look, float pixels) { look.addStrokeText(pixels, 0x1B2633, 1, 0, 1); }

    Look striped{[this](VFEffect& look) {
                     look.addPatternText(&stripes, 1, 1);
                     outline(look, 4);
                 },
                 0xFFFFFF, "stripes"};
    Look checked{[this](VFEffect& look) {
                     look.addPatternText(&checks, 1, 1);
                     outline(look, 4);
                 },
                 0xFFFFFF, "checks"};
    Look halo{[](VFEffect& look) {
                  outline(look, 2);
                  look.addOuterShadowText(120, 3, 4, 0x000000, 0.7F);
              },
              0x1B2633, ""};
    Look face{[](VFEffect&) {}, 0xFFFFFF, ""};
};

void setPage(FT_Face face, GlyphCache& cache, Looks& looks, Page& page) {
    Typesetter setter(face, cache, page);
    setter.paragraph("Painted once", {&looks.striped}, kHeadingPixels);
    setter.paragraph(
        "A page of text repeats a few dozen letters some hundred times. Their effects cost far more "
        "than "
        "laying a finished picture on the page, so each letter is painted when it is first met and kept "
        "as long as there is room.",
        {&looks.halo, &looks.face}, kBodyPixels);
    setter.paragraph("Used often", {&looks.checked}, kHeadingPixels);
    setter.paragraph(
        "The name of a kept letter has three parts: the key of its look, the number of the glyph and "
        "the "
        "size. Two headings with one look but for the pattern in them need a fourth, a name of the "
        "pattern, or the second heading would come out in the letters of the first.",
        {&looks.halo, &looks.face}, kBodyPixels);
}

void report(const char* what, FT_Face face, GlyphCache& cache, Looks& looks, Page& page) {
    const size_t hits = cache.hits;
    const size_t misses = cache.misses;
    const size_t dropped = cache.dropped;
    const auto start = std::chrono::steady_clock::now();
    setPage(face, cache, looks, page);
    const std::chrono::duration<double, std::milli> time = std::chrono::steady_clock::now() - start;
    const size_t painted = cache.misses - misses;
    const size_t drawn = cache.hits - hits + painted;
    std::printf("%-24s %5zu drawn %5zu painted %5.1f %% hits %6.1f KiB kept %5zu dropped %6.1f ms\n",
                what, drawn, painted,
                100.0 * static_cast<double>(drawn - painted) / static_cast<double>(drawn),
                static_cast<double>(cache.used) / 1024, cache.dropped - dropped, time.count());
}

bool writePng(const char* path, const Page& page) {
    png_image png = {};
    png.version = PNG_IMAGE_VERSION;
    png.width = kPageWidth;
    png.height = kPageHeight;
    png.format = PNG_FORMAT_RGB;
    return png_image_write_to_file(&png, path, 0, page.rgb.data(), 0, nullptr) != 0;
}

}  // namespace

int main(int argc, char** argv) {
    const char* font = argc > 1 ? argv[1] : "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf";
    const char* path = argc > 2 ? argv[2] : "glyph_cache.png";

    FT_Library library = nullptr;
    FT_Face face = nullptr;
    if (FT_Init_FreeType(&library) != 0 || FT_New_Face(library, font, 0, &face) != 0) {
        std::fprintf(stderr, "cannot read the font %s\n", font);
        return 1;
    }

    Looks looks;
    Page page;
    GlyphCache roomy(face, size_t{1} << 20);
    report("1 MiB, first page", face, roomy, looks, page);
    Page again;
    report("1 MiB, the page again", face, roomy, looks, again);
    GlyphCache tight(face, size_t{128} << 10);
    Page third;
    report("128 KiB, first page", face, tight, looks, third);
    FT_Done_Face(face);
    FT_Done_FreeType(library);

    if (page.rgb != again.rgb || page.rgb != third.rgb) {
        std::fprintf(stderr, "the pages differ\n");
        return 1;
    }
    if (!writePng(path, page)) {
        std::fprintf(stderr, "cannot write %s\n", path);
        return 1;
    }
    return 0;
}
