#pragma once

#include <cstdint>
#include <vector>

#include "png_rows.h"

namespace vorelpaint {

struct DeflatedPixels {
    std::vector<uint8_t> stream;  ///< zlib's (RFC 1950)
    bool isBetterFiltered;        ///< whether filters probably make it smaller
};

/// Compresses rows as they are, without filters.
///
/// Pictures of text repeat whole pixels: runs of one colour, the row above, edges seen before. Here they
/// are looked for pixel by pixel rather than byte by byte, in four places: the pixel before, the one
/// above, and where this pixel, or this and the next one, was last. One pass finds them and counts what
/// there is; each block of them then has codes of its own. Rows have fewer than 2^32 pixels in all.
DeflatedPixels deflatedPixels(const PngRows& rows);

}  // namespace vorelpaint
