#include "background.h"

#include <algorithm>

#include "style/vorelstyle.h"

namespace vorelpaint {
namespace {

constexpr int kSquare = 8;
constexpr uint32_t kLightSquare = 0xFFFFFF;
constexpr uint32_t kDarkSquare = 0xCCCCCC;

uint8_t channelOf(uint32_t colour, int channel) {
    return static_cast<uint8_t>(colour >> (16 - 8 * channel));
}

void unpremultiply(uint8_t* pixel) {
    const unsigned int alpha = pixel[3];
    if (alpha == 0 || alpha == 255) return;
    for (int c = 0; c < 3; ++c) {
        pixel[c] = static_cast<uint8_t>(std::min(255U, (pixel[c] * 255U + alpha / 2) / alpha));
    }
}

void flatten(uint8_t* pixel, uint32_t colour) {
    const unsigned int rest = 255U - pixel[3];
    for (int c = 0; c < 3; ++c) {
        const unsigned int under = (channelOf(colour, c) * rest + 127U) / 255U;
        pixel[c] = static_cast<uint8_t>(std::min(255U, pixel[c] + under));
    }
    pixel[3] = 255;
}

uint32_t squareAt(int x, int y) {
    return (x / kSquare + y / kSquare) % 2 == 0 ? kLightSquare : kDarkSquare;
}

}  // namespace

std::optional<Background> parseBackground(std::string_view text) {
    if (text == "transparent") return Background{};
    if (text == "checkerboard") return Background{Background::Kind::checkerboard, 0};
    const std::optional<uint32_t> colour = vorelstyle::parseColour(text);
    if (!colour) return std::nullopt;
    return Background{Background::Kind::colour, *colour};
}

void layOn(voreltext::Image& image, const Background& background) {
    layOn(image, background, 0, image.height);
}

void layOn(voreltext::Image& image, const Background& background, int top, int bottom) {
    uint8_t* pixel =
        image.pixels.data() + static_cast<size_t>(top) * static_cast<size_t>(image.width) * 4;
    for (int y = top; y < bottom; ++y) {
        for (int x = 0; x < image.width; ++x, pixel += 4) {
            switch (background.kind) {
                case Background::Kind::transparent:
                    unpremultiply(pixel);
                    break;
                case Background::Kind::colour:
                    flatten(pixel, background.colour);
                    break;
                case Background::Kind::checkerboard:
                    flatten(pixel, squareAt(x, y));
                    break;
            }
        }
    }
}

}  // namespace vorelpaint
