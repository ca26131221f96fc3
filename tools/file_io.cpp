#include "file_io.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <memory>

#include "error.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

struct Closer {
    void operator()(std::FILE* file) const {
        if (file != stdin) std::fclose(file);
    }
};
using File = std::unique_ptr<std::FILE, Closer>;

[[noreturn]] void failWithErrno(const std::string& what) {
    throw ToolError(what + ": " + std::strerror(errno));
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

/// A file under a passing name in the directory of its target; gone again unless renamed.
class TemporaryFile {
  public:
    explicit TemporaryFile(const fs::path& target)
        : mTarget(target),
          mName((target.parent_path() / ("." + target.filename().string() + ".XXXXXX")).string()) {
        const int descriptor = ::mkstemp(mName.data());
        if (descriptor < 0) failWithErrno("cannot write " + target.string());
        // mkstemp makes the file private; a new file has what the process's mask allows.
        const mode_t mask = ::umask(0);
        ::umask(mask);
        ::fchmod(descriptor, 0666 & ~mask);
        mFile.reset(::fdopen(descriptor, "wb"));
    }

    ~TemporaryFile() {
        if (!mRenamed) ::unlink(mName.c_str());
    }

    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;

    std::FILE* get() const { return mFile.get(); }

    void renameToTarget() {
        mFile.reset();
        if (std::rename(mName.c_str(), mTarget.c_str()) != 0) {
            failWithErrno("cannot write " + mTarget.string());
        }
        mRenamed = true;
    }

  private:
    fs::path mTarget;
    std::string mName;
    File mFile;
    bool mRenamed = false;
};

/// Where a path leads: the target of a symbolic link is replaced, not the link.
fs::path followLinks(const std::string& path) {
    std::error_code error;
    fs::path target = fs::canonical(path, error);
    return error ? fs::path(path) : target;
}

}  // namespace

std::string readFile(const std::string& path, size_t maxBytes) {
    const bool standard = path == "-";
    const std::string name = standard ? "standard input" : "'" + path + "'";
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
    const fs::path target = followLinks(path);
    std::error_code ignored;
    if (fs::exists(target, ignored) && !fs::is_regular_file(target, ignored)) {
        const File device(std::fopen(target.c_str(), "wb"));
        if (!device) failWithErrno("cannot write " + path);
        return fill(device.get(), path, write);
    }
    TemporaryFile temporary(target);
    fill(temporary.get(), path, write);
    temporary.renameToTarget();
}

}  // namespace vorelpaint
