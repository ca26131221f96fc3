#include "interrupt.h"

#include <unistd.h>

#include <array>
#include <climits>
#include <cstring>

#include "console.h"

namespace vorelpaint {
namespace {

constexpr std::array<int, 3> kSignals{SIGINT, SIGTERM, SIGHUP};

/// A plain array: the handler must not touch anything that could be half-changed.
std::array<char, PATH_MAX> gUnfinished{};

sigset_t heldSet() {
    sigset_t set;
    sigemptyset(&set);
    for (const int number : kSignals)
        sigaddset(&set, number);
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
    struct sigaction action {};
    action.sa_handler = cleanUp;
    action.sa_mask = heldSet();
    action.sa_flags = static_cast<int>(SA_RESETHAND);
    for (const int number : kSignals) {
        struct sigaction before {};
        ::sigaction(number, nullptr, &before);
        if (before.sa_handler != SIG_IGN) ::sigaction(number, &action, nullptr);
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
