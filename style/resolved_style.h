#pragma once

#include "style/note.h"
#include "style/style.h"

namespace vorelstyle {

/// The farthest that a look is moved, in pixels.
constexpr int kMaxOffset = 32767;

/// The style with its lengths in pixels, for a font of `fontSizePx` pixels and multiplied by `scale`,
/// which makes the effects of any style larger or smaller. Both are above 0; `note` may be empty.
///
/// Lengths in pixels follow the scale alone: at 1 they stay as they are, fractions included, else they
/// are rounded, those above 0 to at least 1. Shares of the font's size come out in whole pixels,
///
///     value * fontSizePx / 100 * scale
///
/// to the nearest, halves away from zero. Above the library's 100 pixels either is 100, which is noted.
///
/// A share below 1 pixel would vanish or stay as strong as at 1, while the text around it gets smaller;
/// instead it fades. A stroke, a glow and the distance of a shadow are 1 pixel then, and the effect's
/// opacity is multiplied by the length: a stroke of 0.3 pixels is one of 1 pixel at 30 % of its opacity.
/// At 1 pixel that is the whole opacity, so there is no jump. A blur below half a pixel is rounded away,
/// and the shadow is hard; a shadow whose distance is 0 in the file keeps it, with its opacity. The
/// stops of a glow keep theirs, as the effect's opacity counts for all of them.
///
/// A tile's width is rounded, to 1 pixel at least; a pattern's scale is multiplied within the library's
/// 0.1 to 10, else noted. Offsets are rounded in either unit; beyond kMaxOffset they are cut, and noted.
Style resolvedStyle(Style style, int fontSizePx, float scale, const Note& note = {});

/// Throws StyleError, naming the length, when an effect of the look has one that is still a share.
void requireResolved(const LookStyle& look);

}  // namespace vorelstyle
