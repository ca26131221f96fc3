#include "file_io.h"

#include <unistd.h>

#include <cerrno>
#include <charconv>
#include <cstring>
#include <memory>
#include <system_error>

#include "compose/system/file_bytes.h"
#include "error.h"
#include "new_file.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

constexpr int kMaxLinks = 40;

struct Closer {
    void operator()(std::FILE* file) const { std::fclose(file); }
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

/// The path that a link leads to, or nothing where there is no link.
std::optional<fs::path> linkAt(const fs::path& path) {
    std::error_code error;
    if (!fs::is_symlink(fs::symlink_status(path, error))) return std::nullopt;
    const fs::path target = fs::read_symlink(path, error);
    if (error) throw ToolError("cannot write " + inQuotes(path.string()) + ": " + error.message());
    return path.parent_path() / target;
}

/// Writes into a file that is open already, at its place. Its own descriptor stays open.
void writeInto(int descriptor, const std::string& name, const std::function<void(std::FILE*)>& write) {
    const int twin = ::dup(descriptor);
    const File file(twin < 0 ? nullptr : ::fdopen(twin, "wb"));
    if (!file) failWithErrno("cannot write " + name);
    fill(file.get(), name, write);
}

}  // namespace

std::optional<int> openFileOf(const fs::path& path) {
    std::error_code error;
    const fs::path shown = fs::canonical("/proc/self/fd", error);
    if (error || fs::canonical(path.parent_path(), error) != shown) return std::nullopt;
    const std::string number = path.filename().string();
    const char* end = number.data() + number.size();
    int descriptor = 0;
    const auto [stop, fault] = std::from_chars(number.data(), end, descriptor);
    if (fault != std::errc{} || stop != end) return std::nullopt;
    return descriptor;
}

fs::path followLinks(fs::path path) {
    for (int links = 0; !openFileOf(path); ++links) {
        const std::optional<fs::path> next = linkAt(path);
        if (!next) break;
        if (links == kMaxLinks)
            throw ToolError("cannot write " + inQuotes(path.string()) + ": too many links");
        path = *next;
    }
    return path;
}

bool isStandardOutput(const std::string& path) {
    return path == "-" || openFileOf(followLinks(path)) == STDOUT_FILENO;
}

std::string readFileOrInput(const std::string& path, size_t maxBytes) {
    if (path == "-") return vorelcompose::readAll(stdin, "standard input", maxBytes);
    return vorelcompose::readFile(path, maxBytes);
}

void writeFile(const std::string& path, const std::function<void(std::FILE*)>& write) {
    if (path == "-") return fill(stdout, "standard output", write);
    const fs::path target = followLinks(path);
    if (const std::optional<int> open = openFileOf(target)) {
        return writeInto(*open, inQuotes(path), write);
    }
    std::error_code ignored;
    if (fs::exists(path, ignored) && !fs::is_regular_file(path, ignored)) {
        const File device(std::fopen(path.c_str(), "wb"));
        if (!device) failWithErrno("cannot write " + inQuotes(path));
        return fill(device.get(), inQuotes(path), write);
    }
    NewFile file(target);
    fill(file.get(), inQuotes(path), write);
    file.finish();
}

void writeFile(const std::string& path, const std::vector<uint8_t>& bytes) {
    writeFile(path, [&](std::FILE* file) { writeAll(file, bytes); });
}

void writeAll(std::FILE* file, const std::vector<uint8_t>& bytes) {
    const size_t written = std::fwrite(bytes.data(), 1, bytes.size(), file);
    if (written != bytes.size()) throw ToolError(std::strerror(errno));
}

}  // namespace vorelpaint
