#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "style/vorelstyle.h"

namespace vorelpaint {

/// Reads a style file; "-" is standard input. Throws ToolError when it cannot be read, StyleError,
/// naming the file, when it is wrong.
vorelstyle::Style loadStyle(const std::filesystem::path& path);

/// Loads the pictures of a style from PNG files, whose paths start beside the style's own file.
vorelstyle::LoadImage imagesOf(const vorelstyle::Style& style);

/// The style file of a preset. Throws StyleError, listing the presets, when there is none, and ToolError
/// without a directory of presets.
std::filesystem::path findPreset(const std::string& name);

/// The names of all presets, sorted. Throws ToolError without a directory of presets.
std::vector<std::string> presetNames();

}  // namespace vorelpaint
