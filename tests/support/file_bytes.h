#pragma once

#include <cstdio>
#include <optional>
#include <string>

/// Files of the tests. By C's functions: there are C++ libraries without streams of files.
namespace vorel_test {

/// All bytes of a file; nothing when it cannot be read.
inline std::optional<std::string> bytesOfFile(const std::string& path) {
    std::FILE* const file = std::fopen(path.c_str(), "rb");
    if (file == nullptr) return std::nullopt;
    std::string bytes;
    char block[4096];
    for (size_t got = 0; (got = std::fread(block, 1, sizeof block, file)) > 0;)
        bytes.append(block, got);
    const bool failed = std::ferror(file) != 0;
    std::fclose(file);
    if (failed) return std::nullopt;
    return bytes;
}

}  // namespace vorel_test
