#include "text/font.h"

#include <ft2build.h>
#include FT_FREETYPE_H

#include "text/error.h"

namespace voreltext {

Font::Font(const FontFile& file, int sizePx) {
    open(sizePx, "'" + file.path + "' is ",
         [&] { return FT_New_Face(mLibrary, file.path.c_str(), file.faceIndex, &mFace); });
}

Font::Font(const FontBytes& bytes, int sizePx) {
    open(sizePx, "the bytes are ", [&] {
        return FT_New_Memory_Face(mLibrary, bytes.data, static_cast<FT_Long>(bytes.size),
                                  bytes.faceIndex, &mFace);
    });
}

Font::~Font() {
    FT_Done_FreeType(mLibrary);
}

/// Opens the face by `openFace`; a message begins with `subject`.
template <typename Open>
void Font::open(int sizePx, const std::string& subject, Open openFace) {
    if (FT_Init_FreeType(&mLibrary) != 0) throw TextError("cannot start FreeType");
    const bool opened = openFace() == 0;
    const bool usable = opened && FT_IS_SCALABLE(mFace) &&
                        FT_Set_Pixel_Sizes(mFace, 0, static_cast<FT_UInt>(sizePx)) == 0;
    if (usable) return;
    FT_Done_FreeType(mLibrary);
    throw TextError(subject + (opened ? "a font without outlines" : "no font that can be read"));
}

long Font::lineHeight() const {
    return mFace->size->metrics.height;
}

}  // namespace voreltext
