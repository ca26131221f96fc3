#include "text/font.h"

#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_PARAMETER_TAGS_H

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

/// Where a face is opened from; a message begins with `subject`.
struct Font::Source {
    std::string subject;
    long faceIndex;
    FT_Open_Args arguments;
};

Font::Font(const FontFile& file, int sizePx, const std::vector<FontVariation>& variations)
    : mSizePx(sizePx) {
    std::string path = file.path;
    Source source{"'" + path + "' is ", file.faceIndex, {}};
    source.arguments.flags = FT_OPEN_PATHNAME;
    source.arguments.pathname = path.data();
    open(source, variations);
}

Font::Font(const FontBytes& bytes, int sizePx, const std::vector<FontVariation>& variations)
    : mSizePx(sizePx) {
    Source source{"the bytes are ", bytes.faceIndex, {}};
    source.arguments.flags = FT_OPEN_MEMORY;
    source.arguments.memory_base = bytes.data;
    source.arguments.memory_size = static_cast<FT_Long>(bytes.size);
    open(source, variations);
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
    std::swap(mPictures, other.mPictures);
    std::swap(mPicturePpem, other.mPicturePpem);
    std::swap(mSizePx, other.mSizePx);
    mName.swap(other.mName);
    mFamily.swap(other.mFamily);
    std::swap(mAscender, other.mAscender);
    std::swap(mDescender, other.mDescender);
    std::swap(mLineHeight, other.mLineHeight);
    return *this;
}

void Font::open(const Source& source, const std::vector<FontVariation>& variations) {
    if (mSizePx < 1 || mSizePx > kMostSize) {
        throw TextError("the size of a font is " + std::to_string(mSizePx) + "; it may be 1 to " +
                        std::to_string(kMostSize) + " pixels");
    }
    if (FT_Init_FreeType(&mLibrary) != 0) throw TextError("cannot start FreeType");
    try {
        openFaces(source);
        if (!variations.empty()) setAxes(mFace, variations, source.subject);
        if (!chooseSizes()) throw TextError(source.subject + "a font without outlines");
        measure();
        if (mLineHeight <= 0 || mAscender <= mDescender) {
            throw TextError(source.subject + "a font without vertical metrics");
        }
        mFamily = mFace->family_name == nullptr ? "unnamed" : mFace->family_name;
        mName = mFamily;
        if (mFace->style_name != nullptr) mName.append(" ").append(mFace->style_name);
    } catch (...) {
        FT_Done_FreeType(mLibrary);
        throw;
    }
}

/// A second face for the pictures of one that has outlines: each keeps its size. What has pictures in
/// Apple's table has outlines for FreeType only when the pictures are ignored.
void Font::openFaces(const Source& source) {
    const auto openFace = [&](FT_Face& face, std::vector<FT_Parameter> parameters) {
        FT_Open_Args arguments = source.arguments;
        arguments.flags |= FT_OPEN_PARAMS;
        arguments.num_params = static_cast<FT_Int>(parameters.size());
        arguments.params = parameters.data();
        if (FT_Open_Face(mLibrary, &arguments, source.faceIndex, &face) != 0) {
            throw TextError(source.subject + "no font that can be read");
        }
    };
    openFace(mFace, {});
    const bool hasPictures = FT_HAS_COLOR(mFace) && FT_HAS_FIXED_SIZES(mFace);
    if (!hasPictures) return;
    mPictures = mFace;
    if (FT_HAS_SBIX(mFace)) {
        openFace(mFace, {{FT_PARAM_TAG_IGNORE_SBIX, nullptr}});
    } else if (FT_IS_SCALABLE(mFace)) {
        openFace(mPictures, {});
    }
}

bool Font::chooseSizes() {
    if (mPictures != nullptr && !choosePictures()) return false;
    return !hasOutlines() ||
           (FT_IS_SCALABLE(mFace) && FT_Set_Pixel_Sizes(mFace, 0, static_cast<FT_UInt>(mSizePx)) == 0);
}

bool Font::choosePictures() {
    if (FT_Select_Size(mPictures, pictureSizeFor(mPictures, mSizePx)) != 0) return false;
    mPicturePpem = mPictures->size->metrics.y_ppem;
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

bool Font::has(uint32_t code) const {
    return FT_Get_Char_Index(mFace, code) != 0;
}

bool Font::isColour() const {
    return mPictures != nullptr || FT_HAS_COLOR(mFace);
}

}  // namespace voreltext
