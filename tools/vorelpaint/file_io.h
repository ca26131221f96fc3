#pragma once

#include <cstddef>
#include <cstdio>
#include <functional>
#include <string>

namespace vorelpaint {

/// The bytes of a file, or of standard input for "-". Throws ToolError when it cannot be read or is
/// longer than `maxBytes`.
std::string readFile(const std::string& path, size_t maxBytes);

/// Lets `write` fill a temporary file beside `path`, which then takes the name `path` in one step:
/// after a failure nothing is left and an older file is untouched. A replaced file's permissions stay.
/// The target of a symbolic link is made or replaced, not the link. "-" is standard output; a device or
/// a pipe is written directly. Throws ToolError.
void writeFile(const std::string& path, const std::function<void(std::FILE*)>& write);

}  // namespace vorelpaint
