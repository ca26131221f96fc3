#include "interrupt.h"

#include <unistd.h>

#include <array>
#include <climits>
#include <cstring>

#include "console.h"

namespace vorelpaint {
namespace {

/// A plain array: the handler must not touch anything that could be half-changed.
std::array<char, PATH_MAX> gUnfinished{};

/// The signals that end no program, or that no program can do anything about. All others do when they
/// find no handler.
constexpr std::array<int, 9> kHarmless{SIGKILL, SIGSTOP, SIGTSTP, SIGTTIN, SIGTTOU,
                                       SIGCONT, SIGCHLD, SIGURG,  SIGWINCH};

bool isErrorOfWriting(int number) {
    return number == SIGPIPE || number == SIGXFSZ;
}

sigset_t heldSet() {
    sigset_t set;
    sigfillset(&set);
    for (const int number : kHarmless)
        sigdelset(&set, number);
    return set;
}

/// The raised signal arrives when the handler returns, and its default action ends the program.
extern "C" void cleanUp(int number) {
    if (gUnfinished[0] != '\0') ::unlink(gUnfinished.data());
    eraseStatus();
    ::raise(number);
}

}  // namespace

void cleanUpOnSignals() {
    const sigset_t ending = heldSet();
    struct sigaction action {};
    action.sa_handler = cleanUp;
    action.sa_mask = ending;
    action.sa_flags = static_cast<int>(SA_RESETHAND);
    for (int number = 1; number <= SIGRTMAX; ++number) {
        if (sigismember(&ending, number) != 1) continue;
        struct sigaction before {};
        // Some have handlers already: a sanitizer's, for faults.
        if (::sigaction(number, nullptr, &before) != 0 || before.sa_handler != SIG_DFL) continue;
        if (isErrorOfWriting(number)) {
            std::signal(number, SIG_IGN);
        } else {
            ::sigaction(number, &action, nullptr);
        }
    }
}

HeldSignals::HeldSignals() {
    const sigset_t set = heldSet();
    ::pthread_sigmask(SIG_BLOCK, &set, &mBefore);
}

HeldSignals::~HeldSignals() {
    ::pthread_sigmask(SIG_SETMASK, &mBefore, nullptr);
}

void setUnfinishedFile(const std::string& path) {
    // No longer path than this can be opened.
    const size_t length = path.size() < gUnfinished.size() ? path.size() : 0;
    std::memcpy(gUnfinished.data(), path.data(), length);
    gUnfinished[length] = '\0';
}

}  // namespace vorelpaint
