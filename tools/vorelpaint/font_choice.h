#pragma once

#include <optional>
#include <string>

#include "text/voreltext.h"

namespace vorelpaint {

/// The font that `request` names: a file, or a family as fontconfig writes it ("DejaVu Serif",
/// "DejaVu Sans:bold"). Throws ToolError or TextError when there is no such file or family.
voreltext::FontFile findFont(const std::string& request);

/// An installed font that has all characters of a cluster, in a style like that of the main font;
/// nothing when there is none.
std::optional<voreltext::FontFile> findFontFor(const voreltext::Cluster& cluster,
                                               const voreltext::FontFile& main);

}  // namespace vorelpaint
