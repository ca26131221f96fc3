#include "program.h"

#include <fcntl.h>
#include <linux/filter.h>
#include <linux/seccomp.h>
#include <pty.h>
#include <sys/ioctl.h>
#include <sys/prctl.h>
#include <sys/resource.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstddef>
#include <cstdlib>
#include <fstream>
#include <iterator>

namespace vorel_test {

namespace fs = std::filesystem;

namespace {

void redirect(int descriptor, const std::string& path, int flags) {
    const int file = ::open(path.c_str(), flags, 0600);
    if (file < 0 || ::dup2(file, descriptor) < 0) ::_exit(127);
    ::close(file);
}

/// From now on this program answers system calls of this process.
template <size_t kSteps>
void answerSystemCalls(std::array<sock_filter, kSteps> code) {
    const sock_fprog program{static_cast<unsigned short>(kSteps), code.data()};
    if (::prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0) != 0 ||
        ::prctl(PR_SET_SECCOMP, SECCOMP_MODE_FILTER, &program) != 0) {
        ::_exit(127);
    }
}

constexpr auto kCallNumber = static_cast<unsigned int>(offsetof(seccomp_data, nr));

/// From now on openat answers as a file system without unnamed files does.
void refuseUnnamedFiles() {
    constexpr auto kFlags = static_cast<unsigned int>(offsetof(seccomp_data, args) + 2 * sizeof(__u64));
    constexpr unsigned int kUnnamed = static_cast<unsigned int>(O_TMPFILE) & ~unsigned{O_DIRECTORY};
    answerSystemCalls<6>({{
        BPF_STMT(BPF_LD | BPF_W | BPF_ABS, kCallNumber),
        BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, SYS_openat, 0, 3),
        BPF_STMT(BPF_LD | BPF_W | BPF_ABS, kFlags),
        BPF_JUMP(BPF_JMP | BPF_JSET | BPF_K, kUnnamed, 0, 1),
        BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ERRNO | EOPNOTSUPP),
        BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW),
    }});
}

/// Makes them those of this process.
void enter(const Surroundings& surroundings) {
    // The handlers of a sanitizer would take a signal that is sent for a fault.
    const char* options = std::getenv("ASAN_OPTIONS");
    const std::string own =
        "handle_segv=0:handle_sigbus=0:handle_sigfpe=0:handle_sigill=0:handle_sigtrap=0:handle_abort=0";
    ::setenv("ASAN_OPTIONS", options == nullptr ? own.c_str() : (options + (":" + own)).c_str(), 1);
    const rlimit noCore{0, 0};
    ::setrlimit(RLIMIT_CORE, &noCore);  // some of the signals that tests send would write one
    if (surroundings.ignoredSignal != 0) std::signal(surroundings.ignoredSignal, SIG_IGN);
    if (surroundings.largestFile != 0) {
        const rlimit limit{surroundings.largestFile, surroundings.largestFile};
        if (::setrlimit(RLIMIT_FSIZE, &limit) != 0) ::_exit(127);
    }
    if (surroundings.addressSpace != 0) {
        const rlimit limit{surroundings.addressSpace, surroundings.addressSpace};
        if (::setrlimit(RLIMIT_AS, &limit) != 0) ::_exit(127);
    }
    if (surroundings.missingStream >= 0) ::close(surroundings.missingStream);
    if (surroundings.closedOutput) {
        std::array<int, 2> ends{};
        if (::pipe(ends.data()) != 0 || ::dup2(ends[1], STDOUT_FILENO) < 0) ::_exit(127);
        ::close(ends[0]);
        ::close(ends[1]);
    }
    if (!surroundings.unnamedFiles) refuseUnnamedFiles();
}

/// Becomes vorelpaint; does not return.
[[noreturn]] void execVorelpaint(const std::vector<std::string>& arguments) {
    std::vector<std::string> words{VORELPAINT_BINARY};
    words.insert(words.end(), arguments.begin(), arguments.end());
    std::vector<char*> argv;
    for (std::string& word : words)
        argv.push_back(word.data());
    argv.push_back(nullptr);
    ::execv(argv[0], argv.data());
    ::_exit(127);
}

int exitCodeOf(pid_t child) {
    int status = 0;
    ::waitpid(child, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

int runRedirected(const std::vector<std::string>& arguments, const std::string& in,
                  const std::string& out, const std::string& err,
                  const Surroundings& surroundings = {}) {
    const pid_t child = ::fork();
    if (child == 0) {
        redirect(STDIN_FILENO, in, O_RDONLY);
        redirect(STDOUT_FILENO, out, O_WRONLY | O_CREAT);
        redirect(STDERR_FILENO, err, O_WRONLY | O_CREAT);
        enter(surroundings);
        execVorelpaint(arguments);
    }
    return exitCodeOf(child);
}

/// What is written to a terminal until its last user closes it.
std::string readTerminal(int master) {
    std::string text;
    std::array<char, 4096> buffer{};
    for (ssize_t count = 0; (count = ::read(master, buffer.data(), buffer.size())) > 0;)
        text.append(buffer.data(), static_cast<size_t>(count));
    return text;
}

}  // namespace

Outcome runVorelpaint(const std::vector<std::string>& arguments, const std::string& input) {
    const TempDir dir;
    const int exitCode =
        runRedirected(arguments, dir.write("in", input), dir.file("out"), dir.file("err"));
    return {exitCode, readBytes(dir.file("out")), readBytes(dir.file("err"))};
}

Outcome runVorelpaintOnTerminal(const std::vector<std::string>& arguments, int columns) {
    const TempDir dir;
    winsize size{};
    size.ws_row = 24;
    size.ws_col = static_cast<unsigned short>(columns);
    int master = -1;
    const pid_t child = ::forkpty(&master, nullptr, nullptr, &size);
    if (child == 0) {
        redirect(STDIN_FILENO, "/dev/null", O_RDONLY);
        redirect(STDOUT_FILENO, dir.file("out"), O_WRONLY | O_CREAT);
        execVorelpaint(arguments);
    }
    const std::string drawn = readTerminal(master);
    ::close(master);
    const int exitCode = exitCodeOf(child);
    return {exitCode, readBytes(dir.file("out")), drawn};
}

Outcome runVorelpaintIn(const Surroundings& surroundings, const std::vector<std::string>& arguments) {
    const TempDir dir;
    const int exitCode =
        runRedirected(arguments, "/dev/null", dir.file("out"), dir.file("err"), surroundings);
    return {exitCode, readBytes(dir.file("out")), readBytes(dir.file("err"))};
}

RunningVorelpaint::RunningVorelpaint(const std::vector<std::string>& arguments,
                                     const Surroundings& surroundings)
    : mChild(::fork()) {
    if (mChild != 0) return;
    redirect(STDIN_FILENO, "/dev/null", O_RDONLY);
    redirect(STDOUT_FILENO, "/dev/null", O_WRONLY);
    redirect(STDERR_FILENO, "/dev/null", O_WRONLY);
    enter(surroundings);
    execVorelpaint(arguments);
}

RunningVorelpaint::~RunningVorelpaint() {
    if (mChild < 0) return;
    ::kill(mChild, SIGKILL);
    wait();
}

void RunningVorelpaint::send(int signal) const {
    ::kill(mChild, signal);
}

bool RunningVorelpaint::freeze() const {
    send(SIGSTOP);
    siginfo_t info{};
    ::waitid(P_PID, static_cast<id_t>(mChild), &info, WSTOPPED | WEXITED | WNOWAIT);
    return info.si_code == CLD_STOPPED;
}

void RunningVorelpaint::thaw() const {
    send(SIGCONT);
}

bool RunningVorelpaint::isWritingIn(const fs::path& directory) const {
    const std::string begin = (directory / ".vorelpaint.").string();
    const std::string unnamed = (directory / "#").string();
    std::error_code ended;
    for (const fs::directory_entry& open :
         fs::directory_iterator("/proc/" + std::to_string(mChild) + "/fd", ended)) {
        const std::string path = fs::read_symlink(open.path(), ended).string();
        if (path.rfind(begin, 0) == 0 || path.rfind(unnamed, 0) == 0) return true;
    }
    return false;
}

bool RunningVorelpaint::hasEnded() const {
    siginfo_t info{};
    ::waitid(P_PID, static_cast<id_t>(mChild), &info, WEXITED | WNOHANG | WNOWAIT);
    return info.si_pid != 0;
}

int RunningVorelpaint::wait() {
    int status = 0;
    ::waitpid(mChild, &status, 0);
    mChild = -1;
    return status;
}

void refuseToClose() {
    answerSystemCalls<4>({{
        BPF_STMT(BPF_LD | BPF_W | BPF_ABS, kCallNumber),
        BPF_JUMP(BPF_JMP | BPF_JEQ | BPF_K, SYS_close, 0, 1),
        BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ERRNO | ENOSPC),
        BPF_STMT(BPF_RET | BPF_K, SECCOMP_RET_ALLOW),
    }});
}

Outcome runVorelpaintInto(const std::string& outPath, const std::vector<std::string>& arguments) {
    const TempDir dir;
    const int exitCode = runRedirected(arguments, "/dev/null", outPath, dir.file("err"));
    return {exitCode, "", readBytes(dir.file("err"))};
}

}  // namespace vorel_test
