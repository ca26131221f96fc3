#pragma once

#include <optional>
#include <string>

#include "text/voreltext.h"

/// Where fonts are found. For several threads at a time.
namespace vorelpaint {

/// Reads what fontconfig knows, unless it has been read: at the latest when a family is asked for. While
/// it does, nothing else may write to standard error.
void loadInstalledFonts();

/// Whether a request names a file, be it there or not, and no family.
bool namesFontFile(const std::string& request);

/// The font that `request` names: a file, or a family as fontconfig writes it ("DejaVu Serif",
/// "DejaVu Sans:bold"). Throws ToolError or TextError when there is no such file or family.
voreltext::FontFile findFont(const std::string& request);

/// An installed font that has all characters of a cluster, in a style like that of the main font;
/// nothing when there is none.
std::optional<voreltext::FontFile> findFontFor(const voreltext::Cluster& cluster,
                                               const voreltext::FontFile& main);

}  // namespace vorelpaint
