#pragma once

#include <ft2build.h>
#include FT_FREETYPE_H

#include <string>

namespace vorel_bench {

/// How glyphs are loaded: unhinted outlines.
constexpr FT_Int32 kLoadFlags = FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP;

/// An open font at one size. A font that cannot be opened ends the process.
class FontFace {
  public:
    FontFace(const std::string& path, int sizePx);
    ~FontFace();
    FontFace(const FontFace&) = delete;
    FontFace& operator=(const FontFace&) = delete;

    FT_Library library() const { return mLibrary; }
    FT_Face face() const { return mFace; }

  private:
    FT_Library mLibrary = nullptr;
    FT_Face mFace = nullptr;
};

}  // namespace vorel_bench
