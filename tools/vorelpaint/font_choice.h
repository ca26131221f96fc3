#pragma once

#include <string>

#include "compose/system/system_font_source.h"
#include "text/voreltext.h"

/// Where fonts are found. For several threads at a time.
namespace vorelpaint {

/// The fonts of files and those that are installed, for the whole program.
vorelcompose::SystemFontSource& fontSource();

/// Reads what fontconfig knows, unless it has been read: at the latest when a family is asked for. While
/// it does, nothing else may write to standard error.
void loadInstalledFonts();

/// The font that `request` names: a file, or a family as fontconfig writes it ("DejaVu Serif",
/// "DejaVu Sans:bold"). Throws ComposeError or TextError when there is no such file or family.
voreltext::FontFile findFont(const std::string& request);

}  // namespace vorelpaint
