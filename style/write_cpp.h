#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "style/pattern_image.h"
#include "style/style.h"

namespace vorelstyle {

/// A C++17 source that makes the library calls of a resolved style. One look that is not moved,
/// of the whole block, is one function, `name`; else there is a function for each look, `name` with its
/// number from 1 on, and the array `name` + "Looks", which tells them in the order of painting with
/// their offsets and spans, and how they are painted. The pictures are those of the Stack of the same
/// style, fill (0xRRGGBB), text opacity and pattern pictures. Throws StyleError as Stack does, and for a
/// pattern with a picture too large to be written out.
std::string writtenAsCpp(const std::string& name, const Style& style, std::optional<uint32_t> fill = {},
                         std::optional<float> textOpacity = {}, const LoadImage& load = {});

/// The name of that function for a style of this name: "addPaperCut" for "paper-cut".
std::string functionName(const std::string& look);

}  // namespace vorelstyle
