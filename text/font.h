#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

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

/// An open font at one size. For one thread at a time, with all that is laid out in it.
class Font {
  public:
    /// `sizePx` is the size of the em in pixels, at least 1. Throws TextError when the file is no font
    /// with outlines.
    Font(const FontFile& file, int sizePx);

    /// The same of bytes, which must outlive the font.
    Font(const FontBytes& bytes, int sizePx);

    ~Font();
    Font(const Font&) = delete;
    Font& operator=(const Font&) = delete;

    long lineHeight() const;                     ///< in 64ths of a pixel
    FT_FaceRec_* face() const { return mFace; }  ///< FreeType's own

  private:
    template <typename Open>
    void open(int sizePx, const std::string& subject, Open openFace);

    FT_LibraryRec_* mLibrary = nullptr;
    FT_FaceRec_* mFace = nullptr;
};

}  // namespace voreltext
