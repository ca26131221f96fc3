#pragma once

#include <ft2build.h>
#include FT_FREETYPE_H

#include "font_finder.h"

namespace vorelpaint {

/// How every glyph is loaded: as its designer's outline, which lands on any fraction of a pixel.
constexpr FT_Int32 kLoadFlags = FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP;

/// An open font at one size in pixels.
class Font {
  public:
    /// Throws ToolError when the file is no font with outlines.
    Font(const FontFile& file, int sizePx);
    ~Font();
    Font(const Font&) = delete;
    Font& operator=(const Font&) = delete;

    FT_Face face() const { return mFace; }
    long lineHeight() const { return mFace->size->metrics.height; }  ///< in 64ths of a pixel

  private:
    FT_Library mLibrary = nullptr;
    FT_Face mFace = nullptr;
};

}  // namespace vorelpaint
