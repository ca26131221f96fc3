#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "style.h"

namespace vorelpaint {

/// Reads a style file. Throws ToolError, naming the file.
Style loadStyle(const std::filesystem::path& path);

/// What a fault of a style from this file begins with: "style 'FILE': ", nothing without a file.
std::string faultPrefix(const std::filesystem::path& file);

/// The style file of a preset. Throws ToolError, listing the presets, when there is none.
std::filesystem::path findPreset(const std::string& name);

/// The names of all presets, sorted.
std::vector<std::string> presetNames();

}  // namespace vorelpaint
