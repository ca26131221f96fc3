#include "console.h"

#include <fcntl.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <csignal>
#include <cstdio>
#include <iostream>
#include <string_view>

#include "error.h"
#include "style/vorelstyle.h"

namespace vorelpaint {
namespace {

constexpr size_t kUsualColumns = 80;
constexpr std::string_view kErase = "\r\x1B[K";

std::string gStatus;
volatile std::sig_atomic_t gStatusShown = 0;

size_t terminalWidth() {
    winsize size{};
    const bool known = ::ioctl(STDERR_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_col > 0;
    return known ? size.ws_col : kUsualColumns;
}

void drawStatus() {
    if (gStatus.empty()) return;
    gStatusShown = 1;
    std::cerr << gStatus.substr(0, terminalWidth() - 1) << std::flush;
}

}  // namespace

/// The lowest free number is always the one that is given.
void reserveStandardStreams() {
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
        if (::fcntl(stream, F_GETFD) >= 0) continue;
        const int direction = stream == STDIN_FILENO ? O_WRONLY : O_RDONLY;
        [[maybe_unused]] const int placeholder = ::open("/dev/null", direction);
    }
}

void print(const std::string& text) {
    const size_t written = std::fwrite(text.data(), 1, text.size(), stdout);
    if (written == text.size() && std::fflush(stdout) == 0) return;
    failWithErrno("cannot write standard output");
}

void say(const std::string& line) {
    eraseStatus();
    std::cerr << "vorelpaint: " << vorelstyle::printable(line) << '\n';
    drawStatus();
}

bool hasTerminal() {
    return ::isatty(STDERR_FILENO) == 1;
}

void showStatus(const std::string& line) {
    if (!hasTerminal()) return;
    eraseStatus();
    gStatus = line;
    drawStatus();
}

void eraseStatus() {
    if (gStatusShown == 0) return;
    gStatusShown = 0;
    // Nothing can be done about a terminal that is gone.
    [[maybe_unused]] const ssize_t written = ::write(STDERR_FILENO, kErase.data(), kErase.size());
}

}  // namespace vorelpaint
