#pragma once

#include <filesystem>
#include <string>
#include <vector>

/// The presets are the style files of one directory, with the pictures of their patterns: style/presets,
/// or where they are installed.
namespace vorelcompose {

/// The names of the presets in a directory, sorted. Throws StyleError when it cannot be read.
std::vector<std::string> presetNames(const std::filesystem::path& directory);

/// The style file of a preset in a directory. Throws StyleError, listing the presets, when there is
/// none.
std::filesystem::path presetFile(const std::filesystem::path& directory, const std::string& name);

}  // namespace vorelcompose
