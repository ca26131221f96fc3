#include "style/pattern_image.h"

#include <algorithm>

#include "style/error.h"
#include "style/message.h"

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

}  // namespace

PatternImage patternImage(const Style& style, const Pattern& pattern, const LoadImage& load) {
    try {
        PatternImage image = loaded(pattern.image, load);
        for (size_t at = 0; at < image.pixels.size(); at += 4) {
            std::rotate(&image.pixels[at], &image.pixels[at + 3], &image.pixels[at] + 4);
        }
        return image;
    } catch (const StyleError& error) {
        throw StyleError(faultPrefix(style.name) + "pattern.image: " + error.what());
    }
}

}  // namespace vorelstyle
