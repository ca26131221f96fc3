// A page of text from a bounded cache of painted glyphs, the one that was not used for longest going
// first. Prints the hit rate and the memory, and writes the page.
//
//     glyph_cache [FONT_FILE [PICTURE.png]]
#include <ft2build.h>
#include <voreleffect/look.h>

#include <chrono>
#include <cstdio>
#include <list>
#include <string>
#include <unordered_map>
#include <vector>
#include FT_FREETYPE_H
#include FT_ADVANCES_H

#include "../shared/page.h"

using namespace VFontEffect;

namespace {

constexpr int kPageWidth = 900;
constexpr int kPageHeight = 640;
constexpr int kMargin = 40;
constexpr int kBodyPixels = 26;
constexpr int kHeadingPixels = 58;
constexpr unsigned kPaper = 0x5C6F84;

// --- The cache --------------------------------------------------------------------------------------

/// A painter and the name under which its glyphs are kept. The key tells all of the look, patterns
/// included.
struct NamedPainter {
    explicit NamedPainter(const Look& look) : key(look.key()), painter(look) {}

    std::string key;
    Painter painter;
};

/// A glyph as it lies on the page, its origin the pen.
struct PaintedGlyph {
    std::size_t bytes() const {
        return static_cast<std::size_t>(picture.stride()) * static_cast<std::size_t>(picture.height()) +
               sizeof *this + key.size();
    }

    std::string key;
    Picture picture;
};

class GlyphCache {
  public:
    GlyphCache(FT_Face face, std::size_t limitBytes) : mFace(face), mLimit(limitBytes) {}

    /// The glyph in this look and size; stays valid until the next call.
    const Picture& get(NamedPainter& look, unsigned glyph, int pixels) {
        const std::string key = look.key + '/' + std::to_string(glyph) + '/' + std::to_string(pixels);
        const auto found = mPlaces.find(key);
        if (found != mPlaces.end()) {
            ++hits;
            mGlyphs.splice(mGlyphs.begin(), mGlyphs, found->second);
            return mGlyphs.front().picture;
        }
        ++misses;
        mGlyphs.push_front({key, paint(look.painter, glyph, pixels)});
        mPlaces[key] = mGlyphs.begin();
        used += mGlyphs.front().bytes();
        while (used > mLimit && mGlyphs.size() > 1)
            dropOldest();
        return mGlyphs.front().picture;
    }

    std::size_t hits = 0;
    std::size_t misses = 0;
    std::size_t dropped = 0;
    std::size_t used = 0;

  private:
    /// Paints one glyph in a picture of its own. A gradient or a pattern thus starts anew in every
    /// glyph; for one that runs through a line, paint and cache the line.
    Picture paint(Painter& painter, unsigned index, int pixels) {
        FT_Set_Pixel_Sizes(mFace, 0, static_cast<unsigned>(pixels));
        constexpr FT_Int32 kFlags = FT_LOAD_RENDER | FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP;
        if (FT_Load_Glyph(mFace, index, kFlags) != 0) return {};
        const FT_GlyphSlot slot = mFace->glyph;
        const FT_Bitmap& bitmap = slot->bitmap;
        const Glyph glyph = {slot->bitmap_left,
                             -slot->bitmap_top,
                             bitmap.buffer,
                             static_cast<int>(bitmap.width),
                             static_cast<int>(bitmap.rows),
                             bitmap.pitch};
        return painter.paint(glyph).value_or(Picture());
    }

    void dropOldest() {
        used -= mGlyphs.back().bytes();
        mPlaces.erase(mGlyphs.back().key);
        mGlyphs.pop_back();
        ++dropped;
    }

    FT_Face mFace;
    std::size_t mLimit;
    std::list<PaintedGlyph> mGlyphs;  // the one used last in front
    std::unordered_map<std::string, std::list<PaintedGlyph>::iterator> mPlaces;
};

// --- The page ---------------------------------------------------------------------------------------

/// Sets words from left to right and line by line, and draws them from the cache.
class Typesetter {
  public:
    Typesetter(FT_Face face, GlyphCache& cache, Page& page) : mFace(face), mCache(cache), mPage(page) {}

    /// The looks are painted one over the other, each line of text wholly in the first one before the
    /// next: so the outline of a letter lies beneath its neighbours, never on them.
    void paragraph(const std::string& text, const std::vector<NamedPainter*>& looks, int pixels) {
        FT_Set_Pixel_Sizes(mFace, 0, static_cast<unsigned>(pixels));
        const int lineHeight = static_cast<int>(mFace->size->metrics.height >> 6) + pixels / 5;
        std::string line;
        std::size_t at = 0;
        while (at < text.size()) {
            const std::size_t end = std::min(text.find(' ', at), text.size());
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

    void drawLine(const std::string& line, const std::vector<NamedPainter*>& looks, int pixels,
                  int lineHeight) {
        const int baseline = mTop + pixels;
        for (NamedPainter* look : looks) {
            int pen = kMargin;
            for (const char c : line) {
                mCache.get(*look, glyphOf(c), pixels).layOver(mPage.view(), pen, baseline);
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

/// A pattern of 8 x 8 pixels in two colours: stripes along the sum, or checks.
Pattern tile(unsigned first, unsigned second, bool stripes) {
    constexpr unsigned kSide = 8;
    std::vector<unsigned char> rgba;
    for (unsigned i = 0; i < kSide * kSide; ++i) {
        const unsigned x = i % kSide;
        const unsigned y = i / kSide;
        const bool odd = stripes ? (x + y) % kSide < kSide / 2 : (x < kSide / 2) != (y < kSide / 2);
        const unsigned color = odd ? first : second;
        for (const int shift : {16, 8, 0})
            rgba.push_back(static_cast<unsigned char>(color >> shift));
        rgba.push_back(255);
    }
    return Pattern({rgba.data(), kSide, kSide});
}

Look outlined(const Pattern& pattern) {
    return Look().fill(rgb(0xFFFFFF)).add(Stroke(4, rgb(0x1B2633))).add(pattern);
}

/// The four looks of the page.
struct Looks {
    NamedPainter striped{outlined(tile(0xFFD166, 0xF2994A, true))};
    NamedPainter checked{outlined(tile(0x9BE7C4, 0x52B69A, false))};
    NamedPainter halo{Look()
                          .fill(rgb(0x1B2633))
                          .add(OuterShadow(rgb(0)).angle(120).distance(3).size(4).opacity(0.7F))
                          .add(Stroke(2, rgb(0x1B2633)))};
    NamedPainter face{Look().fill(rgb(0xFFFFFF))};
};

void setPage(FT_Face face, GlyphCache& cache, Looks& looks, Page& page) {
    Typesetter setter(face, cache, page);
    setter.paragraph("Painted once", {&looks.striped}, kHeadingPixels);
    setter.paragraph(
        "A page of text repeats a few dozen letters some hundred times. Their effects cost far more "
        "than laying a finished picture on the page, so each letter is painted when it is first met and "
        "kept as long as there is room.",
        {&looks.halo, &looks.face}, kBodyPixels);
    setter.paragraph("Used often", {&looks.checked}, kHeadingPixels);
    setter.paragraph(
        "The name of a kept letter has three parts: the key of its look, the number of the glyph and "
        "the size. The headings differ by the pattern alone, and so do their keys: else the second one "
        "would come out in the letters of the first.",
        {&looks.halo, &looks.face}, kBodyPixels);
}

void report(const char* what, FT_Face face, GlyphCache& cache, Looks& looks, Page& page) {
    const std::size_t hits = cache.hits;
    const std::size_t misses = cache.misses;
    const std::size_t dropped = cache.dropped;
    const auto start = std::chrono::steady_clock::now();
    setPage(face, cache, looks, page);
    const std::chrono::duration<double, std::milli> time = std::chrono::steady_clock::now() - start;
    const std::size_t painted = cache.misses - misses;
    const std::size_t drawn = cache.hits - hits + painted;
    std::printf("%-24s %5zu drawn %5zu painted %5.1f %% hits %6.1f KiB kept %5zu dropped %6.1f ms\n",
                what, drawn, painted,
                100.0 * static_cast<double>(drawn - painted) / static_cast<double>(drawn),
                static_cast<double>(cache.used) / 1024, cache.dropped - dropped, time.count());
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
    Page page(kPageWidth, kPageHeight, kPaper);
    GlyphCache roomy(face, std::size_t{1} << 20);
    report("1 MiB, first page", face, roomy, looks, page);
    Page again(kPageWidth, kPageHeight, kPaper);
    report("1 MiB, the page again", face, roomy, looks, again);
    GlyphCache tight(face, std::size_t{128} << 10);
    Page third(kPageWidth, kPageHeight, kPaper);
    report("128 KiB, first page", face, tight, looks, third);
    FT_Done_Face(face);
    FT_Done_FreeType(library);

    if (!(page == again && page == third)) {
        std::fprintf(stderr, "the pages differ\n");
        return 1;
    }
    if (!page.writePng(path)) {
        std::fprintf(stderr, "cannot write %s\n", path);
        return 1;
    }
    return 0;
}
