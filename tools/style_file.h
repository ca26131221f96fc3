#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "style.h"

namespace vorelpaint {

/// Reads a style file. Throws ToolError, naming the file.
Style loadStyle(const std::filesystem::path& path);

/// The style file of a preset. Throws ToolError, listing the presets, when there is none.
std::filesystem::path findPreset(const std::string& name);

/// The names of all presets, sorted.
std::vector<std::string> presetNames();

}  // namespace vorelpaint
