#pragma once

#include <cstddef>

#include "compose/composition.h"
#include "text/voreltext.h"

/// Pictures of what the steps of painting do, to look at: of the size of the canvas and premultiplied,
/// each look where it stands. `look` is a position in the stack, 0 the lowest. Each throws TextError as
/// Composition::paint.
namespace vorelcompose {

/// The coverage of the glyphs, in white.
voreltext::Image coveragePicture(const Composition& composition, size_t look);

/// One effect alone, by its position in the plan of the look, and cut as the run cuts it: what is on the
/// text, and the fill, to the coverage of the glyphs; what is outside the text to what they leave.
///
/// In a look that is not layered, painted as one block, the pictures make the whole, but for the
/// rounding of each. From the topmost on, with the coverage c and the alpha a of what is above: a
/// picture P on the text adds P * (1 - a / c), the fill the same times c where anything is above it, and
/// a picture beneath the text adds P * (1 - a).
voreltext::Image effectPicture(const Composition& composition, size_t look, size_t effect);

/// What the colours of a font are, where the look takes them: the pictures of its glyphs.
voreltext::Image fontPicture(const Composition& composition, size_t look);

/// The look as a whole, without the other ones.
voreltext::Image lookPicture(const Composition& composition, size_t look);

}  // namespace vorelcompose
