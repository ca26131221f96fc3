#pragma once

#include <iosfwd>
#include <string>

#include "style/pattern_image.h"
#include "style/style.h"

namespace vorelstyle {

/// Writes a C++ source with one function, `name`, that makes the library calls of the style: the picture
/// is the one that Look paints of the same style, fill (0xRRGGBB), text opacity and pattern picture.
/// Throws StyleError when a pattern has no picture, or one too large to be written out.
void writeCpp(std::ostream& out, const std::string& name, const Style& style, uint32_t fill,
              float textOpacity, const LoadImage& load = {});

/// The name of that function for a look of this name: "addPaperCut" for "paper-cut".
std::string functionName(const std::string& look);

}  // namespace vorelstyle
