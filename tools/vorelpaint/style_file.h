#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "compose/system/style_files.h"
#include "options.h"
#include "style/vorelstyle.h"

namespace vorelpaint {

/// The file of the style that is asked for; nothing where it stands in a job, or nowhere. Throws
/// ToolError or StyleError.
std::optional<std::filesystem::path> chosenStyleFile(const Options& options);

/// The style that is asked for, as its file has it, which may be "-" for standard input; an empty one
/// when none is. Throws ToolError, ComposeError or StyleError.
vorelstyle::Style chosenStyle(const Options& options);

/// The same with the pictures of its patterns; the style of a file may come from the shelf.
FoundStyle chosenStyle(const Options& options, StyleShelf& shelf);

/// The looks of that style for text of the size that is asked for, with such colours of its markup.
LayerSet looksOf(const Options& options, const std::vector<vorelstyle::ColourRange>& colours,
                 const Note& note);

/// The style file of a preset. Throws StyleError, listing the presets, when there is none, and ToolError
/// without a directory of presets.
std::filesystem::path findPreset(const std::string& name);

/// The names of all presets, sorted. Throws ToolError without a directory of presets.
std::vector<std::string> presetNames();

}  // namespace vorelpaint
