#include "child_program.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstdint>

#include "error.h"

namespace vorelpaint {
namespace {

/// As large as a process without privileges may make it: fewer turns between the two programs.
constexpr int kPipeBytes = 1 << 20;
constexpr size_t kMaxComplaintBytes = 4096;
constexpr int kNotStarted = 127;

struct Pipe {
    int reading;
    int writing;
};

Pipe openPipe() {
    std::array<int, 2> ends{};
    if (::pipe2(ends.data(), O_CLOEXEC) != 0) failWithErrno("cannot make a pipe");
    return {ends[0], ends[1]};
}

void closeIfOpen(int& descriptor) {
    if (descriptor >= 0) ::close(descriptor);
    descriptor = -1;
}

/// In the child: the same file under a number that none of the program to come has.
int aside(int file) {
    constexpr int kFirstFree = 16;
    return ::fcntl(file, F_DUPFD_CLOEXEC, kFirstFree);
}

/// The reason why the program could not be started, from the pipe that its start closes; 0 when it was.
int reasonIn(int report) {
    int reason = 0;
    const ssize_t count = ::read(report, &reason, sizeof reason);
    return count == static_cast<ssize_t>(sizeof reason) ? reason : 0;
}

std::string partOf(int file, off_t begin) {
    std::string text(kMaxComplaintBytes, '\0');
    const ssize_t count = ::pread(file, text.data(), text.size(), begin);
    text.resize(static_cast<size_t>(std::max<ssize_t>(count, 0)));
    return text;
}

std::string startOf(int file) {
    return partOf(file, 0);
}

std::string endOf(int file) {
    return partOf(file, std::max<off_t>(::lseek(file, 0, SEEK_END) - off_t{kMaxComplaintBytes}, 0));
}

/// As a program is given them: they stay those of `words`.
std::vector<char*> pointersTo(std::vector<std::string>& words) {
    std::vector<char*> pointers;
    pointers.reserve(words.size() + 1);
    for (std::string& word : words)
        pointers.push_back(word.data());
    pointers.push_back(nullptr);
    return pointers;
}

/// Without what FFmpeg writes before a complaint, the name and the address of a part of it:
/// "[mov @ 0x55d3286aa480] ".
std::string withoutOrigin(const std::string& line) {
    const size_t end = line.find("] ");
    const bool hasOrigin = line.rfind('[', 0) == 0 && line.find(" @ 0x") < end;
    return hasOrigin && end != std::string::npos ? line.substr(end + 2) : line;
}

}  // namespace

ChildProgram::ChildProgram(std::vector<std::string> words, Stream stream, int given)
    : mName(words.front()), mErrors(::memfd_create("errors", MFD_CLOEXEC)) {
    if (mErrors < 0) failWithErrno("cannot run " + mName);
    const Pipe data = openPipe();
    Pipe report = openPipe();
    const bool feeds = stream == Stream::input;
    mStream = feeds ? data.writing : data.reading;
    int theirs = feeds ? data.reading : data.writing;
    ::fcntl(mStream, F_SETPIPE_SZ, kPipeBytes);

    const std::vector<char*> pointers = pointersTo(words);  // the child must not ask for memory
    const pid_t parent = ::getpid();
    mChild = ::fork();
    if (mChild == 0) {
        ::prctl(PR_SET_PDEATHSIG, SIGKILL);
        if (::getppid() == parent) become(pointers.data(), stream, theirs, given, report.writing);
        ::_exit(kNotStarted);
    }
    const int fault = errno;
    closeIfOpen(theirs);
    closeIfOpen(report.writing);
    const int reason = mChild < 0 ? fault : reasonIn(report.reading);
    closeIfOpen(report.reading);
    if (reason != 0) failToStart(reason);
}

void ChildProgram::failToStart(int reason) {
    waitForEnd();
    closeIfOpen(mStream);
    closeIfOpen(mErrors);
    if (reason == ENOENT)
        throw ToolError("there is no " + mName + ": films are made by FFmpeg, which is not installed");
    errno = reason;
    failWithErrno("cannot run " + mName);
}

void ChildProgram::become(char* const* words, Stream stream, int theirs, int given, int report) const {
    const int nowhere = aside(::open("/dev/null", O_RDWR | O_CLOEXEC));
    const int data = aside(theirs);
    const int errors = aside(mErrors);
    const int kept = aside(given);
    const int told = aside(report);
    sigset_t none;
    sigemptyset(&none);
    ::sigprocmask(SIG_SETMASK, &none, nullptr);
    const bool feeds = stream == Stream::input;
    const bool isReady = ::dup2(feeds ? data : nowhere, STDIN_FILENO) >= 0 &&
                         ::dup2(feeds ? nowhere : data, STDOUT_FILENO) >= 0 &&
                         ::dup2(errors, STDERR_FILENO) >= 0 &&
                         (given < 0 || ::dup2(kept, kGivenFile) >= 0);
    if (isReady) ::execvp(words[0], words);
    const int reason = errno;
    [[maybe_unused]] const ssize_t count = ::write(told, &reason, sizeof reason);
}

ChildProgram::~ChildProgram() {
    if (mChild > 0) ::kill(mChild, SIGKILL);
    waitForEnd();
    closeIfOpen(mStream);
    closeIfOpen(mErrors);
}

bool ChildProgram::write(const void* bytes, size_t size) {
    const auto* next = static_cast<const uint8_t*>(bytes);
    while (size > 0) {
        const ssize_t count = ::write(mStream, next, size);
        if (count < 0 && errno == EINTR) continue;
        if (count < 0 && errno == EPIPE) return false;
        if (count < 0) failWithErrno("cannot write to " + mName);
        next += count;
        size -= static_cast<size_t>(count);
    }
    return true;
}

std::string ChildProgram::readAll(size_t maxBytes) {
    std::string text;
    std::array<char, 4096> buffer{};
    while (true) {
        const ssize_t count = ::read(mStream, buffer.data(), buffer.size());
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) failWithErrno("cannot read from " + mName);
        if (count == 0) return text;
        text.append(buffer.data(), static_cast<size_t>(count));
        if (text.size() > maxBytes) throw ToolError(mName + " tells too much");
    }
}

void ChildProgram::finish(const std::vector<std::string>& faults) {
    closeIfOpen(mStream);
    const int status = waitForEnd();
    if (WIFSIGNALED(status)) {
        throw ToolError(mName + " was ended by signal " + std::to_string(WTERMSIG(status)));
    }
    if (WEXITSTATUS(status) != 0) throw ToolError(mName + " failed: " + complaint());
    const std::string fault = complaintAmong(faults);
    if (!fault.empty()) throw ToolError(mName + " failed: " + fault);
}

int ChildProgram::waitForEnd() {
    int status = 0;
    while (mChild > 0 && ::waitpid(mChild, &status, 0) < 0 && errno == EINTR) {
    }
    mChild = -1;
    return status;
}

std::string ChildProgram::complaint() const {
    const std::string text = startOf(mErrors);
    const size_t begin = text.find_first_not_of("\r\n");
    if (begin == std::string::npos) return "it does not say why";
    const size_t end = std::min(text.find_first_of("\r\n", begin), text.size());
    return withoutOrigin(text.substr(begin, end - begin));
}

std::string ChildProgram::complaintAmong(const std::vector<std::string>& faults) const {
    const std::string text = faults.empty() ? "" : endOf(mErrors);
    for (size_t at = 0; at < text.size();) {
        const size_t end = std::min(text.find_first_of("\r\n", at), text.size());
        std::string line = withoutOrigin(text.substr(at, end - at));
        const auto begins = [&](const std::string& fault) { return line.rfind(fault, 0) == 0; };
        if (std::any_of(faults.begin(), faults.end(), begins)) return line;
        at = end + 1;
    }
    return "";
}

}  // namespace vorelpaint
