#include "crew.h"

#include <malloc.h>
#include <poll.h>
#include <sched.h>
#include <sys/eventfd.h>
#include <sys/resource.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdint>
#include <utility>

#include "error.h"
#include "font_choice.h"
#include "interrupt.h"
#include "ranges.h"

namespace vorelpaint {
namespace {

/// Lets the C library keep the memory of one picture for the next instead of giving it back and having
/// it cleared: that takes as long as painting. Larger blocks than these, and more than that, go back.
void keepMemory() {
    constexpr int kLargestKept = 16 << 20;
    constexpr int kMostKept = 64 << 20;
    ::mallopt(M_MMAP_THRESHOLD, kLargestKept);
    ::mallopt(M_TRIM_THRESHOLD, kMostKept);
}

/// Those that it may run on: a job of a cluster has some of its machine's.
int coresOfThisProcess() {
    cpu_set_t cores;
    if (::sched_getaffinity(0, sizeof cores, &cores) == 0) return CPU_COUNT(&cores);
    return static_cast<int>(std::thread::hardware_concurrency());
}

/// As many of the threads as there is room for where a process may map so much and no more: each has a
/// stack, a heap and pictures of its own, and libraries that are refused memory may crash.
int threadsWithRoom(int threads) {
    constexpr rlim_t kRoomOfOne = rlim_t{256} << 20;
    rlimit space{};
    if (::getrlimit(RLIMIT_AS, &space) != 0 || space.rlim_cur == RLIM_INFINITY) return threads;
    return static_cast<int>(std::min(static_cast<rlim_t>(threads), space.rlim_cur / kRoomOfOne));
}

}  // namespace

int threadsFor(const Options& options) {
    return options.jobs.value_or(std::clamp(coresOfThisProcess(), kJobs.low, kJobs.high));
}

Crew::Crew(int asked) {
    keepMemory();
    const int threads = asked < 2 ? asked : threadsWithRoom(asked);
    if (threads < 2) return;
    loadInstalledFonts();
    mDone = ::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK);
    if (mDone < 0) failWithErrno("cannot start threads");
    mThreads.reserve(static_cast<size_t>(threads));
    try {
        for (int i = 0; i < threads; ++i)
            startThread();
    } catch (const std::exception&) {  // the system has no more of them, or no memory for them
    }
    mMost = std::max(size_t{1}, 2 * mThreads.size());
}

Crew::~Crew() {
    {
        const std::lock_guard<std::mutex> alone(mMutex);
        mIsOver = true;
    }
    mChange.notify_all();
    for (std::thread& thread : mThreads)
        thread.join();
    if (mDone >= 0) ::close(mDone);
}

/// A thread holds the signals that are held where it is started.
void Crew::startThread() {
    const HeldSignals held;
    mThreads.emplace_back([this] { work(); });
}

void Crew::perform(Given& given, Workbench& bench) {
    try {
        given.task(bench);
    } catch (...) {
        given.fault = std::current_exception();
    }
}

void Crew::work() {
    Workbench bench;
    std::unique_lock<std::mutex> alone(mMutex);
    while (true) {
        mChange.wait(alone, [this] { return mIsOver || !mWaiting.empty(); });
        if (mIsOver) return;
        const std::shared_ptr<Given> given = std::move(mWaiting.front());
        mWaiting.pop_front();
        alone.unlock();
        perform(*given, bench);
        alone.lock();
        given->isDone = true;
        const uint64_t one = 1;
        [[maybe_unused]] const ssize_t written = ::write(mDone, &one, sizeof one);
    }
}

void Crew::give(Task task) {
    auto given = std::make_shared<Given>();
    given->task = std::move(task);
    mTasks.push_back(given);
    if (mThreads.empty()) {
        perform(*given, mBench);
        given->isDone = true;
        return;
    }
    try {
        const std::lock_guard<std::mutex> alone(mMutex);
        mWaiting.push_back(given);
    } catch (...) {  // nobody would ever do it
        mTasks.pop_back();
        throw;
    }
    mChange.notify_one();
}

bool Crew::isDone(const Given& given) const {
    const std::lock_guard<std::mutex> alone(mMutex);
    return given.isDone;
}

bool Crew::isFirstDone() const {
    return isDone(*mTasks.front());
}

void Crew::wait(int input) const {
    waitFor(*mTasks.front(), input);
}

void Crew::waitForAll() const {
    for (const std::shared_ptr<Given>& given : mTasks)
        waitFor(*given);
}

void Crew::waitFor(const Given& given, int input) const {
    while (!isDone(given)) {
        // poll() passes over descriptors below 0.
        std::array<pollfd, 2> events{{{mDone, POLLIN, 0}, {input, POLLIN, 0}}};
        if (::poll(events.data(), events.size(), -1) < 0 && errno != EINTR) failWithErrno("cannot wait");
        uint64_t count = 0;
        if (events[0].revents != 0) {
            [[maybe_unused]] const ssize_t ignored = ::read(mDone, &count, sizeof count);
        }
        if (events[1].revents != 0) return;
    }
}

void Crew::take() {
    wait();
    const std::shared_ptr<Given> given = std::move(mTasks.front());
    mTasks.pop_front();
    if (given->fault) std::rethrow_exception(given->fault);
}

}  // namespace vorelpaint
