#pragma once

#include <cstddef>
#include <cstdio>
#include <string>

namespace vorelcompose {

/// The bytes of a file. Throws ComposeError when it cannot be read or is longer than `maxBytes`.
std::string readFile(const std::string& path, size_t maxBytes);

/// The same of what is left of an open file, which messages call `name`.
std::string readAll(std::FILE* file, const std::string& name, size_t maxBytes);

}  // namespace vorelcompose
