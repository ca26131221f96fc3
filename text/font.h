#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

struct FT_FaceRec_;
struct FT_LibraryRec_;

namespace voreltext {

struct FontFile {
    std::string path;
    long faceIndex = 0;  ///< which of the file's fonts
};

/// A font file's bytes. They are not copied: whoever hands them over keeps them.
struct FontBytes {
    const uint8_t* data;
    size_t size;
    long faceIndex = 0;
};

/// The place of a variable font on one of its axes.
struct FontVariation {
    std::string axis;  ///< its tag, such as "wght"
    float value;       ///< in the axis's own units, 700 for a bold weight
};

/// An open font at one size. For one thread at a time, with all that is laid out in it.
class Font {
  public:
    /// `sizePx` is the size of the em in pixels, 1 to kMostSize. Axes that are not named stay as the
    /// font has them; of one that is named twice the last value counts. Throws TextError when the file
    /// is no font with outlines or pictures in colour, when it has no vertical metrics, when it has no
    /// such axis or the value is beyond the axis's range, and for a size out of its own.
    Font(const FontFile& file, int sizePx, const std::vector<FontVariation>& variations = {});

    /// The same of bytes, which must outlive the font.
    Font(const FontBytes& bytes, int sizePx, const std::vector<FontVariation>& variations = {});

    static constexpr int kMostSize = 16384;

    ~Font();
    Font(Font&& other) noexcept;
    Font& operator=(Font&& other) noexcept;
    Font(const Font&) = delete;
    Font& operator=(const Font&) = delete;

    int sizePx() const { return mSizePx; }
    const std::string& name() const { return mName; }  ///< family and style, "DejaVu Sans Bold"
    const std::string& family() const { return mFamily; }

    /// The font's own, for its size, in 64ths of a pixel and whole pixels: how far its letters reach
    /// above the baseline, below it (negative), and from one baseline to the next.
    long ascender() const { return mAscender; }
    long descender() const { return mDescender; }
    long lineHeight() const { return mLineHeight; }

    bool has(uint32_t code) const;  ///< whether it has a glyph for the character
    bool isColour() const;          ///< whether some of its glyphs have colours of their own
    bool hasOutlines() const { return mPictures != mFace; }  ///< else all of its glyphs are pictures

    /// FreeType's own: the face, and the face with the pictures, which are of one size; null without,
    /// and the same where there is nothing else.
    FT_FaceRec_* face() const { return mFace; }
    FT_FaceRec_* pictures() const { return mPictures; }
    int picturePpem() const { return mPicturePpem; }  ///< pixels of the em of the pictures, 0 without

    /// A length of the face, as FreeType and shapers tell it, in the font's size.
    int64_t scaled(int64_t units) const;

  private:
    struct Source;

    void open(const Source& source, const std::vector<FontVariation>& variations);
    void openFaces(const Source& source);
    bool chooseSizes();
    bool choosePictures();
    void measure();

    FT_LibraryRec_* mLibrary = nullptr;
    FT_FaceRec_* mFace = nullptr;
    FT_FaceRec_* mPictures = nullptr;
    int mPicturePpem = 0;
    int mSizePx;
    std::string mName;
    std::string mFamily;
    long mAscender = 0;
    long mDescender = 0;
    long mLineHeight = 0;
};

}  // namespace voreltext
