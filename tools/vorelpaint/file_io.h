#pragma once

#include <cstddef>
#include <cstdio>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>

namespace vorelpaint {

/// The bytes of a file, or of standard input for "-". Throws ComposeError when it cannot be read or
/// is longer than `maxBytes`.
std::string readFileOrInput(const std::string& path, size_t maxBytes);

/// The open file of this process, by its number, whose name a path is: /dev/fd/3.
std::optional<int> openFileOf(const std::filesystem::path& path);

/// The path that the symbolic links of a path lead to, which may not be there yet; that of an open file
/// where they come by one, as /dev/stdout does. Throws ToolError.
std::filesystem::path followLinks(std::filesystem::path path);

/// Whether a path, "-" or such as /dev/stdout, is standard output. Throws ToolError.
bool isStandardOutput(const std::string& path);

/// Lets `write` fill a NewFile, which takes the name `path` when it is whole. The target of a symbolic
/// link is made or replaced, not the link. "-" is standard output; a device or a pipe is written
/// directly, and an open file under such a name as /dev/stdout from its place on. Throws ToolError.
void writeFile(const std::string& path, const std::function<void(std::FILE*)>& write);
void writeFile(const std::string& path, const std::vector<uint8_t>& bytes);

/// Throws ToolError.
void writeAll(std::FILE* file, const std::vector<uint8_t>& bytes);

}  // namespace vorelpaint
