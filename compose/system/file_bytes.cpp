#include "compose/system/file_bytes.h"

#include <cerrno>
#include <cstring>
#include <memory>

#include "compose/error.h"

namespace vorelcompose {
namespace {

struct Closer {
    void operator()(std::FILE* file) const { std::fclose(file); }
};
using File = std::unique_ptr<std::FILE, Closer>;

/// With the system's reason, which errno holds.
[[noreturn]] void failToRead(const std::string& name) {
    throw ComposeError("cannot read " + name + ": " + std::strerror(errno));
}

}  // namespace

std::string readFile(const std::string& path, size_t maxBytes) {
    const std::string name = "'" + path + "'";
    const File file(std::fopen(path.c_str(), "rb"));
    if (!file) failToRead(name);
    return readAll(file.get(), name, maxBytes);
}

std::string readAll(std::FILE* file, const std::string& name, size_t maxBytes) {
    std::string bytes(maxBytes + 1, '\0');
    bytes.resize(std::fread(bytes.data(), 1, bytes.size(), file));
    if (std::ferror(file) != 0) failToRead(name);
    if (bytes.size() > maxBytes) {
        throw ComposeError(name + " is longer than " + std::to_string(maxBytes) + " bytes");
    }
    return bytes;
}

}  // namespace vorelcompose
