#include "compose/background.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstring>
#include <vector>

#include "style/vorelstyle.h"

namespace vorelcompose {
namespace {

constexpr int kSquare = 8;
constexpr uint32_t kLightSquare = 0xFFFFFF;
constexpr uint32_t kDarkSquare = 0xCCCCCC;

uint8_t channelOf(uint32_t colour, int channel) {
    return static_cast<uint8_t>(colour >> (16 - 8 * channel));
}

/// For each alpha and channel the value with the alpha divided out, rounded to nearest and at most 255.
class StraightChannels {
  public:
    StraightChannels() : mValues(size_t{256} * 256) {
        for (unsigned int alpha = 1; alpha < 256; ++alpha) {
            for (unsigned int channel = 0; channel < 256; ++channel) {
                const unsigned int straight = (channel * 255U + alpha / 2) / alpha;
                mValues[alpha * 256 + channel] = static_cast<uint8_t>(std::min(255U, straight));
            }
        }
    }

    const uint8_t* of(uint8_t alpha) const { return &mValues[size_t{alpha} * 256]; }

  private:
    std::vector<uint8_t> mValues;
};

void straightenEach(uint8_t* pixels, size_t count) {
    static const StraightChannels kStraight;
    for (uint8_t* pixel = pixels; pixel != pixels + 4 * count; pixel += 4) {
        if (pixel[3] == 255) continue;
        const uint8_t* straight = kStraight.of(pixel[3]);
        for (int c = 0; c < 3; ++c)
            pixel[c] = straight[pixel[c]];
    }
}

/// Clear pixels become one value, whatever they were: equal pixels are small in a file. Most have it
/// already, and most of a picture of text is clear.
void straighten(uint8_t* pixels, size_t count) {
    constexpr size_t kAtOnce = 16;
    constexpr std::array<uint8_t, 4 * kAtOnce> kClear{};
    for (size_t at = 0; at < count; at += kAtOnce) {
        const size_t some = std::min(kAtOnce, count - at);
        if (std::memcmp(pixels + 4 * at, kClear.data(), 4 * some) != 0)
            straightenEach(pixels + 4 * at, some);
    }
}

/// A colour as it shows through pixels, by their alpha.
class ColourBeneath {
  public:
    explicit ColourBeneath(uint32_t colour) {
        for (unsigned int alpha = 0; alpha < 256; ++alpha) {
            for (int c = 0; c < 3; ++c) {
                const unsigned int shown = (channelOf(colour, c) * (255U - alpha) + 127U) / 255U;
                mShown[alpha][static_cast<size_t>(c)] = static_cast<uint8_t>(shown);
            }
        }
    }

    void layUnder(uint8_t* pixels, size_t count) const {
        for (uint8_t* pixel = pixels; pixel != pixels + 4 * count; pixel += 4) {
            const std::array<uint8_t, 4>& shown = mShown[pixel[3]];
            for (size_t c = 0; c < 3; ++c)
                pixel[c] = static_cast<uint8_t>(std::min(255, pixel[c] + shown[c]));
            pixel[3] = 255;
        }
    }

  private:
    std::array<std::array<uint8_t, 4>, 256> mShown{};
};

/// Squares of two colours.
void layOnCheckerboard(voreltext::Image& image, int top, int bottom) {
    const std::array<ColourBeneath, 2> colours{ColourBeneath(kLightSquare), ColourBeneath(kDarkSquare)};
    uint8_t* pixel = image.pixels.data() + offsetOf(image, 0, top);
    for (int y = top; y < bottom; ++y) {
        for (int x = 0; x < image.width; x += kSquare) {
            const auto count = static_cast<size_t>(std::min(kSquare, image.width - x));
            colours[static_cast<size_t>((x / kSquare + y / kSquare) % 2)].layUnder(pixel, count);
            pixel += 4 * count;
        }
    }
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
    uint8_t* pixels = image.pixels.data() + offsetOf(image, 0, top);
    const size_t count = (offsetOf(image, 0, bottom) - offsetOf(image, 0, top)) / 4;
    switch (background.kind) {
        case Background::Kind::transparent:
            return straighten(pixels, count);
        case Background::Kind::colour:
            return ColourBeneath(background.colour).layUnder(pixels, count);
        case Background::Kind::checkerboard:
            return layOnCheckerboard(image, top, bottom);
    }
}

}  // namespace vorelcompose
