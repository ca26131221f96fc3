#pragma once

#include <vector>

#include "workload.h"

/// A page of 3840 x 2160 pixels, with the margins of a look, full of text in two sizes.
namespace vorel_bench {

/// A line of the page and where its extents begin.
struct PlacedLine {
    const Workload* line;
    int left;
    int top;
};

/// Rows of titles, each over rows of smaller lines, that begin further right from row to row.
std::vector<PlacedLine> posterLines();

const Workload& poster4k();  ///< "POSTER4K": the glyphs of all lines

}  // namespace vorel_bench
