#pragma once

#include <initializer_list>
#include <string>
#include <vector>

#include "literal_image.h"
#include "random.h"

/// Coverage masks to paint from: the same on every run and every machine.
namespace vorel_test {

struct NamedMask {
    std::string name;
    literal::Mask mask;
};

/// Shapes drawn by hand and by formula, noise and single lines, from 1 x 1 to 300 x 200.
const std::vector<NamedMask>& maskGallery();

/// The glyphs of a rasterised line of text, laid into one mask. Read from the file that the
/// environment variable VOREL_GLYPH_MASKS names, else the compile definition of the same name; the
/// program in glyph_masks.cpp writes such a file. Where neither names one the mask is 0 x 0.
const literal::Mask& glyphLine();

literal::Mask filledMask(int width, int height, uint8_t coverage);

/// One string per row: '#' covers fully, '+' by 128, '-' by 1, anything else not at all.
literal::Mask maskFromRows(std::initializer_list<const char*> rows);

/// A disc; its rim is one pixel of falling coverage when `smooth`, else a hard edge.
literal::Mask discMask(int width, int height, float centreX, float centreY, float radius, bool smooth);

/// Every pixel random; `emptyPercent` of them are 0.
literal::Mask noiseMask(Random& random, int width, int height, int emptyPercent);

/// One of all the kinds above, with random parameters.
literal::Mask randomMask(Random& random, int width, int height);

/// Like no text: noise that is sparse or dense, ramps, and plateaus with grain.
literal::Mask unlikeText(Random& random, int width, int height);

}  // namespace vorel_test
