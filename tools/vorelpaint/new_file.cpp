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

/// Gives a file, which was made private, to the owner and the group of the one that it replaces, as far
/// as this process may, with the permissions of that one; a new file has what the process's mask allows.
/// The right to act as the owner is not taken over: it would be that of whoever owns the file now.
void takePlaceOf(const fs::path& target, int descriptor) {
    constexpr mode_t kPermissions = S_IRWXU | S_IRWXG | S_IRWXO;
    struct stat replaced {};
    if (::stat(target.c_str(), &replaced) != 0) {
        const mode_t mask = ::umask(0);
        ::umask(mask);
        ::fchmod(descriptor, 0666 & ~mask);
        return;
    }
    // The group first: who has given a file away may not choose its group.
    [[maybe_unused]] int given = ::fchown(descriptor, static_cast<uid_t>(-1), replaced.st_gid);
    given = ::fchown(descriptor, replaced.st_uid, static_cast<gid_t>(-1));
    ::fchmod(descriptor, replaced.st_mode & kPermissions);
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
    int descriptor = kind == Kind::unnamed ? openUnnamed() : -1;
    if (descriptor < 0) descriptor = openNamed();
    takePlaceOf(mTarget, descriptor);
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
    mPassingName = std::move(name);
    return descriptor;
}

/// Some file systems report only when a file is closed that there is no space. An unnamed one must stay
/// open until it has its name; its twin is closed before.
void NewFile::finish() {
    if (kind() == Kind::unnamed) {
        const int twin = ::dup(::fileno(mFile.get()));
        if (twin < 0 || ::close(twin) != 0) fail();
        link();
        mFile.reset();
    } else {
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
