#include "file_io.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <memory>

#include "error.h"
#include "interrupt.h"

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

[[noreturn]] void failWithErrno(const std::string& what) {
    throw ToolError(what + ": " + std::strerror(errno));
}

std::string inQuotes(const fs::path& path) {
    return "'" + path.string() + "'";
}

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

/// A replaced file's permissions stay; a new file has what the process's mask allows.
mode_t modeFor(const fs::path& target) {
    struct stat replaced {};
    if (::stat(target.c_str(), &replaced) == 0) return replaced.st_mode & 07777;
    const mode_t mask = ::umask(0);
    ::umask(mask);
    return 0666 & ~mask;
}

/// A file under a passing name in the directory of its target; gone again unless renamed, also when a
/// signal ends the program.
class TemporaryFile {
  public:
    explicit TemporaryFile(const fs::path& target)
        : mTarget(target), mName((target.parent_path() / ".vorelpaint.XXXXXX").string()) {
        const mode_t mode = modeFor(target);
        const int descriptor = make();
        ::fchmod(descriptor, mode);  // mkstemp makes the file private
        mFile.reset(::fdopen(descriptor, "wb"));
        if (mFile) return;
        const int fault = errno;
        ::close(descriptor);
        remove();
        errno = fault;
        failWithErrno("cannot write " + inQuotes(target));
    }

    ~TemporaryFile() {
        if (!mRenamed) remove();
    }

    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;

    std::FILE* get() const { return mFile.get(); }

    void renameToTarget() {
        mFile.reset();
        const HeldSignals held;
        if (std::rename(mName.c_str(), mTarget.c_str()) != 0) {
            failWithErrno("cannot write " + inQuotes(mTarget));
        }
        setUnfinishedFile("");
        mRenamed = true;
    }

  private:
    int make() {
        const HeldSignals held;
        const int descriptor = ::mkstemp(mName.data());
        if (descriptor < 0) failWithErrno("cannot write " + inQuotes(mTarget));
        setUnfinishedFile(mName);
        return descriptor;
    }

    void remove() const {
        const HeldSignals held;
        ::unlink(mName.c_str());
        setUnfinishedFile("");
    }

    fs::path mTarget;
    std::string mName;
    File mFile;
    bool mRenamed = false;
};

/// Where a path leads: the target of a symbolic link is made or replaced, not the link.
fs::path followLinks(fs::path path) {
    std::error_code error;
    for (int links = 0; fs::is_symlink(fs::symlink_status(path, error)); ++links) {
        if (links == kMaxLinks) throw ToolError("cannot write " + inQuotes(path) + ": too many links");
        const fs::path target = fs::read_symlink(path, error);
        if (error) throw ToolError("cannot write " + inQuotes(path) + ": " + error.message());
        path = path.parent_path() / target;
    }
    return path;
}

}  // namespace

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
    TemporaryFile temporary(followLinks(path));
    fill(temporary.get(), inQuotes(path), write);
    temporary.renameToTarget();
}

}  // namespace vorelpaint
