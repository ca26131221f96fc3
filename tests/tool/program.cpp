#include "program.h"

#include <fcntl.h>
#include <pty.h>
#include <sys/ioctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <csignal>
#include <cstdlib>
#include <fstream>
#include <iterator>

namespace vorel_test {

namespace fs = std::filesystem;

TempDir::TempDir() {
    std::string name = (fs::temp_directory_path() / "vorelpaint_test.XXXXXX").string();
    if (::mkdtemp(name.data()) == nullptr) std::abort();
    mPath = name;
}

TempDir::~TempDir() {
    std::error_code ignored;
    fs::remove_all(mPath, ignored);
}

std::string TempDir::write(const std::string& name, const std::string& bytes) const {
    std::ofstream(mPath / name, std::ios::binary) << bytes;
    return file(name);
}

std::vector<std::string> TempDir::list() const {
    std::vector<std::string> names;
    for (const auto& entry : fs::directory_iterator(mPath)) {
        names.push_back(entry.path().filename().string());
    }
    std::sort(names.begin(), names.end());
    return names;
}

std::string readBytes(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

namespace {

void redirect(int descriptor, const std::string& path, int flags) {
    const int file = ::open(path.c_str(), flags, 0600);
    if (file < 0 || ::dup2(file, descriptor) < 0) ::_exit(127);
    ::close(file);
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
                  const std::string& out, const std::string& err) {
    const pid_t child = ::fork();
    if (child == 0) {
        redirect(STDIN_FILENO, in, O_RDONLY);
        redirect(STDOUT_FILENO, out, O_WRONLY | O_CREAT);
        redirect(STDERR_FILENO, err, O_WRONLY | O_CREAT);
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

RunningVorelpaint::RunningVorelpaint(const std::vector<std::string>& arguments, int ignored)
    : mChild(::fork()) {
    if (mChild != 0) return;
    redirect(STDIN_FILENO, "/dev/null", O_RDONLY);
    redirect(STDOUT_FILENO, "/dev/null", O_WRONLY);
    redirect(STDERR_FILENO, "/dev/null", O_WRONLY);
    if (ignored != 0) std::signal(ignored, SIG_IGN);
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

int RunningVorelpaint::wait() {
    int status = 0;
    ::waitpid(mChild, &status, 0);
    mChild = -1;
    return status;
}

Outcome runVorelpaintInto(const std::string& outPath, const std::vector<std::string>& arguments) {
    const TempDir dir;
    const int exitCode = runRedirected(arguments, "/dev/null", outPath, dir.file("err"));
    return {exitCode, "", readBytes(dir.file("err"))};
}

}  // namespace vorel_test
