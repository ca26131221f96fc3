#pragma once

#include "style/style.h"

namespace vorelstyle {

/// The style with its lengths multiplied: sizes and distances in pixels, rounded, those that were
/// above 0 to at least 1; patterns scale with them, from 0.1 up. A factor of 1 changes nothing. For text
/// smaller or larger than the style was designed for.
Style scaledStyle(Style style, float factor);

}  // namespace vorelstyle
