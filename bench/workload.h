#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace vorel_bench {

/// The coverage of one glyph and where it stands in the mask.
struct Glyph {
    int x;
    int y;
    int width;
    int height;
    std::vector<uint8_t> coverage;
};

/// What is decorated: coverage cropped to its extents, whole and glyph by glyph.
struct Workload {
    std::string name;
    std::string text;  ///< empty where no font is used
    std::string font;
    int sizePx = 0;
    int width = 0;
    int height = 0;
    std::vector<uint8_t> mask;  ///< overlapping glyphs keep the larger coverage
    std::vector<Glyph> glyphs;  ///< those with coverage

    /// Pixels of the mask grown by `margin` on each side.
    int64_t grownPixels(int margin) const {
        return (int64_t{width} + 2 * margin) * (int64_t{height} + 2 * margin);
    }
};

/// Makes the mask of the glyphs.
void mergeGlyphs(Workload& workload);

const Workload& line48();    ///< "Summer Sale: 50% Off Everything!" at 48 pixels
const Workload& title160();  ///< "Typefaces", bold, at 160 pixels
const Workload& glyph48();   ///< "R" at 48 pixels
const Workload& noise();     ///< uniform random coverage, 512 x 128

}  // namespace vorel_bench
