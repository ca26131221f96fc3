#include "font_face.h"

#include <cstdio>
#include <cstdlib>

namespace vorel_bench {

FontFace::FontFace(const std::string& path, int sizePx) {
    if (FT_Init_FreeType(&mLibrary) != 0 || FT_New_Face(mLibrary, path.c_str(), 0, &mFace) != 0 ||
        FT_Set_Pixel_Sizes(mFace, 0, static_cast<FT_UInt>(sizePx)) != 0) {
        std::fprintf(stderr, "cannot open the font %s\n", path.c_str());
        std::exit(1);
    }
}

FontFace::~FontFace() {
    FT_Done_Face(mFace);
    FT_Done_FreeType(mLibrary);
}

}  // namespace vorel_bench
