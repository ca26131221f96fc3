#pragma once

#include <cstddef>
#include <cstdio>
#include <filesystem>
#include <functional>
#include <string>

namespace vorelpaint {

/// The bytes of a file, or of standard input for "-". Throws ToolError when it cannot be read or is
/// longer than `maxBytes`.
std::string readFile(const std::string& path, size_t maxBytes);

/// The path that the symbolic links of a path lead to, which may not be there yet. Throws ToolError.
std::filesystem::path followLinks(std::filesystem::path path);

/// Lets `write` fill a NewFile, which takes the name `path` when it is whole. The target of a symbolic
/// link is made or replaced, not the link. "-" is standard output; a device or a pipe is written
/// directly. Throws ToolError.
void writeFile(const std::string& path, const std::function<void(std::FILE*)>& write);

}  // namespace vorelpaint
