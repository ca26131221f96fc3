#pragma once

#include <string>
#include <vector>

#include "text/font.h"

namespace voreltext {

/// Moves a variable font to a place on its axes. Throws TextError, which begins with `subject`, when the
/// font has no such axis or the value is beyond the axis's range; it names those that there are.
void setAxes(FT_FaceRec_* face, const std::vector<FontVariation>& variations,
             const std::string& subject);

}  // namespace voreltext
