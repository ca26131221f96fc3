#pragma once

#include <optional>
#include <string_view>

namespace vorelstyle {

/// A size or a distance of a style.
struct Length {
    enum class Unit {
        pixels,
        percent  ///< of the size of the font: a share, which resolvedStyle turns into pixels
    };

    float value = 0;
    Unit unit = Unit::pixels;

    bool operator==(const Length& other) const { return value == other.value && unit == other.unit; }
};

/// Reads "4px" or "4%". One spelling: a minus sign if any, digits without needless zeros in front, and
/// behind a point one to three more; nothing else around them, in any locale. Nothing for other text.
std::optional<Length> parseLength(std::string_view text);

}  // namespace vorelstyle
