#include "new_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <string>
#include <utility>

#include "error.h"
#include "interrupt.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

/// What the passing names begin with of a file that becomes `target`.
std::string passingName(const fs::path& target) {
    return (target.parent_path() / ".vorelpaint.").string();
}

/// A replaced file's permissions stay; a new file has what the process's mask allows.
mode_t modeFor(const fs::path& target) {
    struct stat replaced {};
    if (::stat(target.c_str(), &replaced) == 0) return replaced.st_mode & 07777;
    const mode_t mask = ::umask(0);
    ::umask(mask);
    return 0666 & ~mask;
}

/// Where the system shows an open file under a name that a file without one can be linked from.
std::string shownName(int descriptor) {
    return "/proc/self/fd/" + std::to_string(descriptor);
}

void removeKeepingErrno(const std::string& name) {
    const int fault = errno;
    ::unlink(name.c_str());
    errno = fault;
}

}  // namespace

NewFile::NewFile(fs::path target, Kind kind) : mTarget(std::move(target)) {
    const mode_t mode = modeFor(mTarget);
    int descriptor = kind == Kind::unnamed ? openUnnamed() : -1;
    if (descriptor < 0) descriptor = openNamed();
    ::fchmod(descriptor, mode);  // it was made private
    mFile.reset(::fdopen(descriptor, "wb"));
    if (mFile) return;
    const int fault = errno;
    ::close(descriptor);
    removePassing();
    errno = fault;
    fail();
}

NewFile::~NewFile() {
    removePassing();
}

void NewFile::removePassing() const {
    if (mPassingName.empty()) return;
    const HeldSignals held;
    ::unlink(mPassingName.c_str());
    setUnfinishedFile("");
}

/// -1 where there are no such files, or no way to give them a name.
int NewFile::openUnnamed() const {
    const fs::path parent = mTarget.parent_path();
    const int descriptor =
        ::open(parent.empty() ? "." : parent.c_str(), O_TMPFILE | O_WRONLY | O_CLOEXEC, 0600);
    if (descriptor < 0 || ::access(shownName(descriptor).c_str(), F_OK) == 0) return descriptor;
    ::close(descriptor);
    return -1;
}

int NewFile::openNamed() {
    std::string name = passingName(mTarget) + "XXXXXX";
    const HeldSignals held;
    const int descriptor = ::mkstemp(name.data());
    if (descriptor < 0) fail();
    setUnfinishedFile(name);
    mPassingName = name;
    return descriptor;
}

void NewFile::finish() {
    if (kind() == Kind::unnamed) {
        link();
        mFile.reset();
    } else {
        // Some file systems report only now that there is no space.
        if (std::fclose(mFile.release()) != 0) fail();
        rename();
    }
}

/// No system call links over an older file. To replace one in one step the new one takes a passing name
/// for an instant, in which no signal is let in.
void NewFile::link() const {
    const std::string shown = shownName(::fileno(mFile.get()));
    const auto linkTo = [&](const std::string& name) {
        return ::linkat(AT_FDCWD, shown.c_str(), AT_FDCWD, name.c_str(), AT_SYMLINK_FOLLOW) == 0;
    };
    const std::string begin = passingName(mTarget) + std::to_string(::getpid()) + ".";
    const HeldSignals held;
    if (linkTo(mTarget.string())) return;
    for (int attempt = 0; errno == EEXIST; ++attempt) {
        const std::string passing = begin + std::to_string(attempt);
        if (!linkTo(passing)) continue;
        if (std::rename(passing.c_str(), mTarget.c_str()) == 0) return;
        removeKeepingErrno(passing);
        break;
    }
    fail();
}

void NewFile::rename() {
    const HeldSignals held;
    if (std::rename(mPassingName.c_str(), mTarget.c_str()) != 0) fail();
    setUnfinishedFile("");
    mPassingName.clear();
}

void NewFile::fail() const {
    failWithErrno("cannot write " + inQuotes(mTarget.string()));
}

}  // namespace vorelpaint
