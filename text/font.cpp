#include "text/font.h"

#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_SIZES_H

#include <utility>

#include "text/error.h"
#include "text/font_axes.h"
#include "text/units.h"

namespace voreltext {
namespace {

/// The smallest of the face's sizes of pictures that need not be enlarged, else the largest.
int pictureSizeFor(FT_Face face, int sizePx) {
    int best = 0;
    for (int i = 1; i < face->num_fixed_sizes; ++i) {
        const FT_Pos size = face->available_sizes[i].y_ppem;
        const FT_Pos found = face->available_sizes[best].y_ppem;
        const FT_Pos wanted = sizePx * kUnit;
        const bool isBetter = found < wanted ? size > found : size >= wanted && size < found;
        if (isBetter) best = i;
    }
    return best;
}

}  // namespace

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
    std::swap(mPictureSize, other.mPictureSize);
    std::swap(mPicturePpem, other.mPicturePpem);
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
    if (!variations.empty()) setAxes(mFace, variations, subject);
    if (!chooseSize()) throw TextError(subject + "a font without outlines");
    measure();
    if (mLineHeight <= 0 || mAscender <= mDescender) {
        throw TextError(subject + "a font without vertical metrics");
    }
    mName = mFace->family_name == nullptr ? "unnamed" : mFace->family_name;
    if (mFace->style_name != nullptr) mName.append(" ").append(mFace->style_name);
}

bool Font::chooseSize() {
    if (!hasOutlines()) {
        mPictureSize = mFace->size;
        return choosePictures();
    }
    if (FT_HAS_COLOR(mFace) && FT_New_Size(mFace, &mPictureSize) == 0) {
        const FT_Size outlines = mFace->size;
        FT_Activate_Size(mPictureSize);
        if (!choosePictures()) mPictureSize = nullptr;  // the face keeps it to its end
        FT_Activate_Size(outlines);
    }
    return FT_Set_Pixel_Sizes(mFace, 0, static_cast<FT_UInt>(mSizePx)) == 0;
}

/// For the active size of the face.
bool Font::choosePictures() {
    const bool isChosen = FT_HAS_COLOR(mFace) && FT_HAS_FIXED_SIZES(mFace) &&
                          FT_Select_Size(mFace, pictureSizeFor(mFace, mSizePx)) == 0;
    if (isChosen) mPicturePpem = mFace->size->metrics.y_ppem;
    return mPicturePpem > 0;
}

void Font::measure() {
    const FT_Size_Metrics& metrics = mFace->size->metrics;
    mAscender = ceilToPixel(scaled(metrics.ascender)) * kUnit;
    mDescender = floorToPixel(scaled(metrics.descender)) * kUnit;
    mLineHeight = floorToPixel(scaled(metrics.height) + kUnit / 2) * kUnit;
}

int64_t Font::scaled(int64_t units) const {
    if (hasOutlines()) return units;
    return floorOf(2 * units * mSizePx + mPicturePpem, 2 * int64_t{mPicturePpem});
}

bool Font::hasOutlines() const {
    return FT_IS_SCALABLE(mFace);
}

bool Font::has(uint32_t code) const {
    return FT_Get_Char_Index(mFace, code) != 0;
}

bool Font::isColour() const {
    return FT_HAS_COLOR(mFace);
}

}  // namespace voreltext
