#pragma once

#include <iosfwd>
#include <string>

#include "style.h"

namespace vorelpaint {

/// Writes a C++ source with one function, `name`, that makes the library calls of the style: the picture
/// is the one that Look paints of the same style, fill (0xRRGGBB) and text opacity. Throws ToolError
/// when a pattern image cannot be read or is too large to be written out.
void writeCpp(std::ostream& out, const std::string& name, const Style& style, uint32_t fill,
              float textOpacity);

/// The name of that function for a look of this name: "addPaperCut" for "paper-cut".
std::string functionName(const std::string& look);

}  // namespace vorelpaint
