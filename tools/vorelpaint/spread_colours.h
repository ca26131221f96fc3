#pragma once

#include "text/voreltext.h"

namespace vorelpaint {

/// Gives each clear pixel that is at most `reach` steps (left, right, up or down), from 1 to 254, away
/// from one that is not the colour of the nearest such; it stays clear. The picture is straight R, G, B,
/// A.
///
/// What halves the planes of colour, or stores waves of it, mixes the colours of neighbours whatever
/// their alpha: the black of clear pixels would darken the edges of a text.
void spreadColours(voreltext::Image& image, int reach);

}  // namespace vorelpaint
