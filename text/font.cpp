#include "text/font.h"

#include <ft2build.h>
#include FT_FREETYPE_H

#include <utility>

#include "text/error.h"

namespace voreltext {

Font::Font(const FontFile& file, int sizePx, const std::vector<FontVariation>& variations)
    : mSizePx(sizePx) {
    open("'" + file.path + "' is ", variations,
         [&] { return FT_New_Face(mLibrary, file.path.c_str(), file.faceIndex, &mFace); });
}

Font::Font(const FontBytes& bytes, int sizePx, const std::vector<FontVariation>& variations)
    : mSizePx(sizePx) {
    open("the bytes are ", variations, [&] {
        return FT_New_Memory_Face(mLibrary, bytes.data, static_cast<FT_Long>(bytes.size),
                                  bytes.faceIndex, &mFace);
    });
}

Font::~Font() {
    FT_Done_FreeType(mLibrary);
}

Font::Font(Font&& other) noexcept : mSizePx(other.mSizePx) {
    *this = std::move(other);
}

Font& Font::operator=(Font&& other) noexcept {
    std::swap(mLibrary, other.mLibrary);
    std::swap(mFace, other.mFace);
    std::swap(mSizePx, other.mSizePx);
    mName.swap(other.mName);
    std::swap(mAscender, other.mAscender);
    std::swap(mDescender, other.mDescender);
    std::swap(mLineHeight, other.mLineHeight);
    return *this;
}

/// Opens the face by `openFace`; a message begins with `subject`.
template <typename Open>
void Font::open(const std::string& subject, const std::vector<FontVariation>& variations,
                Open openFace) {
    if (FT_Init_FreeType(&mLibrary) != 0) throw TextError("cannot start FreeType");
    try {
        if (openFace() != 0) throw TextError(subject + "no font that can be read");
        prepare(subject, variations);
    } catch (...) {
        FT_Done_FreeType(mLibrary);
        throw;
    }
}

void Font::prepare(const std::string& subject, const std::vector<FontVariation>& variations) {
    (void)variations;
    if (!chooseSize()) throw TextError(subject + "a font without outlines");
    measure();
    if (mLineHeight <= 0 || mAscender <= mDescender) {
        throw TextError(subject + "a font without vertical metrics");
    }
    mName = mFace->family_name == nullptr ? "unnamed" : mFace->family_name;
    if (mFace->style_name != nullptr) mName.append(" ").append(mFace->style_name);
}

bool Font::chooseSize() {
    return FT_IS_SCALABLE(mFace) && FT_Set_Pixel_Sizes(mFace, 0, static_cast<FT_UInt>(mSizePx)) == 0;
}

void Font::measure() {
    const FT_Size_Metrics& metrics = mFace->size->metrics;
    mAscender = metrics.ascender;
    mDescender = metrics.descender;
    mLineHeight = metrics.height;
}

bool Font::has(uint32_t code) const {
    return FT_Get_Char_Index(mFace, code) != 0;
}

bool Font::isColour() const {
    return FT_HAS_COLOR(mFace);
}

}  // namespace voreltext
