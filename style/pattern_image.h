#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "style/style.h"

namespace vorelstyle {

/// A colour picture: packed rows of four bytes a pixel.
struct PatternImage {
    int width = 0;
    int height = 0;
    std::vector<uint8_t> pixels;
};

/// Gives the picture that a style names in its pattern: straight R, G, B, A. Throws StyleError with what
/// is wrong with the picture; the style's name and the key are put before it.
using LoadImage = std::function<PatternImage(const std::string& image)>;

/// The picture of a pattern as the library takes it: A, R, G, B. Throws StyleError when `load` is empty,
/// fails, or gives a picture without its pixels.
PatternImage patternImage(const Style& style, const Pattern& pattern, const LoadImage& load);

}  // namespace vorelstyle
