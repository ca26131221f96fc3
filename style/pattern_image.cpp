#include "style/pattern_image.h"

#include <algorithm>
#include <cmath>

#include "style/error.h"

namespace vorelstyle {
namespace {

PatternImage loaded(const std::string& image, const LoadImage& load) {
    if (!load) throw StyleError("there is nothing to load '" + image + "' with");
    PatternImage picture = load(image);
    const bool sized = picture.width >= 0 && picture.height >= 0;
    const auto width = static_cast<size_t>(picture.width);
    const auto height = static_cast<size_t>(picture.height);
    if (!sized || picture.pixels.size() / 4 != width * height || picture.pixels.size() % 4 != 0) {
        throw StyleError("'" + image + "' has another size than its pixels");
    }
    return picture;
}

/// The scale at which so many columns make a tile of this width. The library cuts the product to whole
/// pixels, which a quotient that was rounded down would leave one short.
float scaleOf(float width, float columns) {
    const float scale = width / columns;
    return scale * columns < width ? std::nextafter(scale, kLargestPatternScale) : scale;
}

}  // namespace

std::string beyondScale(float asked, float painted) {
    const std::string limit = spelled(painted);
    return (asked > painted ? " is more than the library's " : " is less than the library's ") + limit +
           "; painted with " + limit;
}

PatternImage patternImage(const Pattern& pattern, const LoadImage& load) {
    return withFaultsUnder("pattern.image: ", [&] {
        PatternImage image = loaded(pattern.image, load);
        for (size_t at = 0; at < image.pixels.size(); at += 4) {
            std::rotate(&image.pixels[at], &image.pixels[at + 3], &image.pixels[at] + 4);
        }
        return image;
    });
}

float patternScale(const Pattern& pattern, const PatternImage& image, const Note& note) {
    if (!pattern.width) return pattern.scale;
    const float width = pattern.width->value;
    if (image.width == 0) return 1;  // paints nothing
    const float asked = scaleOf(width, static_cast<float>(image.width));
    const float scale = std::clamp(asked, kSmallestPatternScale, kLargestPatternScale);
    if (asked != scale) {
        note("pattern.width: " + spelled(width) + " pixels of a picture of " +
             std::to_string(image.width) + " are a scale of " + spelled(asked) + ", which" +
             beyondScale(asked, scale));
    }
    return scale;
}

}  // namespace vorelstyle
