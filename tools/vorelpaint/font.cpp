#include "font.h"

#include <string>

#include "error.h"

namespace vorelpaint {

Font::Font(const FontFile& file, int sizePx) {
    if (FT_Init_FreeType(&mLibrary) != 0) throw ToolError("cannot start FreeType");
    const bool opened = FT_New_Face(mLibrary, file.path.c_str(), file.faceIndex, &mFace) == 0;
    const bool usable = opened && FT_IS_SCALABLE(mFace) &&
                        FT_Set_Pixel_Sizes(mFace, 0, static_cast<FT_UInt>(sizePx)) == 0;
    if (usable) return;
    FT_Done_FreeType(mLibrary);
    throw ToolError("'" + file.path + "' is " +
                    (opened ? "a font without outlines" : "no font that can be read"));
}

Font::~Font() {
    FT_Done_FreeType(mLibrary);
}

}  // namespace vorelpaint
