#pragma once

#include <cstdint>
#include <functional>
#include <optional>

#include "text/run.h"
#include "text/text_layout.h"

namespace voreltext {

/// A picture, and the place in it of the text's origin, where its first baseline begins.
struct Canvas {
    int width;
    int height;
    int x;  ///< may lie outside, and beyond kFarAway counts as there
    int y;
};

/// Farther from a picture than any text reaches.
constexpr int kFarAway = 1 << 30;

/// The place, or the nearest one within kFarAway.
int notTooFar(int64_t place);

/// Which part of the canvas a text's box stands at.
enum class Anchor { topLeft, top, topRight, left, center, right, bottomLeft, bottom, bottomRight };

/// What is asked of a picture, in pixels.
struct CanvasRequest {
    std::optional<int> width;  ///< without one the canvas is as wide as the box and its effects need
    std::optional<int> height;
    Anchor anchor = Anchor::center;
    int margin = 0;   ///< between the box and each edge of a width or height that is asked for
    int padding = 0;  ///< around the box and its effects, where none is
};

/// The room within the margins, at least 1 x 1; nothing for a side that is not asked for. Throws
/// TextError when the margins leave none.
struct Room {
    std::optional<int> width;
    std::optional<int> height;

    bool holds(const Box& box) const;
};
Room roomOf(const CanvasRequest& request);

/// Where a text whose box is `box` stands, with the pixels `effects` around it. In a width or height
/// that is asked for the box stands at the anchor, an odd pixel on its right or below, and the effects
/// reach into the margin; it may be larger than its room. Throws TextError for a picture that is too
/// large, or of a negative size.
Canvas placedOn(const CanvasRequest& request, const Box& box, const Margins& effects);

/// The largest whole size from 1 to `size` that fits. `fits` is asked for some of them, and it is taken
/// that below a size that fits all do. Nothing when not even 1 fits.
std::optional<int> largestThatFits(int size, const std::function<bool(int)>& fits);

}  // namespace voreltext
