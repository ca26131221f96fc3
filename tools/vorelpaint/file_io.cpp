#include "file_io.h"

#include <memory>

#include "error.h"
#include "new_file.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

constexpr int kMaxLinks = 40;

struct Closer {
    void operator()(std::FILE* file) const {
        if (file != stdin) std::fclose(file);
    }
};
using File = std::unique_ptr<std::FILE, Closer>;

/// Writes through `write` and makes sure that every byte reached the system.
void fill(std::FILE* file, const std::string& name, const std::function<void(std::FILE*)>& write) {
    errno = 0;
    try {
        write(file);
    } catch (const ToolError& error) {
        throw ToolError("cannot write " + name + ": " + error.what());
    }
    if (std::fflush(file) != 0 || std::ferror(file) != 0) failWithErrno("cannot write " + name);
}

}  // namespace

fs::path followLinks(fs::path path) {
    std::error_code error;
    for (int links = 0; fs::is_symlink(fs::symlink_status(path, error)); ++links) {
        if (links == kMaxLinks)
            throw ToolError("cannot write " + inQuotes(path.string()) + ": too many links");
        const fs::path target = fs::read_symlink(path, error);
        if (error) throw ToolError("cannot write " + inQuotes(path.string()) + ": " + error.message());
        path = path.parent_path() / target;
    }
    return path;
}

std::string readFile(const std::string& path, size_t maxBytes) {
    const bool standard = path == "-";
    const std::string name = standard ? "standard input" : inQuotes(path);
    const File file(standard ? stdin : std::fopen(path.c_str(), "rb"));
    if (!file) failWithErrno("cannot read " + name);
    std::string bytes(maxBytes + 1, '\0');
    bytes.resize(std::fread(bytes.data(), 1, bytes.size(), file.get()));
    if (std::ferror(file.get()) != 0) failWithErrno("cannot read " + name);
    if (bytes.size() > maxBytes) {
        throw ToolError(name + " is longer than " + std::to_string(maxBytes) + " bytes");
    }
    return bytes;
}

void writeFile(const std::string& path, const std::function<void(std::FILE*)>& write) {
    if (path == "-") return fill(stdout, "standard output", write);
    std::error_code ignored;
    if (fs::exists(path, ignored) && !fs::is_regular_file(path, ignored)) {
        const File device(std::fopen(path.c_str(), "wb"));
        if (!device) failWithErrno("cannot write " + inQuotes(path));
        return fill(device.get(), inQuotes(path), write);
    }
    NewFile file(followLinks(path));
    fill(file.get(), inQuotes(path), write);
    file.finish();
}

}  // namespace vorelpaint
