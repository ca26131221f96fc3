#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "style/note.h"
#include "style/style.h"

namespace vorelstyle {

/// What the library paints patterns with.
constexpr float kSmallestPatternScale = 0.1F;
constexpr float kLargestPatternScale = 10;

/// What a note says of a scale beyond them: " is more than the library's 10; painted with 10".
std::string beyondScale(float asked, float painted);

/// A colour picture: packed rows of four bytes a pixel.
struct PatternImage {
    int width = 0;
    int height = 0;
    std::vector<uint8_t> pixels;
};

/// Gives the picture that a style names in its pattern: straight R, G, B, A. Throws StyleError with what
/// is wrong with the picture; the style's name and the path of the key are put before it.
using LoadImage = std::function<PatternImage(const std::string& image)>;

/// The picture of a pattern as the library takes it: A, R, G, B. Throws StyleError when `load` is empty,
/// fails, or gives a picture without its pixels.
PatternImage patternImage(const Pattern& pattern, const LoadImage& load);

/// The scale that a resolved pattern is painted with: its own, or that at which the picture's columns
/// make a tile of its width, within the library's 0.1 to 10. `note` gets a line where they do not
/// suffice.
float patternScale(const Pattern& pattern, const PatternImage& image, const Note& note);

}  // namespace vorelstyle
