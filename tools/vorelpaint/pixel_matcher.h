#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "png_rows.h"

namespace vorelpaint {

/// A repetition of pixels that came before.
struct PixelMatch {
    size_t length = 0;    ///< in pixels; 0 where nothing repeats
    size_t distance = 0;  ///< in bytes of the file's rows, as deflate counts it
};

/// Finds where pixels repeat, from at most 32 KiB before, as far as deflate can tell, and within one row
/// on either side.
class PixelMatcher {
  public:
    /// The rows must outlive it; they have fewer than 2^32 pixels.
    explicit PixelMatcher(const PngRows& rows);

    /// The longest repetition that it finds at a pixel, among those of pixels that it was shown, of the
    /// pixel before and of the row above.
    PixelMatch at(size_t x, size_t y) const;

    /// Remembers where a pixel is. They are to be shown in their order; some may be left out.
    void show(size_t x, size_t y);

  private:
    size_t slotOfOne(size_t x, size_t y) const;
    size_t slotOfTwo(size_t x, size_t y) const;
    bool tryPlace(PixelMatch& best, uint32_t place, size_t x, size_t y) const;
    void tryPlaces(PixelMatch& best, size_t x, size_t y) const;

    PngRows mRows;
    int mShift;
    std::vector<uint32_t> mOfOne;   ///< by a pixel where it was last
    std::vector<uint32_t> mOfTwo;   ///< by two pixels in a row where they were last ...
    std::vector<uint32_t> mBefore;  ///< ... and by such a place where they were before
};

}  // namespace vorelpaint
