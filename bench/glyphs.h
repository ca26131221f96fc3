#pragma once

#include <vector>

#include "workload.h"

/// Where the glyphs of a workload come from: its font, or a file of them where there is no FreeType.
namespace vorel_bench {

/// Those with coverage, in their places on the baseline 0. A font or a file that cannot be read ends the
/// process.
std::vector<Glyph> glyphsOf(const Workload& workload);

}  // namespace vorel_bench
