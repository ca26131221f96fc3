#pragma once

#include <string>

#include "text/voreltext.h"

namespace vorelpaint {

/// The font that `request` names: a file, or a family as fontconfig writes it ("DejaVu Serif",
/// "DejaVu Sans:bold"). Throws ToolError or TextError when there is no such file or family.
voreltext::FontFile findFont(const std::string& request);

}  // namespace vorelpaint
