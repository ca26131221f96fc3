// What the recipes share: a line of letters, a page to paint on, a PNG of it, and a check.
#pragma once

#include <voreleffect/look.h>

#include <vector>

/// A line of letters. The glyphs show coverage that the line owns, so it cannot be copied.
struct Line {
    /// Sets the text (Latin-1) in DejaVu Sans Bold of so many pixels; its origin is the start of the
    /// baseline.
    Line(const char* text, int pixels);
    Line(const Line&) = delete;
    Line& operator=(const Line&) = delete;

    std::vector<VFontEffect::Glyph> glyphs;  ///< one for each letter that has pixels

  private:
    std::vector<std::vector<unsigned char>> mCoverage;
};

/// An opaque page in one colour.
struct Page {
    Page(int pageWidth, int pageHeight, VFontEffect::Color color);

    /// To paint on it.
    VFontEffect::PictureView view() { return {pixels.data(), width, height}; }

    int width;
    int height;
    std::vector<unsigned char> pixels;  ///< R, G, B, A in packed rows
};

/// Writes premultiplied pixels as a PNG, whose pixels are straight; ends the program where it cannot.
void writePng(const char* path, const VFontEffect::PictureView& picture);

/// Ends the program with the words where they are not true.
void check(bool isTrue, const char* words);
