#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "text/voreltext.h"

namespace vorelcompose {

struct Background {
    enum class Kind { transparent, colour, checkerboard };
    Kind kind = Kind::transparent;
    uint32_t colour = 0;  ///< 0xRRGGBB
};

/// Reads "transparent", "checkerboard" or a colour; nothing for anything else.
std::optional<Background> parseBackground(std::string_view text);

/// Lays a premultiplied picture on the background; the result is straight, as a PNG stores it.
void layOn(voreltext::Image& image, const Background& background);

/// The same with the rows from `top` on and above `bottom`.
void layOn(voreltext::Image& image, const Background& background, int top, int bottom);

}  // namespace vorelcompose
